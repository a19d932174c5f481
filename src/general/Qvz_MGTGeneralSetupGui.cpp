#include "Qvz_MGTGeneralSetupGui.h"

#include "GeneralSetupWidget.h"
#include "Qvz_MGTGeneralSetup.h"
#include "Qvz_MGTPageGui.h"
#include "Qvz_MGTWizMain.h"
#include "Qvz_StrArray.h"
#include "Wg_Wizard.h"

#include <QButtonGroup>

using Port::CompareExact;

namespace {

// The address quoted in the note on the user guide.
const char* const kSupportSite = "https://support.example.com";

bool Equals(const Port::StringBase& s, const char* text) {
    return s.Compare(text, CompareExact) == 0;
}

Port::StringBase TextOf(const QComboBox* combo) {
    return Port::StringBase::FromQString(combo->currentText());
}

// Switches ifTrue on when condition holds, else its sibling: exclusive radio
// buttons cannot be switched off by themselves.
void SetOn(QRadioButton* ifTrue, QRadioButton* otherwise, bool condition) {
    (condition ? ifTrue : otherwise)->setChecked(true);
}

} // namespace

Qvz_MGTGeneralSetupGui::Qvz_MGTGeneralSetupGui(Qvz_MGTGeneralSetup* page, QWidget* parent)
    : Wg_WizardPage(parent), m_pPage(page) {
    m_pForm = new GeneralSetupWidget(nullptr, nullptr, {});
    setPageName("General Setup");
    setPageWidget(m_pForm);
}

Qvz_MGTGeneralSetupGui::~Qvz_MGTGeneralSetupGui() = default;

void Qvz_MGTGeneralSetupGui::onActive() {
    // The form keeps what the user left in it; only More Info is switched on.
    Qvz_WizMain* main = m_pPage ? m_pPage->m_pWizMain : nullptr;
    if (main && main->m_pWizard)
        main->m_pWizard->enableMoreInfo(true);
}

bool Qvz_MGTGeneralSetupGui::onNext() {
    if (!m_pPage)
        return false;
    SaveGUIToPage();
    if (!m_pPage->WriteWizData())
        return false;
    return Wg_WizardPage::onNext();
}

void Qvz_MGTGeneralSetupGui::onMoreInfo() {
    if (m_pPage)
        m_pPage->InvokeMoreInfo("qvz_mgtintro");
}

