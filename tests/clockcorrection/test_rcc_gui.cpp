// The clock-correction controller and form, driven offscreen through their
// slots with the real widgets found by object name.

#include "HostRunner.h"
#include "PageGuiSupport.h"
#include "Qvz_DesignJson.h"
#include "Qvz_MGTRCC.h"
#include "Qvz_MGTRCCGui.h"
#include "Qvz_MGTRCCWidget.h"
#include "Qvz_MGTWizMain.h"
#include "TestApp.h"

#include <QCheckBox>
#include <QComboBox>
#include <QGroupBox>
#include <QLabel>
#include <QLineEdit>
#include <QMetaMethod>
#include <QSpinBox>
#include <gtest/gtest.h>

#include <iterator>
#include <string>
#include <vector>

namespace {

Qvz_WizData LoadFixture(const char* name) {
    return LoadFixtureFile(QString("clockcorrection/") + name);
}

// Sets (or adds) attributes of the active block.
void Set(Qvz_WizData& d, std::initializer_list<std::pair<const char*, const char*>> values);

// A fixture whose every sequence element is eleven binary digits (the GT11
// fixture carries a short one over from its design data).
Qvz_WizData LoadValid(const char* name) {
    Qvz_WizData d = LoadFixture(name);
    Set(d, {{"CLK_COR_SEQ_1_4", "00000000000"}});
    return d;
}

// Sets (or adds) attributes of the active block.
void Set(Qvz_WizData& d, std::initializer_list<std::pair<const char*, const char*>> values) {
    for (const auto& v : values)
        d.GetActiveBlock()->AddAttribute(v.first, v.second);
}

const char* const kSeq2Labels[4] = {"IDC_STATIC_CLK_COR_SEQ_2_1", "IDC_STATIC_CLK_COR_SEQ_2_2",
                                    "IDC_STATIC_CLK_COR_SEQ_2_3", "IDC_STATIC_CLK_COR_SEQ_2_4"};
const char* const kSeq2Edits[4] = {"IDC_EDIT_CLK_COR_SEQ_2_1", "IDC_EDIT_CLK_COR_SEQ_2_2",
                                   "IDC_EDIT_CLK_COR_SEQ_2_3", "IDC_EDIT_CLK_COR_SEQ_2_4"};

// A window-run wizard over data with the clock-correction controller created
// (not yet activated).
struct RccGui : PageGuiRig<Qvz_MGTRCC, Qvz_MGTRCCGui> {
    explicit RccGui(Qvz_WizData d) : PageGuiRig(std::move(d), Qvz_MGTWizMain::kClockCorrection) {}
    explicit RccGui(const char* fixture) : RccGui(LoadFixture(fixture)) {}

    QString Label(const char* name) { return W<QLabel>(name)->text(); }
    // Picks a length in the list as the user would.
    void ChooseLength(const char* length) {
        QComboBox* c = W<QComboBox>("cbSeqLen");
        const int i = c->findText(length);
        ASSERT_GE(i, 0) << length;
        c->setCurrentIndex(i);
        emit c->textActivated(c->currentText());
    }
};

} // namespace

TEST(RccGui, SlotsInTheirOrder) {
    const std::vector<std::string> names = OwnSlots(Qvz_MGTRCCGui::staticMetaObject);
    const std::vector<std::string> expected = {"onActive()",
                                               "onCancel()",
                                               "onBack()",
                                               "onNext()",
                                               "onFinish()",
                                               "onMoreInfo()",
                                               "init()",
                                               "OnCheckClkCorSeq2Use()",
                                               "OnComboSeqLen()",
                                               "OnMaxChanged(int)",
                                               "OnMinChanged(int)",
                                               "ValidateLE_ALL()"};
    EXPECT_EQ(names, expected);
}

