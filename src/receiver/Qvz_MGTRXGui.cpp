#include "Qvz_MGTRXGui.h"

#include "Qvz_MGTRX.h"
#include "Qvz_MGTRXWidget.h"

Qvz_MGTRXGui::Qvz_MGTRXGui(Qvz_MGTRX* page, QWidget* parent)
    : Qvz_MGTPageGui(page, parent, kEntryCount, "qvz_mgtrx2"), m_pPage(page) {
    m_pForm = new Qvz_MGTRXWidget(nullptr, nullptr, false, {});
    SetPageForm("Receiver Setup", m_pForm);

    connect(m_pForm->bgDecodingButtons, &QButtonGroup::idClicked, this,
            &Qvz_MGTRXGui::OnRadioDecoding);
    connect(m_pForm->bgStaticDecodingControlButtons, &QButtonGroup::idClicked, this,
            &Qvz_MGTRXGui::OnRadio8b10bDecoding);
    connect(m_pForm->cbLossOfSync, &QCheckBox::toggled, this, &Qvz_MGTRXGui::OnCheckRxLossOfSync);
    connect(m_pForm->cbUseCRC, &QCheckBox::toggled, this, &Qvz_MGTRXGui::OnCheckUseCRC);

    SetupEntry(kAfeEq, m_pForm->leRXAFEEQ, "([01]){3}",
               "Please enter a valid 3-bit binary value for RXAFEEQ");
    SetupEntry(kCrcInit, m_pForm->leCRCinit, "([0-9A-Fa-f]){8}",
               "Please enter a valid 8-digit hex value for RXCRCINITVAL");
    ConnectEntries(this, &Qvz_MGTRXGui::ValidateLE_ALL);
}

Qvz_MGTRXGui::~Qvz_MGTRXGui() = default;

bool Qvz_MGTRXGui::ReadPage() {
    return m_pPage && m_pPage->ReadWizData();
}

bool Qvz_MGTRXGui::WritePage() {
    return m_pPage && m_pPage->WriteWizData();
}

void Qvz_MGTRXGui::LoadComboBoxes(Qvz_Block* block) {
    if (!block)
        return;
    FillComboBox(m_pForm->cbRXIncr, block->GetNamedAttribute("RX_LOS_INVALID_INCR"));
    FillComboBox(m_pForm->cbRXThreshold, block->GetNamedAttribute("RX_LOS_THRESHOLD"));
    FillComboBox(m_pForm->cbRxCRCwidth, block->GetNamedAttribute("QVZ_RXCRC_DATAWIDTH"));
}

void Qvz_MGTRXGui::DataToWidgets() {
    if (!m_pPage)
        return;
    const Qvz_MGTRX& p = *m_pPage;
    Qvz_MGTRXWidget& f = *m_pForm;
    Qvz_WizPage::SetComboBoxText(f.cbRXIncr, p.m_losInvalidIncr);
    Qvz_WizPage::SetComboBoxText(f.cbRXThreshold, p.m_losThreshold);
    Qvz_WizPage::SetComboBoxText(f.cbRxCRCwidth, p.m_crcDataWidth);
    f.sbSHInvalidMax->setValue(p.m_shInvalidCntMax);
    f.sbSHMax->setValue(p.m_shCntMax);
    f.cbLossOfSync->setChecked(p.m_lossOfSyncFsm != 0);

    // An exclusive group ignores switching its checked button off: the
    // choice that is meant is checked instead.
    QRadioButton* mode = p.m_decodingMode == Qvz_MGTRX::kDecodingDynamic  ? f.rbDDC
                         : p.m_decodingMode == Qvz_MGTRX::kDecodingStatic ? f.rbSDC
                                                                          : f.rbDisableDecoding;
    mode->setChecked(true);
    (p.m_staticDecoding == Qvz_MGTRX::kStatic64B66B ? f.rb64BDecoding : f.rb8BDecoding)
        ->setChecked(true);

    f.cbCRC->setChecked(p.m_rxCrcUse);
    f.cbUseCRC->setChecked(p.m_crcUse);
    f.checkboxRatio->setChecked(p.m_crcClockDouble);
    f.leRXAFEEQ->setText(p.m_rxAfeEq.ToQString());
    f.leCRCinit->setText(p.m_crcInitVal.ToQString());
}

