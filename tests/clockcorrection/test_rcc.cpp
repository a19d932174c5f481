#include "Qvz_MGTRCC.h"
#include "Qvz_MGTWizMain.h"
#include "TestApp.h"
#include "Wg_WizardPage.h"

#include <QApplication>
#include <QComboBox>
#include <QSpinBox>
#include <QWidget>
#include <gtest/gtest.h>

#include <memory>
#include <string>
#include <vector>

namespace {

QApplication& App() {
    return TestApp();
}

const char* const kSeqNames[8] = {"CLK_COR_SEQ_1_1", "CLK_COR_SEQ_1_2", "CLK_COR_SEQ_1_3",
                                  "CLK_COR_SEQ_1_4", "CLK_COR_SEQ_2_1", "CLK_COR_SEQ_2_2",
                                  "CLK_COR_SEQ_2_3", "CLK_COR_SEQ_2_4"};

Qvz_Attribute* Attr(Qvz_Block* b, const char* name, const char* value,
                    std::initializer_list<const char*> legal = {}, const char* def = nullptr) {
    Qvz_Attribute* a = b->AddAttribute(name, value);
    for (const char* l : legal)
        a->GetLegalValues().Add(l);
    if (def)
        a->SetDefaultValue(def);
    return a;
}

// A wizard main (batch unless told otherwise) with one active block and the page.
struct Fixture {
    explicit Fixture(const char* primitive, bool batch = true) {
        block = data.AddBlock(
            std::make_unique<Qvz_Block>("INST", primitive, Qvz_FamilyOfPrimitive(primitive)));
        block->SetIsUsed(true);
        wiz.SetWizData(&data);
        wiz.m_batchMode = batch;
        page = std::make_unique<Qvz_MGTRCC>(&wiz);
    }
    // Every attribute the page reads, with plain values.
    void AddAll() {
        Attr(block, "CLK_CORRECT_USE", "TRUE");
        Attr(block, "CLK_COR_KEEP_IDLE", "FALSE");
        Attr(block, "CLK_COR_INSERT_IDLE_FLAG", "FALSE");
        Attr(block, "RX_BUFFER_USE", "FALSE");
        Attr(block, "CLK_COR_SEQ_LEN", "4", {"1", "2", "4", "8"});
        Attr(block, "CLK_COR_SEQ_2_USE", "FALSE");
        for (const char* n : kSeqNames)
            Attr(block, n, "00000000000");
        Attr(block, "CLK_COR_SEQ_1_MASK", "1111");
        Attr(block, "CLK_COR_SEQ_2_MASK", "1111");
        Attr(block, "CLK_COR_REPEAT_WAIT", "1", {"0..31"});
        Attr(block, "CLK_COR_MIN_LAT", "28", {"0..63"});
        Attr(block, "CLK_COR_MAX_LAT", "36", {"0..63"});
        Attr(block, "CLK_COR_SEQ_DROP", "FALSE");
        Attr(block, "CLK_COR_8B10B_DE", "TRUE");
    }
    std::string Value(const char* name) const { return block->GetAttributeValue(name).str(); }
    std::vector<std::string> Texts() const {
        std::vector<std::string> out;
        for (const Qvz_Message& m : wiz.GetMessages())
            out.push_back(m.text.str());
        return out;
    }

    Qvz_WizData data;
    Qvz_Block* block = nullptr;
    Qvz_MGTWizMain wiz{"w", false};
    std::unique_ptr<Qvz_MGTRCC> page;
};

} // namespace

TEST(RccBinaryValue, KeepsTheSizedDigits) {
    const struct {
        const char* value;
        const char* expected;
    } cases[] = {
        {"11'b00110111100", "00110111100"},
        {"4'b0101", "0101"},
        {"0101", "0101"},
        {"", ""},
        {"2'b0101", "01"}, // the size decides: the last two digits
        {"0'b0101", ""},
        // Sizes larger than the digits, or no number, keep just the digits
        // instead of reaching into the prefix.
        {"8'b0101", "0101"},
        {"11'b01", "01"},
        {"99999999999999'b01", "01"},
        {"x'b0101", "0101"},
        {"'b0101", "0101"},
        {"-2'b0101", "0101"},
        {" 2'b0101", "0101"},
        {"4'b", ""},
    };
    for (const auto& c : cases) {
        Qvz_Attribute a("CLK_COR_SEQ_1_1", c.value);
        EXPECT_EQ(Qvz_MGTRCC::GetBinaryValue(&a), c.expected) << c.value;
    }
    EXPECT_EQ(Qvz_MGTRCC::GetBinaryValue(nullptr), "");
}