TEST(RccGui, FormControlsInCreationOrderWithTheirTexts) {
    TestApp();
    Qvz_MGTRCCWidget form;
    EXPECT_EQ(form.windowTitle(), "Korvane Velomux Wizard - Receiver Clock Correction Setup");
    EXPECT_EQ(form.layout()->objectName(), "Qvz_MGTRCCWidgetLayout");
    const struct {
        const char* name;
        const char* kind;
        const char* inside;
        const char* text;
    } controls[] = {
        {"cbEnable", "QCheckBox", "", "&Enable clock correction"},
        {"cbKeepIdle", "QCheckBox", "", "&Retain at least one clock correction sequence"},
        {"IDC_CHECK_CLK_COR_SEQ_DROP", "QCheckBox", "", "Enable drop mo&de clock correction"},
        {"cbInsertIdleFlag", "QCheckBox", "",
         "Raise RXRUNDISP for the inserted &clock correction (idle) sequence"},
        {"IDC_CHECK_CLK_COR_8B10B_DE", "QCheckBox", "", "Se&t CLK_COR_8B10B_DE"},
        {"IDC_STATIC_CLK_COR_REPEAT_WAIT", "QLabel", "",
         "The minimum number of RXUSRCLK cycles without clock correction:"},
        {"sbRepeatWait", "QSpinBox", "", ""},
        {"IDC_STATIC_CLK_COR_SEQ_LEN", "QLabel", "",
         "Length of clock correction sequence (in Bytes):"},
        {"cbSeqLen", "QComboBox", "", "XX"},
        {"groupBox38", "QGroupBox", "", "Define clock correction sequence (11-bit vector)"},
        {"IDC_STATIC_CLK_COR_SEQ_1_1", "QLabel", "groupBox38", "1_1"},
        {"IDC_STATIC_CLK_COR_SEQ_1_2", "QLabel", "groupBox38", "1_2"},
        {"IDC_STATIC_CLK_COR_SEQ_1_3", "QLabel", "groupBox38", "1_3"},
        {"IDC_STATIC_CLK_COR_SEQ_1_4", "QLabel", "groupBox38", "1_4"},
        {"IDC_EDIT_CLK_COR_SEQ_1_1", "QLineEdit", "groupBox38", ""},
        {"IDC_EDIT_CLK_COR_SEQ_1_2", "QLineEdit", "groupBox38", ""},
        {"IDC_EDIT_CLK_COR_SEQ_1_3", "QLineEdit", "groupBox38", ""},
        {"IDC_EDIT_CLK_COR_SEQ_1_4", "QLineEdit", "groupBox38", ""},
        {"IDC_CHECK_CLK_COR_SEQ_2_USE", "QCheckBox", "groupBox38",
         "&Use second clock correction sequence"},
        {"IDC_STATIC_CLK_COR_SEQ_2_1", "QLabel", "groupBox38", "2_1"},
        {"IDC_STATIC_CLK_COR_SEQ_2_2", "QLabel", "groupBox38", "2_2"},
        {"IDC_STATIC_CLK_COR_SEQ_2_3", "QLabel", "groupBox38", "2_3"},
        {"IDC_STATIC_CLK_COR_SEQ_2_4", "QLabel", "groupBox38", "2_4"},
        {"IDC_EDIT_CLK_COR_SEQ_2_1", "QLineEdit", "groupBox38", ""},
        {"IDC_EDIT_CLK_COR_SEQ_2_2", "QLineEdit", "groupBox38", ""},
        {"IDC_EDIT_CLK_COR_SEQ_2_3", "QLineEdit", "groupBox38", ""},
        {"IDC_EDIT_CLK_COR_SEQ_2_4", "QLineEdit", "groupBox38", ""},
        {"gbMask", "QGroupBox", "", "Mask (4-bit vector)"},
        {"IDC_STATIC_CLK_COR_SEQ_1_MASK", "QLabel", "gbMask", "CLK_COR_SEQ_1_MASK:"},
        {"IDC_EDIT_CLK_COR_SEQ_1_MASK", "QLineEdit", "gbMask", ""},
        {"IDC_STATIC_CLK_COR_SEQ_2_MASK", "QLabel", "gbMask", "CLK_COR_SEQ_2_MASK:"},
        {"IDC_EDIT_CLK_COR_SEQ_2_MASK", "QLineEdit", "gbMask", ""},
        {"gbLatency", "QGroupBox", "", "Latency"},
        {"IDC_STATIC_CLK_COR_MIN_LAT", "QLabel", "gbLatency", "Minimum:"},
        {"sbMin", "QSpinBox", "gbLatency", ""},
        {"IDC_STATIC_CLK_COR_MAX_LAT", "QLabel", "gbLatency", "Maximum:"},
        {"sbMax", "QSpinBox", "gbLatency", ""},
    };
    std::vector<std::string> expectedOrder;
    for (const auto& c : controls) {
        expectedOrder.push_back(c.name);
        QWidget* w = form.findChild<QWidget*>(c.name);
        ASSERT_NE(w, nullptr) << c.name;
        EXPECT_TRUE(w->inherits(c.kind)) << c.name;
        const QWidget* inside = *c.inside ? form.findChild<QWidget*>(c.inside) : &form;
        EXPECT_EQ(w->parentWidget(), inside) << c.name;
        QString text;
        if (auto* l = qobject_cast<QLabel*>(w))
            text = l->text();
        else if (auto* b = qobject_cast<QAbstractButton*>(w))
            text = b->text();
        else if (auto* g = qobject_cast<QGroupBox*>(w))
            text = g->title();
        else if (auto* e = qobject_cast<QLineEdit*>(w))
            text = e->text();
        else if (auto* cb = qobject_cast<QComboBox*>(w))
            text = cb->itemText(0);
        EXPECT_EQ(text.toStdString(), c.text) << c.name;
    }
    // Children are listed in the order they were made.
    std::vector<std::string> order;
    for (QWidget* w : form.findChildren<QWidget*>()) {
        const std::string name = w->objectName().toStdString();
        for (const auto& c : controls)
            if (name == c.name)
                order.push_back(name);
    }
    EXPECT_EQ(order, expectedOrder);

    EXPECT_FALSE(form.cbSeqLen->isEditable());
    EXPECT_EQ(form.cbSeqLen->count(), 1);
    EXPECT_FALSE(form.isModal());
    // languageChange goes back to the single placeholder item.
    form.cbSeqLen->clear();
    form.cbSeqLen->addItem("2");
    form.cbSeqLen->addItem("4");
    form.cbEnable->setText("x");
    form.languageChange();
    ASSERT_EQ(form.cbSeqLen->count(), 1);
    EXPECT_EQ(form.cbSeqLen->itemText(0), "XX");
    EXPECT_EQ(form.cbEnable->text(), "&Enable clock correction");
}