void Qvz_MGTGeneralSetupGui::InitUIData() {
    if (!m_pPage)
        return;
    Qvz_MGTGeneralSetup& p = *m_pPage;
    GeneralSetupWidget& f = *m_pForm;

    for (QWidget* w :
         {static_cast<QWidget*>(f.cbHalfRate), static_cast<QWidget*>(f.bgImpedence),
          static_cast<QWidget*>(f.gbBREFCLK), static_cast<QWidget*>(f.bgRefClkSelectionGT3)})
        w->setVisible(p.m_isGT);
    for (QWidget* w : {static_cast<QWidget*>(f.gbPMASpeed), static_cast<QWidget*>(f.cbEnablePMA),
                       static_cast<QWidget*>(f.cbUseREFCLK), static_cast<QWidget*>(f.cbUseBREFCLK)})
        w->setVisible(p.m_isGT10);
    f.cbBypassPCS->setHidden(p.m_isGT11);
    f.gbRefClkSelection->setHidden(p.m_isGT11);
    f.bgTXRef->setVisible(p.m_isGT11);
    f.bgRXRef->setVisible(p.m_isGT11);
    f.bgGT11Mode->setHidden(!p.m_isGT11);

    const char* guide = p.m_isGT10 ? "DOC2" : p.m_isGT11 ? "DOC3" : "DOC1";
    Port::StringBase note;
    note.Format("In order to ensure a successful multi-gigabit transceiver design, please review "
                "the Korvane Velomux Transceiver User Guide, %s.",
                guide);
    note += "  The user guide contains detailed information on digital and analog design "
            "considerations, including board level design guidelines to facilitate your system "
            "design.  The user guide is available on the Korvane support website, ";
    note += kSupportSite;
    note += " in the documentation category under the Products and Services heading.";
    f.textLabel1->setText(note.ToQString());

    Qvz_StrArray types;
    p.GetMgtTypeChoices(types, p.m_pWizData);
    types.Sort();
    f.cbTransceiver->clear();
    for (const Port::StringBase& t : types.Items())
        f.cbTransceiver->addItem(t.ToQString());

    RefreshForBlock(p.m_pBlock);

    // Only now: the refresh above must not run the slots.
    connect(f.cbTransceiver, &QComboBox::textActivated, this,
            &Qvz_MGTGeneralSetupGui::OnComboMGTType);
    connect(f.cbMGTWidth, &QComboBox::textActivated, this,
            &Qvz_MGTGeneralSetupGui::OnComboDataWidth);
    connect(f.bgRefClkSelectionGT3Buttons, &QButtonGroup::idClicked, this,
            &Qvz_MGTGeneralSetupGui::OnRadioRefClk);
    connect(f.bgREFCLKButtons, &QButtonGroup::idClicked, this,
            &Qvz_MGTGeneralSetupGui::OnRadioRefClk);
    connect(f.bgBREFCLKButtons, &QButtonGroup::idClicked, this,
            &Qvz_MGTGeneralSetupGui::OnRadioRefClk);
    connect(f.cbUseREFCLK, &QCheckBox::toggled, this, &Qvz_MGTGeneralSetupGui::OnRadioRefClk);
    connect(f.cbUseBREFCLK, &QCheckBox::toggled, this, &Qvz_MGTGeneralSetupGui::OnRadioRefClk);
    connect(f.cbTX, &QCheckBox::toggled, this, &Qvz_MGTGeneralSetupGui::OnCheckTXRX);
    connect(f.cbRX, &QCheckBox::toggled, this, &Qvz_MGTGeneralSetupGui::OnCheckTXRX);
    connect(f.bgGT11ModeButtons, &QButtonGroup::idClicked, this,
            &Qvz_MGTGeneralSetupGui::OnSingleMGT);
}

void Qvz_MGTGeneralSetupGui::RefreshForBlock(Qvz_Block* block) {
    if (!block || !m_pPage)
        return;
    Qvz_MGTGeneralSetup& p = *m_pPage;
    GeneralSetupWidget& f = *m_pForm;
    Qvz_WizPage::SetComboBoxText(f.cbTransceiver, p.m_displayName);
    LoadComboBox(f.cbMGTWidth, p.GetDataWidthChoices(block));
    Qvz_WizPage::SetComboBoxText(f.cbMGTWidth, p.m_dataWidth);
    if (!f.gbPMASpeed->isHidden()) {
        LoadComboBox(f.cbPMASpeed, p.GetPmaSpeedChoices(block, p.m_dataWidth));
        UpdatePmaSpeed(block);
    }
    DataToWidgets();
}

void Qvz_MGTGeneralSetupGui::LoadComboBox(QComboBox* combo, Qvz_StrArray* list) {
    if (!combo)
        return;
    combo->clear();
    if (!list)
        return;
    for (const Port::StringBase& item : list->Items())
        combo->addItem(item.ToQString());
}

Port::StringBase Qvz_MGTGeneralSetupGui::GetCurrentWidthSetting() const {
    return TextOf(m_pForm->cbMGTWidth);
}

void Qvz_MGTGeneralSetupGui::UpdatePmaSpeed(Qvz_Block* block) {
    if (!block || !m_pPage || !block->GetNamedAttribute("PMA_SPEED"))
        return;
    Port::StringBase speed = m_pPage->m_pmaSpeed;
    Port::StringBase width = GetCurrentWidthSetting();
    m_pPage->CheckPmaSpeed(block, speed, width);
    Qvz_WizPage::SetComboBoxText(m_pForm->cbPMASpeed, speed);
    m_pForm->cbPMASpeed->setEnabled(m_pPage->m_pmaSpeedEditable);
}