TEST(RccRead, FlagsReadTrueOnlyForTRUEAndFalseWhenAbsent) {
    const struct {
        const char* value; // nullptr: attribute absent
        int expected;
    } cases[] = {{"TRUE", 1}, {"FALSE", 0}, {"true", 0}, {"", 0}, {nullptr, 0}};
    const char* names[] = {"CLK_CORRECT_USE",   "CLK_COR_KEEP_IDLE", "CLK_COR_INSERT_IDLE_FLAG",
                           "CLK_COR_SEQ_2_USE", "CLK_COR_SEQ_DROP",  "CLK_COR_8B10B_DE"};
    for (const auto& c : cases) {
        Fixture f("GT10_CUSTOM");
        if (c.value)
            for (const char* n : names)
                Attr(f.block, n, c.value);
        // Start every flag from the opposite of what is expected.
        Qvz_MGTRCC& p = *f.page;
        p.m_clkCorrectUse = p.m_keepIdle = p.m_insertIdleFlag = p.m_seq2Use = p.m_seqDrop =
            p.m_8b10bDe = !c.expected;
        ASSERT_TRUE(p.ReadWizData());
        const int got[] = {p.m_clkCorrectUse, p.m_keepIdle, p.m_insertIdleFlag,
                           p.m_seq2Use,       p.m_seqDrop,  p.m_8b10bDe};
        for (int i = 0; i < 6; ++i)
            EXPECT_EQ(got[i], c.expected) << names[i] << "=" << (c.value ? c.value : "(absent)");
    }
}

TEST(RccRead, SequenceLengthFallsBackToTheDefaultWhenNotLegal) {
    const struct {
        const char* value; // nullptr: attribute absent
        std::initializer_list<const char*> legal;
        const char* expected;
    } cases[] = {
        {"2", {"1", "2", "4", "8"}, "2"},
        {"5", {"1", "2", "4", "8"}, "3"},
        {"2", {}, "3"}, // no legal values: nothing matches
        {nullptr, {}, "7"},
    };
    for (const auto& c : cases) {
        Fixture f("GT10_CUSTOM");
        if (c.value)
            Attr(f.block, "CLK_COR_SEQ_LEN", c.value, c.legal, "3");
        f.page->m_seqLength = "7";
        ASSERT_TRUE(f.page->ReadWizData());
        EXPECT_EQ(f.page->m_seqLength, c.expected) << (c.value ? c.value : "(absent)");
    }
}

TEST(RccRead, NumbersTakeTheirRangeFromTheLastRangeEntry) {
    Fixture f("GT10_CUSTOM");
    Attr(f.block, "CLK_COR_REPEAT_WAIT", " 07", {"TRUE", "2..9"});
    Attr(f.block, "CLK_COR_MIN_LAT", "20", {"0..10", "12..40", "bad"});
    Attr(f.block, "CLK_COR_MAX_LAT", "44", {});
    Qvz_MGTRCC& p = *f.page;
    p.m_maxLatLow = 5;
    p.m_maxLatHigh = 6;
    ASSERT_TRUE(p.ReadWizData());
    EXPECT_EQ(p.m_repeatWait, "7");
    EXPECT_EQ(p.m_repeatWaitValue, 7);
    EXPECT_EQ(p.m_repeatWaitLow, 2);
    EXPECT_EQ(p.m_repeatWaitHigh, 9);
    EXPECT_EQ(p.m_minLat, "20");
    EXPECT_EQ(p.m_minLatLow, 12);
    EXPECT_EQ(p.m_minLatHigh, 40);
    // No range entry: the range starts over at 0..63.
    EXPECT_EQ(p.m_maxLat, "44");
    EXPECT_EQ(p.m_maxLatLow, 0);
    EXPECT_EQ(p.m_maxLatHigh, 63);
}

