#include "Qvz_WizMain.h"
#include "Qvz_WizPage.h"

#include <gtest/gtest.h>

#include <string>
#include <vector>

namespace {

std::vector<std::string> g_calls;

// A page that records its batch step and answers as told.
class ScriptedPage : public Qvz_WizPage {
public:
    ScriptedPage(Qvz_WizMain* main, std::string name, bool ok)
        : Qvz_WizPage(main), m_name(std::move(name)), m_ok(ok) {}
    bool DoBatchPage() override {
        g_calls.push_back(m_name);
        IssueMessage(("from " + m_name).c_str(), !m_ok, false, true);
        return m_ok;
    }
    bool CreateGuiDlg(QWidget*) override { return false; }
    Wg_WizardPage* GetGuiDlg() override { return nullptr; }

private:
    std::string m_name;
    bool m_ok;
};

class ScriptedMain : public Qvz_WizMain {
public:
    explicit ScriptedMain(std::vector<bool> answers) : Qvz_WizMain("t", false), m_answers(answers) {}
    int finishCalls = 0;

protected:
    bool InstantiatePages() override {
        for (std::size_t i = 0; i < m_answers.size(); ++i)
            m_pPages[i] = new ScriptedPage(this, "p" + std::to_string(i), m_answers[i]);
        return true;
    }
    int Finish() override {
        ++finishCalls;
        g_calls.push_back("finish");
        return 0;
    }
    Port::StringBase GetPageTitle(int slot) const override {
        return ("Page " + std::to_string(slot)).c_str();
    }

private:
    std::vector<bool> m_answers;
};

} // namespace

TEST(BatchRun, RunsPagesInOrderAndStopsAtTheFirstRefusal) {
    const struct {
        std::vector<bool> answers;
        int result;
        std::vector<std::string> calls;
        const char* failed;
    } cases[] = {
        {{true, true, true}, Qvz_RunCompleted, {"p0", "p1", "p2", "finish"}, ""},
        {{true, false, true}, Qvz_RunRefused, {"p0", "p1"}, "Page 1"},
        {{false}, Qvz_RunRefused, {"p0"}, "Page 0"},
        {{}, Qvz_RunCompleted, {"finish"}, ""},
    };
    for (const auto& c : cases) {
        g_calls.clear();
        Qvz_WizData data;
        ScriptedMain wiz(c.answers);
        Qvz_RecordingSink sink;
        wiz.SetWizData(&data);
        wiz.SetMessageSink(&sink);
        EXPECT_EQ(wiz.Run(), c.result);
        EXPECT_EQ(g_calls, c.calls);
        EXPECT_EQ(wiz.GetFailedPageTitle(), c.failed);
        // Every message reaches the sink and the record, in order and with its flags.
        ASSERT_EQ(wiz.GetMessages().size(), sink.messages.size());
        for (std::size_t i = 0; i < sink.messages.size(); ++i) {
            EXPECT_EQ(sink.messages[i].text, ("from " + c.calls[i]).c_str());
            EXPECT_EQ(wiz.GetMessages()[i].flag1, sink.messages[i].flag1);
            EXPECT_TRUE(sink.messages[i].flag3);
        }
    }
}

TEST(BatchRun, ARunStartsAfreshAndTakesTheTargetOfTheData) {
    g_calls.clear();
    Qvz_WizData data;
    data.Target().supportsGT11 = true;
    data.Target().maxBondGT11 = 24;
    data.Target().fileName = "top";
    ScriptedMain wiz({false});
    wiz.SetWizData(&data);
    EXPECT_EQ(wiz.Run(), Qvz_RunRefused);
    EXPECT_TRUE(wiz.m_batchMode);
    EXPECT_TRUE(wiz.m_supportsMGT11);
    EXPECT_FALSE(wiz.m_supportsMGT3);
    EXPECT_EQ(wiz.m_maxBondGT11, 24);
    EXPECT_EQ(wiz.m_fileName, "top");
    EXPECT_EQ(wiz.Run(), Qvz_RunRefused);
    EXPECT_EQ(wiz.GetMessages().size(), 1u) << "messages of an earlier run are not kept";
}

TEST(BatchRun, WithoutASinkMessagesAreStillRecorded) {
    Qvz_WizData data;
    ScriptedMain wiz({true});
    wiz.SetWizData(&data);
    EXPECT_EQ(wiz.Run(), Qvz_RunCompleted);
    ASSERT_EQ(wiz.GetMessages().size(), 1u);
    EXPECT_EQ(wiz.GetMessages()[0].text, "from p0");
}
