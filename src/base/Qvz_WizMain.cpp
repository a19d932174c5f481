#include "Qvz_WizMain.h"

#include "Qvz_Summary.h"
#include "Qvz_WizPage.h"
#include "Wg_SummaryPage.h"
#include "Wg_Wizard.h"

#include <QDialog>

Qvz_WizMain::Qvz_WizMain(const Port::StringBase& name, bool flag) : m_name(name), m_flag(flag) {}

Qvz_WizMain::Qvz_WizMain(const Qvz_WizMain& other)
    : m_fileName(other.m_fileName), m_batchMode(other.m_batchMode),
      m_supportsMGT3(other.m_supportsMGT3), m_supportsMGT10(other.m_supportsMGT10),
      m_supportsMGT11(other.m_supportsMGT11), m_maxBondGT(other.m_maxBondGT),
      m_maxBondGT10(other.m_maxBondGT10), m_maxBondGT11(other.m_maxBondGT11), m_name(other.m_name),
      m_flag(other.m_flag), m_pWizData(other.m_pWizData), m_runMode(other.m_runMode),
      m_pSink(other.m_pSink), m_pHelp(other.m_pHelp) {}

Qvz_WizMain& Qvz_WizMain::operator=(const Qvz_WizMain& other) {
    if (this == &other)
        return *this;
    DeletePages();
    m_fileName = other.m_fileName;
    m_batchMode = other.m_batchMode;
    m_supportsMGT3 = other.m_supportsMGT3;
    m_supportsMGT10 = other.m_supportsMGT10;
    m_supportsMGT11 = other.m_supportsMGT11;
    m_maxBondGT = other.m_maxBondGT;
    m_maxBondGT10 = other.m_maxBondGT10;
    m_maxBondGT11 = other.m_maxBondGT11;
    m_name = other.m_name;
    m_flag = other.m_flag;
    m_pWizData = other.m_pWizData;
    m_runMode = other.m_runMode;
    m_pSink = other.m_pSink;
    m_pHelp = other.m_pHelp;
    m_messages.clear();
    m_failedPage = Port::StringBase();
    return *this;
}

Qvz_WizMain::~Qvz_WizMain() {
    DeletePages();
}

void Qvz_WizMain::DeletePages() {
    for (auto*& p : m_pPages) {
        delete p;
        p = nullptr;
    }
}

void Qvz_WizMain::SetWizData(Qvz_WizData* data) {
    m_pWizData = data;
    const Qvz_Target t = data ? data->Target() : Qvz_Target();
    m_supportsMGT3 = t.supportsGT;
    m_supportsMGT10 = t.supportsGT10;
    m_supportsMGT11 = t.supportsGT11;
    m_maxBondGT = t.maxBondGT;
    m_maxBondGT10 = t.maxBondGT10;
    m_maxBondGT11 = t.maxBondGT11;
    m_fileName = t.fileName;
}

Qvz_WizPage* Qvz_WizMain::GetPage(int slot) const {
    return slot >= 0 && slot < kMaxPages ? m_pPages[slot] : nullptr;
}

void Qvz_WizMain::Prepare() {
    m_messages.clear();
    m_failedPage = Port::StringBase();
    m_batchMode = (m_runMode == Qvz_RunMode::Batch);
    SetWizData(m_pWizData); // the target may have changed since
    DeletePages();
    InstantiatePages();
}

int Qvz_WizMain::Run() {
    Prepare();
    return m_batchMode ? RunBatchMode() : RunGuiMode();
}

int Qvz_WizMain::RunBatchMode() {
    for (int i = 0; i < kMaxPages && m_pPages[i]; ++i) {
        if (!m_pPages[i]->DoBatchPage()) {
            m_failedPage = GetPageTitle(i);
            return Qvz_RunRefused;
        }
    }
    return Finish() == 0 ? Qvz_RunCompleted : Qvz_RunRefused;
}

bool Qvz_WizMain::CreateGuiDlgs(Wg_Wizard* wizard) {
    bool ok = true;
    for (int i = 0; i < kMaxPages && m_pPages[i]; ++i)
        ok = m_pPages[i]->CreateGuiDlg(wizard) && ok;
    return ok;
}

bool Qvz_WizMain::BuildDialog(Wg_Wizard* wizard) {
    m_pWizard = wizard;
    m_pSummaryPage = nullptr;
    CreateGuiDlgs(wizard);
    if (wizard) {
        auto* summary = new Wg_SummaryPage(wizard);
        m_pSummaryPage = summary;
        wizard->setSummaryPage(summary);
        wizard->setEnterSummaryHook([this, summary] {
            const bool ok = EnterSummary();
            m_summaryFinished = ok;
            FillSummary(summary, ok);
            return ok;
        });
        wizard->setLeaveSummaryHook([this] { LeaveSummary(); });
        FillSummary(summary, false);
    }
    const bool customized = CustomizeGui(wizard);
    // A customization that does not place the summary still ends with it.
    if (wizard && wizard->indexOf(m_pSummaryPage) < 0)
        wizard->addPage(m_pSummaryPage);
    return customized;
}

void Qvz_WizMain::FillSummary(Wg_SummaryPage* page, bool finished) const {
    if (!page)
        return;
    const Qvz_Summary s = m_pWizData ? Qvz_Summary::Of(*m_pWizData) : Qvz_Summary();
    QString text = s.ToText(false);
    if (!finished)
        text += "The ports, pins and bonded copies could not be completed.\n";
    page->setSummary(s.ToHtml(finished), text);
}

int Qvz_WizMain::RunGuiMode() {
    int result = Qvz_RunRefused;
    {
        Wg_Wizard wizard;
        BuildDialog(&wizard);
        m_summaryFinished = false;
        m_endedIncomplete = false;
        if (wizard.exec() == QDialog::Accepted) {
            // Finish on a summary whose finish routine failed would hand the
            // host undecided pins as if they were done.
            m_endedIncomplete = !m_summaryFinished;
            if (!m_endedIncomplete)
                result = Finish() == 0 ? Qvz_RunCompleted : Qvz_RunRefused;
        }
        // The controllers die with the dialog; nothing may reach them after.
        m_pSummaryPage = nullptr;
        m_pWizard = nullptr;
    }
    DeletePages();
    return result;
}

void Qvz_WizMain::IssueMessage(const Port::StringBase& text, bool f1, bool f2, bool f3) {
    Qvz_Message m{text, f1, f2, f3};
    m_messages.push_back(m);
    if (m_pSink)
        m_pSink->Show(m);
}

void Qvz_WizMain::InvokeMoreInfo(const Port::StringBase& key) {
    if (!m_batchMode && m_pHelp)
        m_pHelp->Open(key);
}
