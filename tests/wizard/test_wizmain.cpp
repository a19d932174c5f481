#include "Qvz_MGTWizMain.h"
#include "Wg_Wizard.h"

#include <QApplication>
#include <gtest/gtest.h>

namespace {

QApplication& App() {
    static int argc = 1;
    static char name[] = "test_wizard";
    static char* argv[] = {name, nullptr};
    static QApplication app(argc, argv);
    return app;
}

Qvz_Block* AddBlock(Qvz_WizData& d, const char* name, const char* prim, const char* display,
                    const char* width, const char* oldDisplay = nullptr) {
    auto b = std::make_unique<Qvz_Block>(name, prim, Qvz_FamilyOfPrimitive(prim));
    if (display)
        b->AddAttribute("MGT_DISPLAY_NAME", display);
    if (oldDisplay)
        b->AddAttribute("QVZ_OLD_DISPLAY_NAME", oldDisplay);
    if (width) {
        b->AddAttribute("QVZ_RX_DATA_WIDTH", width);
        b->AddAttribute("RX_DATA_WIDTH", width);
    }
    return d.AddBlock(std::move(b));
}

void SetFamilies(Qvz_WizData& d, bool gt, bool gt10, bool gt11) {
    d.Target().supportsGT = gt;
    d.Target().supportsGT10 = gt10;
    d.Target().supportsGT11 = gt11;
}

} // namespace

TEST(GetBlkPrimName, GtNamesCarryTheirWidthExceptCustom) {
    EXPECT_EQ(Qvz_MGTWizMain::GetBlkPrimName(nullptr), "");
    const struct {
        const char* prim;
        const char* width;
        const char* expected;
    } cases[] = {
        {"GT_CUSTOM", "2", "GT_CUSTOM"},
        {"GT_FIBRE_CHAN", "2", "GT_FIBRE_CHAN_2"},
        {"GT_ETHERNET", nullptr, "GT_ETHERNET_"},
        {"GT10_CUSTOM", "4", "GT10_CUSTOM"},
        {"GT11_CUSTOM", "4", "GT11_CUSTOM"},
    };
    for (const auto& c : cases) {
        Qvz_WizData d;
        Qvz_Block* b = AddBlock(d, "I", c.prim, "x", c.width);
        EXPECT_EQ(Qvz_MGTWizMain::GetBlkPrimName(b), c.expected) << c.prim;
    }
}

TEST(GetBlock, FiltersByFamilyDisplayNameAndWidth) {
    Qvz_WizData d;
    AddBlock(d, "GT_FC", "GT_FIBRE_CHAN", "FibreChannel", "2");
    AddBlock(d, "ETH2", "GT10_ETHERNET_2", "Ethernet", "2");
    AddBlock(d, "ETH4", "GT10_ETHERNET_4", "Ethernet", "4");
    AddBlock(d, "CUST", "GT10_CUSTOM", "10G Custom", "8");
    AddBlock(d, "OLD", "GT10_OC48_4", "", "4", "OC48");
    AddBlock(d, "G11", "GT11_CUSTOM", "Custom", "4");

    struct Case {
        bool gt, gt10, gt11;
        const char* display;
        const char* width;
        bool anyWidth;
        const char* expected; // nullptr: none
    };
    const Case cases[] = {
        {false, true, false, "Ethernet", "4", false, "ETH4"},
        {false, true, false, "Ethernet", "2", false, "ETH2"},
        {false, true, false, "Ethernet", "8", false, nullptr},
        {false, true, false, "Ethernet", "8", true, "ETH2"},
        {false, true, false, "ethernet", "4", false, nullptr},
        // "Custom" anywhere in the name skips the width test.
        {false, true, false, "10G Custom", "1", false, "CUST"},
        // The old display name stands in for an empty one.
        {false, true, false, "OC48", "4", false, "OLD"},
        // Family filter.
        {false, false, false, "Ethernet", "4", true, nullptr},
        {false, false, true, "Custom", "1", false, "G11"},
        {true, false, false, "FibreChannel", "4", false, "GT_FC"},
        // A device with GT transceivers never tests widths, for any family.
        {true, true, false, "Ethernet", "8", false, "ETH2"},
    };
    for (const auto& c : cases) {
        SetFamilies(d, c.gt, c.gt10, c.gt11);
        Qvz_MGTWizMain wiz("w", false);
        wiz.SetWizData(&d);
        const Qvz_Block* b = wiz.GetBlock(&d, c.display, c.width, c.anyWidth);
        if (!c.expected)
            EXPECT_EQ(b, nullptr) << c.display << "/" << c.width;
        else
            EXPECT_TRUE(b && b->GetName() == c.expected) << c.display << "/" << c.width;
    }
    Qvz_MGTWizMain wiz("w", false);
    EXPECT_EQ(wiz.GetBlock(nullptr, "Ethernet", "4", true), nullptr);
}

