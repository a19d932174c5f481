// The resets the General Setup write applies per family, primitive and type.

#include "GeneralSupport.h"

#include <gtest/gtest.h>

namespace {

const char* const kBypassResets[][2] = {
    {"ALIGN_COMMA_MSB", "FALSE"},     {"CHAN_BOND_MODE", "OFF"},
    {"CLK_CORRECT_USE", "FALSE"},     {"COMMA_10B_MASK", "0000000000"},
    {"DEC_MCOMMA_DETECT", "FALSE"},   {"DEC_PCOMMA_DETECT", "FALSE"},
    {"MCOMMA_DETECT", "FALSE"},       {"PCOMMA_DETECT", "FALSE"},
    {"RX_CRC_USE", "FALSE"},          {"RX_DECODE_USE", "FALSE"},
    {"TX_CRC_USE", "FALSE"},          {"RX_BUFFER_USE", "FALSE"},
    {"RX_LOSS_OF_SYNC_FSM", "FALSE"},
};

// A block holding every attribute the bypass resets, set to something else.
std::unique_ptr<Qvz_Block> BypassBlock(bool withBypassAttr, const char* bypassValue) {
    auto b = std::make_unique<Qvz_Block>("B", "GT10_CUSTOM", Qvz_Family::GT10);
    if (withBypassAttr)
        b->AddAttribute("QVZX_ONLY_BYPASS_PCS", bypassValue);
    for (const auto& r : kBypassResets)
        if (std::string(r[0]) != "RX_BUFFER_USE") // one missing: must not be added
            b->AddAttribute(r[0], "KEEP");
    return b;
}

} // namespace

TEST(ApplyPcsBypassResets, BypassResetsThePcsAttributes) {
    TestPage page(nullptr);
    page.m_bypassPcs = true;
    auto b = BypassBlock(true, "FALSE");
    page.ApplyPcsBypassResets(b.get());
    EXPECT_EQ(b->GetAttributeValue("QVZX_ONLY_BYPASS_PCS"), "TRUE");
    // Added even when the block lacked it.
    EXPECT_EQ(b->GetAttributeValue("QVZX_ONLY_TX_8B10B_USE"), "FALSE");
    for (const auto& r : kBypassResets) {
        if (std::string(r[0]) == "RX_BUFFER_USE")
            EXPECT_EQ(b->GetNamedAttribute(r[0]), nullptr);
        else
            EXPECT_EQ(b->GetAttributeValue(r[0]), r[1]) << r[0];
    }
}

TEST(ApplyPcsBypassResets, WithoutBypassOnlyTheSwitchChanges) {
    const struct {
        const char* what;
        bool hasAttr;
        const char* before;
        bool bypass;
    } cases[] = {
        {"bypass off", true, "TRUE", false},
        {"no attribute, bypass on", false, "", true},
        {"no attribute, bypass off", false, "", false},
    };
    for (const auto& c : cases) {
        TestPage page(nullptr);
        page.m_bypassPcs = c.bypass;
        auto b = BypassBlock(c.hasAttr, c.before);
        auto expected = std::make_unique<Qvz_Block>(*b);
        if (c.hasAttr)
            expected->GetNamedAttribute("QVZX_ONLY_BYPASS_PCS")->SetValue("FALSE");
        page.ApplyPcsBypassResets(b.get());
        EXPECT_TRUE(*b == *expected) << c.what;
    }
    TestPage page(nullptr);
    page.ApplyPcsBypassResets(nullptr);
}

TEST(ResetZephineClockCorrection, FollowsTheDataWidth) {
    const struct {
        const char* width;
        const char* seq[4]; // CLK_COR_SEQ_1_1 .. 1_4 afterwards
        bool changed[4];
    } cases[] = {
        {"1", {"D1", "00000000000", "00000000000", "00000000000"}, {true, true, true, true}},
        {"2", {"D1", "D2", "00000000000", "00000000000"}, {true, true, true, true}},
        {"4", {"D1", "D2", "D2", "D2"}, {true, true, true, true}},
        {"8", {"D1", "V2", "V3", "V4"}, {true, false, false, false}},
        {"", {"D1", "V2", "V3", "V4"}, {true, false, false, false}},
    };
    const char* names[4] = {"CLK_COR_SEQ_1_1", "CLK_COR_SEQ_1_2", "CLK_COR_SEQ_1_3",
                            "CLK_COR_SEQ_1_4"};
    for (const auto& c : cases) {
        TestPage page(nullptr);
        page.m_dataWidth = c.width;
        Qvz_Block b("Z", "GT_ZEPHINE", Qvz_Family::GT);
        for (int i = 0; i < 4; ++i) {
            const std::string v = "V" + std::to_string(i + 1), d = "D" + std::to_string(i + 1);
            Attr(&b, names[i], v.c_str(), d.c_str());
        }
        page.ResetZephineClockCorrection(&b);
        // Added when missing.
        EXPECT_EQ(b.GetAttributeValue("CLK_COR_SEQ_LEN"), c.width);
        for (int i = 0; i < 4; ++i) {
            EXPECT_EQ(b.GetAttributeValue(names[i]), c.seq[i]) << c.width << " " << names[i];
            EXPECT_EQ(b.GetNamedAttribute(names[i])->IsChanged(), c.changed[i])
                << c.width << " " << names[i];
        }
    }
}