TEST(RccRead, AbsentAttributesKeepFieldsExceptMasks) {
    Fixture f("GT11_CUSTOM");
    Attr(f.block, "CLK_COR_SEQ_1_2", "11'b11111000001");
    Attr(f.block, "CLK_COR_SEQ_2_4", "10100000111");
    Qvz_MGTRCC& p = *f.page;
    p.m_seq1[0] = "00000000001";
    p.m_seq1Mask = "1101";
    p.m_seq2Mask = "0111";
    p.m_repeatWait = "5";
    ASSERT_TRUE(p.ReadWizData());
    EXPECT_EQ(p.m_seq1[0], "00000000001");
    EXPECT_EQ(p.m_seq1[1], "11111000001");
    EXPECT_EQ(p.m_seq2[3], "10100000111");
    EXPECT_EQ(p.m_repeatWait, "5");
    EXPECT_EQ(p.m_seq1Mask, "1111");
    EXPECT_EQ(p.m_seq2Mask, "1111");
    EXPECT_TRUE(p.m_isGT11);
    EXPECT_FALSE(p.m_isGT10);
    EXPECT_TRUE(f.wiz.GetMessages().empty());
}

TEST(RccRead, InvalidMasksTakeTheDefaultsAndSaySo) {
    struct Case {
        const char* name;
        const char* primitive;
        const char* length;
        const char* lengthDefault;
        const char* mask1;
        const char* mask1Default;
        const char* mask2;
        const char* mask2Default;
        const char* message; // nullptr: none
        const char* mask1After;
        const char* mask2After;
        const char* lengthAfter;
    };
    const Case cases[] = {
        {"mask 1 only", "GT10_CUSTOM", "2", "4", "1000", "1111", "1111", "1111",
         "The CLK_COR_SEQ_1_MASK value of 1000 is not valid.  It can have only 2 zeros (the "
         "length of the clock correction sequence).  The wizard will use the default length 4 and "
         "the CLK_COR_SEQ_1_MASK default 1111 instead of the current values.",
         "1111", "1111", "4"},
        {"mask 1, mask 2 too many for the default length", "GT11_CUSTOM", "3", "1", "4'b0000",
         "4'b1110", "4'b1100", "4'b1101",
         "The CLK_COR_SEQ_1_MASK value of 0000 is not valid.  It can have only 3 zeros (the "
         "length of the clock correction sequence).  The wizard will use the default length 1 and "
         "defaults for both CLK_COR_SEQ_1_MASK (1110) and CLK_COR_SEQ_2_MASK (1101) instead of "
         "the current values.",
         "1110", "1101", "1"},
        {"mask 2 only", "GT10_CUSTOM", "1", "4", "1110", "1111", "1000", "1111",
         "The CLK_COR_SEQ_2_MASK value of 1000 is not valid.  It can have only 1 zero (the length "
         "of the clock correction sequence).",
         "1110", "1111", "4"},
        {"mask 2, mask 1 too many for the default length", "GT10_CUSTOM", "3", "1", "1100", "0111",
         "0000", "1011",
         "The CLK_COR_SEQ_2_MASK value of 0000 is not valid.  It can have only 3 zeros (the "
         "length of the clock correction sequence).  The wizard will use the default length 1 and "
         "defaults for both CLK_COR_SEQ_1_MASK (0111) and CLK_COR_SEQ_2_MASK (1011) instead of "
         "the current values.",
         "0111", "1011", "1"},
        {"both, other default length", "GT10_CUSTOM", "1", "4", "1100", "1111", "0000", "1111",
         "The CLK_COR_SEQ_1_MASK(=1100) and CLK_COR_SEQ_2_MASK(=0000) values are not valid.  They "
         "each can have only 1 zero (the length of the clock correction sequence).  The wizard "
         "will use the defaults (1111 and 1111, respectively, using default length 4) instead of "
         "the current values.",
         "1111", "1111", "4"},
        {"both, same default length", "GT11_CUSTOM", "2", "2", "4'b1000", "4'b1110", "0001",
         "4'b1101",
         "The CLK_COR_SEQ_1_MASK(=1000) and CLK_COR_SEQ_2_MASK(=0001) values are not valid.  They "
         "each can have only 2 zeros (the length of the clock correction sequence).  The wizard "
         "will use the defaults (1110 and 1101, respectively) instead of the current values.",
         "1110", "1101", "2"},
        {"first family is not checked", "GT_CUSTOM", "1", "4", "0000", "1111", "0000", "1111",
         nullptr, "0000", "0000", "1"},
        {"valid masks", "GT10_CUSTOM", "2", "4", "1100", "1111", "0011", "1111", nullptr, "1100",
         "0011", "2"},
    };
    for (const Case& c : cases) {
        Fixture f(c.primitive);
        Attr(f.block, "CLK_COR_SEQ_LEN", c.length, {"1", "2", "3", "4", "8"}, c.lengthDefault);
        Attr(f.block, "CLK_COR_SEQ_1_MASK", c.mask1, {}, c.mask1Default);
        Attr(f.block, "CLK_COR_SEQ_2_MASK", c.mask2, {}, c.mask2Default);
        ASSERT_TRUE(f.page->ReadWizData()) << c.name;
        const auto& msgs = f.wiz.GetMessages();
        if (c.message) {
            ASSERT_EQ(msgs.size(), 1u) << c.name;
            EXPECT_EQ(msgs[0].text, c.message) << c.name;
            EXPECT_FALSE(msgs[0].flag1 || msgs[0].flag2 || msgs[0].flag3) << c.name;
        } else {
            EXPECT_TRUE(msgs.empty()) << c.name;
        }
        EXPECT_EQ(f.page->m_seq1Mask, c.mask1After) << c.name;
        EXPECT_EQ(f.page->m_seq2Mask, c.mask2After) << c.name;
        EXPECT_EQ(f.page->m_seqLength, c.lengthAfter) << c.name;
    }
}

