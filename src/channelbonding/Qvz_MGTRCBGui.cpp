#include "Qvz_MGTRCBGui.h"

#include "Qvz_MGTRCBConfig11Dialog.h"
#include "Qvz_MGTRCBConfigDialog.h"
#include "Qvz_MGTRCBLaneIDDialog.h"
#include "Qvz_MGTRCBWidget.h"

namespace {

const char* const kSeqSuffixes[8] = {"1_1", "1_2", "1_3", "1_4", "2_1", "2_2", "2_3", "2_4"};

bool Has(const Port::StringBase& s, const char* text) {
    return s.GetIndexOfString(text, Port::CompareSearch) != Port::StringBase::npos;
}

} // namespace

Qvz_MGTRCBGui::Qvz_MGTRCBGui(Qvz_MGTRCB* page, QWidget* parent)
    : Qvz_MGTPageGui(page, parent, kEntryCount, "qvz_mgtrx3"), m_pPage(page) {
    m_pForm = new Qvz_MGTRCBWidget(nullptr, nullptr, false, {});
    SetPageForm("Receiver Channel Bonding Setup", m_pForm);
    Qvz_MGTRCBWidget& f = *m_pForm;

    connect(f.sbCBondNum, &QSpinBox::valueChanged, this, &Qvz_MGTRCBGui::OnSpinCBondNum);
    connect(f.IDC_BUTTON_VIEW_PLACEMENT, &QPushButton::clicked, this,
            &Qvz_MGTRCBGui::OnButtonViewPlacement);
    connect(f.IDC_BUTTON_LANE_ID, &QPushButton::clicked, this,
            &Qvz_MGTRCBGui::OnButtonDefineLaneID);
    connect(f.IDC_CHECK_CHAN_BOND_SEQ_2_USE, &QCheckBox::clicked, this,
            &Qvz_MGTRCBGui::OnCheckCBondSeq2Use);

    QLineEdit* const sequences[8] = {f.IDC_EDIT_CHAN_BOND_SEQ_1_1, f.IDC_EDIT_CHAN_BOND_SEQ_1_2,
                                     f.IDC_EDIT_CHAN_BOND_SEQ_1_3, f.IDC_EDIT_CHAN_BOND_SEQ_1_4,
                                     f.IDC_EDIT_CHAN_BOND_SEQ_2_1, f.IDC_EDIT_CHAN_BOND_SEQ_2_2,
                                     f.IDC_EDIT_CHAN_BOND_SEQ_2_3, f.IDC_EDIT_CHAN_BOND_SEQ_2_4};
    for (int s = 0; s < 8; ++s) {
        Port::StringBase message = "Please enter a valid 11-bit binary value for channel bonding "
                                   "sequence ";
        message += kSeqSuffixes[s];
        SetupEntry(kSeqFirst + s, sequences[s], "([01]){11}", message);
    }
    SetupEntry(kSeq1Mask, f.IDC_EDIT_CHAN_BOND_SEQ_1_MASK, "([01]){4}",
               "Please enter a valid 4-bit binary value for channel bonding sequence 1 mask");
    SetupEntry(kSeq2Mask, f.IDC_EDIT_CHAN_BOND_SEQ_2_MASK, "([01]){4}",
               "Please enter a valid 4-bit binary value for channel bonding sequence 2 mask");
    ConnectEntries(this, &Qvz_MGTRCBGui::ValidateLE_ALL);
}

Qvz_MGTRCBGui::~Qvz_MGTRCBGui() = default;

bool Qvz_MGTRCBGui::ReadPage() {
    return m_pPage && m_pPage->ReadWizData();
}

bool Qvz_MGTRCBGui::WritePage() {
    return m_pPage && m_pPage->WriteWizData(true);
}

bool Qvz_MGTRCBGui::onBack() {
    WidgetsToData();
    if (!m_pPage || !m_pPage->WriteWizData(false))
        return false;
    return Wg_WizardPage::onBack();
}

bool Qvz_MGTRCBGui::onFinish() {
    if (!CheckEntries())
        return true;
    WidgetsToData();
    if (!WritePage())
        return true;
    return Wg_WizardPage::onFinish();
}

QComboBox* Qvz_MGTRCBGui::SeqLenComboBox() {
    return m_pForm->cbSeqLen;
}

QSpinBox* Qvz_MGTRCBGui::CBondNumSpinBox() {
    return m_pForm->sbCBondNum;
}

QSpinBox* Qvz_MGTRCBGui::LimitSpinBox() {
    return m_pForm->sbCBondLimit;
}

