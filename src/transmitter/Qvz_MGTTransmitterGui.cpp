#include "Qvz_MGTTransmitterGui.h"

#include "Qvz_MGTTXWidget.h"
#include "Qvz_MGTTransmitter.h"

Qvz_MGTTransmitterGui::Qvz_MGTTransmitterGui(Qvz_MGTTransmitter* page, QWidget* parent)
    : Qvz_MGTPageGui(page, parent, kEntryCount, "qvz_mgttx"), m_pPage(page) {
    m_pForm = new Qvz_MGTTXWidget(nullptr, nullptr, false, {});
    SetPageForm("Transmitter Setup", m_pForm);

    connect(m_pForm->leCRCValue, &QLineEdit::textChanged, this,
            &Qvz_MGTTransmitterGui::Validate_leCRCValue);
    connect(m_pForm->cbCRC, &QCheckBox::toggled, this, &Qvz_MGTTransmitterGui::OnCheckUseCrc);
    connect(m_pForm->bgEncodingButtons, &QButtonGroup::idClicked, this,
            &Qvz_MGTTransmitterGui::OnRadioEncoding);
    connect(m_pForm->cbPreDriver, &QCheckBox::toggled, this,
            &Qvz_MGTTransmitterGui::OnCheckPreDriver);
    connect(m_pForm->cbPostDriver, &QCheckBox::toggled, this,
            &Qvz_MGTTransmitterGui::OnCheckPostDriver);

    SetupEntry(kForcedCrc, m_pForm->leCRCValue, "([01]){8}",
               "Please enter a valid 8-bit binary value for Forced CRC value");
    SetupEntry(kPreTapDac, m_pForm->lePreTapDac, "([01]){5}",
               "Please enter a valid 5-bit binary value for TXPRE_TAP_DAC");
    SetupEntry(kDatTapDac, m_pForm->leDatTapDac, "([01]){5}",
               "Please enter a valid 5-bit binary value for TXDAT_TAP_DAC");
    SetupEntry(kPostTapDac, m_pForm->lePostTapDac, "([01]){5}",
               "Please enter a valid 5-bit binary value for TXPOST_TAP_DAC");
    SetupEntry(kCrcInit, m_pForm->leCRCinit, "([0-9A-Fa-f]){8}",
               "Please enter a valid 8-digit gex value for TXCRCINITVAL");
    ConnectEntries(this, &Qvz_MGTTransmitterGui::ValidateLE_ALL);
}

Qvz_MGTTransmitterGui::~Qvz_MGTTransmitterGui() = default;

bool Qvz_MGTTransmitterGui::ReadPage() {
    return m_pPage && m_pPage->ReadWizData();
}

bool Qvz_MGTTransmitterGui::WritePage() {
    return m_pPage && m_pPage->WriteWizData();
}

void Qvz_MGTTransmitterGui::LoadComboBoxes(Qvz_Block* block) {
    if (!block)
        return;
    if (block->SupportsMGT3())
        FillComboBox(m_pForm->cbOVS, block->GetNamedAttribute("TX_DIFF_CTRL"));
    FillComboBox(m_pForm->cbCRCwidth, block->GetNamedAttribute("QVZ_TXCRC_DATAWIDTH"));
    FillComboBox(m_pForm->cbCRCFormat, block->GetNamedAttribute("CRC_FORMAT"));
    if (!Qvz_MGTTransmitter::IsFibreChannel(block)) {
        FillComboBox(m_pForm->cbSOP, block->GetNamedAttribute("CRC_START_OF_PKT"));
        FillComboBox(m_pForm->cbEOP, block->GetNamedAttribute("CRC_END_OF_PKT"));
    }
}