TEST(ResetZephineClockCorrection, LeavesOtherPrimitivesAndMissingSequencesAlone) {
    TestPage page(nullptr);
    page.m_dataWidth = "4";
    for (const char* prim : {"GT_CUSTOM", "GT_ZEPHINE_X", "GT10_ZEPHINE_4"}) {
        Qvz_Block b("Z", prim, Qvz_FamilyOfPrimitive(prim));
        Attr(&b, "CLK_COR_SEQ_1_1", "V1", "D1");
        const Qvz_Block before(b);
        page.ResetZephineClockCorrection(&b);
        EXPECT_TRUE(b == before) << prim;
    }
    // Without CLK_COR_SEQ_1_2 there is no default to repeat.
    Qvz_Block b("Z", "GT_ZEPHINE", Qvz_Family::GT);
    Attr(&b, "CLK_COR_SEQ_1_3", "V3", "D3");
    page.ResetZephineClockCorrection(&b);
    EXPECT_EQ(b.GetAttributeValue("CLK_COR_SEQ_1_3"), "V3");
    EXPECT_EQ(b.GetNamedAttribute("CLK_COR_SEQ_1_1"), nullptr);
    EXPECT_EQ(b.GetNamedAttribute("CLK_COR_SEQ_1_2"), nullptr);
    page.ResetZephineClockCorrection(nullptr);
}

