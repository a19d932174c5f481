#include "RcbTestSupport.h"

#include <QApplication>
#include <QComboBox>
#include <QSpinBox>
#include <gtest/gtest.h>

namespace {

QApplication& App() {
    static int argc = 1;
    static char name[] = "test_channelbonding";
    static char* argv[] = {name, nullptr};
    static QApplication app(argc, argv);
    return app;
}

std::string Texts(const std::vector<Qvz_Message>& ms) {
    std::string s;
    for (const auto& m : ms)
        s += m.text.str() + "\n";
    return s;
}

} // namespace

TEST(RcbRead, FailedReadsNeverWriteThePageDefaults) {
    {
        Qvz_MGTWizMain wiz("no data", false); // no design data at all
        wiz.Prepare();
        auto* page = static_cast<Qvz_MGTRCB*>(wiz.GetPage(Qvz_MGTWizMain::kChannelBonding));
        EXPECT_FALSE(page->DoBatchPage());
        EXPECT_FALSE(page->WriteWizData(true));
        ASSERT_EQ(wiz.GetMessages().size(), 2u);
        EXPECT_EQ(wiz.GetMessages()[0].text, "Tessel Wizard internal data error.");
        EXPECT_EQ(wiz.GetMessages()[1].text, "Tessel Wizard internal data error.");
    }
    {
        RcbRig rig;
        rig.data.Target().maxBondGT10 = 20;
        BondingAttrs(rig.Block("G", "GT10_CUSTOM", false), "10G Custom", "4");
        rig.Start();
        EXPECT_FALSE(rig.page->DoBatchPage()); // no active block
        EXPECT_TRUE(rig.Messages().empty());
    }
    for (int max : {0, -4, 1}) {
        // GT11 rounds 1 down to 0 as well.
        RcbRig rig;
        rig.data.Target().maxBondGT11 = max;
        Qvz_Block* b = rig.Block("G", "GT11_CUSTOM");
        BondingAttrs(b, "Custom", "1");
        Attr(b, "CHAN_BOND_SEQ_1_MASK", "0000"); // would be refused by a write
        const Qvz_Block before(*b);
        rig.Start();
        EXPECT_FALSE(rig.page->ReadWizData()) << max;
        EXPECT_EQ(rig.page->m_MaxCBondNum, 0);
        EXPECT_TRUE(rig.page->DoBatchPage()) << max;
        EXPECT_TRUE(rig.page->WriteWizData(true)) << max;
        EXPECT_TRUE(*b == before) << max;
        EXPECT_TRUE(rig.Messages().empty()) << Texts(rig.Messages());
    }
}

TEST(RcbRead, FamilyMaximumAndGt11Rounding) {
    const struct {
        const char* prim;
        int gt, gt10, gt11, expected;
    } cases[] = {
        {"GT_CUSTOM", 20, 8, 6, 20},
        {"GT10_CUSTOM", 20, 8, 6, 8},
        {"GT11_CUSTOM", 20, 8, 13, 12},
        {"GT11_CUSTOM", 20, 8, 24, 24},
    };
    for (const auto& c : cases) {
        RcbRig rig;
        rig.data.Target().maxBondGT = c.gt;
        rig.data.Target().maxBondGT10 = c.gt10;
        rig.data.Target().maxBondGT11 = c.gt11;
        BondingAttrs(rig.Block("G", c.prim), "Custom", "2");
        ASSERT_TRUE(rig.Start()->ReadWizData());
        EXPECT_EQ(rig.page->m_MaxCBondNum, c.expected) << c.prim;
    }
}

TEST(RcbRead, BinaryValuesLoseTheirSizePrefix) {
    const struct {
        const char* value;
        const char* expected;
    } cases[] = {
        {"11'b00101111100", "00101111100"},
        {"00101111100", "00101111100"},
        {"4'b000001111", "1111"}, // size counts from the end
        {"x'b0101", "0101"},      // size is no number
        {"16'b1010", "1010"},     // size larger than the digits
        {"-2'b0110", "0110"},     // a negative size is no size
        {"'b0110", "0110"},
    };
    for (const auto& c : cases) {
        RcbRig rig;
        rig.data.Target().maxBondGT11 = 24;
        Qvz_Block* b = rig.Block("G", "GT11_CUSTOM");
        BondingAttrs(b, "Custom", "2");
        Attr(b, "CHAN_BOND_SEQ_1_1", c.value);
        Attr(b, "CHAN_BOND_SEQ_2_MASK", c.value);
        ASSERT_TRUE(rig.Start()->ReadWizData());
        EXPECT_EQ(rig.page->m_seq[0], c.expected) << c.value;
        EXPECT_EQ(rig.page->m_seq2Mask, c.expected) << c.value;
    }
}

