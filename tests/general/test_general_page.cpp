// Finding, reading and writing the transceiver block.

#include "GeneralSupport.h"

#include <gtest/gtest.h>

using Strings = std::vector<std::string>;

namespace {

Strings Items(const Qvz_StrArray& a) {
    Strings out;
    for (const auto& s : a.Items())
        out.push_back(s.str());
    return out;
}

} // namespace

TEST(GeneralSetup, WithoutDataKeepsItsInitialValues) {
    for (bool withMain : {false, true}) {
        Qvz_MGTWizMain main("w", false);
        main.SetWizData(nullptr);
        TestPage page(withMain ? &main : nullptr);
        EXPECT_EQ(page.m_displayName, "FibreChannel");
        EXPECT_EQ(page.m_dataWidth, "4");
        EXPECT_EQ(page.m_pmaSpeed, "0_32");
        EXPECT_TRUE(page.m_txUse && page.m_rxUse && page.m_gt11UseB);
        EXPECT_FALSE(page.m_isGT || page.m_isGT10 || page.m_isGT11 || page.m_gt11Single);
        EXPECT_EQ(page.m_pBlock, nullptr);
        // The batch step has nothing to write and does not refuse.
        EXPECT_TRUE(page.DoBatchPage());
        EXPECT_TRUE(main.GetMessages().empty());
    }
}

TEST(GeneralSetup, ConstructionReadsTheActiveBlock) {
    Design d(false, true, false);
    d.Block("OTHER", "GT10_CUSTOM", "10G Custom", "QVZ_RX_DATA_WIDTH", "4");
    Qvz_Block* b = d.Block("ETH", "GT10_ETHERNET_2", "Ethernet", "QVZ_RX_DATA_WIDTH", "2", true);
    Attr(b, "QVZ_BOOL_RX_USE", "FALSE");
    Attr(b, "TERMINATION_IMP", "50", nullptr, nullptr, false);
    Attr(b, "REF_CLK_V_SEL", "1");
    Attr(b, "QVZX_ONLY_USE_REFCLK", "FALSE");
    Attr(b, "QVZX_ONLY_REFCLK", "REFCLK1");
    Attr(b, "QVZX_ONLY_REFCLK_DYN", "DYN");
    Attr(b, "QVZX_ONLY_BREFCLK", "B");
    Attr(b, "QVZX_ONLY_BREFCLK_DYN", "BD");
    Attr(b, "QVZX_ONLY_BYPASS_PCS", "TRUE");
    Attr(b, "QVZX_ONLY_ENABLE_PMA", "maybe", nullptr, nullptr, false);
    Attr(b, "TXABPMACLKSEL", "REFCLK");
    Attr(b, "RXPMACLKSEL", "BREFCLK");
    // The speeds for width 2 come from their own list.
    Attr(b, "PMA_SPEED", "1_32", "0_32", "1_32,2_32");
    Attr(b, "QVZ_PMA_SPEED_2", "", "2_64", "2_64,3_64");
    // GT11 settings are read on GT11 targets only.
    Attr(b, "QVZ_GT11_MODE", "SINGLE");
    Attr(b, "QVZ_GT11_USE_B", "FALSE");
    Pin(b, "TXDATA", 16, true)->SetSigName("TXDATA_IN");
    b->GetNamedPin("TXDATA")->SetPinSigBitProp("S", 7, 0, 7, 0);

    TestPage page(&d.Main());
    EXPECT_TRUE(d.Messages().empty());
    EXPECT_EQ(page.m_pBlock, b);
    EXPECT_EQ(page.m_displayName, "Ethernet");
    EXPECT_EQ(page.m_dataWidth, "2");
    EXPECT_TRUE(page.m_txUse); // missing reads as used
    EXPECT_FALSE(page.m_rxUse);
    EXPECT_FALSE(page.m_serdes10b);
    EXPECT_FALSE(page.m_serdes10bEditable);
    EXPECT_EQ(page.m_termination, "50");
    EXPECT_FALSE(page.m_terminationEditable);
    EXPECT_EQ(page.m_refClkVSel, "1");
    EXPECT_TRUE(page.m_refClkVSelEditable);
    EXPECT_EQ(page.m_useRefClk, 0);
    EXPECT_EQ(page.m_useBRefClk, 1);
    EXPECT_EQ(page.m_refClk, "REFCLK1");
    EXPECT_EQ(page.m_refClkDyn, "DYN");
    EXPECT_EQ(page.m_bRefClk, "B");
    EXPECT_EQ(page.m_bRefClkDyn, "BD");
    EXPECT_TRUE(page.m_bypassPcs);
    EXPECT_TRUE(page.m_bypassPcsEditable);
    EXPECT_TRUE(page.m_enablePma);
    EXPECT_FALSE(page.m_enablePmaEditable);
    EXPECT_EQ(page.m_txabPmaClkSel, "REFCLK");
    EXPECT_EQ(page.m_rxPmaClkSel, "BREFCLK");
    EXPECT_EQ(page.m_pmaSpeed, "2_64");
    EXPECT_TRUE(page.m_pmaSpeedEditable);
    EXPECT_FALSE(page.m_gt11Single);
    EXPECT_TRUE(page.m_gt11UseB);
    // The block is found with its pins disconnected.
    EXPECT_EQ(b->GetNamedPin("TXDATA")->GetSigName(), "");
    EXPECT_FALSE(b->GetNamedPin("TXDATA")->HasPinSigBitProp());

    Design d11(false, false, true);
    Qvz_Block* g = d11.Block("G", "GT11_CUSTOM", "Custom", "QVZ_RX_DATA_WIDTH", "4", true);
    Attr(g, "QVZ_GT11_MODE", "SINGLE");
    Attr(g, "QVZ_GT11_USE_B", "FALSE");
    TestPage page11(&d11.Main());
    EXPECT_TRUE(page11.m_gt11Single);
    EXPECT_FALSE(page11.m_gt11UseB);
}