TEST(RccGui, FamilyDecidesWhatIsShown) {
    const struct {
        const char* fixture;
        bool firstFamily;
    } cases[] = {{"gt.json", true}, {"gt10.json", false}, {"gt11.json", false}};
    const char* firstFamilyOnly[] = {"IDC_STATIC_CLK_COR_REPEAT_WAIT", "sbRepeatWait"};
    const char* laterFamiliesOnly[] = {"gbMask",
                                       "IDC_STATIC_CLK_COR_SEQ_1_MASK",
                                       "IDC_EDIT_CLK_COR_SEQ_1_MASK",
                                       "IDC_STATIC_CLK_COR_SEQ_2_MASK",
                                       "IDC_EDIT_CLK_COR_SEQ_2_MASK",
                                       "gbLatency",
                                       "IDC_STATIC_CLK_COR_MIN_LAT",
                                       "sbMin",
                                       "IDC_STATIC_CLK_COR_MAX_LAT",
                                       "sbMax",
                                       "IDC_CHECK_CLK_COR_SEQ_DROP",
                                       "IDC_CHECK_CLK_COR_8B10B_DE"};
    for (const auto& c : cases) {
        RccGui t(c.fixture);
        t.gui->onActive();
        EXPECT_TRUE(t.gui->IsActive()) << c.fixture;
        for (const char* name : firstFamilyOnly)
            EXPECT_EQ(t.Shown(name), c.firstFamily) << c.fixture << " " << name;
        for (const char* name : laterFamiliesOnly)
            EXPECT_EQ(t.Shown(name), !c.firstFamily) << c.fixture << " " << name;
        for (const char* name : {"cbEnable", "cbKeepIdle", "cbInsertIdleFlag",
                                 "IDC_CHECK_CLK_COR_SEQ_2_USE", "IDC_EDIT_CLK_COR_SEQ_1_1"})
            EXPECT_TRUE(t.Shown(name)) << c.fixture << " " << name;
    }
    // The first family's repeat wait follows its attribute.
    Qvz_WizData d = LoadFixture("gt.json");
    d.GetActiveBlock()->GetNamedAttribute("CLK_COR_REPEAT_WAIT")->SetEditable(false);
    RccGui t(std::move(d));
    t.gui->onActive();
    EXPECT_TRUE(t.Shown("sbRepeatWait"));
    EXPECT_FALSE(t.Enabled("sbRepeatWait"));
    EXPECT_FALSE(t.Enabled("IDC_STATIC_CLK_COR_REPEAT_WAIT"));
}

TEST(RccGui, AttributesDecideWhatIsOfferedAndEnabled) {
    Qvz_WizData d = LoadFixture("gt10.json");
    Qvz_Block* b = d.GetActiveBlock();
    b->RemoveAttribute("CLK_COR_KEEP_IDLE");
    b->RemoveAttribute("CLK_COR_8B10B_DE");
    b->RemoveAttribute("CLK_COR_SEQ_1_3");
    b->RemoveAttribute("CLK_COR_MAX_LAT");
    b->GetNamedAttribute("CLK_CORRECT_USE")->SetEditable(false);
    b->GetNamedAttribute("CLK_COR_SEQ_LEN")->SetEditable(false);
    b->GetNamedAttribute("CLK_COR_SEQ_1_MASK")->SetEditable(false);
    b->GetNamedAttribute("CLK_COR_SEQ_DROP")->SetEditable(false);
    RccGui t(std::move(d));
    t.gui->onActive();
    const struct {
        const char* name;
        bool shown, enabled;
    } expected[] = {
        {"cbEnable", true, false},
        {"cbKeepIdle", false, true},
        {"cbInsertIdleFlag", true, true},
        {"IDC_CHECK_CLK_COR_SEQ_DROP", true, false},
        {"IDC_CHECK_CLK_COR_8B10B_DE", false, true},
        {"cbSeqLen", true, false},
        {"IDC_STATIC_CLK_COR_SEQ_LEN", true, false},
        {"IDC_EDIT_CLK_COR_SEQ_1_2", true, true},
        {"IDC_EDIT_CLK_COR_SEQ_1_3", true, false},
        {"IDC_STATIC_CLK_COR_SEQ_1_3", true, false},
        {"IDC_EDIT_CLK_COR_SEQ_1_MASK", true, false},
        {"sbMin", true, true},
        {"sbMax", true, false},
        {"IDC_STATIC_CLK_COR_MAX_LAT", true, false},
        {"gbLatency", true, true},
    };
    for (const auto& e : expected) {
        EXPECT_EQ(t.Shown(e.name), e.shown) << e.name;
        EXPECT_EQ(t.Enabled(e.name), e.enabled) << e.name;
    }

    // A box hidden for one block comes back for a block that has its attribute.
    t.data.GetActiveBlock()->AddAttribute("CLK_COR_KEEP_IDLE", "TRUE");
    t.gui->onActive();
    EXPECT_TRUE(t.Shown("cbKeepIdle"));
    EXPECT_TRUE(t.W<QCheckBox>("cbKeepIdle")->isChecked());
}