TEST(RcbRead, LockedSequencesFallBackToDefaultsButMasksDoNot) {
    RcbRig rig;
    rig.data.Target().maxBondGT10 = 20;
    Qvz_Block* b = rig.Block("G", "GT10_CUSTOM");
    BondingAttrs(b, "10G Custom", "2");
    Attr(b, "CHAN_BOND_SEQ_1_3", "11111111111", "00000000111", false);
    Attr(b, "CHAN_BOND_SEQ_1_MASK", "1011", "1111", false);
    Attr(b, "CHAN_BOND_SEQ_2_USE", "TRUE", "FALSE", false);
    Attr(b, "QVZ_CHAN_BOND_PRIMARY_ROW", "0");
    ASSERT_TRUE(rig.Start()->ReadWizData());
    EXPECT_EQ(rig.page->m_seq[2], "00000000111");
    EXPECT_EQ(b->GetAttributeValue("CHAN_BOND_SEQ_1_3"), "00000000111");
    EXPECT_EQ(rig.page->m_seq1Mask, "1011");
    EXPECT_EQ(rig.page->m_seq2Use, 0);
    EXPECT_EQ(rig.page->m_primaryRowBottom, 1);
}

TEST(RcbRead, NumberAndRanges) {
    RcbRig rig;
    rig.data.Target().maxBondGT10 = 20;
    Qvz_Block* b = rig.Block("G", "GT10_CUSTOM");
    BondingAttrs(b, "10G Custom", "6");
    Attr(b, "CHAN_BOND_LIMIT", "99", "12", true, {"1..31"});
    Attr(b, "CHAN_BOND_OFFSET", "40", nullptr, true, {"2..9", "7"});
    Attr(b, "CHAN_BOND_WAIT", "3", nullptr, true, {});
    ASSERT_TRUE(rig.Start()->ReadWizData());
    EXPECT_EQ(rig.page->m_cbondNum, 6);
    // The limit alone falls back to its default when out of range.
    EXPECT_EQ(rig.page->m_limitText, "12");
    EXPECT_EQ(b->GetAttributeValue("CHAN_BOND_LIMIT"), "12");
    EXPECT_EQ(rig.page->m_offset, 40);
    EXPECT_EQ(rig.page->m_offsetMin, 7); // the last legal entry decides
    EXPECT_EQ(rig.page->m_offsetMax, 7);
    EXPECT_EQ(rig.page->m_waitMin, 1);
    EXPECT_EQ(rig.page->m_waitMax, 15);
    Attr(b, "QVZ_BOOL_RX_USE", "FALSE");
    ASSERT_TRUE(rig.page->ReadWizData());
    EXPECT_EQ(rig.page->m_cbondNumText, "0");
}

TEST(RcbWrite, ChecksInOrderAndWritesNothingOnFailure) {
    const std::string nrange = "The allowable range for the number of channel bonded transceivers "
                               "is between 0 and 20, excluding 1.";
    const struct {
        const char* number;
        int limit, wait, offset;
        std::string message;
    } cases[] = {
        {"1", 99, 99, 99, nrange},
        {"21", 16, 8, 8, nrange},
        {"-2", 16, 8, 8, nrange},
        {"4", 32, 99, 99,
         "The allowable range for the maximum number of bytes a slave receiver can read is "
         "between 1 and 31."},
        {"4", 16, 0, 99,
         "The allowable range for the minimum number of RXUSRCLK cycles is between 1 and 15."},
        {"4", 16, 8, 16,
         "The allowable range for the offset from channel bonding sequence is between 0 and 15."},
    };
    for (const auto& c : cases) {
        RcbRig rig;
        rig.data.Target().maxBondGT10 = 20;
        Qvz_Block* b = rig.Block("G", "GT10_CUSTOM");
        BondingAttrs(b, "10G Custom", "2");
        ASSERT_TRUE(rig.Start()->ReadWizData());
        const Qvz_Block before(*b);
        rig.page->m_cbondNumText = c.number;
        rig.page->m_limit = c.limit;
        rig.page->m_wait = c.wait;
        rig.page->m_offset = c.offset;
        rig.page->m_seq1Mask = "0000"; // would fail last
        EXPECT_FALSE(rig.page->WriteWizData(true)) << c.number;
        ASSERT_EQ(rig.Messages().size(), 1u) << Texts(rig.Messages());
        EXPECT_EQ(rig.Messages()[0].text.str(), c.message);
        EXPECT_FALSE(rig.Messages()[0].flag1);
        EXPECT_TRUE(*b == before);
    }
}

