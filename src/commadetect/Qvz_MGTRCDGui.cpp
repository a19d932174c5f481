#include "Qvz_MGTRCDGui.h"

#include "Qvz_MGTRCD.h"
#include "Qvz_MGTRCDWidget.h"

#include <QRegularExpression>

namespace {

// Pattern and message of each validated entry, by family.
struct EntryPatterns {
    const char* gt11Pattern;
    const char* gt11Message;
    const char* pattern;
    const char* message;
};

const EntryPatterns kEntries[Qvz_MGTRCDGui::kEntryCount] = {
    {"([0-9A-Fa-f]){8}", "Please enter a valid 8-digit hex value for Plus-comma value",
     "([01]){10}", "Please enter a valid 10-bit binary value for Plus-comma value"},
    {"([0-9A-Fa-f]){8}", "Please enter a valid 8-digit hex value for Minus-comma value",
     "([01]){10}", "Please enter a valid 10-bit binary value for Minus-comma value"},
    {"([0-9A-Fa-f]){3}", "Please enter a valid 3-digit hex value for Comma Mask", "([01]){10}",
     "Please enter a valid 10-bit binary value for Comma Mask"},
};

} // namespace

Qvz_MGTRCDGui::Qvz_MGTRCDGui(Qvz_MGTRCD* page, QWidget* parent)
    : Qvz_MGTPageGui(page, parent, kEntryCount, "qvz_mgtrx1"), m_pPage(page) {
    m_pForm = new Qvz_MGTRCDWidget(nullptr, nullptr, false, {});
    SetPageForm("Receiver Comma Detect Setup", m_pForm);
    // Validators and connections wait for the first activation, when the
    // block's family is known; cbDisableCD is connected in init().
}

Qvz_MGTRCDGui::~Qvz_MGTRCDGui() = default;

bool Qvz_MGTRCDGui::ReadPage() {
    return m_pPage && m_pPage->ReadWizData();
}

bool Qvz_MGTRCDGui::WritePage() {
    return m_pPage && m_pPage->WriteWizData();
}

void Qvz_MGTRCDGui::init() {
    connect(m_pForm->cbDisableCD, &QCheckBox::toggled, this, &Qvz_MGTRCDGui::OnCheckTurnoffComma,
            Qt::UniqueConnection);
}

void Qvz_MGTRCDGui::onActive() {
    m_active = false;
    // In a window run the read loads the form and runs UpdateControls.
    ReadPage();
    SetupEntries();
    m_active = true;
    EnableMoreInfo();
}

void Qvz_MGTRCDGui::SetupEntries() {
    const bool gt11 = m_pPage && m_pPage->m_isGT11;
    QLineEdit* const edits[kEntryCount] = {m_pForm->lePCV, m_pForm->leMCV, m_pForm->leCommaMask};
    for (int i = 0; i < kEntryCount; ++i) {
        const EntryPatterns& e = kEntries[i];
        SetupEntry(i, edits[i], gt11 ? e.gt11Pattern : e.pattern, gt11 ? e.gt11Message : e.message);
    }
    ConnectEntries(this, &Qvz_MGTRCDGui::ValidateLE_ALL);
}

void Qvz_MGTRCDGui::LoadComboBoxes(Qvz_Block* block) {
    m_pForm->cbAlign->clear();
    if (block)
        FillComboBox(m_pForm->cbAlign, block->GetNamedAttribute("ALIGN_COMMA_WORD"));
}

