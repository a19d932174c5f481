// Which later pages the General Setup write enables, against a real dialog.

#include "GeneralSupport.h"
#include "Qvz_PlaceholderGui.h"
#include "Wg_Wizard.h"

#include <gtest/gtest.h>

namespace {

const char* const kTitles[6] = {"General Setup",
                                "Transmitter Setup",
                                "Receiver Comma Detect Setup",
                                "Receiver Setup",
                                "Receiver Clock Correction Setup",
                                "Receiver Channel Bonding Setup"};

struct Dialog {
    Wg_Wizard wizard;
    Dialog() {
        for (const char* t : kTitles)
            wizard.addPage(new Qvz_PlaceholderGui(t, &wizard));
    }
    void SetAll(bool on) {
        for (const char* t : kTitles)
            wizard.enablePage(t, on);
    }
    // '1' or '0' per page 0..5.
    std::string State() const {
        std::string s;
        for (const char* t : kTitles)
            s += wizard.isPageEnabled(t) ? '1' : '0';
        return s;
    }
};

struct PageCase {
    const char* what;
    const char* prim;
    const char* display;    // MGT_DISPLAY_NAME (may be empty)
    const char* oldDisplay; // QVZ_OLD_DISPLAY_NAME or null
    bool single;            // GT11 mode
    bool clkCor;            // block has a CLK_COR attribute
    bool tx, rx;
    bool bypassAttr, bypass;
    const char* pages; // expected state of pages 1..5
    bool bondingOff;   // QVZ_CHAN_BOND_NUMBER forced to "0"
};

const PageCase kPageCases[] = {
    // The rows of the table, receiver and transmitter used.
    {"fibre channel", "GT_FIBRE_CHAN", "FibreChannel", nullptr, false, true, true, true, false,
     false, "10110", true},
    {"ethernet", "GT_ETHERNET", "Ethernet", nullptr, false, true, true, true, false, false, "10110",
     true},
    {"gt custom", "GT_CUSTOM", "Custom", nullptr, false, true, true, true, false, false, "11111",
     false},
    {"gt10 oc192", "GT10_OC192_8", "OC192", nullptr, false, true, true, true, false, false, "11100",
     true},
    {"gt10 oc48", "GT10_OC48_4", "OC48", nullptr, false, true, true, true, false, false, "11100",
     true},
    {"gt10 oc48 by old name", "GT10_OC48_2", "", "OC48", false, true, true, true, false, false,
     "11100", true},
    {"gt10 zephinex", "GT10_ZEPHINEX_4", "ZephineX", nullptr, false, true, true, true, false, false,
     "10111", false},
    {"gt10 ethernet", "GT10_ETHERNET_4", "Ethernet", nullptr, false, true, true, true, false, false,
     "10111", false},
    {"gt10 fibre channel", "GT10_FIBRE_CHAN_2", "FibreChannel", nullptr, false, true, true, true,
     false, false, "10111", false},
    {"gt10 other", "GT10_ZEPHINE_4", "Zephine", nullptr, false, true, true, true, false, false,
     "11111", false},
    {"gt10 custom", "GT10_CUSTOM", "10G Custom", nullptr, false, false, true, true, false, false,
     "11111", false},
    {"gt11 single, no clk_cor", "GT11_CUSTOM", "Custom", nullptr, true, false, true, true, false,
     false, "11100", true},
    {"gt11 single, clk_cor", "GT11_CUSTOM", "Custom", nullptr, true, true, true, true, false, false,
     "11110", true},
    {"gt11 dual, no clk_cor", "GT11_CUSTOM", "Custom", nullptr, false, false, true, true, false,
     false, "11101", false},
    {"gt11 dual, clk_cor", "GT11_CUSTOM", "Custom", nullptr, false, true, true, true, false, false,
     "11111", false},
    {"other gt primitive", "GT_ZEPHINE", "Zephine", nullptr, false, true, true, true, false, false,
     "10111", false},
    // Directions.
    {"receiver unused", "GT_CUSTOM", "Custom", nullptr, false, true, true, false, false, false,
     "10000", true},
    {"receiver unused, gt11 dual", "GT11_CUSTOM", "Custom", nullptr, false, true, true, false,
     false, false, "10000", true},
    {"transmitter unused", "GT_CUSTOM", "Custom", nullptr, false, true, false, true, false, false,
     "01111", false},
    {"transmitter unused, oc48", "GT10_OC48_4", "OC48", nullptr, false, true, false, true, false,
     false, "01100", true},
    // PCS bypass switches clock correction and bonding off on top of the row.
    {"bypass, gt custom", "GT_CUSTOM", "Custom", nullptr, false, true, true, true, true, true,
     "11100", true},
    {"bypass, gt10 ethernet", "GT10_ETHERNET_4", "Ethernet", nullptr, false, true, true, true, true,
     true, "10100", true},
    {"bypass, receiver unused", "GT_CUSTOM", "Custom", nullptr, false, true, true, false, true,
     true, "10000", true},
    // Bypass counts only when the block has the attribute, and only when set.
    {"bypass without attribute", "GT_CUSTOM", "Custom", nullptr, false, true, true, true, false,
     true, "11111", false},
    {"attribute without bypass", "GT_CUSTOM", "Custom", nullptr, false, true, true, true, true,
     false, "11111", false},
};

Qvz_Block* MakeBlock(Design& d, const PageCase& c) {
    Qvz_Block* b = d.Block("I", c.prim, c.display);
    if (c.oldDisplay)
        b->AddAttribute("QVZ_OLD_DISPLAY_NAME", c.oldDisplay);
    if (c.clkCor)
        b->AddAttribute("CLK_COR_SEQ_1_1", "x");
    if (c.bypassAttr)
        b->AddAttribute("QVZX_ONLY_BYPASS_PCS", "FALSE");
    b->AddAttribute("QVZ_CHAN_BOND_NUMBER", "4");
    return b;
}

void SetUpPage(TestPage& page, const PageCase& c) {
    page.m_gt11Single = c.single;
    page.m_txUse = c.tx;
    page.m_rxUse = c.rx;
    page.m_bypassPcs = c.bypass;
}

} // namespace

