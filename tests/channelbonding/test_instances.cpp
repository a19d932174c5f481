#include "RcbTestSupport.h"

#include <gtest/gtest.h>

#include <string>

namespace {

Qvz_Pin* Pin(Qvz_Block* b, const char* name, const char* dir, int width, const char* signal = "",
             bool dataWidth = false) {
    Qvz_Pin* p = b->AddPin(name, dir);
    p->SetWidth(width);
    p->SetSigName(signal);
    p->SetSupportsDataWidth(dataWidth);
    return p;
}

Qvz_Signal* Sig(Qvz_WizData& d, const char* name, int width, bool const0 = false) {
    Qvz_Signal* s = d.AddSignal(name, true, "");
    s->SetIsBus(width > 1, width);
    s->SetIsConst0(const0);
    return s;
}

int CountSignals(const Qvz_WizData& d, const char* name) {
    int n = 0;
    for (const auto& s : d.GetSignals())
        n += s->GetName() == name;
    return n;
}

std::string PinSig(const Qvz_WizData& d, const std::string& block, const char* pin) {
    const Qvz_Block* b = d.GetNamedBlock(block);
    const Qvz_Pin* p = b ? b->GetNamedPin(pin) : nullptr;
    return p ? p->GetSigName().str() : "<missing>";
}

// A GT10 master as the finish routine leaves it, with every kind of pin the
// copies treat differently.
Qvz_Block* Gt10Master(RcbRig& rig, const char* name, const char* display, const char* number) {
    rig.data.Target().maxBondGT10 = 20;
    Qvz_Block* b = rig.Block(name, "GT10_CUSTOM");
    BondingAttrs(b, display, number);
    Attr(b, "QVZX_ONLY_USE_BREFCLK", "TRUE");
    Attr(b, "QVZX_ONLY_BREFCLK_DYN", "STATIC");
    Attr(b, "QVZX_ONLY_BREFCLK", "BREFCLK");
    Qvz_WizData& d = rig.data;
    Sig(d, "TXDATA_IN", 16);
    Sig(d, "RXDATA_OUT", 32);
    Sig(d, "TXCHARISK_IN", 4);
    Sig(d, "GND_BUS", 4, true);
    Sig(d, "LOOPBACK_IN", 2);
    Sig(d, "CHANBOND_M_S1_OUT", 5);
    Sig(d, "ENCHANSYNC_IN", 1);
    Sig(d, "CHBONDDONE_OUT", 1);
    Sig(d, "RXUSRCLK", 1);
    Sig(d, "BREFCLK_IN", 1);
    Pin(b, "TXDATA", "IN", 32, "TXDATA_IN", true);
    Pin(b, "RXDATA", "OUT", 32, "RXDATA_OUT", true);
    Qvz_Pin* charIsK = Pin(b, "TXCHARISK", "IN", 4);
    charIsK->SetPinSigBitProp("TXCHARISK_IN", 1, 0, 1, 0);
    charIsK->SetPinSigBitProp("TXCHARISK_IN", 3, 2, 3, 2);
    Pin(b, "TXBYPASS8B10B", "IN", 4)->SetPinSigBitProp("GND_BUS", 3, 0, 3, 0);
    Pin(b, "LOOPBACK", "IN", 2)->SetAttributeValue("QVZX_ONLY_PIN_SIG_BIT_1_0", "LOOPBACK_IN");
    Pin(b, "POWERDOWN", "IN", 1)->SetIsGrounded(true);
    Pin(b, "RXRECCLK", "OUT", 1);
    Pin(b, "CHBONDI", "IN", 5)->SetIsGrounded(true);
    Pin(b, "CHBONDO", "OUT", 5, "CHANBOND_M_S1_OUT");
    Pin(b, "CHBONDDONE", "OUT", 1, "CHBONDDONE_OUT");
    Pin(b, "ENCHANSYNC", "IN", 1, "ENCHANSYNC_IN");
    Pin(b, "RXUSRCLK", "IN", 1, "RXUSRCLK");
    Pin(b, "REFCLK", "IN", 1, "REFCLK");
    Pin(b, "BREFCLK", "IN", 1, "BREFCLK_IN");
    Pin(b, "BREFCLK2", "IN", 1, "BREFCLK2_IN");
    return b;
}

// Reads and fully writes the page, as the batch step and Next do.
Qvz_MGTRCB* Configure(RcbRig& rig) {
    Qvz_MGTRCB* page = rig.Start();
    EXPECT_TRUE(page->ReadWizData());
    EXPECT_TRUE(page->WriteWizData(true));
    return page;
}

} // namespace