TEST(GeneralSetup, ReadingKeepsOrReplacesThePmaSpeed) {
    const struct {
        const char* speed;
        const char* width;
        bool perWidthList;
        const char* expected;
    } cases[] = {
        {"1_32", "4", false, "1_32"},
        {"9_99", "4", false, "0_32"},  // not legal: the default
        {"1_32 ", "4", false, "0_32"}, // legal values match exactly
        {"", "4", false, "0_32"},
        {"1_32", "2", true, "2_64"}, // the width's own list rules
        {"3_64", "2", true, "3_64"},
        {"3_64", "4", true, "0_32"}, // no list for width 4: PMA_SPEED's
    };
    for (const auto& c : cases) {
        Design d(false, true, false);
        Qvz_Block* b =
            d.Block("C", "GT10_CUSTOM", "10G Custom", "QVZ_RX_DATA_WIDTH", c.width, true);
        Attr(b, "PMA_SPEED", c.speed, "0_32", "0_32,1_32");
        if (c.perWidthList)
            Attr(b, "QVZ_PMA_SPEED_2", "", "2_64", "2_64,3_64");
        TestPage page(&d.Main());
        EXPECT_EQ(page.m_pmaSpeed, c.expected) << c.speed << "/" << c.width;
    }
    // A block without any PMA speed attribute leaves the value alone.
    TestPage page(nullptr);
    Qvz_Block b("B", "GT10_CUSTOM", Qvz_Family::GT10);
    Port::StringBase speed = "x", width = "4";
    page.CheckPmaSpeed(&b, speed, width);
    page.CheckPmaSpeed(nullptr, speed, width);
    EXPECT_EQ(speed, "x");
}

TEST(GeneralSetup, ChoiceListsComeFromTheLegalValues) {
    TestPage page(nullptr);
    Qvz_Block b("C", "GT10_CUSTOM", Qvz_Family::GT10);
    Attr(&b, "QVZ_RX_DATA_WIDTH", "4", nullptr, "1,2,4,8");
    Attr(&b, "RX_DATA_WIDTH", "4", nullptr, "9");
    Attr(&b, "PMA_SPEED", "0_32", nullptr, "0_32,1_32");
    Attr(&b, "QVZ_PMA_SPEED_8", "", nullptr, "8_1");
    ASSERT_NE(page.GetDataWidthChoices(&b), nullptr);
    EXPECT_EQ(Items(*page.GetDataWidthChoices(&b)), (Strings{"1", "2", "4", "8"}));
    EXPECT_EQ(Items(*page.GetPmaSpeedChoices(&b, "4")), (Strings{"0_32", "1_32"}));
    EXPECT_EQ(Items(*page.GetPmaSpeedChoices(&b, "8")), (Strings{"8_1"}));
    // On GT the width list is RX_DATA_WIDTH's.
    page.m_isGT = true;
    EXPECT_EQ(Items(*page.GetDataWidthChoices(&b)), (Strings{"9"}));
    Qvz_Block bare("B", "GT10_CUSTOM", Qvz_Family::GT10);
    EXPECT_EQ(page.GetDataWidthChoices(&bare), nullptr);
    EXPECT_EQ(page.GetPmaSpeedChoices(&bare, "4"), nullptr);
    EXPECT_EQ(page.GetDataWidthChoices(nullptr), nullptr);
    EXPECT_EQ(page.GetPmaSpeedChoices(nullptr, "4"), nullptr);
}

