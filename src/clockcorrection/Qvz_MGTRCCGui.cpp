#include "Qvz_MGTRCCGui.h"

#include "Qvz_MGTRCCWidget.h"

#include <limits>

namespace {

const char* const kSeqNames[8] = {"CLK_COR_SEQ_1_1", "CLK_COR_SEQ_1_2", "CLK_COR_SEQ_1_3",
                                  "CLK_COR_SEQ_1_4", "CLK_COR_SEQ_2_1", "CLK_COR_SEQ_2_2",
                                  "CLK_COR_SEQ_2_3", "CLK_COR_SEQ_2_4"};

// Enabled when the block has the attribute and may change it.
void EnableByAttribute(const Qvz_Attribute* attr, QWidget* label, QWidget* control) {
    const bool on = attr && attr->IsEditable();
    label->setEnabled(on);
    control->setEnabled(on);
}

} // namespace

Qvz_MGTRCCGui::Qvz_MGTRCCGui(Qvz_MGTRCC* page, QWidget* parent)
    : Qvz_MGTPageGui(page, parent, kEntryCount, "qvz_mgtclkcor"), m_pPage(page) {
    m_pForm = new Qvz_MGTRCCWidget(nullptr, nullptr, false, {});
    SetPageForm("Receiver Clock Correction Setup", m_pForm);
    Qvz_MGTRCCWidget& f = *m_pForm;

    connect(f.IDC_CHECK_CLK_COR_SEQ_2_USE, &QCheckBox::toggled, this,
            &Qvz_MGTRCCGui::OnCheckClkCorSeq2Use);
    connect(f.cbSeqLen, &QComboBox::textActivated, this, &Qvz_MGTRCCGui::OnComboSeqLen);

    SetupEntry(kSeq1Mask, f.IDC_EDIT_CLK_COR_SEQ_1_MASK, "([01]){4}",
               "Please enter a valid 4-bit binary value for clock correction sequence 1_MASK");
    SetupEntry(kSeq2Mask, f.IDC_EDIT_CLK_COR_SEQ_2_MASK, "([01]){4}",
               "Please enter a valid 4-bit binary value for clock correction sequence 2_MASK");
    QLineEdit* const sequences[8] = {f.IDC_EDIT_CLK_COR_SEQ_1_1, f.IDC_EDIT_CLK_COR_SEQ_1_2,
                                     f.IDC_EDIT_CLK_COR_SEQ_1_3, f.IDC_EDIT_CLK_COR_SEQ_1_4,
                                     f.IDC_EDIT_CLK_COR_SEQ_2_1, f.IDC_EDIT_CLK_COR_SEQ_2_2,
                                     f.IDC_EDIT_CLK_COR_SEQ_2_3, f.IDC_EDIT_CLK_COR_SEQ_2_4};
    for (int i = 0; i < 8; ++i) {
        Port::StringBase message;
        message.Format(
            "Please enter a valid 11-bit binary value for clock correction sequence %d_%d",
            i / 4 + 1, i % 4 + 1);
        SetupEntry(kSeq1First + i, sequences[i], "([01]){11}", message);
    }
    ConnectEntries(this, &Qvz_MGTRCCGui::ValidateLE_ALL);
}

Qvz_MGTRCCGui::~Qvz_MGTRCCGui() = default;

bool Qvz_MGTRCCGui::ReadPage() {
    return m_pPage && m_pPage->ReadWizData();
}

bool Qvz_MGTRCCGui::WritePage() {
    return m_pPage && m_pPage->WriteWizData();
}

QComboBox* Qvz_MGTRCCGui::SeqLengthComboBox() {
    return m_pForm->cbSeqLen;
}

QSpinBox* Qvz_MGTRCCGui::LatencySpinBox(SpinBoxId which) {
    switch (which) {
    case kRepeatWait:
        return m_pForm->sbRepeatWait;
    case kMinLat:
        return m_pForm->sbMin;
    case kMaxLat:
        return m_pForm->sbMax;
    }
    return nullptr;
}