TEST(RcbWrite, Gt11OddNumberRefusedInWindowsAndLoweredInBatch) {
    for (Qvz_RunMode mode : {Qvz_RunMode::Window, Qvz_RunMode::Batch}) {
        RcbRig rig;
        rig.data.Target().maxBondGT11 = 24;
        Qvz_Block* b = rig.Block("G", "GT11_CUSTOM");
        BondingAttrs(b, "Custom", "5");
        ASSERT_TRUE(rig.Start(mode)->ReadWizData());
        const bool batch = mode == Qvz_RunMode::Batch;
        EXPECT_EQ(rig.page->WriteWizData(true), batch);
        ASSERT_EQ(rig.Messages().size(), 1u);
        EXPECT_EQ(rig.Messages()[0].text,
                  batch ? "Because dual GT11s will be generated, the number of channel bonded "
                          "transceivers must be an even number.  The current number of 5 has "
                          "been changed to be 4."
                        : "Because dual GT11s will be generated, the number of channel bonded "
                          "transceivers must be an even number.");
        EXPECT_EQ(b->GetAttributeValue("QVZ_CHAN_BOND_NUMBER"), batch ? "4" : "5");
        EXPECT_EQ(b->GetAttributeValue("CHAN_BOND_MODE"), batch ? "MASTER" : "OFF");
    }
}

TEST(RcbWrite, BackWritesWithoutRoleAndLoc) {
    RcbRig rig;
    rig.data.Target().maxBondGT = 20;
    Qvz_Block* b = rig.Block("G", "GT_CUSTOM");
    BondingAttrs(b, "Custom", "4");
    ASSERT_TRUE(rig.Start()->ReadWizData());
    rig.page->m_allowRepeat = 0;
    ASSERT_TRUE(rig.page->WriteWizData(false));
    EXPECT_EQ(b->GetAttributeValue("CHAN_BOND_ONE_SHOT"), "TRUE");
    EXPECT_EQ(b->GetAttributeValue("CHAN_BOND_MODE"), "OFF");
    EXPECT_EQ(b->GetNamedAttribute("LOC"), nullptr);
    ASSERT_TRUE(rig.page->WriteWizData(true));
    EXPECT_EQ(b->GetAttributeValue("CHAN_BOND_MODE"), "MASTER");
    EXPECT_EQ(b->GetAttributeValue("LOC"), "GT_X5Y1");
}