TEST(GeneralSetup, MigratesOldAttributeNames) {
    for (bool gt : {true, false}) {
        TestPage page(nullptr);
        page.m_isGT = gt;
        Qvz_Block b("B", gt ? "GT_CUSTOM" : "GT10_CUSTOM", gt ? Qvz_Family::GT : Qvz_Family::GT10);
        b.AddAttribute("BOOL_RX_USE", "FALSE");
        b.AddAttribute("BOOL_TX_USE", "TRUE");
        b.AddAttribute("CHAN_BOND_NUMBER", "3");
        b.AddAttribute("CHAN_BOND_PRIMARY_ROW", "1");
        b.AddAttribute("QVZ_CHAN_BOND_NUMBER", "0"); // the old value wins
        b.AddAttribute("RX_DATA_WIDTH", "2");
        b.AddAttribute("TX_DATA_WIDTH", "2");
        page.MigrateOldAttributes(&b);
        page.MigrateOldAttributes(nullptr);
        EXPECT_EQ(b.GetAttributeValue("QVZ_BOOL_RX_USE"), "FALSE");
        EXPECT_EQ(b.GetAttributeValue("QVZ_BOOL_TX_USE"), "TRUE");
        EXPECT_EQ(b.GetAttributeValue("QVZ_CHAN_BOND_NUMBER"), "3");
        EXPECT_EQ(b.GetAttributeValue("QVZ_CHAN_BOND_PRIMARY_ROW"), "1");
        for (const char* old :
             {"BOOL_RX_USE", "BOOL_TX_USE", "CHAN_BOND_NUMBER", "CHAN_BOND_PRIMARY_ROW"})
            EXPECT_EQ(b.GetNamedAttribute(old), nullptr) << old;
        // GT keeps its own width names.
        EXPECT_EQ(b.GetNamedAttribute("RX_DATA_WIDTH") != nullptr, gt);
        EXPECT_EQ(b.GetNamedAttribute("TX_DATA_WIDTH") != nullptr, gt);
        EXPECT_EQ(b.GetAttributeValue("QVZ_RX_DATA_WIDTH"), gt ? "" : "2");
        EXPECT_EQ(b.GetAttributeValue("QVZ_TX_DATA_WIDTH"), gt ? "" : "2");
    }
}

TEST(FindBlock, WithoutAnActiveBlockLooksUpTheFamilysDefaultType) {
    const struct {
        const char* what;
        bool gt, gt10, gt11;
        const char* expectedBlock; // null: none found
        const char* expectedType;
    } cases[] = {
        {"gt10", false, true, false, "C10", "10G Custom"},
        {"gt11", false, false, true, "C11", "Custom"},
        {"gt", true, false, false, "FC", "FibreChannel"},
        {"none offered", false, false, false, nullptr, "FibreChannel"},
    };
    for (const auto& c : cases) {
        Design d(c.gt, c.gt10, c.gt11);
        d.Block("C11", "GT11_CUSTOM", "Custom", "QVZ_RX_DATA_WIDTH", "2");
        d.Block("C10", "GT10_CUSTOM", "10G Custom", "QVZ_RX_DATA_WIDTH", "8");
        d.Block("FC", "GT_FIBRE_CHAN", "FibreChannel", "RX_DATA_WIDTH", "1");
        TestPage page(&d.Main());
        if (c.expectedBlock) {
            ASSERT_NE(page.m_pBlock, nullptr) << c.what;
            EXPECT_EQ(page.m_pBlock->GetName(), c.expectedBlock) << c.what;
            EXPECT_TRUE(d.Messages().empty()) << c.what;
        } else {
            EXPECT_EQ(page.m_pBlock, nullptr) << c.what;
            EXPECT_EQ(d.Messages(), Strings{kDataError}) << c.what;
        }
        EXPECT_EQ(page.m_displayName, c.expectedType) << c.what;
        // Looking up does not activate anything.
        EXPECT_TRUE(d.ActiveBlocks().empty()) << c.what;
    }
}