QSpinBox* Qvz_MGTRCBGui::OffsetSpinBox() {
    return m_pForm->sbCBondOffset;
}

QSpinBox* Qvz_MGTRCBGui::WaitSpinBox() {
    return m_pForm->sbCBondWait;
}

void Qvz_MGTRCBGui::DataToWidgets() {
    if (!m_pPage)
        return;
    const Qvz_MGTRCB& p = *m_pPage;
    Qvz_MGTRCBWidget& f = *m_pForm;
    f.sbCBondLimit->setValue(p.m_limit);
    f.sbCBondOffset->setValue(p.m_offset);
    f.sbCBondWait->setValue(p.m_wait);
    f.sbCBondNum->setValue(p.m_cbondNum);
    Qvz_WizPage::SetComboBoxText(f.cbSeqLen, p.m_seqLen);
    for (int s = 0; s < Qvz_MGTRCB::kSeqCount; ++s)
        SeqEdit(s)->setText(p.m_seq[s].ToQString());
    f.IDC_EDIT_CHAN_BOND_SEQ_1_MASK->setText(p.m_seq1Mask.ToQString());
    f.IDC_EDIT_CHAN_BOND_SEQ_2_MASK->setText(p.m_seq2Mask.ToQString());
    f.IDC_CHECK_CHAN_BOND_ONE_SHOT->setChecked(p.m_allowRepeat != 0);
    // An exclusive group cannot turn its checked button off; check the other.
    if (p.m_primaryRowBottom == 1)
        f.IDC_RADIO_PRIMARY_ROW_BOTTOM->setChecked(true);
    else
        f.IDC_RADIO_PRIMARY_ROW_TOP->setChecked(true);
    f.IDC_CHECK_CHAN_BOND_SEQ_2_USE->setChecked(p.m_seq2Use != 0);
}

void Qvz_MGTRCBGui::WidgetsToData() {
    if (!m_pPage)
        return;
    Qvz_MGTRCB& p = *m_pPage;
    const Qvz_MGTRCBWidget& f = *m_pForm;
    for (int s = 0; s < Qvz_MGTRCB::kSeqCount; ++s)
        p.m_seq[s] = EntryText(SeqEdit(s));
    p.m_seq1Mask = EntryText(f.IDC_EDIT_CHAN_BOND_SEQ_1_MASK);
    p.m_seq2Mask = EntryText(f.IDC_EDIT_CHAN_BOND_SEQ_2_MASK);
    // A list without items (a length attribute with no legal values) keeps
    // the length read from the block instead of taking an empty one.
    ReadComboBox(f.cbSeqLen, p.m_seqLen);
    p.m_allowRepeat = f.IDC_CHECK_CHAN_BOND_ONE_SHOT->isChecked() ? 1 : 0;
    p.m_primaryRowBottom = f.IDC_RADIO_PRIMARY_ROW_BOTTOM->isChecked() ? 1 : 0;
    p.m_limit = f.sbCBondLimit->value();
    p.m_offset = f.sbCBondOffset->value();
    p.m_wait = f.sbCBondWait->value();
    p.m_cbondNum = f.sbCBondNum->value();
    p.m_limitText.Format("%d", p.m_limit);
    p.m_offsetText.Format("%d", p.m_offset);
    p.m_waitText.Format("%d", p.m_wait);
    p.m_cbondNumText.Format("%d", p.m_cbondNum);
    p.m_seq2Use = f.IDC_CHECK_CHAN_BOND_SEQ_2_USE->isChecked() ? 1 : 0;
}