TEST(RcbMasks, MessagesOnReadAndWrite) {
    const struct {
        bool onRead;
        const char* len;
        const char* mask1;
        const char* mask2;
        const char* defLen;
        std::string text;
        const char* newLen;
        const char* newMask1;
        const char* newMask2;
    } cases[] = {
        {false, "2", "0001", "1111", "4",
         "The mask for channel bonding sequence 1 (CHAN_BOND_SEQ_1_MASK=0001) is not valid.  It "
         "can have only 2 zeros (the length of the channel bonding sequence).  Please change the "
         "value to be valid.",
         "2", "0001", "1111"},
        {false, "1", "1111", "0011", "4",
         "The mask for channel bonding sequence 2 (CHAN_BOND_SEQ_2_MASK=0011) is not valid.  It "
         "can have only 1 zero (the length of the channel bonding sequence).  Please change the "
         "value to be valid.",
         "1", "1111", "0011"},
        {false, "1", "0011", "0110", "4",
         "The masks for channel bonding sequences 1 and 2 (CHAN_BOND_SEQ_1_MASK(=0011) and "
         "CHAN_BOND_SEQ_2_MASK(=0110)) are not valid.  They each can have only 1 zero (the length "
         "of the channel bonding sequence (CHAN_BOND_SEQ_LEN)).  Please change the mask values to "
         "be valid.",
         "1", "0011", "0110"},
        {true, "2", "0001", "1111", "4",
         "The mask for channel bonding sequence 1 (CHAN_BOND_SEQ_1_MASK=0001) is not valid.  It "
         "can have only 2 zeros (the length of the channel bonding sequence (CHAN_BOND_SEQ_LEN)).  "
         "The wizard will use the default length 4 and the CHAN_BOND_SEQ_1_MASK default 1110 "
         "instead of the current values.",
         "4", "1110", "1111"},
        {true, "2", "0001", "1100", "1",
         "The mask for channel bonding sequence 1 (CHAN_BOND_SEQ_1_MASK=0001) is not valid.  It "
         "can have only 2 zeros (the length of the channel bonding sequence (CHAN_BOND_SEQ_LEN)).  "
         "The wizard will use the default length 1 and defaults for both CHAN_BOND_SEQ_1_MASK "
         "(1110) and CHAN_BOND_SEQ_2_MASK (1101) instead of the current values.",
         "1", "1110", "1101"},
        {true, "1", "1110", "1100", "4",
         "The mask for channel bonding sequence 2 (CHAN_BOND_SEQ_2_MASK=1100) is not valid.  It "
         "can have only 1 zero (the length of the channel bonding sequence (CHAN_BOND_SEQ_LEN)).",
         "4", "1110", "1101"},
        {true, "2", "0011", "1000", "1",
         "The mask for channel bonding sequence 2 (CHAN_BOND_SEQ_2_MASK=1000) is not valid.  It "
         "can have only 2 zeros (the length of the channel bonding sequence (CHAN_BOND_SEQ_LEN)).  "
         "The wizard will use the default length 1 and defaults for both CHAN_BOND_SEQ_1_MASK "
         "(1110) and CHAN_BOND_SEQ_2_MASK (1101) instead of the current values.",
         "1", "1110", "1101"},
        {true, "1", "0011", "0011", "4",
         "The masks for channel bonding sequence 1 (CHAN_BOND_SEQ_1_MASK=0011) and sequence 2 "
         "(CHAN_BOND_SEQ_2_MASK=0011) are not valid.  They each can have only 1 zero (the length "
         "of the channel bonding sequence (CHAN_BOND_SEQ_LEN)).  The wizard will use the defaults "
         "(1110 and 1101, respectively, using default length 4) instead of the current values.",
         "4", "1110", "1101"},
        {true, "1", "0011", "0110", "1",
         "The masks for channel bonding sequence 1 (CHAN_BOND_SEQ_1_MASK=0011) and sequence 2 "
         "(CHAN_BOND_SEQ_2_MASK=0110) are not valid.  They each can have only 1 zero (the length "
         "of the channel bonding sequence (CHAN_BOND_SEQ_LEN)).  The wizard will use the defaults "
         "(1110 and 1101, respectively) instead of the current values.",
         "1", "1110", "1101"},
    };
    for (const auto& c : cases) {
        RcbRig rig;
        rig.data.Target().maxBondGT10 = 20;
        Qvz_Block* b = rig.Block("G", "GT10_CUSTOM");
        BondingAttrs(b, "10G Custom", "2");
        Attr(b, "CHAN_BOND_SEQ_1_MASK", "1111", "4'b1110");
        Attr(b, "CHAN_BOND_SEQ_2_MASK", "1111", "1101");
        Attr(b, "CHAN_BOND_SEQ_LEN", "4", c.defLen, true, {"1", "2", "4"});
        ASSERT_TRUE(rig.Start()->ReadWizData());
        rig.page->m_seqLen = c.len;
        rig.page->m_seq1Mask = c.mask1;
        rig.page->m_seq2Mask = c.mask2;
        EXPECT_EQ(rig.page->CheckSeqMasks(b, c.onRead), c.onRead) << c.text;
        ASSERT_EQ(rig.Messages().size(), 1u);
        EXPECT_EQ(rig.Messages()[0].text.str(), c.text);
        EXPECT_EQ(rig.Messages()[0].flag1, !c.onRead);
        EXPECT_EQ(rig.page->m_seqLen, c.newLen) << c.text;
        EXPECT_EQ(rig.page->m_seq1Mask, c.newMask1) << c.text;
        EXPECT_EQ(rig.page->m_seq2Mask, c.newMask2) << c.text;
    }
}

TEST(RcbMasks, FirstFamilyIsNeverChecked) {
    RcbRig rig;
    rig.data.Target().maxBondGT = 20;
    Qvz_Block* b = rig.Block("G", "GT_CUSTOM");
    BondingAttrs(b, "Custom", "2");
    Attr(b, "CHAN_BOND_SEQ_1_MASK", "0000");
    Attr(b, "CHAN_BOND_SEQ_LEN", "1", "1", true, {"1"});
    ASSERT_TRUE(rig.Start()->DoBatchPage());
    EXPECT_TRUE(rig.Messages().empty());
    EXPECT_EQ(b->GetAttributeValue("CHAN_BOND_SEQ_1_MASK"), "0000");
}