TEST(BondedInstances, CopiesArePlacedAndWiredOwnPorts) {
    RcbRig rig;
    Qvz_Block* master = Gt10Master(rig, "GT10_CUSTOM_INST", "10G Custom", "4");
    Configure(rig)->GenerateBondedInstances(master, false, 4);
    const Qvz_WizData& d = rig.data;

    EXPECT_EQ(master->GetName(), "GT10_CUSTOM_INST1");
    EXPECT_EQ(master->GetAttributeValue("LOC"), "GT10_X5Y1");
    EXPECT_EQ(master->GetAttributeValue("CHAN_BOND_MODE"), "MASTER");
    EXPECT_EQ(d.GetNamedBlock("GT10_CUSTOM_INST5"), nullptr);
    const char* locs[] = {"GT10_X4Y1", "GT10_X6Y1", "GT10_X3Y1"};
    for (int i = 2; i <= 4; ++i) {
        const std::string name = "GT10_CUSTOM_INST" + std::to_string(i);
        const Qvz_Block* c = d.GetNamedBlock(name);
        ASSERT_NE(c, nullptr) << name;
        EXPECT_TRUE(c->IsUsed());
        EXPECT_EQ(c->GetAttributeValue("LOC"), locs[i - 2]);
        EXPECT_EQ(c->GetAttributeValue("CHAN_BOND_MODE"), "SLAVE_1_HOP");
        EXPECT_EQ(c->GetAttributeValue("CHAN_BOND_ONE_SHOT"), "FALSE");
        EXPECT_EQ(PinSig(d, name, "CHBONDI"), "CHANBOND_M_S1_OUT");
        EXPECT_FALSE(c->GetNamedPin("CHBONDI")->IsGrounded());
        EXPECT_EQ(PinSig(d, name, "CHBONDO"), "CHANBOND_S1_S2_OUT_BLK" + std::to_string(i));
    }
    const std::string c2 = "GT10_CUSTOM_INST2";
    const Qvz_Signal* chain = d.GetNamedSignal("CHANBOND_S1_S2_OUT_BLK2");
    ASSERT_NE(chain, nullptr);
    EXPECT_TRUE(chain->IsBus());
    EXPECT_EQ(chain->GetWidth(), 5);

    // Ports named after the master's signals, as wide as those.
    EXPECT_EQ(PinSig(d, c2, "TXDATA"), "TXDATA_IN_BLK2");
    const Qvz_Signal* tx = d.GetNamedSignal("TXDATA_IN_BLK2");
    ASSERT_NE(tx, nullptr);
    EXPECT_EQ(tx->GetWidth(), 16);
    EXPECT_TRUE(tx->IsBus());
    EXPECT_TRUE(tx->IsExternal());
    EXPECT_EQ(tx->GetDirection(), "I");
    EXPECT_EQ(tx->GetAttributeValue("BUS_ONLY_USE_BITS"), "16");
    EXPECT_EQ(PinSig(d, c2, "RXDATA"), "RXDATA_OUT_BLK2");
    EXPECT_FALSE(d.GetNamedSignal("RXDATA_OUT_BLK2")->HasAttribute("BUS_ONLY_USE_BITS"));
    EXPECT_EQ(PinSig(d, c2, "ENCHANSYNC"), "ENCHANSYNC_IN_BLK2");
    EXPECT_FALSE(d.GetNamedSignal("ENCHANSYNC_IN_BLK2")->IsBus());
    EXPECT_EQ(PinSig(d, c2, "RXUSRCLK"), "RXUSRCLK_BLK2");

    // Bit-mapped pins move onto the copy's own signals, even without a
    // whole-pin signal; each signal copied once; constants stay shared.
    const Qvz_Pin* charIsK = d.GetNamedBlock(c2)->GetNamedPin("TXCHARISK");
    EXPECT_EQ(charIsK->GetSigName(), "TXCHARISK_IN_BLK2");
    EXPECT_EQ(charIsK->GetAttributeValue("QVZX_ONLY_PIN_SIG_BIT_1_0"), "TXCHARISK_IN_BLK2[1:0]");
    EXPECT_EQ(charIsK->GetAttributeValue("QVZX_ONLY_PIN_SIG_BIT_3_2"), "TXCHARISK_IN_BLK2[3:2]");
    EXPECT_EQ(CountSignals(d, "TXCHARISK_IN_BLK2"), 1);
    EXPECT_EQ(d.GetNamedSignal("TXCHARISK_IN_BLK2")->GetWidth(), 4);
    EXPECT_EQ(PinSig(d, c2, "TXBYPASS8B10B"), "GND_BUS");
    EXPECT_EQ(d.GetNamedBlock(c2)
                  ->GetNamedPin("TXBYPASS8B10B")
                  ->GetAttributeValue("QVZX_ONLY_PIN_SIG_BIT_3_0"),
              "GND_BUS[3:0]");
    EXPECT_EQ(PinSig(d, c2, "LOOPBACK"), "LOOPBACK_IN_BLK2");
    EXPECT_EQ(d.GetNamedBlock(c2)
                  ->GetNamedPin("LOOPBACK")
                  ->GetAttributeValue("QVZX_ONLY_PIN_SIG_BIT_1_0"),
              "LOOPBACK_IN_BLK2");
    EXPECT_NE(d.GetNamedSignal("LOOPBACK_IN_BLK2"), nullptr);

    // Tied and unconnected pins stay so; near copies keep the master's clocks.
    EXPECT_TRUE(d.GetNamedBlock(c2)->GetNamedPin("POWERDOWN")->IsGrounded());
    EXPECT_EQ(PinSig(d, c2, "POWERDOWN"), "");
    EXPECT_EQ(PinSig(d, c2, "RXRECCLK"), "");
    EXPECT_EQ(PinSig(d, c2, "BREFCLK"), "BREFCLK_IN");
    // The master itself is left as it was wired.
    EXPECT_EQ(PinSig(d, "GT10_CUSTOM_INST1", "TXDATA"), "TXDATA_IN");
    EXPECT_EQ(PinSig(d, "GT10_CUSTOM_INST1", "TXCHARISK"), "");
}

