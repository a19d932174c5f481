#include "DialogDriver.h"
#include "Wg_SummaryPage.h"
#include "Wg_Wizard.h"

#include <QClipboard>
#include <QLabel>
#include <QPushButton>
#include <QRegularExpression>
#include <QStackedWidget>
#include <gtest/gtest.h>

#include <functional>

namespace {

// A page that logs every call the dialog makes and answers as told.
class LogPage : public Wg_WizardPage {
public:
    LogPage(QWidget* parent, const QString& name, QStringList* log)
        : Wg_WizardPage(parent), m_log(log) {
        setPageName(name);
        auto* label = new QLabel(name, parent);
        label->setObjectName("form_" + name);
        setPageWidget(label);
    }
    bool allowNext = true;
    bool allowBack = true;
    bool allowCancel = true;
    bool keepOnFinish = false;
    bool hasHelp = false;
    Wg_Wizard* wizard = nullptr;
    std::function<void()> whileNext;

    void init() override { *m_log << "init " + pageName(); }
    void onActive() override {
        *m_log << "active " + pageName();
        if (hasHelp && wizard)
            wizard->enableMoreInfo(true);
    }
    bool onNext() override {
        *m_log << "next " + pageName();
        if (whileNext)
            whileNext();
        return allowNext && Wg_WizardPage::onNext();
    }
    bool onBack() override {
        *m_log << "back " + pageName();
        return allowBack && Wg_WizardPage::onBack();
    }
    bool onFinish() override {
        *m_log << "finish " + pageName();
        return keepOnFinish || Wg_WizardPage::onFinish();
    }
    bool onCancel() override {
        *m_log << "cancel " + pageName();
        return allowCancel;
    }
    void onMoreInfo() override { *m_log << "help " + pageName(); }

private:
    QStringList* m_log;
};

// Pages A to D and a summary, named and linked as a wizard main links them.
struct AppFirst {
    AppFirst() { TestApp(); }
};

struct Fixture : AppFirst {
    Fixture() {
        const QStringList names = {"A", "B", "C", "D", "Summary"};
        for (int i = 0; i < names.size(); ++i) {
            auto* p = new LogPage(&wizard, names[i], &log);
            p->wizard = &wizard;
            if (i > 0)
                p->setPageBackName(names[i - 1]);
            if (i + 1 < names.size())
                p->setPageNextName(names[i + 1]);
            pages << p;
        }
        wizard.setSummaryPage(pages.last());
        for (LogPage* p : pages)
            wizard.addPage(p);
        wizard.setEnterSummaryHook([this] {
            log << "enter summary";
            return enterAnswer;
        });
        wizard.setLeaveSummaryHook([this] { log << "leave summary"; });
    }
    QPushButton* Button(const char* name) { return wizard.findChild<QPushButton*>(name); }
    QString Current() const { return wizard.currentPage() ? wizard.currentPage()->pageName() : ""; }
    QString Shown() const {
        auto* label = qobject_cast<QLabel*>(wizard.shownForm());
        return label ? label->text() : "";
    }

    Wg_Wizard wizard;
    QStringList log;
    QList<LogPage*> pages;
    bool enterAnswer = true;
};

} // namespace

TEST(Wizard, WalksEnabledPagesBothWaysWithTheLabelsOfWhereTheButtonsLead) {
    Fixture f;
    f.wizard.enablePage("B", false);
    f.wizard.show();

    struct Step {
        const char* button; // nullptr: just look
        const char* page;
        const char* backLabel;
        bool backEnabled;
        const char* nextLabel;
        bool nextEnabled;
    };
    // B is disabled: every button that would name it names the page it
    // really leads to instead.
    const Step steps[] = {
        {nullptr, "A", "Back", false, "C", true},
        {"buttonNext", "C", "A", true, "D", true},
        {"buttonNext", "D", "C", true, "Summary", true},
        {"buttonNext", "Summary", "D", true, "Next", false},
        {"buttonNext", "Summary", "D", true, "Next", false}, // nothing after the summary
        {"buttonBack", "D", "C", true, "Summary", true},
        {"buttonBack", "C", "A", true, "D", true},
        {"buttonBack", "A", "Back", false, "C", true},
        {"buttonBack", "A", "Back", false, "C", true}, // nothing before the first
    };
    int i = 0;
    for (const Step& s : steps) {
        if (s.button)
            f.Button(s.button)->click();
        EXPECT_EQ(f.Current(), s.page) << "step " << i;
        EXPECT_EQ(f.Shown(), s.page) << "step " << i;
        EXPECT_EQ(f.Button("buttonBack")->text(), s.backLabel) << "step " << i;
        EXPECT_EQ(f.Button("buttonBack")->isEnabled(), s.backEnabled) << "step " << i;
        EXPECT_EQ(f.Button("buttonNext")->text(), s.nextLabel) << "step " << i;
        EXPECT_EQ(f.Button("buttonNext")->isEnabled(), s.nextEnabled) << "step " << i;
        EXPECT_TRUE(f.Button("buttonFinish")->isEnabled()) << "step " << i;
        EXPECT_TRUE(f.Button("buttonCancel")->isEnabled()) << "step " << i;
        ++i;
    }
    EXPECT_EQ(f.log.filter("active B"), QStringList());
    EXPECT_EQ(f.log.count("enter summary"), 1);
    EXPECT_EQ(f.log.count("leave summary"), 1);

    // Enabling B again while A is shown brings its label and the page back.
    f.wizard.enablePage("B", true);
    EXPECT_EQ(f.Button("buttonNext")->text(), "B");
    f.Button("buttonNext")->click();
    EXPECT_EQ(f.Current(), "B");
}