TEST(RccWrite, RangeAndOrderChecksComeFirstAndWriteNothing) {
    struct Case {
        const char* repeatWait;
        const char* minLat;
        const char* maxLat;
        bool batch;
        const char* message;
    };
    const Case cases[] = {
        {"40", "28", "36", true,
         "The allowable range for the minimum number of RXUSRCLK cycles is between 0 and 31."},
        // The repeat wait is checked before the latencies.
        {"-1", "99", "99", true,
         "The allowable range for the minimum number of RXUSRCLK cycles is between 0 and 31."},
        {"1", "99", "64", true,
         "The allowable range for the maximum clock correction latency is between 4 and 63."},
        {"1", "2", "36", true,
         "The allowable range for the minimum clock correction latency is between 3 and 60."},
        {"1", "36", "36", true,
         "The Maximum Latency (CLK_COR_MAX_LAT) value must be greater than the Minimum Latency "
         "(CLK_COR_MIN_LAT) value.  The wizard cannot continue."},
        {"1", "37", "36", false,
         "Please enter a Maximum Latency value that is greater than the Minimum Latency value."},
    };
    for (const Case& c : cases) {
        Fixture f("GT10_CUSTOM", c.batch);
        f.AddAll();
        Attr(f.block, "CLK_COR_MIN_LAT", "28", {"3..60"});
        Attr(f.block, "CLK_COR_MAX_LAT", "36", {"4..63"});
        ASSERT_TRUE(f.page->ReadWizData());
        const Qvz_Block before(*f.block);
        // Masks that would be refused too: the range checks come first.
        f.page->m_seqLength = "1";
        f.page->m_seq1Mask = "0000";
        f.page->m_repeatWait = c.repeatWait;
        f.page->m_minLat = c.minLat;
        f.page->m_maxLat = c.maxLat;
        EXPECT_FALSE(f.page->WriteWizData()) << c.message;
        EXPECT_EQ(f.Texts(), std::vector<std::string>{c.message});
        EXPECT_FALSE(f.wiz.GetMessages()[0].flag1) << c.message;
        EXPECT_TRUE(*f.block == before) << c.message;
    }
}

TEST(RccWrite, RefusedMasksLeaveOnlyTheRepeatWaitWritten) {
    const struct {
        const char* length;
        const char* mask1;
        const char* mask2;
        const char* message;
    } cases[] = {
        {"2", "1000", "1111",
         "The CLK_COR_SEQ_1_MASK value of 1000 is not valid.  It can have only 2 zeros (the "
         "length of the clock correction sequence).  Please change the value to be valid."},
        {"1", "1110", "0011",
         "The CLK_COR_SEQ_2_MASK value of 0011 is not valid.  It can have only 1 zero (the length "
         "of the clock correction sequence).  Please change the value to be valid."},
        {"1", "0011", "0000",
         "The CLK_COR_SEQ_1_MASK(=0011) and CLK_COR_SEQ_2_MASK(=0000) values are not valid.  They "
         "each can have only 1 zero (the length of the clock correction sequence).  Please change "
         "the mask values to be valid."},
    };
    for (const auto& c : cases) {
        Fixture f("GT11_CUSTOM", false);
        f.AddAll();
        ASSERT_TRUE(f.page->ReadWizData());
        Qvz_MGTRCC& p = *f.page;
        p.m_repeatWait = "9";
        p.m_seqLength = c.length;
        p.m_seq1Mask = c.mask1;
        p.m_seq2Mask = c.mask2;
        p.m_clkCorrectUse = 0;
        EXPECT_FALSE(p.WriteWizData());
        EXPECT_EQ(f.Texts(), std::vector<std::string>{c.message});
        EXPECT_TRUE(f.wiz.GetMessages()[0].flag1);
        EXPECT_FALSE(f.wiz.GetMessages()[0].flag2 || f.wiz.GetMessages()[0].flag3);
        EXPECT_EQ(f.Value("CLK_COR_REPEAT_WAIT"), "9");
        EXPECT_EQ(f.Value("CLK_CORRECT_USE"), "TRUE");
        EXPECT_EQ(f.Value("CLK_COR_SEQ_LEN"), "4");
        EXPECT_EQ(f.Value("RX_BUFFER_USE"), "FALSE");
    }
}