TEST(FindBlock, ObsoleteZephine8IsReplacedByZephine4) {
    for (bool hasZephine4 : {true, false}) {
        Design d(false, true, false);
        Qvz_Block* z8 =
            d.Block("Z8", "GT10_ZEPHINE_8", "Zephine_8", "QVZ_RX_DATA_WIDTH", "8", true);
        Qvz_Block* z4 = nullptr;
        if (hasZephine4)
            z4 = d.Block("Z4", "GT10_ZEPHINE_4", "Zephine", "QVZ_RX_DATA_WIDTH", "4");
        TestPage page(&d.Main());
        EXPECT_FALSE(z8->IsUsed());
        if (hasZephine4) {
            EXPECT_EQ(page.m_pBlock, z4);
            EXPECT_EQ(page.m_displayName, "Zephine");
            EXPECT_EQ(d.ActiveBlocks(), Strings{"Z4"});
            EXPECT_EQ(d.Messages(), Strings{"The primitive GT10_ZEPHINE_8 is obsolete.  The wizard "
                                            "will use GT10_ZEPHINE_4 instead."});
            EXPECT_FALSE(d.main.GetMessages()[0].flag1);
        } else {
            EXPECT_EQ(page.m_pBlock, nullptr);
            EXPECT_EQ(page.m_displayName, "10G Custom");
            EXPECT_TRUE(d.ActiveBlocks().empty());
            EXPECT_EQ(d.Messages(), Strings{kDataError});
        }
    }
}

TEST(FindBlock, Gt10_3GIOBlockIsReplacedByPciExpressWithItsValues) {
    Design d(false, true, false);
    Qvz_Block* old = d.Block("GIO", "GT10_3GIO_2", "3GIO", "QVZ_RX_DATA_WIDTH", "2", true);
    Attr(old, "QVZ_BOOL_RX_USE", "FALSE");
    Attr(old, "PMA_SPEED", "1_32");
    Attr(old, "ONLY_IN_OLD", "x");
    Qvz_Block* pci = d.Block("GT10_PCI_EXPRESS_2_INST", "GT10_PCI_EXPRESS_2", "PCI Express",
                             "QVZ_RX_DATA_WIDTH", "4");
    Attr(pci, "QVZ_BOOL_RX_USE", "TRUE");
    Attr(pci, "PMA_SPEED", "0_32", "0_32", "0_32,1_32");
    TestPage page(&d.Main());
    EXPECT_EQ(page.m_pBlock, pci);
    EXPECT_EQ(d.ActiveBlocks(), Strings{"GT10_PCI_EXPRESS_2_INST"});
    EXPECT_EQ(d.Messages(), Strings{"The primitive GT10_3GIO_2 has been changed to "
                                    "GT10_PCI_EXPRESS_2.  The wizard will use GT10_PCI_EXPRESS_2 "
                                    "instead."});
    // Shared values move over, the display name and foreign attributes do not.
    EXPECT_EQ(pci->GetAttributeValue("MGT_DISPLAY_NAME"), "PCI Express");
    EXPECT_EQ(pci->GetAttributeValue("QVZ_RX_DATA_WIDTH"), "2");
    EXPECT_EQ(pci->GetAttributeValue("PMA_SPEED"), "1_32");
    EXPECT_EQ(pci->GetNamedAttribute("ONLY_IN_OLD"), nullptr);
    EXPECT_FALSE(page.m_rxUse);
    EXPECT_EQ(page.m_displayName, "PCI Express");
    EXPECT_EQ(page.m_pmaSpeed, "1_32");
}

