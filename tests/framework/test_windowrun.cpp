#include "DialogDriver.h"
#include "Qvz_Messages.h"
#include "Qvz_WizMain.h"
#include "Qvz_WizPage.h"
#include "Wg_SummaryPage.h"

#include <QLabel>
#include <QMessageBox>
#include <QTextBrowser>
#include <gtest/gtest.h>

namespace {

class TestPage;

// A controller that issues a message through its page when told to.
class TestGui : public Wg_WizardPage {
public:
    TestGui(TestPage* page, const QString& title, QWidget* parent);
    bool onNext() override;
    void onMoreInfo() override;

    QString message; // issued on Next when not empty
    bool critical = false;

private:
    TestPage* m_page;
};

class TestPage : public Qvz_WizPage {
public:
    TestPage(Qvz_WizMain* main, const QString& title) : Qvz_WizPage(main), m_title(title) {}
    bool CreateGuiDlg(QWidget* parent) override {
        m_gui = parent ? new TestGui(this, m_title, parent) : nullptr;
        return m_gui != nullptr;
    }
    Wg_WizardPage* GetGuiDlg() override { return m_gui; }
    TestGui* Gui() const { return m_gui; }

private:
    QString m_title;
    TestGui* m_gui = nullptr;
};

TestGui::TestGui(TestPage* page, const QString& title, QWidget* parent)
    : Wg_WizardPage(parent), m_page(page) {
    setPageName(title);
    setPageWidget(new QLabel(title, parent));
}

bool TestGui::onNext() {
    if (!message.isEmpty())
        m_page->IssueMessage(Port::StringBase::FromQString(message), critical, false, false);
    return Wg_WizardPage::onNext();
}

void TestGui::onMoreInfo() {
    m_page->InvokeMoreInfo("qvz_mgttx");
}

// Two pages, linked as a wizard main links them; the summary hooks count,
// and entering the summary makes a port the way the finish routine would.
class TestMain : public Qvz_WizMain {
public:
    TestMain() : Qvz_WizMain("Test Wizard", false) {}
    TestGui* Gui(int slot) const {
        auto* p = static_cast<TestPage*>(GetPage(slot));
        return p ? p->Gui() : nullptr;
    }
    int enters = 0;
    int leaves = 0;
    int finishes = 0;
    bool enterAnswer = true;

protected:
    bool InstantiatePages() override {
        m_pPages[0] = new TestPage(this, "One");
        m_pPages[1] = new TestPage(this, "Two");
        return true;
    }
    bool CustomizeGui(Wg_Wizard* wizard) override {
        wizard->setCaption("Test Wizard");
        m_pPages[0]->GetGuiDlg()->setPageNextName("Two");
        m_pPages[1]->GetGuiDlg()->setPageBackName("One");
        m_pPages[1]->GetGuiDlg()->setPageNextName("Summary");
        m_pSummaryPage->setPageBackName("Two");
        wizard->addPage(m_pPages[0]->GetGuiDlg());
        wizard->addPage(m_pPages[1]->GetGuiDlg());
        wizard->addPage(m_pSummaryPage);
        return true;
    }
    bool DoFinishAtSummaryStart() override {
        ++enters;
        if (Qvz_Block* b = GetWizData()->GetActiveBlock()) {
            GetWizData()->AddSignal("TXDATA_IN", true, "I")->SetIsBus(true, 32);
            b->GetNamedPin("TXDATA")->SetSigName("TXDATA_IN");
        }
        return enterAnswer;
    }
    void GoBackFromSummary() override { ++leaves; }
    int Finish() override {
        ++finishes;
        return 0;
    }
};

void MakeData(Qvz_WizData& data) {
    auto b = std::make_unique<Qvz_Block>("GT10_CUSTOM_INST", "GT10_CUSTOM", Qvz_Family::GT10);
    b->AddAttribute("MGT_DISPLAY_NAME", "10G Custom");
    b->AddAttribute("QVZ_RX_DATA_WIDTH", "4");
    b->AddPin("TXDATA", "IN")->SetWidth(32);
    b->SetIsUsed(true);
    data.AddBlock(std::move(b));
}

QString SummaryText(Qvz_WizMain& wiz) {
    auto* s = dynamic_cast<Wg_SummaryPage*>(wiz.GetSummaryPage());
    return s ? s->summaryText() : QString("(no summary page)");
}

} // namespace