TEST(RccWrite, WritesEveryAttributeInTheFamilyForm) {
    const struct {
        const char* primitive;
        const char* seq;
        const char* mask;
    } cases[] = {
        {"GT11_CUSTOM", "11'b10100000111", "4'b0011"},
        {"GT10_CUSTOM", "10100000111", "0011"},
        {"GT_CUSTOM", "10100000111", "0011"},
    };
    for (const auto& c : cases) {
        Fixture f(c.primitive);
        f.AddAll();
        ASSERT_TRUE(f.page->ReadWizData());
        Qvz_MGTRCC& p = *f.page;
        p.m_repeatWait = "3";
        p.m_seqLength = "2";
        p.m_minLat = "30";
        p.m_maxLat = "40";
        for (int i = 0; i < 4; ++i)
            p.m_seq1[i] = p.m_seq2[i] = "10100000111";
        p.m_seq1Mask = p.m_seq2Mask = "0011";
        p.m_clkCorrectUse = 0;
        p.m_keepIdle = 7; // any non-zero flag is true...
        p.m_insertIdleFlag = 1;
        p.m_seq2Use = 2; // ...but the second sequence only for exactly 1
        p.m_seqDrop = 1;
        p.m_8b10bDe = 0;
        ASSERT_TRUE(p.WriteWizData()) << c.primitive;
        EXPECT_TRUE(f.wiz.GetMessages().empty());
        const struct {
            const char* name;
            const char* value;
        } expected[] = {
            {"CLK_CORRECT_USE", "FALSE"},
            {"CLK_COR_KEEP_IDLE", "TRUE"},
            {"CLK_COR_INSERT_IDLE_FLAG", "TRUE"},
            {"RX_BUFFER_USE", "TRUE"}, // clock correction needs the receive buffer
            {"CLK_COR_SEQ_LEN", "2"},
            {"CLK_COR_SEQ_2_USE", "FALSE"},
            {"CLK_COR_SEQ_1_MASK", c.mask},
            {"CLK_COR_SEQ_2_MASK", c.mask},
            {"CLK_COR_REPEAT_WAIT", "3"},
            {"CLK_COR_MIN_LAT", "30"},
            {"CLK_COR_MAX_LAT", "40"},
            {"CLK_COR_SEQ_DROP", "TRUE"},
            {"CLK_COR_8B10B_DE", "FALSE"},
        };
        for (const auto& e : expected)
            EXPECT_EQ(f.Value(e.name), e.value) << c.primitive << " " << e.name;
        for (const char* n : kSeqNames)
            EXPECT_EQ(f.Value(n), c.seq) << c.primitive << " " << n;
    }
}

TEST(RccWrite, RxBufferUseOnlyFalseBecomesTrueAndMissingAttributesStayMissing) {
    const struct {
        const char* before;
        const char* after;
    } cases[] = {{"FALSE", "TRUE"}, {"TRUE", "TRUE"}, {"false", "false"}, {"", ""}};
    for (const auto& c : cases) {
        Fixture f("GT10_CUSTOM");
        Attr(f.block, "RX_BUFFER_USE", c.before);
        ASSERT_TRUE(f.page->DoBatchPage());
        EXPECT_EQ(f.Value("RX_BUFFER_USE"), c.after) << c.before;
        EXPECT_EQ(f.block->GetAttributes().size(), 1u);
    }
}