TEST(FindBlock, Gt10_3GIORenameNeedsAWidthAndATarget) {
    const struct {
        const char* what;
        const char* name;
        const char* prim;
        const char* rxWidth;  // RX_DATA_WIDTH or null
        const char* qvzWidth; // QVZ_RX_DATA_WIDTH or null
        const char* expected; // instance name of the block used
    } cases[] = {
        {"by primitive", "OLD", "GT10_3GIO_X", nullptr, "4", "GT10_PCI_EXPRESS_4_INST"},
        {"by instance name", "GT10_3GIO_INST", "GT10_OTHER", nullptr, "4",
         "GT10_PCI_EXPRESS_4_INST"},
        {"RX_DATA_WIDTH first", "OLD", "GT10_3GIO_X", "1", "4", "GT10_PCI_EXPRESS_1_INST"},
        {"no width", "OLD", "GT10_3GIO_X", nullptr, nullptr, "OLD"},
        {"no such block", "OLD", "GT10_3GIO_X", nullptr, "8", "OLD"},
        {"3GIO not at the start", "OLD", "GT10_X3GIO", nullptr, "4", "OLD"},
    };
    for (const auto& c : cases) {
        Design d(false, true, false);
        Qvz_Block* old = d.Block(c.name, c.prim, "3GIO", nullptr, nullptr, true);
        if (c.rxWidth)
            old->AddAttribute("RX_DATA_WIDTH", c.rxWidth);
        if (c.qvzWidth)
            old->AddAttribute("QVZ_RX_DATA_WIDTH", c.qvzWidth);
        d.Block("GT10_PCI_EXPRESS_4_INST", "GT10_PCI_EXPRESS_4", "PCI Express");
        d.Block("GT10_PCI_EXPRESS_1_INST", "GT10_PCI_EXPRESS_1", "PCI Express");
        TestPage page(&d.Main());
        ASSERT_NE(page.m_pBlock, nullptr) << c.what;
        EXPECT_EQ(page.m_pBlock->GetName(), c.expected) << c.what;
        EXPECT_EQ(d.ActiveBlocks(), Strings{c.expected}) << c.what;
        EXPECT_EQ(d.Messages().size(), page.m_pBlock == old ? 0u : 1u) << c.what;
    }
}

TEST(FindBlock, InstanceNamesStartWithALetter) {
    const struct {
        const char* name;
        const char* expected;
    } cases[] = {
        {"4_INST", "GT4_INST"},     {"0", "GT0"}, {"X4", "X4"},
        {"GT10_INST", "GT10_INST"}, {"_9", "_9"}, {"", ""}, // an empty name stays empty
    };
    for (const auto& c : cases) {
        Design d(false, true, false);
        Qvz_Block* b = d.Block(c.name, "GT10_CUSTOM", "10G Custom", "QVZ_RX_DATA_WIDTH", "4", true);
        TestPage page(&d.Main());
        EXPECT_EQ(page.m_pBlock, b) << c.name;
        EXPECT_EQ(b->GetName(), c.expected) << c.name;
    }
    TestPage page(nullptr);
    page.FixBlockInstanceName(nullptr, nullptr);
}

TEST(GetMgtTypeChoices, OffersEachUsableTypeOnceAndTheCurrentOne) {
    Design d(false, true, true);
    d.Block("A", "GT10_ETHERNET_4", "Ethernet");
    d.Block("B", "GT10_ETHERNET_2", "Ethernet");
    d.Block("C", "GT10_ZEPHINE_8", "Zephine_8");
    d.Block("D", "GT10_3GIO_4", "PCI 3GIO");
    d.Block("E", "GT10_NONAME");
    d.Block("F", "GT_FIBRE_CHAN", "FibreChannel"); // family not offered
    d.Block("G", "GT11_CUSTOM", "Custom");
    d.Block("H", "GT10_ZEPHINE_4", "zephine_8"); // only the exact name is barred
    d.Block("I", "GT10_CUSTOM", "10G Custom");

    const struct {
        const char* current;
        Strings expected;
    } cases[] = {
        {"Ethernet", {"Ethernet", "Custom", "zephine_8", "10G Custom"}},
        // The current type is always offered, even one no block has.
        {"Gone", {"Ethernet", "Custom", "zephine_8", "10G Custom", "Gone"}},
        {"Zephine_8", {"Ethernet", "Custom", "zephine_8", "10G Custom", "Zephine_8"}},
        {"FibreChannel", {"Ethernet", "Custom", "zephine_8", "10G Custom", "FibreChannel"}},
    };
    TestPage page(&d.Main());
    for (const auto& c : cases) {
        page.m_displayName = c.current;
        Qvz_StrArray out{"stale"};
        page.GetMgtTypeChoices(out, &d.data);
        EXPECT_EQ(Items(out), c.expected) << c.current;
    }
    Qvz_StrArray out;
    page.GetMgtTypeChoices(out, nullptr);
    EXPECT_EQ(Items(out), Strings{"FibreChannel"});
}

TEST(WriteWizData, RefusesWhenNeitherDirectionIsUsed) {
    Design d(false, true, false);
    Qvz_Block* b = d.Block("C", "GT10_CUSTOM", "10G Custom", "QVZ_RX_DATA_WIDTH", "4", true);
    TestPage page(&d.Main());
    page.m_txUse = page.m_rxUse = false;
    page.m_dataWidth = "8";
    EXPECT_FALSE(page.WriteWizData());
    EXPECT_FALSE(page.DoBatchPage());
    const std::string msg = "Please select transmitter mode and/or receiver mode.";
    EXPECT_EQ(d.Messages(), (Strings{msg, msg}));
    EXPECT_FALSE(d.main.GetMessages()[0].flag1);
    // Nothing was written.
    EXPECT_TRUE(b->IsUsed());
    EXPECT_EQ(b->GetAttributeValue("QVZ_RX_DATA_WIDTH"), "4");
    EXPECT_EQ(b->GetNamedAttribute("QVZ_BOOL_TX_USE"), nullptr);
    // One direction is enough.
    page.m_rxUse = true;
    EXPECT_TRUE(page.WriteWizData());
}