TEST(WindowRun, FinishOnTheSummaryCompletesTheRun) {
    TestApp();
    Qvz_WizData data;
    MakeData(data);
    TestMain wiz;
    Qvz_RecordingSink sink;
    wiz.SetWizData(&data);
    wiz.SetMessageSink(&sink);
    wiz.SetRunMode(Qvz_RunMode::Window);
    QString title, summary;
    DialogDriver driver({
        [&] { title = FindWizard() ? FindWizard()->windowTitle() : ""; },
        [] { Click("buttonNext"); },
        [] { Click("buttonNext"); },
        [&] { summary = SummaryText(wiz); },
        [] { Click("buttonBack"); },
        [] { Click("buttonNext"); },
        [] { Click("buttonFinish"); },
    });
    driver.Start();
    EXPECT_EQ(wiz.Run(), Qvz_RunCompleted);
    EXPECT_TRUE(driver.Done());
    EXPECT_FALSE(driver.TimedOut());
    EXPECT_EQ(title, "Test Wizard");
    EXPECT_EQ(wiz.enters, 2);
    EXPECT_EQ(wiz.leaves, 1);
    EXPECT_EQ(wiz.finishes, 1);
    // The summary is filled after the finish routine has run.
    EXPECT_TRUE(summary.contains("GT10_CUSTOM_INST")) << summary.toStdString();
    EXPECT_TRUE(summary.contains("TXDATA -> TXDATA_IN (32 bits)")) << summary.toStdString();
    // The dialog and its controllers are gone; nothing points at them.
    EXPECT_EQ(wiz.GetWizard(), nullptr);
    EXPECT_EQ(wiz.GetSummaryPage(), nullptr);
    EXPECT_EQ(FindWizard(), nullptr);
}

TEST(WindowRun, CancelRefusesTheRunWithoutFinishing) {
    TestApp();
    Qvz_WizData data;
    MakeData(data);
    TestMain wiz;
    wiz.SetWizData(&data);
    wiz.SetRunMode(Qvz_RunMode::Window);
    DialogDriver driver({[] { Click("buttonNext"); }, [] { Click("buttonCancel"); }});
    driver.Start();
    EXPECT_EQ(wiz.Run(), Qvz_RunRefused);
    EXPECT_FALSE(driver.TimedOut());
    EXPECT_EQ(wiz.finishes, 0);
    EXPECT_EQ(wiz.enters, 0);
}

TEST(WindowRun, FinishFromASetupPageWhoseSummaryFailsStaysOnTheSummary) {
    TestApp();
    Qvz_WizData data;
    MakeData(data);
    TestMain wiz;
    wiz.enterAnswer = false;
    wiz.SetWizData(&data);
    wiz.SetRunMode(Qvz_RunMode::Window);
    QString page, summary;
    DialogDriver driver({
        [] { Click("buttonFinish"); },
        [&] {
            page = CurrentPageName();
            summary = SummaryText(wiz);
        },
        [] { Click("buttonFinish"); },
    });
    driver.Start();
    // Finish on a summary whose finish routine failed refuses the run: the
    // design data would otherwise go out with undecided pins.
    EXPECT_EQ(wiz.Run(), Qvz_RunRefused);
    EXPECT_TRUE(wiz.EndedIncomplete());
    EXPECT_EQ(page, "Summary");
    EXPECT_TRUE(summary.contains("could not be completed")) << summary.toStdString();
    EXPECT_EQ(wiz.enters, 1);
    EXPECT_EQ(wiz.finishes, 0);
}

TEST(WindowRun, ASummaryEnteredAgainSuccessfullyCanFinish) {
    TestApp();
    Qvz_WizData data;
    MakeData(data);
    TestMain wiz;
    wiz.enterAnswer = false;
    wiz.SetWizData(&data);
    wiz.SetRunMode(Qvz_RunMode::Window);
    DialogDriver driver({
        [] { Click("buttonFinish"); },
        [&] { wiz.enterAnswer = true; },
        [] { Click("buttonBack"); },
        [] { Click("buttonNext"); },
        [] { Click("buttonFinish"); },
    });
    driver.Start();
    EXPECT_EQ(wiz.Run(), Qvz_RunCompleted);
    EXPECT_FALSE(wiz.EndedIncomplete());
    EXPECT_EQ(wiz.enters, 2);
    EXPECT_EQ(wiz.finishes, 1);
}

TEST(WindowRun, MessagesReachTheSinkAndTheRecord) {
    TestApp();
    Qvz_WizData data;
    MakeData(data);
    TestMain wiz;
    Qvz_RecordingSink sink;
    wiz.SetWizData(&data);
    wiz.SetMessageSink(&sink);
    wiz.SetRunMode(Qvz_RunMode::Window);
    DialogDriver driver({
        [&] {
            wiz.Gui(0)->message = "Please select transmitter mode and/or receiver mode.";
            Click("buttonNext");
        },
        [] { Click("buttonCancel"); },
    });
    driver.Start();
    EXPECT_EQ(wiz.Run(), Qvz_RunRefused);
    ASSERT_EQ(sink.messages.size(), 1u);
    EXPECT_EQ(sink.messages[0].text, "Please select transmitter mode and/or receiver mode.");
    ASSERT_EQ(wiz.GetMessages().size(), 1u);
    EXPECT_EQ(wiz.GetMessages()[0].text, sink.messages[0].text);
    EXPECT_FALSE(wiz.GetMessages()[0].flag1);
}