TEST(BondedInstances, FarRowTakesSecondaryClocksAndTwoHopChains) {
    RcbRig rig;
    Qvz_Block* master = Gt10Master(rig, "GT10_CUSTOM_INST", "10G Custom", "12");
    Configure(rig)->GenerateBondedInstances(master, false, 12);
    const Qvz_WizData& d = rig.data;
    const auto name = [](int i) { return "GT10_CUSTOM_INST" + std::to_string(i); };
    EXPECT_EQ(PinSig(d, name(10), "BREFCLK"), "BREFCLK_IN");
    for (int i : {11, 12}) {
        EXPECT_EQ(PinSig(d, name(i), "BREFCLK"), "BREFCLK_SECONDARY") << i;
        // A static first BREFCLK leaves BREFCLK2 alone.
        EXPECT_EQ(PinSig(d, name(i), "BREFCLK2"), "BREFCLK2_IN") << i;
        EXPECT_EQ(PinSig(d, name(i), "REFCLK"), "REFCLK") << i;
    }
    EXPECT_EQ(d.GetNamedSignal("BREFCLK_SECONDARY")->GetDirection(), "I");
    EXPECT_EQ(d.GetNamedBlock(name(11))->GetAttributeValue("LOC"), "GT10_X5Y0");
    EXPECT_EQ(d.GetNamedBlock(name(11))->GetAttributeValue("CHAN_BOND_MODE"), "SLAVE_1_HOP");
    EXPECT_EQ(PinSig(d, name(11), "CHBONDI"), "CHANBOND_M_S1_OUT");
    EXPECT_EQ(PinSig(d, name(11), "CHBONDO"), "CHANBOND_S1_S2_OUT_BLK11");
    EXPECT_EQ(d.GetNamedBlock(name(12))->GetAttributeValue("CHAN_BOND_MODE"), "SLAVE_2_HOPS");
    EXPECT_EQ(PinSig(d, name(12), "CHBONDI"), "CHANBOND_S1_S2_OUT_BLK11");
    EXPECT_EQ(PinSig(d, name(12), "CHBONDO"), "CHBONDO_BLK12");
    EXPECT_EQ(PinSig(d, name(6), "CHBONDI"), "CHANBOND_S1_S2_OUT_BLK2");
    EXPECT_EQ(PinSig(d, name(10), "CHBONDI"), "CHANBOND_S1_S2_OUT_BLK4");
    EXPECT_EQ(d.GetNamedSignal("CHANBOND_S1_S2_OUT_BLK11")->GetWidth(), 5);
}