TEST(WriteWizData, AnUnknownTypeIsAnInternalErrorWithEverythingInactive) {
    Design d(false, true, false);
    Qvz_Block* b = d.Block("C", "GT10_CUSTOM", "10G Custom", "QVZ_RX_DATA_WIDTH", "4", true);
    d.data.AddSignal("S", true, "I");
    TestPage page(&d.Main());
    page.m_displayName = "OC48";
    EXPECT_FALSE(page.WriteWizData());
    EXPECT_EQ(d.Messages(), Strings{kDataError});
    EXPECT_FALSE(b->IsUsed());
    EXPECT_FALSE(d.data.GetNamedSignal("S")->IsUsed());
}

TEST(WriteWizData, ActivatesTheChosenBlockAndWritesTheGtSettings) {
    Design d(true, false, false);
    d.Block("FC", "GT_FIBRE_CHAN", "FibreChannel", "RX_DATA_WIDTH", "4", true);
    Qvz_Block* cu = d.Block("CU", "GT_CUSTOM", "Custom", "RX_DATA_WIDTH", "4");
    Attr(cu, "SERDES_10B", "FALSE");
    Attr(cu, "TERMINATION_IMP", "50");
    Attr(cu, "REF_CLK_V_SEL", "0");
    Attr(cu, "PMA_SPEED", "0_32");
    Pin(cu, "TXDATA", 32, true);
    d.data.AddSignal("S", true, "I");
    TestPage page(&d.Main());
    page.m_displayName = "Custom";
    page.m_dataWidth = "2";
    page.m_txUse = false;
    page.m_serdes10b = true;
    page.m_termination = "75";
    page.m_refClkVSel = "1";
    page.m_pmaSpeed = "1_32";
    page.m_refClk = "R";
    page.m_refClkDyn = "RD";
    page.m_bRefClk = "B";
    page.m_bRefClkDyn = "BD";
    page.m_useRefClk = 0;
    ASSERT_TRUE(page.WriteWizData());
    EXPECT_TRUE(d.Messages().empty());
    EXPECT_EQ(d.ActiveBlocks(), Strings{"CU"});
    EXPECT_FALSE(d.data.GetNamedSignal("S")->IsUsed());
    const struct {
        const char* name;
        const char* value;
    } expected[] = {
        {"RX_DATA_WIDTH", "2"},         {"TX_DATA_WIDTH", "2"},     {"QVZ_BOOL_TX_USE", "FALSE"},
        {"QVZ_BOOL_RX_USE", "TRUE"},    {"SERDES_10B", "TRUE"},     {"TERMINATION_IMP", "75"},
        {"REF_CLK_V_SEL", "1"},         {"PMA_SPEED", "1_32"},      {"QVZX_ONLY_REFCLK", "R"},
        {"QVZX_ONLY_REFCLK_DYN", "RD"}, {"QVZX_ONLY_BREFCLK", "B"}, {"QVZX_ONLY_BREFCLK_DYN", "BD"},
    };
    for (const auto& e : expected)
        EXPECT_EQ(cu->GetAttributeValue(e.name), e.value) << e.name;
    // GT writes neither the GT10 clock switches nor the other width names.
    for (const char* absent : {"QVZX_ONLY_USE_REFCLK", "QVZX_ONLY_USE_BREFCLK", "QVZ_RX_DATA_WIDTH",
                               "QVZ_TX_DATA_WIDTH", "QVZ_GT11_MODE", "QVZX_ONLY_BYPASS_PCS"})
        EXPECT_EQ(cu->GetNamedAttribute(absent), nullptr) << absent;
    // GT_CUSTOM keeps its pin widths.
    EXPECT_EQ(cu->GetNamedPin("TXDATA")->GetWidth(), 32);
}