TEST(EnableDependentPages, FollowsPrimitiveDirectionsAndBypass) {
    App();
    for (const auto& c : kPageCases) {
        // From both starting states, so that every page is decided, never left.
        for (bool start : {true, false}) {
            Design d(true, true, true);
            Qvz_Block* block = MakeBlock(d, c);
            Dialog dialog;
            dialog.SetAll(start);
            Qvz_MGTWizMain& main = d.Main(false);
            main.m_pWizard = &dialog.wizard;
            TestPage page(&main);
            SetUpPage(page, c);

            page.EnableDependentPages(block, block->GetPrimitiveName());

            const std::string expected = std::string(start ? "1" : "0") + c.pages;
            EXPECT_EQ(dialog.State(), expected) << c.what << ", starting " << start;
            EXPECT_EQ(block->GetAttributeValue("QVZ_CHAN_BOND_NUMBER"), c.bondingOff ? "0" : "4")
                << c.what;
        }
    }
}

TEST(EnableDependentPages, TheBatchRunTouchesNoPageButStillSwitchesBondingOff) {
    App();
    for (const auto& c : kPageCases) {
        Design d(true, true, true);
        Qvz_Block* block = MakeBlock(d, c);
        Dialog dialog;
        dialog.SetAll(true);
        Qvz_MGTWizMain& main = d.Main(true);
        main.m_pWizard = &dialog.wizard;
        TestPage page(&main);
        SetUpPage(page, c);

        page.EnableDependentPages(block, block->GetPrimitiveName());

        EXPECT_EQ(dialog.State(), "111111") << c.what;
        EXPECT_EQ(block->GetAttributeValue("QVZ_CHAN_BOND_NUMBER"), c.bondingOff ? "0" : "4")
            << c.what;
    }
}

TEST(EnableDependentPages, TheWriteDecidesByTheStoredPrimitiveName) {
    // The GT primitive is presented with its width ("GT_FIBRE_CHAN_2") but the
    // table is looked up by the name stored in the block.
    App();
    Design d(true, false, false);
    Qvz_Block* fc = d.Block("FC", "GT_FIBRE_CHAN", "FibreChannel", "RX_DATA_WIDTH", "2", true);
    fc->AddAttribute("QVZ_CHAN_BOND_NUMBER", "4");
    Dialog dialog;
    Qvz_MGTWizMain& main = d.Main(false);
    main.m_pWizard = &dialog.wizard;
    TestPage page(&main);
    ASSERT_TRUE(page.WriteWizData());
    EXPECT_EQ(dialog.State(), "110110");
    EXPECT_EQ(fc->GetAttributeValue("QVZ_CHAN_BOND_NUMBER"), "0");
}

TEST(EnablePages, RangesAndSinglePages) {
    App();
    Design d(false, true, false);
    Dialog dialog;
    Qvz_MGTWizMain& main = d.Main(false);
    main.m_pWizard = &dialog.wizard;
    TestPage page(&main);
    page.EnablePages(false, 2, 4);
    EXPECT_EQ(dialog.State(), "110001");
    page.EnablePages(true, 3, -1);
    EXPECT_EQ(dialog.State(), "110101");
    // Indices without a page are ignored.
    page.EnablePages(false, 5, 9);
    EXPECT_EQ(dialog.State(), "110100");
    // Without a dialog there is nothing to do.
    main.m_pWizard = nullptr;
    page.EnablePages(false, 0, 5);
    EXPECT_EQ(dialog.State(), "110100");
}