TEST(BondedInstances, WithdrawAndGenerateAgainIsConsistent) {
    RcbRig rig;
    Qvz_Block* master = Gt10Master(rig, "GT10_CUSTOM_INST", "10G Custom", "12");
    Qvz_MGTRCB* page = Configure(rig);
    page->GenerateBondedInstances(master, false, 12);
    const Qvz_WizData generated(rig.data);
    const size_t blocks = rig.data.GetBlocks().size();

    // Finishing twice never duplicates or renames anything again.
    page->GenerateBondedInstances(master, false, 12);
    EXPECT_TRUE(rig.data == generated);

    page->RemoveBondedInstances();
    EXPECT_EQ(master->GetName(), "GT10_CUSTOM_INST");
    EXPECT_TRUE(master->IsUsed());
    EXPECT_EQ(rig.data.GetActiveBlock(), master);
    for (int i = 2; i <= 12; ++i)
        EXPECT_FALSE(rig.data.GetNamedBlock("GT10_CUSTOM_INST" + std::to_string(i))->IsUsed());
    for (const auto& s : rig.data.GetSignals()) {
        const bool bonding = s->GetName().GetIndexOfString("_BLK", 0) != Port::StringBase::npos ||
                             s->GetName() == "CHANBOND_M_S1_OUT" ||
                             s->GetName() == "ENCHANSYNC_IN" || s->GetName() == "CHBONDDONE_OUT";
        EXPECT_EQ(s->IsUsed(), !bonding) << s->GetName().str();
    }
    page->RemoveBondedInstances(); // a second Back changes nothing more
    EXPECT_EQ(master->GetName(), "GT10_CUSTOM_INST");

    // The finish routine marks the master's own bonding signals used again.
    for (const char* s : {"CHANBOND_M_S1_OUT", "ENCHANSYNC_IN", "CHBONDDONE_OUT"})
        rig.data.GetNamedSignal(s)->SetIsUsed(true);
    page->GenerateBondedInstances(master, false, 12);
    EXPECT_EQ(rig.data.GetBlocks().size(), blocks);
    EXPECT_TRUE(rig.data == generated);

    // Fewer slaves the second time: the surplus copies stay withdrawn.
    page->RemoveBondedInstances();
    page->GenerateBondedInstances(master, false, 2);
    EXPECT_TRUE(rig.data.GetNamedBlock("GT10_CUSTOM_INST2")->IsUsed());
    EXPECT_FALSE(rig.data.GetNamedBlock("GT10_CUSTOM_INST3")->IsUsed());
}

TEST(BondedInstances, NamesAndRenameUndoneExactly) {
    const struct {
        const char* master;
        const char* whileGenerated;
        const char* firstCopy;
    } cases[] = {
        {"GT10_CUSTOM_INST", "GT10_CUSTOM_INST1", "GT10_CUSTOM_INST2"},
        // Already ending in INST1: not renamed, and keeps its name on Back.
        {"GT10_CUSTOM_INST1", "GT10_CUSTOM_INST1", "GT10_CUSTOM_INST12"},
        {"LANE_A", "LANE_A", "LANE_A2"},
    };
    for (const auto& c : cases) {
        RcbRig rig;
        Qvz_Block* master = Gt10Master(rig, c.master, "10G Custom", "2");
        Qvz_MGTRCB* page = Configure(rig);
        page->GenerateBondedInstances(master, false, 2);
        EXPECT_EQ(master->GetName(), c.whileGenerated);
        ASSERT_NE(rig.data.GetNamedBlock(c.firstCopy), nullptr) << c.master;
        page->RemoveBondedInstances();
        EXPECT_EQ(master->GetName(), c.master);
        EXPECT_FALSE(rig.data.GetNamedBlock(c.firstCopy)->IsUsed());
    }
}