void Qvz_MGTRCCGui::InitDataMembers(Qvz_Block* block) {
    FillComboBox(m_pForm->cbSeqLen, block ? block->GetNamedAttribute("CLK_COR_SEQ_LEN") : nullptr);
}

void Qvz_MGTRCCGui::DataToWidgets() {
    if (!m_pPage)
        return;
    const Qvz_MGTRCC& p = *m_pPage;
    Qvz_MGTRCCWidget& f = *m_pForm;
    f.sbRepeatWait->setValue(p.m_repeatWaitValue);
    f.cbEnable->setChecked(p.m_clkCorrectUse != 0);
    f.cbKeepIdle->setChecked(p.m_keepIdle != 0);
    f.cbInsertIdleFlag->setChecked(p.m_insertIdleFlag != 0);
    f.IDC_CHECK_CLK_COR_SEQ_2_USE->setChecked(p.m_seq2Use != 0);
    for (int i = 0; i < 4; ++i) {
        SeqEdit(i)->setText(p.m_seq1[i].ToQString());
        SeqEdit(4 + i)->setText(p.m_seq2[i].ToQString());
    }
    Qvz_WizPage::SetComboBoxText(f.cbSeqLen, p.m_seqLength);
    f.IDC_EDIT_CLK_COR_SEQ_1_MASK->setText(p.m_seq1Mask.ToQString());
    f.IDC_EDIT_CLK_COR_SEQ_2_MASK->setText(p.m_seq2Mask.ToQString());
    f.sbMin->setValue(p.m_minLatValue);
    f.sbMax->setValue(p.m_maxLatValue);
    f.IDC_CHECK_CLK_COR_SEQ_DROP->setChecked(p.m_seqDrop != 0);
    f.IDC_CHECK_CLK_COR_8B10B_DE->setChecked(p.m_8b10bDe != 0);
}

void Qvz_MGTRCCGui::WidgetsToData() {
    if (!m_pPage)
        return;
    Qvz_MGTRCC& p = *m_pPage;
    const Qvz_MGTRCCWidget& f = *m_pForm;
    p.m_repeatWaitValue = f.sbRepeatWait->value();
    p.m_repeatWait.Format("%d", p.m_repeatWaitValue);
    p.m_clkCorrectUse = f.cbEnable->isChecked() ? 1 : 0;
    p.m_keepIdle = f.cbKeepIdle->isChecked() ? 1 : 0;
    p.m_insertIdleFlag = f.cbInsertIdleFlag->isChecked() ? 1 : 0;
    p.m_seq2Use = f.IDC_CHECK_CLK_COR_SEQ_2_USE->isChecked() ? 1 : 0;
    for (int i = 0; i < 4; ++i) {
        p.m_seq1[i] = EntryText(SeqEdit(i));
        p.m_seq2[i] = EntryText(SeqEdit(4 + i));
    }
    // A list without items (a length attribute with no legal values) keeps
    // the length read from the block instead of writing an empty one.
    ReadComboBox(f.cbSeqLen, p.m_seqLength);
    p.m_seq1Mask = EntryText(f.IDC_EDIT_CLK_COR_SEQ_1_MASK);
    p.m_seq2Mask = EntryText(f.IDC_EDIT_CLK_COR_SEQ_2_MASK);
    p.m_minLatValue = f.sbMin->value();
    p.m_minLat.Format("%d", p.m_minLatValue);
    p.m_maxLatValue = f.sbMax->value();
    p.m_maxLat.Format("%d", p.m_maxLatValue);
    p.m_seqDrop = f.IDC_CHECK_CLK_COR_SEQ_DROP->isChecked() ? 1 : 0;
    p.m_8b10bDe = f.IDC_CHECK_CLK_COR_8B10B_DE->isChecked() ? 1 : 0;
}

Port::StringBase Qvz_MGTRCCGui::GetSeqLength() const {
    if (!m_pPage)
        return Port::StringBase();
    if (m_pPage->m_isBatch || m_pForm->cbSeqLen->currentIndex() < 0)
        return m_pPage->m_seqLength;
    return Port::StringBase::FromQString(m_pForm->cbSeqLen->currentText());
}