void Qvz_MGTRCDGui::DataToWidgets() {
    if (!m_pPage)
        return;
    // Loading cbDisableCD must not run its slot on half-loaded widgets.
    const bool wasActive = m_active;
    m_active = false;
    const Qvz_MGTRCD& p = *m_pPage;
    Qvz_MGTRCDWidget& f = *m_pForm;
    f.cbPComma->setChecked(p.m_decPcommaDetect != 0);
    f.cbMComma->setChecked(p.m_decMcommaDetect != 0);
    f.cbAlignMSB->setChecked(p.m_alignCommaMsb != 0);
    f.cbVComma->setChecked(p.m_decValidCommaOnly != 0);
    f.cbDisableCD->setChecked(p.m_turnOffComma != 0);

    QRadioButton* const mcd[3] = {f.rbDynamicMCD, f.rbAlwaysMCD, f.rbDisableMCD};
    QRadioButton* const pcd[3] = {f.rbDynamicPCD, f.rbAlwaysPCD, f.rbDisablePCD};
    if (p.m_mcommaMode >= 0 && p.m_mcommaMode < 3)
        mcd[p.m_mcommaMode]->setChecked(true);
    if (p.m_pcommaMode >= 0 && p.m_pcommaMode < 3)
        pcd[p.m_pcommaMode]->setChecked(true);

    f.lePCV->setText(p.m_pcommaValue.ToQString());
    f.leMCV->setText(p.m_mcommaValue.ToQString());
    f.leCommaMask->setText(p.m_commaMask.ToQString());
    Qvz_WizPage::SetComboBoxText(f.cbAlign, p.m_alignCommaWord);
    m_active = wasActive;
}

void Qvz_MGTRCDGui::WidgetsToData() {
    if (!m_pPage)
        return;
    Qvz_MGTRCD& p = *m_pPage;
    const Qvz_MGTRCDWidget& f = *m_pForm;
    p.m_decPcommaDetect = f.cbPComma->isChecked();
    p.m_decMcommaDetect = f.cbMComma->isChecked();
    p.m_alignCommaMsb = f.cbAlignMSB->isChecked();
    p.m_decValidCommaOnly = f.cbVComma->isChecked();
    p.m_turnOffComma = f.cbDisableCD->isChecked();
    p.m_mcommaMode = (f.rbAlwaysMCD->isChecked() ? 1 : 0) + (f.rbDisableMCD->isChecked() ? 2 : 0);
    p.m_pcommaMode = (f.rbAlwaysPCD->isChecked() ? 1 : 0) + (f.rbDisablePCD->isChecked() ? 2 : 0);
    p.m_pcommaValue = Port::StringBase::FromQString(f.lePCV->text());
    p.m_mcommaValue = Port::StringBase::FromQString(f.leMCV->text());
    p.m_commaMask = Port::StringBase::FromQString(f.leCommaMask->text());
    ReadComboBox(f.cbAlign, p.m_alignCommaWord);
}