namespace {

const char* const kGT10AlwaysDeleted[] = {"PMARXFDETSEL",
                                          "PMATXCMSET0",
                                          "PMATXCMSET1",
                                          "PMATXVCODACSEL",
                                          "PMAVSEL",
                                          "TX_6466SCRAMBLER_USE",
                                          "TX_6466GEARBOX_USE",
                                          "CHAN_BOND_WAIT",
                                          "CHAN_BOND_OFFSET",
                                          "ALIGN_COMMA_MSB",
                                          "CLK_COR_REPEAT_WAIT",
                                          "CLK_COR_ADJ_MAX",
                                          "CLK_COR_KEEP_IDLE",
                                          "CLK_COR_INSERT_IDLE_FLAG",
                                          "CRC_END_OF_PKT",
                                          "CRC_FORMAT",
                                          "CRC_START_OF_PKT",
                                          "RX_CRC_USE",
                                          "TX_CRC_FORCE_VALUE",
                                          "TX_CRC_USE",
                                          "CLK_COR_64B66B_SV",
                                          "LANE0_COMMA_SUB",
                                          "LANE1_COMMA_SUB",
                                          "LANE2_COMMA_SUB",
                                          "LANE3_COMMA_SUB",
                                          "LANE4_COMMA_SUB",
                                          "LANE5_COMMA_SUB",
                                          "LANE6_COMMA_SUB",
                                          "LANE7_COMMA_SUB",
                                          "PMARXCALSEL",
                                          "PMATXCALSEL",
                                          "SEQUENCE_ORDERED_SET"};

const char* const kGT10DeletedPins[] = {
    "DISPREGSEL",     "PMALOOPBACK",   "PMARXCLK0SEL",  "PMARXCLK1SEL",  "PMARXLATCHSEL",
    "PMARXRECCLKSEL", "PMATXCLK0SEL",  "PMATXCLK1SEL",  "PMATXLATCHSEL", "PMATXOUTCLKSEL",
    "RXDECODEUSE",    "PMAPWRDN",      "PMAREGLOAD",    "PMACMOUT",      "PMACMIN",
    "PMATERMEN",      "TXFORCECRCERR", "RXCHECKINGCRC", "RXCRCERR"};

// Attributes deleted by display-name group, and some that always stay.
const char* const kShCount[] = {"SH_CNT_MAX", "SH_INVALID_CNT_MAX"};
const char* const kCommaCtl[] = {"ALIGN_COMMA_WORD",  "COMMA_10B_MASK",    "CLK_COR_8B10B_DE",
                                 "DEC_MCOMMA_DETECT", "DEC_PCOMMA_DETECT", "DEC_VALID_COMMA_ONLY"};
const char* const kCommaVal[] = {"MCOMMA_10B_VALUE", "MCOMMA_DETECT", "PCOMMA_10B_VALUE",
                                 "PCOMMA_DETECT"};
const char* const kBondCor[] = {
    "CHAN_BOND_LIMIT",      "CHAN_BOND_MODE",       "CHAN_BOND_NUMBER",    "CHAN_BOND_ONE_SHOT",
    "CHAN_BOND_SEQ_1_1",    "CHAN_BOND_SEQ_1_2",    "CHAN_BOND_SEQ_1_3",   "CHAN_BOND_SEQ_1_4",
    "CHAN_BOND_SEQ_1_MASK", "CHAN_BOND_SEQ_2_1",    "CHAN_BOND_SEQ_2_2",   "CHAN_BOND_SEQ_2_3",
    "CHAN_BOND_SEQ_2_4",    "CHAN_BOND_SEQ_2_MASK", "CHAN_BOND_SEQ_2_USE", "CHAN_BOND_SEQ_LEN",
    "DEC_8B10B_SEL",        "CLK_COR_MAX_LAT",      "CLK_COR_MIN_LAT",     "CLK_COR_SEQ_1_1",
    "CLK_COR_SEQ_1_2",      "CLK_COR_SEQ_1_3",      "CLK_COR_SEQ_1_4",     "CLK_COR_SEQ_1_MASK",
    "CLK_COR_SEQ_2_1",      "CLK_COR_SEQ_2_2",      "CLK_COR_SEQ_2_3",     "CLK_COR_SEQ_2_4",
    "CLK_COR_SEQ_2_MASK",   "CLK_COR_SEQ_2_USE",    "CLK_COR_SEQ_DROP",    "CLK_COR_SEQ_LEN",
    "CLK_CORRECT_USE"};

std::unique_ptr<Qvz_Block> GT10Block(const char* prim) {
    auto b = std::make_unique<Qvz_Block>("B", prim, Qvz_FamilyOfPrimitive(prim));
    for (const char* n : kGT10AlwaysDeleted)
        b->AddAttribute(n, "x");
    for (const char* n : kShCount)
        b->AddAttribute(n, "x");
    for (const char* n : kCommaCtl)
        b->AddAttribute(n, "x");
    for (const char* n : kCommaVal)
        b->AddAttribute(n, "x");
    for (const char* n : kBondCor)
        b->AddAttribute(n, "x");
    b->AddAttribute("PMA_SPEED", "x");
    for (const char* n : kGT10DeletedPins)
        b->AddPin(n, "IN");
    Pin(b.get(), "CHBONDI", 4);
    Pin(b.get(), "CHBONDO", 4, false, "OUT");
    Pin(b.get(), "RXINTDATAWIDTH", 1);
    Pin(b.get(), "TXINTDATAWIDTH", 1);
    Pin(b.get(), "TXKERR", 4);
    Pin(b.get(), "TXDATA", 32, true);
    return b;
}

template <std::size_t N> bool AllPresent(const Qvz_Block& b, const char* const (&names)[N]) {
    for (const char* n : names)
        if (!b.GetNamedAttribute(n))
            return false;
    return true;
}

template <std::size_t N> bool NonePresent(const Qvz_Block& b, const char* const (&names)[N]) {
    for (const char* n : names)
        if (b.GetNamedAttribute(n))
            return false;
    return true;
}

} // namespace