TEST(Wizard, PageDisabledWhileLeavingIsSkipped) {
    // The first page decides which pages follow while it writes on Next.
    Fixture f;
    f.pages[0]->whileNext = [&f] {
        f.wizard.enablePage("B", false);
        f.wizard.enablePage("C", false);
    };
    f.wizard.show();
    f.Button("buttonNext")->click();
    EXPECT_EQ(f.Current(), "D");
    EXPECT_EQ(f.Button("buttonBack")->text(), "A");
}

TEST(Wizard, InitOnceBeforeFirstShowingAndOnActiveEveryTime) {
    Fixture f;
    f.wizard.show();
    f.Button("buttonNext")->click();
    f.Button("buttonBack")->click();
    f.Button("buttonNext")->click();
    const QStringList expected = {"init A", "active A", "next A", "init B",  "active B",
                                  "back B", "active A", "next A", "active B"};
    EXPECT_EQ(f.log, expected);
}

TEST(Wizard, RefusingPageKeepsTheDialogOnIt) {
    Fixture f;
    f.pages[0]->allowNext = false;
    f.pages[1]->allowBack = false;
    f.wizard.show();
    f.Button("buttonNext")->click();
    EXPECT_EQ(f.Current(), "A");
    EXPECT_FALSE(f.log.contains("init B"));

    f.pages[0]->allowNext = true;
    f.Button("buttonNext")->click();
    f.Button("buttonBack")->click();
    EXPECT_EQ(f.Current(), "B");
    EXPECT_EQ(f.log.count("active A"), 1);

    // The summary may refuse Back too: the leave hook must not run then.
    f.pages[4]->allowBack = false;
    f.pages[1]->allowNext = true;
    for (int i = 0; i < 3; ++i)
        f.Button("buttonNext")->click();
    ASSERT_EQ(f.Current(), "Summary");
    f.Button("buttonBack")->click();
    EXPECT_EQ(f.Current(), "Summary");
    EXPECT_FALSE(f.log.contains("leave summary"));
}

TEST(Wizard, FinishFromASetupPageGoesThroughTheSummary) {
    struct Case {
        bool keepOnFinish;
        bool enterAnswer;
        const char* pageAfter;
        bool accepted;
        int enters;
    };
    const Case cases[] = {
        {false, true, "Summary", true, 1},   // ends the run
        {false, false, "Summary", false, 1}, // the summary stays shown
        {true, true, "B", false, 0},         // the page keeps the dialog
    };
    for (const Case& c : cases) {
        Fixture f;
        f.pages[1]->keepOnFinish = c.keepOnFinish;
        f.enterAnswer = c.enterAnswer;
        bool accepted = false;
        QObject::connect(&f.wizard, &QDialog::accepted, [&accepted] { accepted = true; });
        f.wizard.show();
        f.Button("buttonNext")->click();
        f.log.clear();
        f.Button("buttonFinish")->click();
        EXPECT_EQ(f.Current(), c.pageAfter);
        EXPECT_EQ(accepted, c.accepted);
        EXPECT_EQ(f.wizard.isVisible(), !c.accepted);
        EXPECT_EQ(f.log.count("enter summary"), c.enters);
        EXPECT_EQ(f.log.first(), "finish B");
        // The pages in between are neither written nor shown.
        EXPECT_TRUE(f.log.filter(QRegularExpression("^(next|active|init) [CD]$")).isEmpty());
        if (!c.accepted && !c.keepOnFinish) {
            // On the summary, Finish ends the run without entering it again.
            f.Button("buttonFinish")->click();
            EXPECT_TRUE(accepted);
            EXPECT_EQ(f.log.count("enter summary"), 1);
        }
    }
}