void Qvz_MGTRCBGui::UpdateControls() {
    Qvz_Block* block = ActiveBlock();
    if (!block || !m_pPage)
        return;
    const Qvz_MGTRCB& p = *m_pPage;
    Qvz_MGTRCBWidget& f = *m_pForm;
    const bool bonding = p.m_cbondNum != 0;
    const Port::StringBase& name = p.m_displayName;
    const bool seq2Use = p.m_seq2Use != 0;

    // GT11 pairs sit on the left and right edges of the chip.
    if (p.m_isGT11) {
        f.IDC_RADIO_PRIMARY_ROW_TOP->setText("&Right");
        f.IDC_RADIO_PRIMARY_ROW_BOTTOM->setText("&Left");
    } else {
        f.IDC_RADIO_PRIMARY_ROW_TOP->setText("Top");
        f.IDC_RADIO_PRIMARY_ROW_BOTTOM->setText("Bottom");
    }

    // The group holds every common setting, so it follows the bonding number
    // even when the block has no CHAN_BOND_ONE_SHOT.
    const Qvz_Attribute* oneShot = block->GetNamedAttribute("CHAN_BOND_ONE_SHOT");
    f.gbChanBond->setEnabled(bonding);
    f.IDC_CHECK_CHAN_BOND_ONE_SHOT->setEnabled(bonding && IsEditable(oneShot));

    EnableAll({f.IDC_STATIC_CHAN_BOND_LIMIT, f.sbCBondLimit, f.IDC_STATIC_BYTES0},
              bonding && IsEditable(block->GetNamedAttribute("CHAN_BOND_LIMIT")));

    const struct {
        const char* attr;
        QWidget *label, *control, *bytes;
    } optional[] = {
        {"CHAN_BOND_OFFSET", f.IDC_STATIC_CHAN_BOND_OFFSET, f.sbCBondOffset, f.IDC_STATIC_BYTES1},
        {"CHAN_BOND_WAIT", f.IDC_STATIC_CHAN_BOND_WAIT, f.sbCBondWait, f.IDC_STATIC_BYTES2},
        {"CHAN_BOND_SEQ_LEN", f.IDC_STATIC_CHAN_BOND_SEQ_LEN, f.cbSeqLen, f.IDC_STATIC_BYTES3},
    };
    for (const auto& o : optional) {
        // Shown again for the next block that has the attribute.
        ApplyAttrRow(block->GetNamedAttribute(o.attr), bonding, {o.label, o.control, o.bytes});
    }

    ApplyAttrRow(block->GetNamedAttribute("CHAN_BOND_SEQ_1_MASK"), bonding,
                 {f.IDC_STATIC_CHAN_BOND_SEQ_1_MASK, f.IDC_EDIT_CHAN_BOND_SEQ_1_MASK});
    ApplyAttrRow(block->GetNamedAttribute("CHAN_BOND_SEQ_2_MASK"), bonding && seq2Use,
                 {f.IDC_STATIC_CHAN_BOND_SEQ_2_MASK, f.IDC_EDIT_CHAN_BOND_SEQ_2_MASK});

    const bool laneIds = Has(name, "Infiniband") && !p.m_isGT11;
    f.IDC_BUTTON_LANE_ID->setVisible(laneIds);
    if (laneIds)
        f.IDC_BUTTON_LANE_ID->setEnabled(bonding);
    f.IDC_BUTTON_VIEW_PLACEMENT->setEnabled(bonding);

    const bool custom = Has(name, "Custom");
    const bool customLike = custom || name.Compare("PCI Express", Port::CompareExact) == 0;
    QLabel* const labels[8] = {f.IDC_STATIC_CHAN_BOND_SEQ_1_1, f.IDC_STATIC_CHAN_BOND_SEQ_1_2,
                               f.IDC_STATIC_CHAN_BOND_SEQ_1_3, f.IDC_STATIC_CHAN_BOND_SEQ_1_4,
                               f.IDC_STATIC_CHAN_BOND_SEQ_2_1, f.IDC_STATIC_CHAN_BOND_SEQ_2_2,
                               f.IDC_STATIC_CHAN_BOND_SEQ_2_3, f.IDC_STATIC_CHAN_BOND_SEQ_2_4};
    ShowAll({f.IDC_STATIC_CHAN_BOND_SEQ}, true);
    EnableAll({f.IDC_STATIC_CHAN_BOND_SEQ}, customLike && bonding);
    for (int s = 0; s < Qvz_MGTRCB::kSeqCount; ++s) {
        const bool on = s < 4 ? customLike && bonding : custom && bonding && seq2Use;
        ShowAll({labels[s], SeqEdit(s)}, true);
        EnableAll({labels[s], SeqEdit(s)}, on);
    }

    QCheckBox* use2 = f.IDC_CHECK_CHAN_BOND_SEQ_2_USE;
    use2->setVisible(true);
    // A block without the attribute has no second sequence to switch on.
    use2->setEnabled(custom && bonding &&
                     IsEditable(block->GetNamedAttribute("CHAN_BOND_SEQ_2_USE")));

    const bool fixedNumber =
        Has(name, "XAUI") ||
        block->GetAttributeValue("QVZ_GT11_MODE").Compare("SINGLE", Port::CompareExact) == 0;
    EnableAll({f.IDC_STATIC_CHAN_BOND_NUM, f.sbCBondNum}, !fixedNumber);
}