TEST(RcbLaneIds, LoadedPerBlockGrownAndBoundsChecked) {
    RcbRig rig;
    rig.data.Target().maxBondGT10 = 6;
    // Named like the page's initial LANE_ID block: it must still get its list.
    Qvz_Block* b = rig.Block("GT10_CUSTOM_INST", "GT10_INFINIBAND_4");
    BondingAttrs(b, "Infiniband", "4");
    Attr(b, "LANE_ID", "00000000001");
    Attr(b, "CHAN_BOND_SEQ_1_2", "11111111111");
    Attr(b, "CHAN_BOND_SEQ_2_2", "11111111111");
    Attr(rig.Block("GT10_CUSTOM_INST4", "GT10_INFINIBAND_4", false), "LANE_ID", "00000000100");
    ASSERT_TRUE(rig.Start()->ReadWizData());
    const Qvz_MGTRCB& p = *rig.page;
    ASSERT_EQ(p.m_laneIds.GetSize(), 6);
    EXPECT_EQ(p.m_laneIds.GetAt(0), "00000000001");
    EXPECT_EQ(p.m_laneIds.GetAt(1), "00000000000");
    EXPECT_EQ(p.m_laneIds.GetAt(3), "00000000100");
    EXPECT_EQ(p.GetLaneId(-1), "00000000000");
    EXPECT_EQ(p.GetLaneId(6), "00000000000");
    EXPECT_EQ(p.m_seq[1], "00000000001"); // CHAN_BOND_SEQ_1_2 carries the LANE_ID
    EXPECT_EQ(p.m_seq[5], "00000000001");

    // Edits survive a re-read of the same block.
    rig.page->m_laneIds.SetAt(0, "00000000111");
    ASSERT_TRUE(rig.page->ReadWizData());
    EXPECT_EQ(rig.page->m_laneIds.GetAt(0), "00000000111");
    ASSERT_TRUE(rig.page->WriteWizData(true));
    for (const char* a : {"LANE_ID", "CHAN_BOND_SEQ_1_2", "CHAN_BOND_SEQ_2_2"})
        EXPECT_EQ(b->GetAttributeValue(a), "00000000111") << a;

    // An empty list (never loaded) still reads safely.
    RcbRig fresh;
    fresh.Start();
    EXPECT_EQ(fresh.page->GetLaneId(0), "00000000000");
}

namespace {
class FakeView : public Qvz_MGTRCBView {
public:
    QComboBox combo;
    QSpinBox number, limit, offset, wait;
    int pushes = 0;
    QComboBox* SeqLenComboBox() override { return &combo; }
    QSpinBox* CBondNumSpinBox() override { return &number; }
    QSpinBox* LimitSpinBox() override { return &limit; }
    QSpinBox* OffsetSpinBox() override { return &offset; }
    QSpinBox* WaitSpinBox() override { return &wait; }
    void DataToWidgets() override { ++pushes; }
};
} // namespace

TEST(RcbWindow, ReadFillsTheFormAndWriteTakesTheComboText) {
    App();
    RcbRig rig;
    rig.data.Target().maxBondGT10 = 20;
    Qvz_Block* b = rig.Block("G", "GT10_XAUI_4");
    BondingAttrs(b, "XAUI", "0");
    Attr(b, "CHAN_BOND_SEQ_LEN", "3", "2", true, {"1", "2", "4"});
    FakeView view;
    rig.Start(Qvz_RunMode::Window)->SetView(&view);
    ASSERT_TRUE(rig.page->ReadWizData());
    EXPECT_EQ(view.combo.count(), 3);
    EXPECT_EQ(view.combo.currentText(), "2");
    EXPECT_EQ(b->GetAttributeValue("CHAN_BOND_SEQ_LEN"), "2"); // the default, written back
    EXPECT_EQ(view.number.minimum(), 4);
    EXPECT_EQ(view.number.maximum(), 4);
    EXPECT_EQ(view.number.value(), 4);
    EXPECT_EQ(view.limit.maximum(), 31);
    EXPECT_EQ(view.wait.value(), 8);
    EXPECT_EQ(view.pushes, 1);
    view.combo.setCurrentIndex(2);
    ASSERT_TRUE(rig.page->WriteWizData(true));
    EXPECT_EQ(b->GetAttributeValue("CHAN_BOND_SEQ_LEN"), "4");
    EXPECT_EQ(b->GetAttributeValue("QVZ_CHAN_BOND_NUMBER"), "4");
    EXPECT_EQ(b->GetAttributeValue("LOC"), "GT10_X5Y1");
}