TEST(Wizard, FinishOnTheSummaryEndsTheRun) {
    Fixture f;
    bool accepted = false;
    QObject::connect(&f.wizard, &QDialog::accepted, [&accepted] { accepted = true; });
    f.wizard.show();
    for (int i = 0; i < 4; ++i)
        f.Button("buttonNext")->click();
    ASSERT_EQ(f.Current(), "Summary");
    f.Button("buttonFinish")->click();
    EXPECT_TRUE(accepted);
    EXPECT_EQ(f.log.count("enter summary"), 1);
    EXPECT_EQ(f.log.count("finish Summary"), 1);
}

TEST(Wizard, BackFromTheSummaryRunsTheLeaveHookEachTime) {
    Fixture f;
    f.wizard.show();
    for (int round = 0; round < 2; ++round) {
        for (int i = 0; i < 4; ++i)
            f.Button("buttonNext")->click();
        f.Button("buttonBack")->click();
        f.Button("buttonBack")->click();
        f.Button("buttonBack")->click();
    }
    EXPECT_EQ(f.log.count("enter summary"), 2);
    EXPECT_EQ(f.log.count("leave summary"), 2);
    // Back within the setup pages never leaves a summary.
    EXPECT_EQ(f.log.indexOf("leave summary"), f.log.indexOf("back Summary") + 1);
}

TEST(Wizard, CancelAsksThePage) {
    Fixture f;
    f.pages[0]->allowCancel = false;
    bool rejected = false;
    QObject::connect(&f.wizard, &QDialog::rejected, [&rejected] { rejected = true; });
    f.wizard.show();
    f.Button("buttonCancel")->click();
    EXPECT_FALSE(rejected);
    EXPECT_TRUE(f.wizard.isVisible());
    f.pages[0]->allowCancel = true;
    f.Button("buttonCancel")->click();
    EXPECT_TRUE(rejected);
    EXPECT_EQ(f.log.count("cancel A"), 2);
}

TEST(Wizard, MoreInfoIsOfferedOnlyWherePagesAskForIt) {
    Fixture f;
    f.pages[1]->hasHelp = true;
    f.wizard.show();
    QPushButton* help = f.Button("buttonMoreInfo");
    EXPECT_FALSE(help->isEnabled());
    f.Button("buttonNext")->click();
    EXPECT_TRUE(help->isEnabled());
    help->click();
    EXPECT_EQ(f.log.last(), "help B");
    f.Button("buttonNext")->click();
    EXPECT_FALSE(help->isEnabled());
}

TEST(Wizard, SummaryStaysLastAndPagesAreAddedOnce) {
    Fixture f;
    auto* late = new LogPage(&f.wizard, "E", &f.log);
    EXPECT_TRUE(f.wizard.addPage(late));
    EXPECT_FALSE(f.wizard.addPage(late));
    EXPECT_FALSE(f.wizard.addPage(nullptr));
    ASSERT_EQ(f.wizard.pageCount(), 6);
    EXPECT_EQ(f.wizard.page(4), late);
    EXPECT_EQ(f.wizard.page(5), f.wizard.summaryPage());
    EXPECT_EQ(f.wizard.findPage("E"), late);
    EXPECT_EQ(f.wizard.findPage("nope"), nullptr);
    EXPECT_EQ(f.wizard.page(6), nullptr);
    EXPECT_EQ(f.wizard.page(-1), nullptr);
    EXPECT_FALSE(f.wizard.isPageEnabled("nope"));

    // A page deleted by its owner is passed over, not dereferenced.
    delete f.pages[1];
    f.wizard.show();
    f.Button("buttonNext")->click();
    EXPECT_EQ(f.Current(), "C");
}

TEST(Wizard, EmptyWizardShowsAndEnds) {
    TestApp();
    Wg_Wizard wizard;
    bool accepted = false;
    QObject::connect(&wizard, &QDialog::accepted, [&accepted] { accepted = true; });
    wizard.show();
    EXPECT_EQ(wizard.currentPage(), nullptr);
    wizard.next();
    wizard.back();
    wizard.moreInfo();
    wizard.finish();
    EXPECT_TRUE(accepted);
}

TEST(SummaryPage, ShowsTheSummaryAndCopiesItsText) {
    TestApp();
    Wg_Wizard wizard;
    auto* summary = new Wg_SummaryPage(&wizard);
    EXPECT_EQ(summary->pageName(), "Summary");
    summary->setSummary("<p>Instance <b>X</b></p>", "Instance X\n");
    auto* copy = summary->pageWidget()->findChild<QPushButton*>("buttonCopySummary");
    ASSERT_NE(copy, nullptr);
    QGuiApplication::clipboard()->setText("before");
    copy->click();
    EXPECT_EQ(QGuiApplication::clipboard()->text(), "Instance X\n");
    EXPECT_EQ(summary->summaryText(), "Instance X\n");
}