void Qvz_MGTTransmitterGui::DataToWidgets() {
    if (!m_pPage)
        return;
    Qvz_MGTTransmitter& p = *m_pPage;
    Qvz_MGTTXWidget& f = *m_pForm;
    f.leCRCValue->setText(p.m_forcedCrcValue.ToQString());
    f.cbCRC->setChecked(p.m_crcUse);
    f.checkboxRatio->setChecked(p.m_crcClockDouble);

    // Exclusive radio buttons are switched off by checking their sibling.
    QRadioButton* mode = p.m_encodingMode == 0   ? f.rbDisableEncoding
                         : p.m_encodingMode == 1 ? f.rbDEC
                                                 : f.rbSEC;
    mode->setChecked(true);
    (p.m_staticEncoding == 0 ? f.rbEnable8B10B : f.rbEnable64)->setChecked(true);

    Qvz_Block* block = ActiveBlock();
    if (block && p.m_isGT) {
        if (block->GetNamedAttribute("TX_PREEMPHASIS"))
            f.sPre->setValue(p.m_preEmphasisLevel);
        if (block->GetNamedAttribute("TX_DIFF_CTRL"))
            Qvz_WizPage::SetComboBoxText(f.cbOVS, p.m_diffCtrl);
    }
    if (block) {
        if (block->GetNamedAttribute("CRC_FORMAT"))
            Qvz_WizPage::SetComboBoxText(f.cbCRCFormat, p.m_crcFormat);
        const bool fibreChannel = Qvz_MGTTransmitter::IsFibreChannel(block);
        if (!fibreChannel && block->GetNamedAttribute("CRC_START_OF_PKT"))
            Qvz_WizPage::SetComboBoxText(f.cbSOP, p.m_crcStartOfPkt);
        if (!fibreChannel && block->GetNamedAttribute("CRC_END_OF_PKT"))
            Qvz_WizPage::SetComboBoxText(f.cbEOP, p.m_crcEndOfPkt);
    }

    Qvz_WizPage::SetComboBoxText(f.cbCRCwidth, p.m_crcDataWidth);
    f.leCRCinit->setText(p.m_crcInitVal.ToQString());
    f.lePreTapDac->setText(p.m_preTapDac.ToQString());
    f.leDatTapDac->setText(p.m_datTapDac.ToQString());
    f.lePostTapDac->setText(p.m_postTapDac.ToQString());
    f.cbPreDriver->setChecked(p.m_preDriverOn);
    f.cbPostDriver->setChecked(p.m_postDriverOn);
}

void Qvz_MGTTransmitterGui::WidgetsToData() {
    if (!m_pPage)
        return;
    Qvz_MGTTransmitter& p = *m_pPage;
    const Qvz_MGTTXWidget& f = *m_pForm;
    p.m_forcedCrcValue = Port::StringBase::FromQString(f.leCRCValue->text());
    p.m_crcUse = f.cbCRC->isChecked();
    p.m_crcClockDouble = f.checkboxRatio->isChecked();

    p.m_encodingMode = (f.rbDEC->isChecked() ? 1 : 0) + (f.rbSEC->isChecked() ? 2 : 0);
    p.m_staticEncoding = f.rbEnable64->isChecked() ? 1 : 0;

    Qvz_Block* block = ActiveBlock();
    if (block && p.m_isGT) {
        if (block->GetNamedAttribute("TX_PREEMPHASIS")) {
            p.m_preEmphasisLevel = f.sPre->value();
            p.m_preEmphasisText.Format("%d", p.m_preEmphasisLevel);
        }
        if (block->GetNamedAttribute("TX_DIFF_CTRL"))
            ReadComboBox(f.cbOVS, p.m_diffCtrl);
    }
    if (block) {
        if (block->GetNamedAttribute("CRC_FORMAT"))
            ReadComboBox(f.cbCRCFormat, p.m_crcFormat);
        const bool fibreChannel = Qvz_MGTTransmitter::IsFibreChannel(block);
        if (!fibreChannel && block->GetNamedAttribute("CRC_START_OF_PKT"))
            ReadComboBox(f.cbSOP, p.m_crcStartOfPkt);
        if (!fibreChannel && block->GetNamedAttribute("CRC_END_OF_PKT"))
            ReadComboBox(f.cbEOP, p.m_crcEndOfPkt);
    }

    ReadComboBox(f.cbCRCwidth, p.m_crcDataWidth);
    p.m_crcInitVal = Port::StringBase::FromQString(f.leCRCinit->text());
    p.m_preTapDac = Port::StringBase::FromQString(f.lePreTapDac->text());
    p.m_datTapDac = Port::StringBase::FromQString(f.leDatTapDac->text());
    p.m_postTapDac = Port::StringBase::FromQString(f.lePostTapDac->text());
    p.m_preDriverOn = f.cbPreDriver->isChecked();
    p.m_postDriverOn = f.cbPostDriver->isChecked();
}

void Qvz_MGTTransmitterGui::UpdateControls() {
    Qvz_Block* block = ActiveBlock();
    if (!block)
        return;
    Qvz_MGTTXWidget& f = *m_pForm;
    const bool firstFamily = !block->SupportsMGT10() && !block->SupportsMGT11();
    f.gbPre->setVisible(firstFamily);
    f.gbOVS->setVisible(firstFamily);
    f.gbEmphasis->setVisible(block->GetNamedAttribute("TXPRE_TAP_PD") != nullptr);
    UpdateCrcControls();
    UpdateEncodingControls(block);
    OnCheckPreDriver();
    OnCheckPostDriver();
}