TEST(RccGui, ActivationLoadsTheBlock) {
    RccGui t("gt11.json");
    t.gui->onActive();
    EXPECT_TRUE(t.Messages().empty());
    QComboBox* len = t.W<QComboBox>("cbSeqLen");
    EXPECT_EQ(len->count(), 5);
    EXPECT_EQ(len->itemText(2), "3");
    EXPECT_EQ(len->currentText(), "4");
    EXPECT_EQ(t.W<QLineEdit>("IDC_EDIT_CLK_COR_SEQ_1_1")->text(), "00110111100");
    EXPECT_EQ(t.W<QLineEdit>("IDC_EDIT_CLK_COR_SEQ_1_4")->text(), "1011");
    EXPECT_EQ(t.W<QLineEdit>("IDC_EDIT_CLK_COR_SEQ_2_2")->text(), "01010000011");
    EXPECT_EQ(t.W<QLineEdit>("IDC_EDIT_CLK_COR_SEQ_1_MASK")->text(), "0000");
    EXPECT_EQ(t.W<QLineEdit>("IDC_EDIT_CLK_COR_SEQ_2_MASK")->text(), "0011");
    EXPECT_TRUE(t.W<QCheckBox>("cbEnable")->isChecked());
    EXPECT_TRUE(t.W<QCheckBox>("cbKeepIdle")->isChecked());
    EXPECT_FALSE(t.W<QCheckBox>("cbInsertIdleFlag")->isChecked());
    EXPECT_TRUE(t.W<QCheckBox>("IDC_CHECK_CLK_COR_SEQ_2_USE")->isChecked());
    EXPECT_FALSE(t.W<QCheckBox>("IDC_CHECK_CLK_COR_SEQ_DROP")->isChecked());
    EXPECT_TRUE(t.W<QCheckBox>("IDC_CHECK_CLK_COR_8B10B_DE")->isChecked());
    const struct {
        const char* name;
        int low, high, value;
    } spins[] = {{"sbRepeatWait", 0, 31, 0}, {"sbMin", 18, 48, 24}, {"sbMax", 20, 48, 48}};
    for (const auto& s : spins) {
        QSpinBox* box = t.W<QSpinBox>(s.name);
        EXPECT_EQ(box->minimum(), s.low) << s.name;
        EXPECT_EQ(box->maximum(), s.high) << s.name;
        EXPECT_EQ(box->value(), s.value) << s.name;
    }

    // A mask that does not fit the length is replaced when shown, and said so.
    RccGui g("gt10.json");
    g.gui->onActive();
    ASSERT_EQ(g.Messages().size(), 1u);
    EXPECT_FALSE(g.sink.messages[0].flag1);
    EXPECT_EQ(g.W<QComboBox>("cbSeqLen")->currentText(), "4");
    EXPECT_EQ(g.W<QLineEdit>("IDC_EDIT_CLK_COR_SEQ_1_MASK")->text(), "1111");
}