TEST(ClearPinSigBitAttrs, LeavesTheBlockAsItWas) {
    Qvz_Block b("I", "GT10_CUSTOM", Qvz_Family::GT10);
    b.AddPin("TXDATA", "IN")->SetPinSigBitProp("S", 7, 0, 7, 0);
    const Qvz_Block before(b);
    Qvz_MGTWizMain::ClearPinSigBitAttrs(&b);
    Qvz_MGTWizMain::ClearPinSigBitAttrs(nullptr);
    EXPECT_TRUE(b == before);
}

TEST(WizMain, InstantiatesSixPagesInOrderAndLinksTheDialog) {
    App();
    Qvz_WizData d;
    SetFamilies(d, false, true, false);
    Qvz_MGTWizMain wiz("w", false);
    wiz.SetWizData(&d);
    wiz.SetRunMode(Qvz_RunMode::Window);
    wiz.Prepare();
    for (int i = 0; i < 6; ++i)
        EXPECT_NE(wiz.GetPage(i), nullptr) << i;
    for (int i = 6; i < Qvz_WizMain::kMaxPages; ++i)
        EXPECT_EQ(wiz.GetPage(i), nullptr) << i;

    Wg_Wizard dialog;
    EXPECT_TRUE(wiz.BuildDialog(&dialog));
    EXPECT_EQ(dialog.windowTitle(), "Velomux Wizard");
    ASSERT_EQ(dialog.pageCount(), 7);
    const char* titles[] = {"General Setup",
                            "Transmitter Setup",
                            "Receiver Comma Detect Setup",
                            "Receiver Setup",
                            "Receiver Clock Correction Setup",
                            "Receiver Channel Bonding Setup",
                            "Summary"};
    for (int i = 0; i < 7; ++i) {
        Wg_WizardPage* p = dialog.page(i);
        EXPECT_EQ(p->pageBackName(), i == 0 ? QString() : QString(titles[i - 1])) << i;
        EXPECT_EQ(p->pageNextName(), i == 6 ? QString() : QString(titles[i + 1])) << i;
    }
    EXPECT_EQ(dialog.page(6), wiz.GetSummaryPage());
}

TEST(WizMain, FinishReturnsZeroInBothModes) {
    App();
    Qvz_WizData d;
    for (Qvz_RunMode mode : {Qvz_RunMode::Batch, Qvz_RunMode::Window}) {
        Qvz_MGTWizMain wiz("w", false);
        wiz.SetWizData(&d);
        wiz.SetRunMode(mode);
        wiz.Prepare();
        EXPECT_EQ(wiz.FinishRun(), 0);
    }
}

TEST(WizMain, BatchRunWithoutActiveBlockIsRefusedByAPage) {
    Qvz_MGTWizMain wiz("w", false);
    Qvz_WizData d;
    wiz.SetWizData(&d);
    // Nothing to configure: a page's batch step refuses, and the run names it.
    EXPECT_EQ(wiz.Run(), Qvz_RunRefused);
    EXPECT_FALSE(wiz.GetFailedPageTitle().IsEmpty());
}