void Qvz_MGTRCDGui::UpdateControls() {
    Qvz_Block* block = ActiveBlock();
    if (!block || !m_pPage)
        return;
    Qvz_MGTRCDWidget& f = *m_pForm;
    const bool off = m_pPage->m_turnOffComma != 0;
    const bool bypass = Qvz_MGTWizPage::IsTrue(block, "QVZX_ONLY_BYPASS_PCS");

    const struct {
        QWidget* group;
        const char* attr10;
        const char* attr32;
        QWidget *label, *msb, *lsb, *edit;
        const char* detect;
        QWidget* detectGroup;
        const char* decoder;
        QWidget* decoderBox;
    } commas[] = {{f.gbPCD, "PCOMMA_10B_VALUE", "PCOMMA_32B_VALUE", f.IDC_STATIC_PCOMMA_10B_VALUE,
                   f.IDC_STATIC_MSB_PCOMMA, f.IDC_STATIC_LSB_PCOMMA, f.lePCV, "PCOMMA_DETECT",
                   f.bgPCD, "DEC_PCOMMA_DETECT", f.cbPComma},
                  {f.gbMCD, "MCOMMA_10B_VALUE", "MCOMMA_32B_VALUE", f.IDC_STATIC_MCOMMA_10B_VALUE,
                   f.IDC_STATIC_MSB_MCOMMA, f.IDC_STATIC_LSB_MCOMMA, f.leMCV, "MCOMMA_DETECT",
                   f.bgMCD, "DEC_MCOMMA_DETECT", f.cbMComma}};
    for (const auto& c : commas) {
        const Qvz_Attribute* pattern = block->GetNamedAttribute(c.attr10);
        if (!pattern)
            pattern = block->GetNamedAttribute(c.attr32);
        // The group follows the turn-off also without a pattern attribute, so
        // that a greyed group from an earlier block cannot trap its
        // detection choices.
        c.group->setEnabled(!off);
        EnableAll({c.label, c.msb, c.lsb, c.edit}, IsEditable(pattern) && !off);
        c.detectGroup->setEnabled(IsEditable(block->GetNamedAttribute(c.detect)) && !off);
        c.decoderBox->setEnabled(IsEditable(block->GetNamedAttribute(c.decoder)) && !off &&
                                 !bypass);
    }

    const Qvz_Attribute* mask = block->GetNamedAttribute("COMMA_10B_MASK");
    ApplyAttrRow(mask, !off,
                 {f.IDC_STATIC_COMMA_10B_MASK, f.leCommaMask, f.IDC_STATIC_MSB_COMMA,
                  f.IDC_STATIC_LSB_COMMA});
    const Qvz_Attribute* validOnly = block->GetNamedAttribute("DEC_VALID_COMMA_ONLY");
    ApplyAttrRow(validOnly, !off && !bypass, {f.cbVComma});
    const Qvz_Attribute* msb = block->GetNamedAttribute("ALIGN_COMMA_MSB");
    ApplyAttrRow(msb, !off, {f.cbAlignMSB});
    const Qvz_Attribute* word = block->GetNamedAttribute("ALIGN_COMMA_WORD");
    ApplyAttrRow(word, !off, {f.IDC_STATIC_ALIGN_COMMA_WORD, f.cbAlign});

    // The first family numbers its bits the other way round.
    const bool gt = block->SupportsMGT3();
    const QString left = gt ? "LSB" : "MSB", right = gt ? "MSB" : "LSB";
    for (QLabel* l : {f.IDC_STATIC_MSB_PCOMMA, f.IDC_STATIC_MSB_MCOMMA, f.IDC_STATIC_MSB_COMMA})
        l->setText(left);
    for (QLabel* l : {f.IDC_STATIC_LSB_PCOMMA, f.IDC_STATIC_LSB_MCOMMA, f.IDC_STATIC_LSB_COMMA})
        l->setText(right);

    const bool gt11 = block->SupportsMGT11();
    const QString patternEnd = gt11 ? " (8 hex digits):" : " (10-bit value):";
    f.IDC_STATIC_PCOMMA_10B_VALUE->setText("&Plus-comma value" + patternEnd);
    f.IDC_STATIC_MCOMMA_10B_VALUE->setText("&Minus-comma value" + patternEnd);
    f.IDC_STATIC_COMMA_10B_MASK->setText(QString("&Comma mask") +
                                         (gt11 ? " (3 hex digits):" : " (10-bit value):"));
}

void Qvz_MGTRCDGui::OnCheckTurnoffComma() {
    if (!m_active || !m_pPage)
        return;
    WidgetsToData();
    UpdateControls();
    // On: the decoder flags, MSB alignment and mask come back from the
    // block; off: they are cleared.
    m_pPage->ApplyTurnOffComma();
    DataToWidgets();
}

void Qvz_MGTRCDGui::ValidateEntry(int index, QLineEdit* edit, const char* gt11Message,
                                  const char* message) {
    if (!m_pPage)
        return;
    // The entry's whole pattern, as Next checks it, not only its length: a
    // longer or non-digit text loaded from the block is no more valid.
    const EntryPatterns& e = kEntries[index];
    const bool gt11 = m_pPage->m_isGT11;
    const QRegularExpression re(
        QRegularExpression::anchoredPattern(QString::fromUtf8(gt11 ? e.gt11Pattern : e.pattern)));
    if (re.match(edit->text()).hasMatch())
        return;
    m_pPage->IssueMessage(gt11 ? gt11Message : message, false, false, false);
    edit->setFocus();
}

void Qvz_MGTRCDGui::ValidatePComma() {
    ValidateEntry(kPlusComma, m_pForm->lePCV,
                  "Please enter a valid 8-digit hex decimal value for comma value",
                  "Please enter a valid 10-bit binary value for comma value");
}

void Qvz_MGTRCDGui::ValidateMComma() {
    ValidateEntry(kMinusComma, m_pForm->leMCV,
                  "Please enter a valid 8-digit hex decimal value for comma value",
                  "Please enter a valid 10-bit binary value for comma value");
}

void Qvz_MGTRCDGui::ValidateCommaMask() {
    ValidateEntry(kCommaMask, m_pForm->leCommaMask,
                  "Please enter a valid 3-digit hex decimal value for comma mask",
                  "Please enter a valid 10-bit binary value for comma mask");
}