TEST(RccGui, LengthEightContinuesTheFirstSequence) {
    Qvz_WizData d = LoadFixture("gt10.json");
    Set(d, {{"CLK_COR_SEQ_LEN", "8"}, {"CLK_COR_SEQ_2_USE", "FALSE"}});
    d.GetActiveBlock()->GetNamedAttribute("CLK_COR_SEQ_2_3")->SetEditable(false);
    RccGui t(std::move(d));
    t.gui->onActive();
    EXPECT_FALSE(t.Shown("IDC_CHECK_CLK_COR_SEQ_2_USE"));
    for (int i = 0; i < 4; ++i) {
        EXPECT_EQ(t.Label(kSeq2Labels[i]).toStdString(), "1_" + std::to_string(5 + i));
        EXPECT_TRUE(t.Shown(kSeq2Edits[i]));
        EXPECT_EQ(t.Enabled(kSeq2Edits[i]), i != 2) << kSeq2Edits[i];
        EXPECT_EQ(t.Enabled(kSeq2Labels[i]), i != 2) << kSeq2Labels[i];
    }
    // The second mask still goes with the second-sequence flag.
    EXPECT_FALSE(t.Enabled("IDC_EDIT_CLK_COR_SEQ_2_MASK"));

    // Choosing another length gives the second sequence back.
    t.ChooseLength("4");
    EXPECT_EQ(t.page->m_seqLength.str(), "4");
    EXPECT_TRUE(t.Shown("IDC_CHECK_CLK_COR_SEQ_2_USE"));
    for (int i = 0; i < 4; ++i) {
        EXPECT_EQ(t.Label(kSeq2Labels[i]).toStdString(), "2_" + std::to_string(1 + i));
        EXPECT_FALSE(t.Enabled(kSeq2Edits[i])) << kSeq2Edits[i];
    }
    t.ChooseLength("8");
    EXPECT_FALSE(t.Shown("IDC_CHECK_CLK_COR_SEQ_2_USE"));
    EXPECT_EQ(t.Label(kSeq2Labels[3]), "1_8");
    EXPECT_TRUE(t.Enabled(kSeq2Edits[0]));
}

TEST(RccGui, SecondSequenceCheckBoxActsOnlyOnceActive) {
    Qvz_WizData d = LoadFixture("gt11.json");
    Set(d, {{"CLK_COR_SEQ_2_USE", "FALSE"}});
    d.GetActiveBlock()->GetNamedAttribute("CLK_COR_SEQ_2_4")->SetEditable(false);
    RccGui t(std::move(d));
    QCheckBox* use = t.W<QCheckBox>("IDC_CHECK_CLK_COR_SEQ_2_USE");
    QLineEdit* mask2 = t.W<QLineEdit>("IDC_EDIT_CLK_COR_SEQ_2_MASK");

    // Before the page is shown: nothing moves into the page or the form.
    mask2->setEnabled(false);
    use->setChecked(true);
    EXPECT_EQ(t.page->m_seq2Use, 0);
    EXPECT_FALSE(mask2->isEnabled());

    t.gui->onActive();
    EXPECT_FALSE(use->isChecked());
    EXPECT_FALSE(mask2->isEnabled());
    EXPECT_FALSE(t.Enabled(kSeq2Edits[0]));
    use->setChecked(true);
    EXPECT_EQ(t.page->m_seq2Use, 1);
    EXPECT_TRUE(mask2->isEnabled());
    EXPECT_TRUE(t.Enabled("IDC_STATIC_CLK_COR_SEQ_2_MASK"));
    for (int i = 0; i < 4; ++i) {
        EXPECT_EQ(t.Enabled(kSeq2Edits[i]), i != 3) << kSeq2Edits[i];
        EXPECT_EQ(t.Enabled(kSeq2Labels[i]), i != 3) << kSeq2Labels[i];
    }
    use->setChecked(false);
    EXPECT_EQ(t.page->m_seq2Use, 0);
    EXPECT_FALSE(mask2->isEnabled());
    EXPECT_FALSE(t.Enabled(kSeq2Edits[0]));

    // Controls of attributes the block lacks are left as they are.
    t.data.GetActiveBlock()->RemoveAttribute("CLK_COR_SEQ_2_1");
    t.W(kSeq2Edits[0])->setEnabled(true);
    use->setChecked(true);
    use->setChecked(false);
    EXPECT_TRUE(t.Enabled(kSeq2Edits[0]));
    EXPECT_FALSE(t.Enabled(kSeq2Edits[1]));
}