void Qvz_MGTGeneralSetupGui::DataToWidgets() {
    if (!m_pPage)
        return;
    const Qvz_MGTGeneralSetup& p = *m_pPage;
    GeneralSetupWidget& f = *m_pForm;

    f.cbHalfRate->setChecked(p.m_serdes10b);
    f.cbHalfRate->setEnabled(p.m_serdes10bEditable);
    SetOn(f.rb50Ohms, f.rb75Ohms, Equals(p.m_termination, "50"));
    f.bgImpedence->setEnabled(p.m_terminationEditable);

    if (p.m_isGT) {
        SetOn(f.rbUseREFCLK, f.rbUseBREFCLK, p.m_refClkVSel == "0");
        f.bgRefClkSelectionGT3->setEnabled(p.m_refClkVSelEditable);
        SetOn(f.rbStaticControlB, f.rbDynamicControlB, Equals(p.m_bRefClkDyn, "STATIC"));
        SetOn(f.rbBREFCLK2, f.rbBREFCLK, !Equals(p.m_bRefClk, "BREFCLK"));
    }
    if (p.m_isGT10) {
        f.cbUseREFCLK->setChecked(p.m_useRefClk != 0);
        f.cbUseBREFCLK->setChecked(p.m_useBRefClk != 0);
        OnRadioRefClk();
        f.cbEnablePMA->setChecked(p.m_enablePma);
        f.cbEnablePMA->setEnabled(p.m_enablePmaEditable);
    }

    SetOn(f.rbStaticControl, f.rbDynamicControl, Equals(p.m_refClkDyn, "STATIC"));
    SetOn(f.rbREFCLK2, f.rbREFCLK, Equals(p.m_refClk, "REFCLK2"));

    f.cbBypassPCS->setChecked(p.m_bypassPcs);
    f.cbBypassPCS->setEnabled(p.m_bypassPcsEditable);

    if (p.m_isGT11) {
        SetOn(f.radioSingleMGT, f.radioBothMGTs, p.m_gt11Single);
        SetOn(f.radioB, f.radioA, p.m_gt11UseB);
        f.buttonGrpSingleMGT->setEnabled(f.radioSingleMGT->isChecked());
        QRadioButton* tx = Equals(p.m_txabPmaClkSel, "REFCLK1")   ? f.rbTXREFCLK
                           : Equals(p.m_txabPmaClkSel, "REFCLK2") ? f.rbTXREFCLK2
                                                                  : f.rbTXGREFCLK;
        tx->setChecked(true);
        QRadioButton* rx = Equals(p.m_rxPmaClkSel, "REFCLK1")   ? f.rbRXREFCLK
                           : Equals(p.m_rxPmaClkSel, "REFCLK2") ? f.rbRXREFCLK2
                                                                : f.rbRXGREFCLK;
        rx->setChecked(true);
    }

    f.cbTX->setChecked(p.m_txUse);
    f.cbRX->setChecked(p.m_rxUse);
    OnRadioRefClk();
}

void Qvz_MGTGeneralSetupGui::SaveGUIToPage() {
    if (!m_pPage)
        return;
    Qvz_MGTGeneralSetup& p = *m_pPage;
    const GeneralSetupWidget& f = *m_pForm;

    Qvz_MGTPageGui::ReadComboBox(f.cbTransceiver, p.m_displayName);
    Qvz_MGTPageGui::ReadComboBox(f.cbMGTWidth, p.m_dataWidth);
    Qvz_MGTPageGui::ReadComboBox(f.cbPMASpeed, p.m_pmaSpeed);
    p.m_txUse = f.cbTX->isChecked();
    p.m_rxUse = f.cbRX->isChecked();
    p.m_refClkVSel = f.rbUseBREFCLK->isChecked() ? "1" : "0";
    p.m_refClkDyn = f.rbStaticControl->isChecked() ? "STATIC" : "DYNAMIC";
    p.m_refClk = f.rbREFCLK2->isChecked() ? "REFCLK2" : "REFCLK";
    p.m_useRefClk = f.cbUseREFCLK->isChecked() ? 1 : 0;
    p.m_useBRefClk = f.cbUseBREFCLK->isChecked() ? 1 : 0;
    p.m_bRefClkDyn = f.rbStaticControlB->isChecked() ? "STATIC" : "DYNAMIC";
    p.m_bRefClk = f.rbBREFCLK2->isChecked() ? "BREFCLK2" : "BREFCLK";
    p.m_serdes10b = f.cbHalfRate->isChecked();
    p.m_bypassPcs = f.cbBypassPCS->isChecked();
    p.m_termination = f.rb75Ohms->isChecked() ? "75" : "50";
    p.m_gt11Single = f.radioSingleMGT->isChecked();
    p.m_gt11UseB = f.radioB->isChecked();
    p.m_enablePma = f.cbEnablePMA->isChecked();
    p.m_txabPmaClkSel = f.rbTXREFCLK2->isChecked()   ? "REFCLK2"
                        : f.rbTXGREFCLK->isChecked() ? "GREFCLK"
                                                     : "REFCLK1";
    p.m_rxPmaClkSel = f.rbRXREFCLK2->isChecked()   ? "REFCLK2"
                      : f.rbRXGREFCLK->isChecked() ? "GREFCLK"
                                                   : "REFCLK1";
}