TEST(PruneGT10Attributes, DeletesWhatGT10NeverUsesAndFixesPinWidths) {
    TestPage page(nullptr);
    page.m_displayName = "Custom";
    auto b = GT10Block("GT10_CUSTOM");
    page.PruneGT10Attributes(b.get());
    EXPECT_TRUE(NonePresent(*b, kGT10AlwaysDeleted));
    for (const char* n : kGT10DeletedPins)
        EXPECT_EQ(b->GetNamedPin(n), nullptr) << n;
    EXPECT_EQ(b->GetNamedPin("CHBONDI")->GetWidth(), 5);
    EXPECT_EQ(b->GetNamedPin("CHBONDO")->GetWidth(), 5);
    EXPECT_EQ(b->GetNamedPin("RXINTDATAWIDTH")->GetWidth(), 2);
    EXPECT_EQ(b->GetNamedPin("TXINTDATAWIDTH")->GetWidth(), 2);
    EXPECT_EQ(b->GetNamedPin("TXDATA")->GetWidth(), 32);
    // TXKERR is reshaped for GT10_ZEPHINE_1 only.
    EXPECT_EQ(b->GetNamedPin("TXKERR")->GetWidth(), 4);
    EXPECT_FALSE(b->GetNamedPin("TXKERR")->HasFlag("DATAWIDTH"));
    // Another display name deletes no group.
    EXPECT_TRUE(AllPresent(*b, kShCount) && AllPresent(*b, kCommaCtl) &&
                AllPresent(*b, kCommaVal) && AllPresent(*b, kBondCor));
    EXPECT_NE(b->GetNamedAttribute("PMA_SPEED"), nullptr);

    auto z1 = GT10Block("GT10_ZEPHINE_1");
    page.PruneGT10Attributes(z1.get());
    EXPECT_EQ(z1->GetNamedPin("TXKERR")->GetWidth(), 1);
    EXPECT_TRUE(z1->GetNamedPin("TXKERR")->HasFlag("DATAWIDTH"));
    // A block missing all of it is left as it is.
    Qvz_Block bare("B", "GT10_ZEPHINE_1", Qvz_Family::GT10);
    page.PruneGT10Attributes(&bare);
    EXPECT_TRUE(bare.GetPins().empty());
}

TEST(PruneGT10Attributes, DisplayNameGroups) {
    const struct {
        const char* display;
        bool shCount, commaCtl, commaVal, bondCor; // true: deleted
    } cases[] = {
        {"Zephine", true, false, false, false},      {"PCI Express", true, false, false, false},
        {"Infiniband", true, false, false, false},   {"XAUI", true, false, false, false},
        {"OC192", true, false, false, true},         {"OC48", true, false, false, true},
        {"FibreChannel", false, true, false, false}, {"Ethernet", false, true, false, false},
        {"ZephineX", false, true, true, false},      {"Custom", false, false, false, false},
        {"10G Custom", false, false, false, false},  {"oc48", false, false, false, false},
    };
    for (const auto& c : cases) {
        TestPage page(nullptr);
        page.m_displayName = c.display;
        auto b = GT10Block("GT10_X");
        page.PruneGT10Attributes(b.get());
        EXPECT_TRUE(c.shCount ? NonePresent(*b, kShCount) : AllPresent(*b, kShCount)) << c.display;
        EXPECT_TRUE(c.commaVal ? NonePresent(*b, kCommaVal) : AllPresent(*b, kCommaVal))
            << c.display;
        EXPECT_TRUE(c.bondCor ? NonePresent(*b, kBondCor) : AllPresent(*b, kBondCor)) << c.display;
        // CLK_COR_8B10B_DE is in the comma group and the OC group.
        for (const char* n : kCommaCtl) {
            const bool gone = c.commaCtl || (c.bondCor && std::string(n) == "CLK_COR_8B10B_DE");
            EXPECT_EQ(b->GetNamedAttribute(n) == nullptr, gone) << c.display << " " << n;
        }
    }
}

TEST(PruneGT10Attributes, OtherFamiliesAreUntouched) {
    TestPage page(nullptr);
    page.m_displayName = "OC48";
    for (const char* prim : {"GT_CUSTOM", "GT11_CUSTOM"}) {
        auto b = GT10Block(prim);
        const Qvz_Block before(*b);
        page.PruneGT10Attributes(b.get());
        EXPECT_TRUE(*b == before) << prim;
    }
    page.PruneGT10Attributes(nullptr);
}