TEST(BondedInstances, NeverMoreThanTheMaximum) {
    const struct {
        const char* prim;
        int max, n, lastCopy;
    } cases[] = {
        {"GT10_CUSTOM", 6, 30, 6},
        {"GT11_CUSTOM", 13, 13, 12},
        {"GT_CUSTOM", 4, 5, 4},
    };
    for (const auto& c : cases) {
        RcbRig rig;
        rig.data.Target().maxBondGT = rig.data.Target().maxBondGT10 =
            rig.data.Target().maxBondGT11 = c.max;
        Qvz_Block* b = rig.Block("X_INST", c.prim);
        BondingAttrs(b, "Custom", "2");
        Configure(rig)->GenerateBondedInstances(b, false, c.n);
        EXPECT_NE(rig.data.GetNamedBlock("X_INST" + std::to_string(c.lastCopy)), nullptr) << c.prim;
        EXPECT_EQ(rig.data.GetNamedBlock("X_INST" + std::to_string(c.lastCopy + 1)), nullptr)
            << c.prim;
        EXPECT_EQ(rig.data.GetBlocks().size(), static_cast<size_t>(c.lastCopy)) << c.prim;
    }
}

namespace {
Qvz_Block* Gt11Master(RcbRig& rig, int max, const char* useB) {
    rig.data.Target().maxBondGT11 = max;
    Qvz_Block* b = rig.Block("GT11_CUSTOM_INST", "GT11_CUSTOM");
    BondingAttrs(b, "Custom", "0");
    Attr(b, "CHAN_BOND_MODE", "NONE");
    Attr(b, "QVZ_GT11_USE_B", useB);
    Attr(b, "TXABPMACLKSEL", "REFCLK1");
    Attr(b, "RXPMACLKSEL", "REFCLK2");
    Sig(rig.data, "TXDATA_IN", 32);
    Sig(rig.data, "RXDATA_OUT", 32);
    Qvz_Pin* tx = Pin(b, "TXDATA", "IN", 32, "TXDATA_IN", true);
    tx->SetAttributeValue("QVZ_PIN_TIE", "0");
    Pin(b, "RXDATA", "OUT", 32, "RXDATA_OUT", true);
    Pin(b, "COMBUSIN", "IN", 16);
    Pin(b, "COMBUSOUT", "OUT", 16);
    Pin(b, "REFCLK1", "IN", 1, "REFCLK1");
    Pin(b, "REFCLK2", "IN", 1, "REFCLK2");
    return b;
}
} // namespace

TEST(BondedInstances, Gt11SinglePairCopyIsIdleAndWithdrawn) {
    RcbRig rig;
    Qvz_Block* master = Gt11Master(rig, 24, "TRUE");
    Qvz_MGTRCB* page = Configure(rig);
    EXPECT_EQ(master->GetAttributeValue("CHAN_BOND_MODE"), "NONE");
    page->GenerateBondedInstances(master, false, 0);
    const Qvz_WizData& d = rig.data;
    const std::string pair = "GT11_CUSTOM_INST2";
    ASSERT_NE(d.GetNamedBlock(pair), nullptr);
    EXPECT_EQ(d.GetBlocks().size(), 2u);
    EXPECT_EQ(master->GetAttributeValue("GT11_MODE"), "B");
    const Qvz_Block* copy = d.GetNamedBlock(pair);
    EXPECT_EQ(copy->GetAttributeValue("GT11_MODE"), "DONT_CARE");
    EXPECT_EQ(copy->GetNamedAttribute("LOC"), nullptr);
    const Qvz_Pin* tx = copy->GetNamedPin("TXDATA");
    EXPECT_TRUE(tx->IsGrounded());
    EXPECT_EQ(tx->GetSigName(), "");
    EXPECT_FALSE(tx->HasAttribute("QVZ_PIN_TIE"));
    EXPECT_FALSE(copy->GetNamedPin("RXDATA")->IsGrounded());
    EXPECT_EQ(PinSig(d, pair, "RXDATA"), "");
    // The tile bus still joins the pair.
    EXPECT_EQ(PinSig(d, "GT11_CUSTOM_INST1", "COMBUSOUT"), "COMBUSOUT");
    EXPECT_EQ(PinSig(d, pair, "COMBUSIN"), "COMBUSOUT");
    EXPECT_EQ(PinSig(d, pair, "COMBUSOUT"), "COMBUSOUT_BLK2");
    EXPECT_EQ(PinSig(d, "GT11_CUSTOM_INST1", "COMBUSIN"), "COMBUSOUT_BLK2");
    EXPECT_EQ(d.GetNamedSignal("COMBUSOUT_BLK2")->GetWidth(), 16);

    // Its CHAN_BOND_MODE is the master's NONE, yet it is withdrawn.
    page->RemoveBondedInstances();
    EXPECT_FALSE(d.GetNamedBlock(pair)->IsUsed());
    EXPECT_EQ(master->GetName(), "GT11_CUSTOM_INST");
}