TEST(RccGui, NextStopsAtTheFirstBadEnabledEntry) {
    const struct {
        const char* entry;
        const char* text;
        const char* message;
    } cases[] = {
        {"IDC_EDIT_CLK_COR_SEQ_1_MASK", "111",
         "Please enter a valid 4-bit binary value for clock correction sequence 1_MASK"},
        {"IDC_EDIT_CLK_COR_SEQ_2_MASK", "11112",
         "Please enter a valid 4-bit binary value for clock correction sequence 2_MASK"},
        {"IDC_EDIT_CLK_COR_SEQ_1_1", "0000000000",
         "Please enter a valid 11-bit binary value for clock correction sequence 1_1"},
        {"IDC_EDIT_CLK_COR_SEQ_1_2", "",
         "Please enter a valid 11-bit binary value for clock correction sequence 1_2"},
        {"IDC_EDIT_CLK_COR_SEQ_1_3", "000000000000",
         "Please enter a valid 11-bit binary value for clock correction sequence 1_3"},
        {"IDC_EDIT_CLK_COR_SEQ_1_4", "0000000000x",
         "Please enter a valid 11-bit binary value for clock correction sequence 1_4"},
        {"IDC_EDIT_CLK_COR_SEQ_2_1", "1",
         "Please enter a valid 11-bit binary value for clock correction sequence 2_1"},
        {"IDC_EDIT_CLK_COR_SEQ_2_2", "22222222222",
         "Please enter a valid 11-bit binary value for clock correction sequence 2_2"},
        {"IDC_EDIT_CLK_COR_SEQ_2_3", "0101",
         "Please enter a valid 11-bit binary value for clock correction sequence 2_3"},
        {"IDC_EDIT_CLK_COR_SEQ_2_4", " 0000000000",
         "Please enter a valid 11-bit binary value for clock correction sequence 2_4"},
    };
    for (std::size_t i = 0; i < std::size(cases); ++i) {
        RccGui t(LoadValid("gt11.json")); // second sequence in use: all ten entries enabled
        t.gui->onActive();
        // This entry and every later one are bad: only this one speaks.
        for (std::size_t j = i; j < std::size(cases); ++j)
            t.SetText(cases[j].entry, cases[j].text);
        const Qvz_Block before(*t.data.GetActiveBlock());
        EXPECT_FALSE(t.gui->onNext()) << cases[i].entry;
        ASSERT_EQ(t.Messages().size(), 1u) << cases[i].entry;
        EXPECT_EQ(t.Messages()[0], cases[i].message);
        EXPECT_FALSE(t.sink.messages[0].flag1);
        EXPECT_EQ(t.gui->pageWidget()->focusWidget(), t.W(cases[i].entry)) << cases[i].entry;
        EXPECT_TRUE(*t.data.GetActiveBlock() == before) << cases[i].entry;
    }
}

TEST(RccGui, DisabledOrHiddenEntriesDoNotStopNext) {
    // Second sequence off: its bad elements and mask are not checked.
    Qvz_WizData d = LoadValid("gt11.json");
    Set(d, {{"CLK_COR_SEQ_2_USE", "FALSE"}});
    RccGui t(std::move(d));
    t.gui->onActive();
    t.SetText("IDC_EDIT_CLK_COR_SEQ_2_1", "012");
    t.SetText("IDC_EDIT_CLK_COR_SEQ_2_MASK", "1");
    EXPECT_TRUE(t.gui->onNext());
    EXPECT_TRUE(t.Messages().empty());
    EXPECT_EQ(t.Value("CLK_COR_SEQ_2_1"), "3'b012");
    EXPECT_EQ(t.Value("CLK_COR_SEQ_2_USE"), "FALSE");
    // Switched on, the same text stops Next.
    t.W<QCheckBox>("IDC_CHECK_CLK_COR_SEQ_2_USE")->setChecked(true);
    EXPECT_FALSE(t.gui->onNext());
    EXPECT_EQ(t.Messages(), std::vector<std::string>{"Please enter a valid 4-bit binary value for "
                                                     "clock correction sequence 2_MASK"});

    // The first family hides the masks; whatever they hold, they are not checked.
    Qvz_WizData g = LoadFixture("gt.json");
    Set(g, {{"CLK_COR_SEQ_1_MASK", "11"}, {"CLK_COR_SEQ_2_USE", "TRUE"}});
    RccGui first(std::move(g));
    first.gui->onActive();
    first.W<QCheckBox>("IDC_CHECK_CLK_COR_SEQ_2_USE")->setChecked(false);
    first.W<QCheckBox>("IDC_CHECK_CLK_COR_SEQ_2_USE")->setChecked(true);
    first.SetText("IDC_EDIT_CLK_COR_SEQ_2_MASK", "2");
    EXPECT_TRUE(first.gui->onNext());
    EXPECT_TRUE(first.Messages().empty());
    EXPECT_EQ(first.Value("CLK_COR_SEQ_1_MASK"), "11");
}