TEST(WriteWizData, WritesOnlyTheOptionalAttributesTheBlockHas) {
    Design d(false, true, false);
    Qvz_Block* b = d.Block("C", "GT10_CUSTOM", "10G Custom", "QVZ_RX_DATA_WIDTH", "4", true);
    TestPage page(&d.Main());
    ASSERT_TRUE(page.WriteWizData());
    for (const char* absent :
         {"PMA_SPEED", "QVZX_ONLY_ENABLE_PMA", "TXABPMACLKSEL", "RXPMACLKSEL", "SERDES_10B",
          "TERMINATION_IMP", "REF_CLK_V_SEL", "QVZX_ONLY_BYPASS_PCS", "QVZX_ONLY_TX_8B10B_USE",
          "QVZX_ONLY_BREFCLK", "QVZX_ONLY_BREFCLK_DYN", "RX_DATA_WIDTH"})
        EXPECT_EQ(b->GetNamedAttribute(absent), nullptr) << absent;
    // Always written on GT10.
    const struct {
        const char* name;
        const char* value;
    } expected[] = {
        {"QVZ_RX_DATA_WIDTH", "4"},       {"QVZ_TX_DATA_WIDTH", "4"},
        {"QVZ_BOOL_TX_USE", "TRUE"},      {"QVZ_BOOL_RX_USE", "TRUE"},
        {"QVZX_ONLY_USE_REFCLK", "TRUE"}, {"QVZX_ONLY_USE_BREFCLK", "TRUE"},
        {"QVZX_ONLY_REFCLK", ""},         {"QVZX_ONLY_REFCLK_DYN", ""},
    };
    for (const auto& e : expected) {
        ASSERT_NE(b->GetNamedAttribute(e.name), nullptr) << e.name;
        EXPECT_EQ(b->GetAttributeValue(e.name), e.value) << e.name;
    }
}

TEST(WriteWizData, Gt10WritesWidthsAndClocksButNoPinWidths) {
    Design d(false, true, false);
    Qvz_Block* b = d.Block("E2", "GT10_ETHERNET_2", "Ethernet", "QVZ_RX_DATA_WIDTH", "2", true);
    Attr(b, "QVZX_ONLY_USE_REFCLK", "FALSE");
    Attr(b, "QVZX_ONLY_ENABLE_PMA", "TRUE");
    Attr(b, "TXABPMACLKSEL", "A");
    Attr(b, "RXPMACLKSEL", "B");
    Pin(b, "TXDATA", 16, true);
    TestPage page(&d.Main());
    ASSERT_EQ(page.m_pBlock, b);
    page.m_useRefClk = 1;
    page.m_useBRefClk = 0;
    page.m_enablePma = false;
    page.m_txabPmaClkSel = "X";
    page.m_rxPmaClkSel = "Y";
    page.m_refClk = "R";
    ASSERT_TRUE(page.WriteWizData());
    EXPECT_EQ(b->GetAttributeValue("QVZX_ONLY_USE_REFCLK"), "TRUE");
    EXPECT_EQ(b->GetAttributeValue("QVZX_ONLY_USE_BREFCLK"), "FALSE");
    EXPECT_EQ(b->GetAttributeValue("QVZX_ONLY_REFCLK"), "R");
    EXPECT_EQ(b->GetAttributeValue("QVZX_ONLY_ENABLE_PMA"), "FALSE");
    EXPECT_EQ(b->GetAttributeValue("TXABPMACLKSEL"), "X");
    EXPECT_EQ(b->GetAttributeValue("RXPMACLKSEL"), "Y");
    EXPECT_EQ(b->GetAttributeValue("QVZ_TX_DATA_WIDTH"), "2");
    EXPECT_EQ(b->GetNamedPin("TXDATA")->GetWidth(), 16);
    EXPECT_EQ(b->GetNamedAttribute("QVZ_GT11_MODE"), nullptr);
}

TEST(WriteWizData, Gt11WritesTheModeAndTransceiverB) {
    const struct {
        bool single, useB;
        const char* mode;
        const char* bondMode; // null: not written
        const char* useBText;
    } cases[] = {
        {true, true, "SINGLE", "NONE", "TRUE"},
        {true, false, "SINGLE", "NONE", "FALSE"},
        {false, true, "DUAL", nullptr, "TRUE"},
    };
    for (const auto& c : cases) {
        Design d(false, false, true);
        Qvz_Block* b = d.Block("G", "GT11_CUSTOM", "Custom", "QVZ_RX_DATA_WIDTH", "4", true);
        TestPage page(&d.Main());
        page.m_gt11Single = c.single;
        page.m_gt11UseB = c.useB;
        ASSERT_TRUE(page.WriteWizData());
        EXPECT_EQ(b->GetAttributeValue("QVZ_GT11_MODE"), c.mode);
        EXPECT_EQ(b->GetAttributeValue("QVZ_GT11_USE_B"), c.useBText);
        if (c.bondMode)
            EXPECT_EQ(b->GetAttributeValue("CHAN_BOND_MODE"), c.bondMode);
        else
            EXPECT_EQ(b->GetNamedAttribute("CHAN_BOND_MODE"), nullptr);
        EXPECT_EQ(b->GetNamedAttribute("QVZX_ONLY_USE_REFCLK"), nullptr);
        EXPECT_EQ(b->GetNamedAttribute("QVZX_ONLY_REFCLK"), nullptr);
    }
}