TEST(BondedInstances, Gt11DualPairsAlternateAndFarCopiesUseSecondaryClocks) {
    RcbRig rig;
    Qvz_Block* master = Gt11Master(rig, 8, "FALSE");
    Attr(master, "QVZ_CHAN_BOND_NUMBER", "6");
    Configure(rig)->GenerateBondedInstances(master, false, 6);
    const Qvz_WizData& d = rig.data;
    EXPECT_EQ(master->GetAttributeValue("QVZ_GT11_MODE"), "DUAL");
    EXPECT_EQ(master->GetAttributeValue("GT11_MODE"), "A");
    EXPECT_EQ(master->GetAttributeValue("LOC"), "GT11_X1Y2");
    const char* modes[] = {"B", "A", "B", "A", "B"};
    for (int i = 2; i <= 6; ++i)
        EXPECT_EQ(
            d.GetNamedBlock("GT11_CUSTOM_INST" + std::to_string(i))->GetAttributeValue("GT11_MODE"),
            modes[i - 2])
            << i;
    EXPECT_EQ(d.GetNamedBlock("GT11_CUSTOM_INST5")->GetAttributeValue("LOC"), "GT11_X0Y2");
    EXPECT_EQ(PinSig(d, "GT11_CUSTOM_INST3", "REFCLK1"), "REFCLK1");
    EXPECT_EQ(PinSig(d, "GT11_CUSTOM_INST5", "REFCLK1"), "REFCLK1_SECONDARY");
    EXPECT_EQ(PinSig(d, "GT11_CUSTOM_INST6", "REFCLK2"), "REFCLK2_SECONDARY");
    // Dual copies have ports of their own; pairs 3+4 share their own tile bus.
    EXPECT_EQ(PinSig(d, "GT11_CUSTOM_INST3", "TXDATA"), "TXDATA_IN_BLK3");
    EXPECT_EQ(PinSig(d, "GT11_CUSTOM_INST3", "COMBUSOUT"), "COMBUSOUT_BLK3");
    EXPECT_EQ(PinSig(d, "GT11_CUSTOM_INST4", "COMBUSIN"), "COMBUSOUT_BLK3");
    EXPECT_EQ(PinSig(d, "GT11_CUSTOM_INST3", "COMBUSIN"), "COMBUSOUT_BLK4");
}

TEST(BondedInstances, InfinibandCopiesCarryTheirLaneIds) {
    RcbRig rig;
    Qvz_Block* master = Gt10Master(rig, "GT10_INFINIBAND_INST", "Infiniband", "4");
    Attr(master, "LANE_ID", "00000000011");
    Attr(rig.Block("GT10_INFINIBAND_INST3", "GT10_CUSTOM", false), "LANE_ID", "00000000101");
    Configure(rig)->GenerateBondedInstances(master, false, 4);
    const Qvz_WizData& d = rig.data;
    const struct {
        const char* block;
        const char* id;
    } cases[] = {{"GT10_INFINIBAND_INST1", "00000000011"},
                 {"GT10_INFINIBAND_INST2", "00000000000"},
                 {"GT10_INFINIBAND_INST3", "00000000101"},
                 {"GT10_INFINIBAND_INST4", "00000000000"}};
    for (const auto& c : cases)
        for (const char* a : {"LANE_ID", "CHAN_BOND_SEQ_1_2", "CHAN_BOND_SEQ_2_2"})
            EXPECT_EQ(d.GetNamedBlock(c.block)->GetAttributeValue(a), c.id) << c.block << a;
}