void Qvz_MGTRXGui::WidgetsToData() {
    if (!m_pPage)
        return;
    Qvz_MGTRX& p = *m_pPage;
    const Qvz_MGTRXWidget& f = *m_pForm;
    if (Qvz_Block* block = ActiveBlock()) {
        if (block->GetNamedAttribute("RX_LOS_INVALID_INCR"))
            ReadComboBox(f.cbRXIncr, p.m_losInvalidIncr);
        if (block->GetNamedAttribute("RX_LOS_THRESHOLD"))
            ReadComboBox(f.cbRXThreshold, p.m_losThreshold);
    }
    ReadComboBox(f.cbRxCRCwidth, p.m_crcDataWidth);
    p.m_shInvalidCntMax = f.sbSHInvalidMax->value();
    p.m_shInvalidCntMaxText.Format("%d", static_cast<int>(p.m_shInvalidCntMax));
    p.m_shCntMax = f.sbSHMax->value();
    p.m_shCntMaxText.Format("%d", static_cast<int>(p.m_shCntMax));
    p.m_lossOfSyncFsm = f.cbLossOfSync->isChecked() ? 1 : 0;
    p.m_decodingMode = (f.rbDDC->isChecked() ? Qvz_MGTRX::kDecodingDynamic : 0) +
                       (f.rbSDC->isChecked() ? Qvz_MGTRX::kDecodingStatic : 0);
    p.m_staticDecoding =
        f.rb64BDecoding->isChecked() ? Qvz_MGTRX::kStatic64B66B : Qvz_MGTRX::kStatic8B10B;
    p.m_rxCrcUse = f.cbCRC->isChecked();
    p.m_crcUse = f.cbUseCRC->isChecked();
    p.m_crcClockDouble = f.checkboxRatio->isChecked();
    p.m_rxAfeEq = Port::StringBase::FromQString(f.leRXAFEEQ->text());
    p.m_crcInitVal = Port::StringBase::FromQString(f.leCRCinit->text());
}

void Qvz_MGTRXGui::UpdateControls() {
    Qvz_Block* block = ActiveBlock();
    if (!block || !m_pPage)
        return;
    Qvz_MGTRXWidget& f = *m_pForm;
    if (const Qvz_Attribute* a = block->GetNamedAttribute("RX_CRC_USE")) {
        f.cbCRC->setVisible(true);
        f.cbCRC->setEnabled(a->IsEditable() && !m_pPage->m_bypassPcs);
    } else {
        f.cbCRC->setVisible(false);
    }
    f.gbEqualization->setVisible(block->GetNamedAttribute("RXAFEEQ") != nullptr);
    UpdateCrcControls();
    UpdateLossOfSyncControls(block);
    UpdateDecodingControls(block);
    Update64bControls(block);
}

void Qvz_MGTRXGui::UpdateCrcControls() {
    Qvz_Block* block = ActiveBlock();
    if (!block || !m_pPage)
        return;
    Qvz_MGTRXWidget& f = *m_pForm;
    const bool on = m_pPage->m_crcUse;
    if (const Qvz_Attribute* a = block->GetNamedAttribute("QVZ_RXCRC_USE")) {
        f.gbCRC->setVisible(true);
        f.cbUseCRC->setEnabled(a->IsEditable());
    } else {
        f.gbCRC->setVisible(false);
    }
    ApplyAttrRow(block->GetNamedAttribute("QVZ_RXCRC_DATAWIDTH"), on,
                 {f.labelCRCwidth, f.cbRxCRCwidth});
    ApplyAttrRow(block->GetNamedAttribute("RXCRCCLOCKDOUBLE"), on, {f.checkboxRatio});
    ApplyAttrRow(block->GetNamedAttribute("RXCRCINITVAL"), on, {f.labelCRCinit, f.leCRCinit});
}

void Qvz_MGTRXGui::UpdateLossOfSyncControls(Qvz_Block* block) {
    block = BlockOrActive(block);
    if (!block || !m_pPage)
        return;
    const Qvz_MGTRX& p = *m_pPage;
    const bool unused8B10B = p.m_decodingMode == Qvz_MGTRX::kDecodingDisabled ||
                             (p.m_decodingMode == Qvz_MGTRX::kDecodingStatic &&
                              p.m_staticDecoding == Qvz_MGTRX::kStatic64B66B);
    const bool countersOff = unused8B10B || p.m_lossOfSyncFsm == 0;

    Qvz_MGTRXWidget& f = *m_pForm;
    f.gb8BSynchronization->setEnabled(!unused8B10B);
    f.cbLossOfSync->setEnabled(!unused8B10B);
    ApplyAttrRow(block->GetNamedAttribute("RX_LOS_INVALID_INCR"), !countersOff,
                 {f.IDC_STATIC_RX_LOS_INVALID_INCR, f.cbRXIncr});
    ApplyAttrRow(block->GetNamedAttribute("RX_LOS_THRESHOLD"), !countersOff,
                 {f.IDC_STATIC_RX_LOS_THRESHOLD, f.cbRXThreshold});
}