void Qvz_MGTTransmitterGui::UpdateCrcControls() {
    Qvz_Block* block = ActiveBlock();
    if (!block || !m_pPage)
        return;
    Qvz_MGTTXWidget& f = *m_pForm;
    const bool crcUse = m_pPage->m_crcUse;

    if (const Qvz_Attribute* own = block->GetNamedAttribute("QVZ_TXCRC_USE")) {
        f.gbCRC->setVisible(true);
        f.cbCRC->setVisible(true);
        f.cbCRC->setEnabled(own->IsEditable());
    } else if (const Qvz_Attribute* prim = block->GetNamedAttribute("TX_CRC_USE")) {
        f.gbCRC->setVisible(true);
        f.cbCRC->setVisible(true);
        f.cbCRC->setEnabled(prim->IsEditable() && !m_pPage->m_bypassPcs);
    } else {
        f.gbCRC->setVisible(false);
        f.cbCRC->setVisible(false);
    }

    ApplyAttrRow(block->GetNamedAttribute("CRC_FORMAT"), crcUse,
                 {f.IDC_STATIC_CRC_FORMAT, f.cbCRCFormat});
    ApplyAttrRow(block->GetNamedAttribute("TX_CRC_FORCE_VALUE"), crcUse,
                 {f.IDC_STATIC_TX_CRC_FORCE_VALUE, f.leCRCValue});
    ApplyAttrRow(block->GetNamedAttribute("CRC_START_OF_PKT"), crcUse,
                 {f.IDC_STATIC_CRC_START_OF_PKT, f.cbSOP});
    ApplyAttrRow(block->GetNamedAttribute("CRC_END_OF_PKT"), crcUse,
                 {f.IDC_STATIC_CRC_END_OF_PKT, f.cbEOP});
    ApplyAttrRow(block->GetNamedAttribute("QVZ_TXCRC_DATAWIDTH"), crcUse,
                 {f.labelCRCwidth, f.cbCRCwidth});
    ApplyAttrRow(block->GetNamedAttribute("TXCRCCLOCKDOUBLE"), crcUse, {nullptr, f.checkboxRatio});
    ApplyAttrRow(block->GetNamedAttribute("TXCRCINITVAL"), crcUse, {f.labelCRCinit, f.leCRCinit});
}

void Qvz_MGTTransmitterGui::UpdateEncodingControls(Qvz_Block* block) {
    if (!block)
        block = ActiveBlock();
    if (!block || !m_pPage)
        return;
    const Qvz_MGTTransmitter& p = *m_pPage;
    bool allOff = false, dynamicOff = false, off8B10B = false, off64B66B = false;

    const Port::StringBase& name = block->GetPrimitiveName();
    const bool caseA =
        !block->SupportsMGT10() ||
        name.GetIndexOfString("GT10_ZEPHINE", Port::CompareSearch) != Port::StringBase::npos ||
        name.GetIndexOfString("GT10_10GFC", Port::CompareSearch) != Port::StringBase::npos;
    if (caseA) {
        const Qvz_Attribute* enc = block->GetNamedAttribute("QVZX_ONLY_ENCODING");
        const Qvz_Attribute* st = block->GetNamedAttribute("QVZX_ONLY_ENC_STATIC");
        allOff = p.m_bypassPcs || (enc && !enc->IsEditable());
        off8B10B = off64B66B = p.m_encodingMode != 2 || (st && !st->IsEditable());
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
        if (p.m_encodingMode != 2)
            off8B10B = off64B66B = true;
    }

    Qvz_MGTTXWidget& f = *m_pForm;
    const bool isGT = block->SupportsMGT3();
    const bool custom = name.Compare("GT_CUSTOM", Port::CompareExact) == 0;
    f.rbDisableEncoding->setEnabled(!allOff && (!isGT || custom));
    f.gbEncoding->setEnabled(!allOff);
    f.rbDEC->setEnabled(!allOff && !dynamicOff && !isGT);
    f.rbSEC->setEnabled(!allOff);
    f.rbEnable8B10B->setEnabled(!allOff && !off8B10B);
    f.rbEnable64->setEnabled(!allOff && !off64B66B);
    f.rbEnable64->setVisible(block->SupportsMGT10() || block->SupportsMGT11());
}

void Qvz_MGTTransmitterGui::OnRadioEncoding() {
    if (!m_active)
        return;
    WidgetsToData();
    UpdateEncodingControls(ActiveBlock());
}

void Qvz_MGTTransmitterGui::OnCheckPostDriver() {
    const bool on = m_pForm->cbPostDriver->isChecked();
    m_pForm->labelPostTap->setEnabled(on);
    m_pForm->lePostTapDac->setEnabled(on);
}

void Qvz_MGTTransmitterGui::OnCheckPreDriver() {
    const bool on = m_pForm->cbPreDriver->isChecked();
    m_pForm->labelPreTap->setEnabled(on);
    m_pForm->lePreTapDac->setEnabled(on);
}

void Qvz_MGTTransmitterGui::OnCheckUseCrc() {
    if (!m_active)
        return;
    WidgetsToData();
    UpdateCrcControls();
}