TEST(WriteWizData, WarnsWhenThePrimitiveIsNamedLikeTheFile) {
    const char* const warning =
        "The name of a Velomux transceiver primitive you selected is the same as your file name.  "
        "This will cause an error during synthesis.  Please select a different transceiver, or "
        "cancel out from the wizard and choose another file name.";
    const struct {
        const char* fileName;
        bool warned;
    } cases[] = {
        // The name carries the width the block had before this write.
        {"GT_FIBRE_CHAN_4", true},
        {"GT_FIBRE_CHAN_2", false},
        {"gt_fibre_chan_4", false},
        {"GT_FIBRE_CHAN", false},
    };
    for (const auto& c : cases) {
        Design d(true, false, false, c.fileName);
        Qvz_Block* b = d.Block("FC", "GT_FIBRE_CHAN", "FibreChannel", "RX_DATA_WIDTH", "4", true);
        TestPage page(&d.Main());
        page.m_dataWidth = "2";
        EXPECT_TRUE(page.WriteWizData()) << c.fileName;
        EXPECT_EQ(d.Messages(), c.warned ? Strings{warning} : Strings{}) << c.fileName;
        EXPECT_EQ(b->GetAttributeValue("RX_DATA_WIDTH"), "2") << "written all the same";
    }
}

TEST(SetPinWidths, ResizesTheFixedWidthGtPrimitivesOnly) {
    const struct {
        const char* prim;
        const char* width;
        int data, perByte; // expected TXDATA and TXCHARISK widths
    } cases[] = {
        {"GT_FIBRE_CHAN_4", "2", 16, 2},
        {"GT_ETHERNET_1", "1", 8, 1},
        {"GT_ZEPHINE_4", "4", 32, 4},
        {"GT_CUSTOM", "2", 40, 5},
        {"GT10_CUSTOM", "2", 40, 5},
        {"GT11_CUSTOM", "2", 40, 5},
        {"GT_CUSTOM_X", "2", 16, 2},
        // Widths that make no sense leave the pins as they were.
        {"GT_FIBRE_CHAN_4", "", 40, 5},
        {"GT_FIBRE_CHAN_4", "0", 40, 5},
        {"GT_FIBRE_CHAN_4", "-2", 40, 5},
        {"GT_FIBRE_CHAN_4", "abc", 40, 5},
        {"GT_FIBRE_CHAN_4", "268435456", 40, 5},
        {"GT_FIBRE_CHAN_4", "99999999999", 40, 5},
        // Pins wider than design data can hold would be saved to a file
        // that no reader takes back.
        {"GT_FIBRE_CHAN_4", "8193", 40, 5},
        {"GT_FIBRE_CHAN_4", "165536", 40, 5},
        {"GT_FIBRE_CHAN_4", "8192", 65536, 8192},
    };
    for (const auto& c : cases) {
        TestPage page(nullptr);
        page.m_dataWidth = c.width;
        Qvz_Block b("B", "GT_FIBRE_CHAN", Qvz_Family::GT);
        Pin(&b, "TXDATA", 40, true);
        Pin(&b, "RXDATA", 40, true, "OUT");
        Pin(&b, "TXCHARISK", 5, true);
        Pin(&b, "LOOPBACK", 2);
        page.SetPinWidths(&b, c.prim);
        EXPECT_EQ(b.GetNamedPin("TXDATA")->GetWidth(), c.data) << c.prim << "/" << c.width;
        EXPECT_EQ(b.GetNamedPin("RXDATA")->GetWidth(), c.data) << c.prim << "/" << c.width;
        EXPECT_EQ(b.GetNamedPin("TXCHARISK")->GetWidth(), c.perByte) << c.prim << "/" << c.width;
        EXPECT_EQ(b.GetNamedPin("LOOPBACK")->GetWidth(), 2) << c.prim << "/" << c.width;
    }
}