void Qvz_MGTRXGui::Update64bControls(Qvz_Block* block) {
    block = BlockOrActive(block);
    if (!block || !m_pPage)
        return;
    const Qvz_MGTRX& p = *m_pPage;
    const bool static8B10B = p.m_decodingMode == Qvz_MGTRX::kDecodingStatic &&
                             p.m_staticDecoding == Qvz_MGTRX::kStatic8B10B;
    const bool decodes64B66B = p.m_decodingMode != Qvz_MGTRX::kDecodingDisabled && !static8B10B;

    // The group stands and falls with SH_CNT_MAX.
    Qvz_MGTRXWidget& f = *m_pForm;
    ApplyAttrRow(block->GetNamedAttribute("SH_CNT_MAX"), decodes64B66B,
                 {f.IDC_STATIC_SH_CNT_MAX, f.sbSHMax, f.gb64BSynchronization});
    ApplyAttrRow(block->GetNamedAttribute("SH_INVALID_CNT_MAX"), decodes64B66B,
                 {f.IDC_STATIC_SH_INVALID_CNT_MAX, f.sbSHInvalidMax});
}

void Qvz_MGTRXGui::UpdateDecodingControls(Qvz_Block* block) {
    block = BlockOrActive(block);
    if (!block || !m_pPage)
        return;
    const Qvz_MGTRX& p = *m_pPage;
    bool allOff = false, dynamicOff = false, off8B10B = false, off64B66B = false;

    // The receiver goes by the device's families, not by the block's.
    const Port::StringBase& name = block->GetPrimitiveName();
    const bool caseA =
        !p.m_supportsMGT10 ||
        name.GetIndexOfString("GT10_ZEPHINE", Port::CompareSearch) != Port::StringBase::npos ||
        name.GetIndexOfString("GT10_10GFC", Port::CompareSearch) != Port::StringBase::npos;
    if (caseA) {
        const Qvz_Attribute* dec = block->GetNamedAttribute("QVZX_ONLY_DECODING");
        const Qvz_Attribute* st = block->GetNamedAttribute("QVZX_ONLY_DEC_STATIC");
        allOff = p.m_bypassPcs || (dec && !dec->IsEditable());
        off8B10B = off64B66B =
            p.m_decodingMode != Qvz_MGTRX::kDecodingStatic || (st && !st->IsEditable());
    } else {
        if (p.m_bypassPcs) {
            allOff = true;
        } else {
            bool none = true, b8 = true, b64 = true;
            Qvz_MGTWizPage::GetGT10EncodingChoices(block, none, b8, b64);
            if (!none && !b8 && b64)
                allOff = true;
            else if (none && !b8 && !b64)
                allOff = true;
            else if (none && !b8 && b64)
                dynamicOff = off8B10B = true;
            else if (none && b8 && !b64)
                dynamicOff = off64B66B = true;
        }
        if (p.m_decodingMode != Qvz_MGTRX::kDecodingStatic)
            off8B10B = off64B66B = true;
    }

    Qvz_MGTRXWidget& f = *m_pForm;
    f.gbDecoding->setEnabled(!allOff);
    f.rbDisableDecoding->setEnabled(!allOff);
    f.rbDDC->setEnabled(!allOff && !dynamicOff && !p.m_supportsMGT3);
    f.rbSDC->setEnabled(!allOff);
    f.rb8BDecoding->setEnabled(!allOff && !off8B10B);
    f.rb64BDecoding->setEnabled(!allOff && !off64B66B);
    f.rb64BDecoding->setVisible(p.m_supportsMGT10 || p.m_supportsMGT11);
}

void Qvz_MGTRXGui::OnCheckRxLossOfSync() {
    if (!m_active)
        return;
    WidgetsToData();
    UpdateLossOfSyncControls(nullptr);
}

void Qvz_MGTRXGui::OnCheckUseCRC() {
    if (!m_active)
        return;
    WidgetsToData();
    UpdateCrcControls();
}

void Qvz_MGTRXGui::OnRadioDecoding() {
    if (!m_active)
        return;
    WidgetsToData();
    Qvz_Block* block = ActiveBlock();
    UpdateDecodingControls(block);
    UpdateLossOfSyncControls(block);
    Update64bControls(block);
}

void Qvz_MGTRXGui::OnRadio8b10bDecoding() {
    if (!m_active)
        return;
    WidgetsToData();
    Update64bControls(nullptr);
    UpdateLossOfSyncControls(nullptr);
}