void Qvz_MGTRCCGui::UpdateControls() {
    Qvz_Block* block = ActiveBlock();
    if (!block || !m_pPage)
        return;
    const Qvz_MGTRCC& p = *m_pPage;
    Qvz_MGTRCCWidget& f = *m_pForm;
    const bool firstFamily = !block->SupportsMGT10() && !p.m_isGT11;
    const bool length8 = GetSeqLength().Compare("8", Port::CompareExact) == 0;
    const bool seq2Use = p.m_seq2Use != 0;

    // A box hidden for one block must come back for the next one that has
    // the attribute, so presence shows the box as well as enabling it.
    ApplyAttrRow(block->GetNamedAttribute("CLK_CORRECT_USE"), true, {f.cbEnable});
    ApplyAttrRow(block->GetNamedAttribute("CLK_COR_KEEP_IDLE"), true, {f.cbKeepIdle});
    ApplyAttrRow(block->GetNamedAttribute("CLK_COR_INSERT_IDLE_FLAG"), true, {f.cbInsertIdleFlag});

    f.IDC_STATIC_CLK_COR_REPEAT_WAIT->setVisible(firstFamily);
    f.sbRepeatWait->setVisible(firstFamily);
    if (firstFamily)
        EnableByAttribute(block->GetNamedAttribute("CLK_COR_REPEAT_WAIT"),
                          f.IDC_STATIC_CLK_COR_REPEAT_WAIT, f.sbRepeatWait);

    EnableByAttribute(block->GetNamedAttribute("CLK_COR_SEQ_LEN"), f.IDC_STATIC_CLK_COR_SEQ_LEN,
                      f.cbSeqLen);

    QLabel* const labels[8] = {f.IDC_STATIC_CLK_COR_SEQ_1_1, f.IDC_STATIC_CLK_COR_SEQ_1_2,
                               f.IDC_STATIC_CLK_COR_SEQ_1_3, f.IDC_STATIC_CLK_COR_SEQ_1_4,
                               f.IDC_STATIC_CLK_COR_SEQ_2_1, f.IDC_STATIC_CLK_COR_SEQ_2_2,
                               f.IDC_STATIC_CLK_COR_SEQ_2_3, f.IDC_STATIC_CLK_COR_SEQ_2_4};
    for (int i = 0; i < 8; ++i) {
        QLineEdit* edit = SeqEdit(i);
        labels[i]->setVisible(true);
        edit->setVisible(true);
        // Length 8 turns the second row into elements 5 to 8 of the first.
        if (i < 4 || seq2Use || length8) {
            EnableByAttribute(block->GetNamedAttribute(kSeqNames[i]), labels[i], edit);
        } else {
            labels[i]->setEnabled(false);
            edit->setEnabled(false);
        }
        if (i >= 4)
            labels[i]->setText(QString("%1_%2").arg(length8 ? 1 : 2).arg(length8 ? i + 1 : i - 3));
    }

    if (length8)
        f.IDC_CHECK_CLK_COR_SEQ_2_USE->setVisible(false);
    else
        ApplyAttrRow(block->GetNamedAttribute("CLK_COR_SEQ_2_USE"), true,
                     {f.IDC_CHECK_CLK_COR_SEQ_2_USE});

    QWidget* const masks[5] = {f.gbMask, f.IDC_STATIC_CLK_COR_SEQ_1_MASK,
                               f.IDC_EDIT_CLK_COR_SEQ_1_MASK, f.IDC_STATIC_CLK_COR_SEQ_2_MASK,
                               f.IDC_EDIT_CLK_COR_SEQ_2_MASK};
    for (QWidget* w : masks)
        w->setVisible(!firstFamily);
    if (firstFamily) {
        // The first family has no mask check; hidden entries must not stop
        // Next with a message about a field the user cannot see.
        f.IDC_EDIT_CLK_COR_SEQ_1_MASK->setEnabled(false);
        f.IDC_EDIT_CLK_COR_SEQ_2_MASK->setEnabled(false);
    } else {
        EnableByAttribute(block->GetNamedAttribute("CLK_COR_SEQ_1_MASK"),
                          f.IDC_STATIC_CLK_COR_SEQ_1_MASK, f.IDC_EDIT_CLK_COR_SEQ_1_MASK);
        EnableByAttribute(seq2Use ? block->GetNamedAttribute("CLK_COR_SEQ_2_MASK") : nullptr,
                          f.IDC_STATIC_CLK_COR_SEQ_2_MASK, f.IDC_EDIT_CLK_COR_SEQ_2_MASK);
    }

    QWidget* const latency[5] = {f.gbLatency, f.IDC_STATIC_CLK_COR_MIN_LAT, f.sbMin,
                                 f.IDC_STATIC_CLK_COR_MAX_LAT, f.sbMax};
    for (QWidget* w : latency)
        w->setVisible(!firstFamily);
    if (!firstFamily) {
        EnableByAttribute(block->GetNamedAttribute("CLK_COR_MIN_LAT"), f.IDC_STATIC_CLK_COR_MIN_LAT,
                          f.sbMin);
        EnableByAttribute(block->GetNamedAttribute("CLK_COR_MAX_LAT"), f.IDC_STATIC_CLK_COR_MAX_LAT,
                          f.sbMax);
    }

    if (firstFamily) {
        f.IDC_CHECK_CLK_COR_SEQ_DROP->setVisible(false);
        f.IDC_CHECK_CLK_COR_8B10B_DE->setVisible(false);
    } else {
        ApplyAttrRow(block->GetNamedAttribute("CLK_COR_SEQ_DROP"), true,
                     {f.IDC_CHECK_CLK_COR_SEQ_DROP});
        ApplyAttrRow(block->GetNamedAttribute("CLK_COR_8B10B_DE"), true,
                     {f.IDC_CHECK_CLK_COR_8B10B_DE});
    }
}