void Qvz_MGTGeneralSetupGui::OnComboMGTType(const QString& text) {
    if (!m_pPage || !m_pPage->m_pWizData)
        return;
    auto* main = dynamic_cast<Qvz_MGTWizMain*>(m_pPage->m_pWizMain);
    if (!main)
        return;
    Qvz_WizData* data = m_pPage->m_pWizData;
    const Port::StringBase type = Port::StringBase::FromQString(text);
    Qvz_Block* block = main->GetBlock(data, type, GetCurrentWidthSetting(), false);
    // A type offered only at other widths is still taken.
    if (!block)
        block = main->GetBlock(data, type, GetCurrentWidthSetting(), true);
    if (!block)
        return;
    m_pPage->ReadWizData(block);
    RefreshForBlock(block);
}

void Qvz_MGTGeneralSetupGui::OnComboDataWidth(const QString& text) {
    if (!m_pPage)
        return;
    const Qvz_MGTGeneralSetup& p = *m_pPage;
    // GT widths are taken at Next: every width is the same block there.
    if (!p.m_isGT10 && !p.m_isGT11)
        return;
    const Port::StringBase type = TextOf(m_pForm->cbTransceiver);
    if (p.m_isGT11 && Equals(type, "Custom"))
        return;
    auto* main = dynamic_cast<Qvz_MGTWizMain*>(p.m_pWizMain);
    if (!p.m_pWizData || !main)
        return;
    const Port::StringBase width = Port::StringBase::FromQString(text);
    Qvz_Block* block = main->GetBlock(p.m_pWizData, type, width, false);
    if (!block)
        return;
    if (p.m_isGT10 && Equals(type, "10G Custom")) {
        // One block serves every width: keep the user's other settings.
        LoadComboBox(m_pForm->cbPMASpeed, m_pPage->GetPmaSpeedChoices(block, width));
        UpdatePmaSpeed(block);
        return;
    }
    m_pPage->ReadWizData(block);
    RefreshForBlock(block);
}

void Qvz_MGTGeneralSetupGui::OnRadioRefClk() {
    if (!m_pPage)
        return;
    GeneralSetupWidget& f = *m_pForm;
    f.bgStaticControl->setEnabled(f.rbStaticControl->isChecked());
    f.bgStaticControlB->setEnabled(f.rbStaticControlB->isChecked());
    if (m_pPage->m_isGT) {
        f.gbREFCLK->setEnabled(f.rbUseREFCLK->isChecked());
        f.gbBREFCLK->setEnabled(f.rbUseBREFCLK->isChecked());
    }
    if (m_pPage->m_isGT10) {
        f.gbREFCLK->setEnabled(f.cbUseREFCLK->isChecked());
        f.gbBREFCLK->setEnabled(f.cbUseBREFCLK->isChecked());
    }
}

void Qvz_MGTGeneralSetupGui::OnCheckTXRX() {
    m_pForm->bgTXRef->setEnabled(m_pForm->cbTX->isChecked());
    m_pForm->bgRXRef->setEnabled(m_pForm->cbRX->isChecked());
}

void Qvz_MGTGeneralSetupGui::OnSingleMGT() {
    m_pForm->buttonGrpSingleMGT->setEnabled(m_pForm->radioSingleMGT->isChecked());
}