TEST(RccGui, NextWritesTheFormInTheFamilysForm) {
    const struct {
        const char* fixture;
        const char* seq;  // CLK_COR_SEQ_1_2 written
        const char* mask; // CLK_COR_SEQ_2_MASK written
    } cases[] = {
        {"gt.json", "01111100000", "0111"},
        {"gt10.json", "01111100000", "0111"},
        {"gt11.json", "11'b01111100000", "4'b0111"},
    };
    for (const auto& c : cases) {
        Qvz_WizData d = LoadValid(c.fixture);
        Set(d, {{"CLK_COR_SEQ_2_USE", "TRUE"}});
        RccGui t(std::move(d));
        t.gui->onActive();
        t.SetText("IDC_EDIT_CLK_COR_SEQ_1_2", "01111100000");
        t.SetText("IDC_EDIT_CLK_COR_SEQ_1_MASK", "1100"); // fits length 2
        t.SetText("IDC_EDIT_CLK_COR_SEQ_2_MASK", "0111");
        t.W<QCheckBox>("cbEnable")->setChecked(false);
        t.W<QCheckBox>("cbInsertIdleFlag")->setChecked(true);
        t.W<QSpinBox>("sbRepeatWait")->setValue(7);
        t.W<QSpinBox>("sbMin")->setValue(30);
        t.W<QSpinBox>("sbMax")->setValue(40);
        t.W<QCheckBox>("IDC_CHECK_CLK_COR_SEQ_DROP")->setChecked(true);
        t.ChooseLength("2");
        EXPECT_TRUE(t.gui->onNext()) << c.fixture;
        EXPECT_EQ(t.Value("CLK_COR_SEQ_1_2"), c.seq) << c.fixture;
        EXPECT_EQ(t.Value("CLK_COR_SEQ_2_MASK"), c.mask) << c.fixture;
        EXPECT_EQ(t.Value("CLK_CORRECT_USE"), "FALSE") << c.fixture;
        EXPECT_EQ(t.Value("CLK_COR_INSERT_IDLE_FLAG"), "TRUE") << c.fixture;
        EXPECT_EQ(t.Value("CLK_COR_SEQ_2_USE"), "TRUE") << c.fixture;
        EXPECT_EQ(t.Value("CLK_COR_SEQ_LEN"), "2") << c.fixture;
        EXPECT_EQ(t.Value("RX_BUFFER_USE"), "TRUE") << c.fixture;
        const bool first = std::string(c.fixture) == "gt.json";
        // Hidden controls still carry their values; absent attributes stay absent.
        const bool gt10 = std::string(c.fixture) == "gt10.json";
        EXPECT_EQ(t.Value("CLK_COR_REPEAT_WAIT"), gt10 ? "<absent>" : "7") << c.fixture;
        EXPECT_EQ(t.Value("CLK_COR_MIN_LAT"), first ? "<absent>" : "30") << c.fixture;
        EXPECT_EQ(t.Value("CLK_COR_MAX_LAT"), first ? "<absent>" : "40") << c.fixture;
        EXPECT_EQ(t.Value("CLK_COR_SEQ_DROP"), first ? "<absent>" : "TRUE") << c.fixture;
    }
}

TEST(RccGui, UntouchedFormWritesWhatABatchRunWrites) {
    for (const char* fixture : {"gt.json", "gt10.json", "gt11.json"}) {
        Qvz_WizData batchData = LoadValid(fixture);
        Qvz_MGTWizMain batch("b", false);
        Qvz_RecordingSink quiet;
        batch.SetWizData(&batchData);
        batch.SetRunMode(Qvz_RunMode::Batch);
        batch.SetMessageSink(&quiet);
        batch.Prepare();
        ASSERT_TRUE(batch.GetPage(Qvz_MGTWizMain::kClockCorrection)->DoBatchPage()) << fixture;

        RccGui t(LoadValid(fixture));
        t.gui->onActive();
        EXPECT_TRUE(t.gui->onNext()) << fixture;
        EXPECT_TRUE(*t.data.GetActiveBlock() == *batchData.GetActiveBlock()) << fixture;
    }
}

TEST(RccGui, WriteRefusalsKeepThePage) {
    const char* mask1 =
        "The CLK_COR_SEQ_1_MASK value of 1000 is not valid.  It can have only 2 zeros (the length "
        "of the clock correction sequence).  Please change the value to be valid.";
    const char* bothMasksLengthOne =
        "The CLK_COR_SEQ_1_MASK(=1100) and CLK_COR_SEQ_2_MASK(=0000) values are not valid.  They "
        "each can have only 1 zero (the length of the clock correction sequence).  Please change "
        "the mask values to be valid.";
    const char* latencies =
        "Please enter a Maximum Latency value that is greater than the Minimum Latency value.";
    const struct {
        const char* name;
        const char* length;
        const char* mask1;
        const char* mask2;
        int minLat, maxLat;
        const char* message;
        bool flag1;
        const char* repeatWait; // CLK_COR_REPEAT_WAIT after the refusal
    } cases[] = {
        {"mask too many zeros", "2", "1000", "1111", 24, 48, mask1, true, "9"},
        {"length 1 says zero", "1", "1100", "0000", 24, 48, bothMasksLengthOne, true, "9"},
        {"equal latencies", "4", "1111", "1111", 36, 36, latencies, false, "0"},
    };
    for (const auto& c : cases) {
        for (int hook = 0; hook < 3; ++hook) { // Next, Back, Finish
            RccGui t(LoadValid("gt11.json"));
            t.gui->onActive();
            t.ChooseLength(c.length);
            t.SetText("IDC_EDIT_CLK_COR_SEQ_1_MASK", c.mask1);
            t.SetText("IDC_EDIT_CLK_COR_SEQ_2_MASK", c.mask2);
            t.W<QSpinBox>("sbRepeatWait")->setValue(9);
            t.W<QSpinBox>("sbMin")->setValue(c.minLat);
            t.W<QSpinBox>("sbMax")->setValue(c.maxLat);
            const bool stays = hook == 0   ? !t.gui->onNext()
                               : hook == 1 ? !t.gui->onBack()
                                           : t.gui->onFinish();
            EXPECT_TRUE(stays) << c.name << " hook " << hook;
            ASSERT_EQ(t.Messages().size(), 1u) << c.name << " hook " << hook;
            EXPECT_EQ(t.Messages()[0], c.message) << c.name;
            EXPECT_EQ(t.sink.messages[0].flag1, c.flag1) << c.name;
            EXPECT_EQ(t.Value("CLK_COR_REPEAT_WAIT"), c.repeatWait) << c.name;
            EXPECT_EQ(t.Value("CLK_COR_SEQ_LEN"), "4") << c.name;
            EXPECT_EQ(t.Value("RX_BUFFER_USE"), "FALSE") << c.name;
        }
    }
}