TEST(RccPage, MissingDataOrBlock) {
    // No design data: an internal error, on read and write.
    Qvz_MGTWizMain wiz("w", false);
    Qvz_MGTRCC page(&wiz);
    EXPECT_FALSE(page.ReadWizData());
    EXPECT_FALSE(page.WriteWizData());
    EXPECT_FALSE(page.DoBatchPage());
    ASSERT_EQ(wiz.GetMessages().size(), 3u);
    for (const Qvz_Message& m : wiz.GetMessages()) {
        EXPECT_EQ(m.text, "Tessel Wizard internal data error.");
        EXPECT_FALSE(m.flag1 || m.flag2 || m.flag3);
    }

    // Data without an active block: refused without a message.
    Fixture f("GT10_CUSTOM");
    f.block->SetIsUsed(false);
    EXPECT_FALSE(f.page->ReadWizData());
    EXPECT_FALSE(f.page->WriteWizData());
    EXPECT_TRUE(f.wiz.GetMessages().empty());
}

TEST(RccPage, CreatesItsControllerOnlyWithAParent) {
    App();
    Fixture f("GT10_CUSTOM", false);
    EXPECT_FALSE(f.page->CreateGuiDlg(nullptr));
    EXPECT_EQ(f.page->GetGuiDlg(), nullptr);
    QWidget parent;
    EXPECT_TRUE(f.page->CreateGuiDlg(&parent));
    ASSERT_NE(f.page->GetGuiDlg(), nullptr);
    EXPECT_EQ(f.page->GetGuiDlg()->parent(), &parent);
    EXPECT_TRUE(f.wiz.GetMessages().empty());
}

namespace {

// Records what the page asks of its form.
class FakeView : public Qvz_MGTRCCView {
public:
    void InitDataMembers(Qvz_Block* block) override {
        calls.push_back("init");
        combo.clear();
        if (const Qvz_Attribute* a = block->GetNamedAttribute("CLK_COR_SEQ_LEN"))
            for (const Port::StringBase& v : a->GetLegalValues().Items())
                combo.addItem(v.ToQString());
    }
    void UpdateData(bool fromWidgets) override {
        calls.push_back(fromWidgets ? "update(true)" : "update(false)");
    }
    void UpdateControls() override { calls.push_back("controls"); }
    QComboBox* SeqLengthComboBox() override { return &combo; }
    QSpinBox* LatencySpinBox(SpinBoxId which) override { return spins[which]; }

    std::vector<std::string> calls;
    QComboBox combo;
    QSpinBox repeat, min, max;
    QSpinBox* spins[3] = {&repeat, &min, &max};
};

} // namespace

TEST(RccPage, WindowReadLoadsTheForm) {
    App();
    Fixture f("GT10_CUSTOM", false);
    f.AddAll();
    Attr(f.block, "CLK_COR_SEQ_LEN", "8", {"1", "2", "4", "8"});
    Attr(f.block, "CLK_COR_REPEAT_WAIT", "12", {"0..20"});
    Attr(f.block, "CLK_COR_MIN_LAT", "70", {"40..90"});
    Attr(f.block, "CLK_COR_MAX_LAT", "80", {"50..100"});
    FakeView view;
    f.page->SetView(&view);
    ASSERT_TRUE(f.page->ReadWizData());
    EXPECT_EQ(view.calls, (std::vector<std::string>{"init", "update(false)", "controls"}));
    EXPECT_EQ(view.combo.currentText(), "8");
    const struct {
        QSpinBox* box;
        int low, high, value;
    } spins[] = {{&view.repeat, 0, 20, 12}, {&view.min, 40, 90, 70}, {&view.max, 50, 100, 80}};
    for (const auto& s : spins) {
        EXPECT_EQ(s.box->minimum(), s.low);
        EXPECT_EQ(s.box->maximum(), s.high);
        EXPECT_EQ(s.box->value(), s.value);
    }

    // Without a length attribute the combo box offers just the page's length.
    Fixture g("GT10_CUSTOM", false);
    FakeView other;
    g.page->SetView(&other);
    g.page->m_seqLength = "2";
    ASSERT_TRUE(g.page->ReadWizData());
    ASSERT_EQ(other.combo.count(), 1);
    EXPECT_EQ(other.combo.currentText(), "2");

    // A batch run never touches a form.
    Fixture b("GT10_CUSTOM", true);
    FakeView unused;
    b.page->SetView(&unused);
    ASSERT_TRUE(b.page->ReadWizData());
    EXPECT_TRUE(unused.calls.empty());
}
