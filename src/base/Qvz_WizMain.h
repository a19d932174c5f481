#pragma once
// Base of a wizard main: owns the run (window or batch), the page table and
// the facts of the target that the pages read.

#include "Port_StringBase.h"
#include "Qvz_Messages.h"
#include "Qvz_WizData.h"

#include <vector>

class Qvz_WizPage;
class Wg_SummaryPage;
class Wg_Wizard;
class Wg_WizardPage;

enum class Qvz_RunMode { Batch, Window };

// What a run ended with (the host maps these to exit statuses).
enum Qvz_RunResult { Qvz_RunCompleted = 0, Qvz_RunRefused = 1 };

class Qvz_WizMain {
public:
    static constexpr int kMaxPages = 10;

    Qvz_WizMain(const Port::StringBase& name, bool flag);
    // Copies the settings, not the pages (each main owns its own).
    Qvz_WizMain(const Qvz_WizMain& other);
    Qvz_WizMain& operator=(const Qvz_WizMain& other);
    virtual ~Qvz_WizMain();

    // Host side, before Run: the design data (not owned) and the mode. The
    // target's family flags, bonding maxima and file name are taken from the
    // data at once.
    void SetWizData(Qvz_WizData* data);
    Qvz_WizData* GetWizData() const { return m_pWizData; }
    void SetRunMode(Qvz_RunMode mode) { m_runMode = mode; }
    Qvz_RunMode GetRunMode() const { return m_runMode; }
    // Not owned; null sends messages nowhere but the record.
    void SetMessageSink(Qvz_MessageSink* sink) { m_pSink = sink; }
    Qvz_MessageSink* GetMessageSink() const { return m_pSink; }
    void SetHelpHandler(Qvz_HelpHandler* help) { m_pHelp = help; }
    const Port::StringBase& GetName() const { return m_name; }
    bool GetFlag() const { return m_flag; }

    // Runs the wizard: returns a Qvz_RunResult.
    virtual int Run();
    // The steps of a run, for hosts and tests that drive a run themselves:
    // takes the mode and target, and makes the pages afresh.
    void Prepare();
    // Window runs: has each page make its controller, adds the summary page
    // (filled when it is entered) with the summary hooks, and customizes the
    // dialog. Returns what the customization answered.
    bool BuildDialog(Wg_Wizard* wizard);
    // Ends a run the way Finish does; returns its result.
    int FinishRun() { return Finish(); }
    virtual int RunGuiMode();
    virtual int RunBatchMode();
    virtual bool CreateGuiDlgs(Wg_Wizard* wizard);

    // Messages and help, as issued by the pages.
    void IssueMessage(const Port::StringBase& text, bool f1, bool f2, bool f3);
    void InvokeMoreInfo(const Port::StringBase& key);
    const std::vector<Qvz_Message>& GetMessages() const { return m_messages; }
    // Title of the page whose batch step refused, or "" when none did.
    const Port::StringBase& GetFailedPageTitle() const { return m_failedPage; }
    // A window run ended by Finish while the summary's finish routine had
    // failed: refused, since the design data is not complete.
    bool EndedIncomplete() const { return m_endedIncomplete; }

    Qvz_WizPage* GetPage(int slot) const;
    Wg_Wizard* GetWizard() const { return m_pWizard; }
    Wg_WizardPage* GetSummaryPage() const { return m_pSummaryPage; }

    // The window run's own part of the summary hooks, for the framework.
    bool EnterSummary() { return DoFinishAtSummaryStart(); }
    void LeaveSummary() { GoBackFromSummary(); }

protected:
    virtual void GoBackFromSummary() {}
    virtual bool DoFinishAtSummaryStart() { return true; }
    virtual int Finish() { return 0; }
    virtual bool CustomizeGui(Wg_Wizard* /*wizard*/) { return true; }
    virtual bool InstantiatePages() { return true; }
    // Title of the page in slot (for the run report); "" when unknown.
    virtual Port::StringBase GetPageTitle(int /*slot*/) const { return Port::StringBase(); }

    void DeletePages();

public:
    Qvz_WizPage* m_pPages[kMaxPages] = {};
    Wg_WizardPage* m_pSummaryPage = nullptr;
    Wg_Wizard* m_pWizard = nullptr;
    Port::StringBase m_fileName;
    bool m_batchMode = true;
    bool m_supportsMGT3 = false;
    bool m_supportsMGT10 = false;
    bool m_supportsMGT11 = false;
    int m_maxBondGT = 0;
    int m_maxBondGT10 = 0;
    int m_maxBondGT11 = 0;

private:
    // Shows the design data's summary; finished false marks it incomplete.
    void FillSummary(Wg_SummaryPage* page, bool finished) const;

    Port::StringBase m_name;
    bool m_flag = false;
    Qvz_WizData* m_pWizData = nullptr;
    Qvz_RunMode m_runMode = Qvz_RunMode::Batch;
    Qvz_MessageSink* m_pSink = nullptr;
    Qvz_HelpHandler* m_pHelp = nullptr;
    std::vector<Qvz_Message> m_messages;
    Port::StringBase m_failedPage;
    bool m_summaryFinished = false;
    bool m_endedIncomplete = false;
};