void Qvz_MGTRCBGui::OnCheckCBondSeq2Use() {
    if (!m_pPage)
        return;
    WidgetsToData();
    Qvz_Block* block = ActiveBlock();
    if (!block)
        return;
    Qvz_MGTRCBWidget& f = *m_pForm;
    const bool seq2Use = m_pPage->m_seq2Use != 0;
    const struct {
        const char* attr;
        QWidget *label, *edit;
    } pairs[] = {
        {"CHAN_BOND_SEQ_2_1", f.IDC_STATIC_CHAN_BOND_SEQ_2_1, f.IDC_EDIT_CHAN_BOND_SEQ_2_1},
        {"CHAN_BOND_SEQ_2_2", f.IDC_STATIC_CHAN_BOND_SEQ_2_2, f.IDC_EDIT_CHAN_BOND_SEQ_2_2},
        {"CHAN_BOND_SEQ_2_3", f.IDC_STATIC_CHAN_BOND_SEQ_2_3, f.IDC_EDIT_CHAN_BOND_SEQ_2_3},
        {"CHAN_BOND_SEQ_2_4", f.IDC_STATIC_CHAN_BOND_SEQ_2_4, f.IDC_EDIT_CHAN_BOND_SEQ_2_4},
        {"CHAN_BOND_SEQ_2_MASK", f.IDC_STATIC_CHAN_BOND_SEQ_2_MASK,
         f.IDC_EDIT_CHAN_BOND_SEQ_2_MASK},
    };
    for (const auto& pair : pairs)
        if (const Qvz_Attribute* a = block->GetNamedAttribute(pair.attr))
            EnableAll({pair.label, pair.edit}, seq2Use && a->IsEditable());
}

void Qvz_MGTRCBGui::OnSpinCBondNum(int value) {
    if (!m_active || !m_pPage)
        return;
    Qvz_MGTRCB& p = *m_pPage;
    const int step = value > p.m_cbondNum ? 1 : -1;
    WidgetsToData();
    int n = value;
    if (n == 1)
        n += step;
    else if (p.m_isGT11 && n % 2 != 0)
        n += step;
    // Checked after the skip of 1 as well: with a maximum of 1 the skip
    // would otherwise leave the range.
    if (n > p.m_MaxCBondNum)
        n = p.m_MinCBondNum;
    else if (n < p.m_MinCBondNum)
        n = p.m_MaxCBondNum;
    p.m_cbondNum = n;
    p.m_cbondNumText.Format("%d", n);
    // Setting the corrected number must not come back here as a new step.
    m_active = false;
    DataToWidgets();
    m_active = true;
    UpdateControls();
}

int Qvz_MGTRCBGui::CheckedBondNumber() {
    const Qvz_MGTRCB& p = *m_pPage;
    const int n = UT_STR::AToI(p.m_cbondNumText);
    if (n < p.m_MinCBondNum || n == 1 || n > p.m_MaxCBondNum) {
        Port::StringBase text;
        text.Format("The allowable range for the number of channel bonded transceivers is between "
                    "0 and %d, excluding 1.",
                    p.m_MaxCBondNum);
        m_pPage->IssueMessage(text, false, false, false);
        return -1;
    }
    return n;
}

void Qvz_MGTRCBGui::OnButtonViewPlacement() {
    if (!m_pPage)
        return;
    WidgetsToData();
    const int n = CheckedBondNumber();
    if (n < 0)
        return;
    Qvz_MGTRCB& p = *m_pPage;
    p.m_cbondNum = n;
    if (p.m_isGT11) {
        Qvz_MGTRCBConfig11Dialog dialog(nullptr, nullptr, false, {});
        dialog.m_pPage = &p;
        dialog.m_cbondNum = n;
        dialog.m_maxCBondNum = p.m_MaxCBondNum;
        dialog.DataToWidgets();
        dialog.exec();
    } else {
        Qvz_MGTRCBConfigDialog dialog(nullptr, nullptr, false, {});
        dialog.m_cbondNum = n;
        dialog.m_maxCBondNum = p.m_MaxCBondNum;
        dialog.m_primaryRowBottom = p.m_primaryRowBottom;
        dialog.DataToWidgets();
        dialog.exec();
    }
}

void Qvz_MGTRCBGui::OnButtonDefineLaneID() {
    if (!m_pPage)
        return;
    WidgetsToData();
    const int n = CheckedBondNumber();
    if (n < 0)
        return;
    Qvz_MGTRCB& p = *m_pPage;
    p.m_cbondNum = n;
    Qvz_MGTRCBLaneIDDialog dialog(nullptr, nullptr, false, {});
    dialog.SetLaneIds(p.m_laneIds);
    dialog.m_cbondNum = n;
    dialog.DataToWidgets();
    if (dialog.exec() == QDialog::Accepted)
        p.m_laneIds = dialog.m_laneIds;
}