void Qvz_MGTRCCGui::OnCheckClkCorSeq2Use() {
    if (!m_active || !m_pPage)
        return;
    WidgetsToData();
    Qvz_Block* block = ActiveBlock();
    if (!block)
        return;
    Qvz_MGTRCCWidget& f = *m_pForm;
    const bool seq2Use = m_pPage->m_seq2Use != 0;
    QLabel* const labels[4] = {f.IDC_STATIC_CLK_COR_SEQ_2_1, f.IDC_STATIC_CLK_COR_SEQ_2_2,
                               f.IDC_STATIC_CLK_COR_SEQ_2_3, f.IDC_STATIC_CLK_COR_SEQ_2_4};
    for (int i = 0; i < 4; ++i)
        if (const Qvz_Attribute* a = block->GetNamedAttribute(kSeqNames[4 + i]))
            EnableByAttribute(seq2Use ? a : nullptr, labels[i], SeqEdit(4 + i));
    // The mask stays off where the family hides it.
    const bool firstFamily = !block->SupportsMGT10() && !m_pPage->m_isGT11;
    if (const Qvz_Attribute* a = block->GetNamedAttribute("CLK_COR_SEQ_2_MASK"); a && !firstFamily)
        EnableByAttribute(seq2Use ? a : nullptr, f.IDC_STATIC_CLK_COR_SEQ_2_MASK,
                          f.IDC_EDIT_CLK_COR_SEQ_2_MASK);
}

void Qvz_MGTRCCGui::OnComboSeqLen() {
    if (!m_active || !m_pPage)
        return;
    WidgetsToData();
    m_pPage->m_seqLength = GetSeqLength();
    UpdateControls();
}

void Qvz_MGTRCCGui::OnMaxChanged(int value) {
    if (value > std::numeric_limits<int>::min())
        m_pForm->sbMin->setMaximum(value - 1);
}

void Qvz_MGTRCCGui::OnMinChanged(int value) {
    if (value < std::numeric_limits<int>::max())
        m_pForm->sbMax->setMinimum(value + 1);
}
