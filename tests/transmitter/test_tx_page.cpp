// The transmitter page on its own: failures, values the block gets wrong,
// and what a read-write cycle leaves behind.

#include "TxTestSupport.h"

using namespace txtest;

TEST(TransmitterPage, WithoutDataOrBlock) {
    Qvz_MGTWizMain main("w", false); // no design data at all
    Qvz_RecordingSink sink;
    main.SetMessageSink(&sink);
    auto page = std::make_unique<Qvz_MGTTransmitter>(&main);
    EXPECT_FALSE(page->ReadWizData());
    EXPECT_FALSE(page->WriteWizData());
    EXPECT_FALSE(page->DoBatchPage());
    // The batch step reads and writes, and each of them says so.
    ASSERT_EQ(sink.messages.size(), 4u);
    for (const Qvz_Message& m : sink.messages) {
        EXPECT_EQ(m.text, "Tessel Wizard internal data error.");
        EXPECT_FALSE(m.flag1 || m.flag2 || m.flag3);
    }

    Qvz_WizData d = LoadFixture("gt_custom.json");
    d.SetAllBlksIsActive(false);
    Wizard w(d, Qvz_RunMode::Batch);
    EXPECT_FALSE(w.Page()->ReadWizData());
    EXPECT_FALSE(w.Page()->WriteWizData());
    EXPECT_FALSE(w.Page()->DoBatchPage());
    EXPECT_TRUE(w.Messages().empty());
    EXPECT_FALSE(w.Page()->CreateGuiDlg(nullptr));
    EXPECT_EQ(w.Page()->GetGuiDlg(), nullptr);
    EXPECT_TRUE(w.Messages().empty());
}

TEST(TransmitterPage, BlockWithoutItsAttributesIsLeftAlone) {
    for (const char* prim : {"GT_CUSTOM", "GT10_CUSTOM", "GT11_CUSTOM"}) {
        Qvz_WizData d;
        Qvz_Block* b =
            d.AddBlock(std::make_unique<Qvz_Block>("I", prim, Qvz_FamilyOfPrimitive(prim)));
        b->SetIsUsed(true);
        b->AddAttribute("QVZ_BOOL_TX_USE", "TRUE");
        const Qvz_Block before(*b);
        Wizard w(d, Qvz_RunMode::Batch);
        EXPECT_TRUE(w.Page()->DoBatchPage()) << prim;
        EXPECT_TRUE(*b == before) << prim;
        EXPECT_TRUE(w.Messages().empty()) << prim;
    }
}

TEST(TransmitterPage, PreEmphasisStaysOnTheSlider) {
    struct Case {
        const char* value;
        std::vector<const char*> legal;
        int level;
        const char* written;
    };
    const Case cases[] = {
        {"2", {"0..3"}, 2, "2"},
        {"3", {"0..3"}, 3, "3"},
        // Nothing to read: the initial position.
        {"", {"0..3"}, 0, "0"},
        // No number: kept off the slider rather than read as 0.
        {"abc", {"0..3"}, 0, "0"},
        {"2x", {"0..3"}, 0, "0"},
        // Outside the range: the nearest end.
        {"7", {"0..3"}, 3, "3"},
        {"-4", {"0..3"}, 0, "0"},
        {"99999999999999999999", {"0..3"}, 3, "3"},
        // Bounds written high to low.
        {"0", {"3..1"}, 1, "1"},
        {"2", {"3..1"}, 2, "2"},
        {"", {"3..1"}, 1, "1"},
        // The last range entry wins; other entries are ignored.
        {"5", {"0..3", "X", "4..6"}, 5, "5"},
        // No range: 0 to 3.
        {"5", {}, 3, "3"},
    };
    for (const Case& c : cases) {
        Qvz_WizData d = LoadFixture("gt_custom.json");
        Qvz_Attribute* a = Attr(d, "TX_PREEMPHASIS");
        a->SetValue(c.value);
        a->GetLegalValues().RemoveAll();
        for (const char* l : c.legal)
            a->GetLegalValues().Add(l);
        Wizard w(d, Qvz_RunMode::Batch);
        EXPECT_TRUE(w.Page()->DoBatchPage()) << c.value;
        EXPECT_EQ(w.Page()->m_preEmphasisLevel, c.level) << c.value;
        EXPECT_EQ(Value(d, "TX_PREEMPHASIS"), c.written) << c.value;
    }
}

TEST(TransmitterPage, BufferIsForcedOnOnlyFromFalse) {
    const struct {
        const char* value;
        const char* written;
    } cases[] = {{"FALSE", "TRUE"}, {"TRUE", "TRUE"}, {"false", "false"}, {"", ""}};
    for (const auto& c : cases) {
        Qvz_WizData d = LoadFixture("gt_custom.json");
        Attr(d, "TX_BUFFER_USE")->SetValue(c.value);
        Wizard w(d, Qvz_RunMode::Batch);
        EXPECT_TRUE(w.Page()->DoBatchPage());
        EXPECT_EQ(Value(d, "TX_BUFFER_USE"), c.written) << c.value;
    }
}

TEST(TransmitterPage, UnlistedCrcFormatStaysInBatch) {
    Qvz_WizData d = LoadFixture("gt_custom.json");
    Attr(d, "CRC_FORMAT")->SetValue("BOGUS");
    Wizard w(d, Qvz_RunMode::Batch);
    EXPECT_TRUE(w.Page()->DoBatchPage());
    EXPECT_EQ(Value(d, "CRC_FORMAT"), "BOGUS");
}

TEST(TransmitterPage, Gt10CrcSettingsOfThePrimitive) {
    // On the page alone (a whole run prunes these on GT10): the wizard's own
    // CRC flag overrides the primitive's, an empty start of packet takes the
    // initial K27_7, the rest is written back as read.
    Qvz_WizData d = LoadFixture("gt10_custom.json");
    Wizard w(d, Qvz_RunMode::Batch);
    EXPECT_TRUE(w.Page()->DoBatchPage());
    const std::map<std::string, std::string> expected = {{"TX_CRC_USE", "TRUE"},
                                                         {"CRC_FORMAT", "INFINIBAND"},
                                                         {"CRC_START_OF_PKT", "K27_7"},
                                                         {"CRC_END_OF_PKT", "K28_0"},
                                                         {"TX_CRC_FORCE_VALUE", "00001111"}};
    for (const auto& [name, value] : expected)
        EXPECT_EQ(Value(d, name.c_str()), value) << name;
    EXPECT_TRUE(w.Messages().empty());
}

TEST(TransmitterPage, BooleansReadTrueOnlyForTRUE) {
    Qvz_WizData d = LoadFixture("gt10_custom.json");
    Attr(d, "QVZ_TXCRC_USE")->SetValue("true");
    Attr(d, "TXCRCCLOCKDOUBLE")->SetValue("YES");
    Attr(d, "TXPOST_TAP_PD")->SetValue("1");
    Wizard w(d, Qvz_RunMode::Batch);
    EXPECT_TRUE(w.Page()->DoBatchPage());
    for (const char* name : {"QVZ_TXCRC_USE", "TX_CRC_USE", "TXCRCCLOCKDOUBLE", "TXPOST_TAP_PD"})
        EXPECT_EQ(Value(d, name), "FALSE") << name;
}