TEST(WindowRun, MessageBoxSinkShowsABoxOverTheDialog) {
    TestApp();
    struct Case {
        bool critical;
        QMessageBox::Icon icon;
    };
    for (const Case c :
         {Case{true, QMessageBox::Critical}, Case{false, QMessageBox::Information}}) {
        Qvz_WizData data;
        MakeData(data);
        TestMain wiz;
        Qvz_MessageBoxSink sink(&wiz);
        wiz.SetWizData(&data);
        wiz.SetMessageSink(&sink);
        wiz.SetRunMode(Qvz_RunMode::Window);
        QMessageBox::Icon icon = QMessageBox::NoIcon;
        QString text;
        bool parented = false;
        DialogDriver driver({
            [&] {
                wiz.Gui(0)->message = "Internal error: unable to create GUI object";
                wiz.Gui(0)->critical = c.critical;
                Click("buttonNext");
            },
            [&] {
                if (auto* box = qobject_cast<QMessageBox*>(QApplication::activeModalWidget())) {
                    icon = box->icon();
                    text = box->text();
                    parented = box->parentWidget() == wiz.GetWizard();
                    box->accept();
                }
            },
            [] { Click("buttonCancel"); },
        });
        driver.Start();
        EXPECT_EQ(wiz.Run(), Qvz_RunRefused);
        EXPECT_FALSE(driver.TimedOut());
        EXPECT_EQ(icon, c.icon);
        EXPECT_EQ(text, "Internal error: unable to create GUI object");
        EXPECT_TRUE(parented);
        EXPECT_EQ(wiz.GetMessages().size(), 1u);
    }
}

TEST(WindowRun, MoreInfoOpensTheHelpWindow) {
    TestApp();
    Qvz_WizData data;
    MakeData(data);
    TestMain wiz;
    Qvz_HelpWindow help(&wiz);
    wiz.SetWizData(&data);
    wiz.SetHelpHandler(&help);
    wiz.SetRunMode(Qvz_RunMode::Window);
    QString shown;
    bool visible = false;
    DialogDriver driver({
        [&] { wiz.Gui(0)->onMoreInfo(); },
        [&] {
            visible = help.Window() && help.Window()->isVisible();
            if (auto* b = help.Window() ? help.Window()->findChild<QTextBrowser*>("helpBrowser")
                                        : nullptr)
                shown = b->toPlainText();
        },
        [] { Click("buttonCancel"); },
    });
    driver.Start();
    wiz.Run();
    EXPECT_TRUE(visible);
    EXPECT_TRUE(shown.contains("Transmitter")) << shown.toStdString();
    // The window went with the dialog it belonged to.
    EXPECT_EQ(help.Window(), nullptr);
}

TEST(Help, EveryKeyHasAPageAndOddKeysNone) {
    TestApp();
    for (const char* key :
         {"qvz_mgtintro", "qvz_mgttx", "qvz_mgtrx1", "qvz_mgtrx2", "qvz_mgtclkcor", "qvz_mgtrx3"}) {
        const QString page = Qvz_HelpWindow::PageOf(key);
        ASSERT_FALSE(page.isEmpty()) << key;
        QTextBrowser browser;
        browser.setSource(QUrl("qrc" + page));
        EXPECT_FALSE(browser.documentTitle().isEmpty()) << key;
        EXPECT_GT(browser.toPlainText().size(), 400) << key;
    }
    for (const char* key : {"", "qvz_nosuch", "../targets/gt10", "QVZ_MGTTX", "qvz_mgttx.html"})
        EXPECT_TRUE(Qvz_HelpWindow::PageOf(key).isEmpty()) << key;

    // Unknown keys still open the window, saying so.
    Qvz_HelpWindow help(nullptr);
    help.Open("qvz_nosuch");
    ASSERT_NE(help.Window(), nullptr);
    EXPECT_TRUE(help.Window()->findChild<QTextBrowser*>()->toPlainText().contains("qvz_nosuch"));
}

TEST(Help, BatchRunsOpenNothing) {
    struct CountingHelp : Qvz_HelpHandler {
        void Open(const Port::StringBase&) override { ++opened; }
        int opened = 0;
    } help;
    Qvz_WizData data;
    TestMain wiz;
    wiz.SetWizData(&data);
    wiz.SetHelpHandler(&help);
    wiz.Prepare();
    wiz.InvokeMoreInfo("qvz_mgttx");
    EXPECT_EQ(help.opened, 0);
    wiz.SetRunMode(Qvz_RunMode::Window);
    wiz.Prepare();
    wiz.InvokeMoreInfo("qvz_mgttx");
    EXPECT_EQ(help.opened, 1);
}