TEST(CleanUpGT11Attributes, DeletesAndConvertsOldValueForms) {
    const struct {
        const char* name;
        const char* value;
        const char* def;
        const char* expected;
    } conversions[] = {
        {"TXFDCAL_CLOCK_DIVIDE", "2'b00", nullptr, "NONE"},
        {"RXFDCAL_CLOCK_DIVIDE", "2'b00", nullptr, "NONE"},
        {"TXFDCAL_CLOCK_DIVIDE", "2'b01", nullptr, "2'b01"},
        {"RXFDCAL_CLOCK_DIVIDE", "2'b000", nullptr, "2'b000"},
        {"TXPLLNDIVSEL", "4'b0101", "16", "16"},
        {"RXPLLNDIVSEL", "x4'b", "8", "8"},
        {"TXPLLNDIVSEL", "4'h5", "16", "4'h5"},
        {"RXPLLNDIVSEL", "10", "8", "10"},
        {"CLK_COR_SEQ_1_MASK", "4'1100", nullptr, "4'b1100"},
        {"CLK_COR_SEQ_1_MASK", "4'1101", nullptr, "4'1101"},
    };
    for (const auto& c : conversions) {
        TestPage page(nullptr);
        Qvz_Block b("G", "GT11_CUSTOM", Qvz_Family::GT11);
        Attr(&b, c.name, c.value, c.def);
        for (const char* n : {"RXRECCLK2_USE_SYNC", "TXOUTCLK2_USE_SYNC", "QVZX_ONLY_GT11_CLK",
                              "COMMA_32B_MASK", "RX_LOS_INVALID_INCR", "RX_LOS_THRESHOLD"})
            b.AddAttribute(n, "x");
        b.AddAttribute("RX_LOS_INVALID_INCR_X", "kept");
        page.CleanUpGT11Attributes(&b);
        EXPECT_EQ(b.GetAttributeValue(c.name), c.expected) << c.name << "=" << c.value;
        ASSERT_EQ(b.GetAttributes().size(), 2u) << c.name;
        EXPECT_EQ(b.GetAttributeValue("RX_LOS_INVALID_INCR_X"), "kept");
    }
}

TEST(CleanUpGT11Attributes, OtherFamiliesAreUntouched) {
    TestPage page(nullptr);
    for (const char* prim : {"GT_CUSTOM", "GT10_CUSTOM"}) {
        Qvz_Block b("B", prim, Qvz_FamilyOfPrimitive(prim));
        Attr(&b, "TXPLLNDIVSEL", "4'b0101", "16");
        Attr(&b, "RX_LOS_THRESHOLD", "4");
        const Qvz_Block before(b);
        page.CleanUpGT11Attributes(&b);
        EXPECT_TRUE(b == before) << prim;
    }
    page.CleanUpGT11Attributes(nullptr);
}

TEST(FamilyResets, RunOnTheBlockTheWriteActivates) {
    // A GT10 "OC48" write ends with the OC group pruned and bonding off.
    Design d(false, true, false);
    Qvz_Block* b = d.Block("OC", "GT10_OC48_4", "OC48", "QVZ_RX_DATA_WIDTH", "4", true);
    Attr(b, "SH_CNT_MAX", "1");
    Attr(b, "CLK_COR_SEQ_1_1", "1");
    Attr(b, "QVZ_CHAN_BOND_NUMBER", "4");
    Attr(b, "QVZX_ONLY_BYPASS_PCS", "TRUE");
    Attr(b, "ALIGN_COMMA_MSB", "TRUE");
    Attr(b, "RX_DECODE_USE", "TRUE");
    TestPage page(&d.Main());
    ASSERT_TRUE(page.m_bypassPcs);
    ASSERT_TRUE(page.WriteWizData());
    EXPECT_EQ(b->GetNamedAttribute("SH_CNT_MAX"), nullptr);
    EXPECT_EQ(b->GetNamedAttribute("CLK_COR_SEQ_1_1"), nullptr);
    EXPECT_EQ(b->GetNamedAttribute("ALIGN_COMMA_MSB"), nullptr); // reset, then pruned
    EXPECT_EQ(b->GetAttributeValue("RX_DECODE_USE"), "FALSE");
    EXPECT_EQ(b->GetAttributeValue("QVZX_ONLY_TX_8B10B_USE"), "FALSE");
    EXPECT_EQ(b->GetAttributeValue("QVZ_CHAN_BOND_NUMBER"), "0");

    // A GT write on GT_ZEPHINE resets its clock-correction sequence.
    Design g(true, false, false);
    Qvz_Block* z = g.Block("Z", "GT_ZEPHINE", "Zephine", "RX_DATA_WIDTH", "4", true);
    Attr(z, "CLK_COR_SEQ_1_1", "V1", "D1");
    Attr(z, "CLK_COR_SEQ_1_2", "V2", "D2");
    TestPage gpage(&g.Main());
    gpage.m_dataWidth = "1";
    ASSERT_TRUE(gpage.WriteWizData());
    EXPECT_EQ(z->GetAttributeValue("CLK_COR_SEQ_LEN"), "1");
    EXPECT_EQ(z->GetAttributeValue("CLK_COR_SEQ_1_1"), "D1");
    EXPECT_EQ(z->GetAttributeValue("CLK_COR_SEQ_1_2"), "00000000000");
}