TEST(RccGui, BackAndFinishWriteWithoutCheckingTheEntries) {
    RccGui t("gt10.json");
    t.gui->onActive();
    t.sink.messages.clear();
    t.SetText("IDC_EDIT_CLK_COR_SEQ_1_1", "0101");
    EXPECT_TRUE(t.gui->onBack());
    EXPECT_TRUE(t.Messages().empty());
    EXPECT_EQ(t.Value("CLK_COR_SEQ_1_1"), "0101");
    t.SetText("IDC_EDIT_CLK_COR_SEQ_1_1", "01");
    EXPECT_FALSE(t.gui->onFinish()); // the framework's own answer: leave
    EXPECT_EQ(t.Value("CLK_COR_SEQ_1_1"), "01");
    EXPECT_TRUE(t.gui->onCancel());

    // Without an active block the write fails: the page stays.
    t.data.SetAllBlksIsActive(false);
    EXPECT_FALSE(t.gui->onNext());
    EXPECT_FALSE(t.gui->onBack());
    EXPECT_TRUE(t.gui->onFinish());
    t.gui->onActive(); // leaves the form alone
    EXPECT_TRUE(t.gui->IsActive());
}

TEST(RccGui, LengthWithoutChoicesKeepsTheBlocksLength) {
    Qvz_WizData d = LoadFixture("gt10.json");
    Qvz_Attribute* len = d.GetActiveBlock()->GetNamedAttribute("CLK_COR_SEQ_LEN");
    len->GetLegalValues().RemoveAll();
    Set(d, {{"CLK_COR_SEQ_1_MASK", "1111"}});
    RccGui t(std::move(d));
    t.gui->onActive();
    EXPECT_EQ(t.W<QComboBox>("cbSeqLen")->count(), 0);
    EXPECT_EQ(t.gui->GetSeqLength().str(), "4");
    EXPECT_TRUE(t.gui->onNext());
    EXPECT_EQ(t.Value("CLK_COR_SEQ_LEN"), "4");

    // A block without the attribute offers the page's length alone.
    Qvz_WizData g = LoadFixture("gt10.json");
    g.GetActiveBlock()->RemoveAttribute("CLK_COR_SEQ_LEN");
    RccGui u(std::move(g));
    u.page->m_seqLength = "8";
    u.gui->onActive();
    ASSERT_EQ(u.W<QComboBox>("cbSeqLen")->count(), 1);
    EXPECT_EQ(u.W<QComboBox>("cbSeqLen")->currentText(), "8");
    EXPECT_FALSE(u.Enabled("cbSeqLen"));
    EXPECT_EQ(u.Label(kSeq2Labels[0]), "1_5");
}

TEST(RccGui, LatencySlotsAreNotConnected) {
    RccGui t("gt10.json");
    t.gui->onActive();
    QSpinBox* min = t.W<QSpinBox>("sbMin");
    QSpinBox* max = t.W<QSpinBox>("sbMax");
    max->setValue(20);
    min->setValue(30);
    EXPECT_EQ(min->maximum(), 40);
    EXPECT_EQ(max->minimum(), 12);
    t.gui->OnMaxChanged(20);
    EXPECT_EQ(min->maximum(), 19);
    t.gui->OnMinChanged(15);
    EXPECT_EQ(max->minimum(), 16);
}

TEST(RccGui, PageNameFormAndMoreInfo) {
    RccGui t("gt11.json");
    EXPECT_EQ(t.gui->pageName(), "Receiver Clock Correction Setup");
    EXPECT_EQ(t.gui->pageWidget(), t.gui->Form());
    EXPECT_EQ(t.gui->parent(), &t.parent);
    EXPECT_FALSE(t.gui->isAdvanced());
    EXPECT_FALSE(t.gui->IsActive());
    EXPECT_EQ(t.gui->EntryCount(), 10);
    t.gui->onMoreInfo();
    EXPECT_EQ(t.help.keys, std::vector<std::string>{"qvz_mgtclkcor"});
}
