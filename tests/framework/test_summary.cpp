#include "Qvz_Summary.h"

#include <gtest/gtest.h>

namespace {

// A finished GT10 design: a port, two ties, a bit-wise pin, an internal
// signal and one bonded copy.
void MakeFinished(Qvz_WizData& d) {
    auto m = std::make_unique<Qvz_Block>("GT10_CUSTOM_INST1", "GT10_CUSTOM", Qvz_Family::GT10);
    m->AddAttribute("MGT_DISPLAY_NAME", "10G <Custom>");
    m->AddAttribute("QVZ_RX_DATA_WIDTH", "2");
    m->AddAttribute("LOC", "GT10_X5Y1");
    m->AddAttribute("CHAN_BOND_MODE", "MASTER");
    // A 32-bit pin of which the port uses 16 bits: the port is told as wide as its signal.
    m->AddPin("TXDATA", "IN")->SetWidth(32);
    m->GetNamedPin("TXDATA")->SetSigName("TXDATA_IN");
    m->AddPin("RXDATA", "OUT")->SetWidth(16);
    m->GetNamedPin("RXDATA")->SetSigName("RXDATA_OUT");
    m->AddPin("LOOPBACK", "IN")->SetIsGrounded(true);
    m->AddPin("POWERDOWN", "IN")->SetIsVcc(true);
    m->AddPin("RXCHARISK", "OUT")->SetPinSigBitProp("RXCHARISK_INT", 1, 0, 1, 0);
    m->AddPin("UNUSED", "OUT");
    m->SetIsUsed(true);
    auto copy = std::make_unique<Qvz_Block>("GT10_CUSTOM_INST2", "GT10_CUSTOM", Qvz_Family::GT10);
    copy->AddAttribute("LOC", "GT10_X4Y1");
    copy->AddAttribute("CHAN_BOND_MODE", "SLAVE_1_HOP");
    copy->SetIsUsed(true);
    auto idle = std::make_unique<Qvz_Block>("OTHER", "GT10_OC48_4", Qvz_Family::GT10);
    d.AddBlock(std::move(m));
    d.AddBlock(std::move(copy));
    d.AddBlock(std::move(idle));
    d.AddSignal("TXDATA_IN", true, "I")->SetIsBus(true, 16);
    d.AddSignal("RXDATA_OUT", true, "O")->SetIsBus(true, 16);
    d.AddSignal("RXCHARISK_INT", false, "");
    d.AddSignal("STALE", false, "")->SetIsUsed(false);
}

} // namespace

TEST(Summary, TellsWhatTheDesignDataHoldsForTheHost) {
    Qvz_WizData d;
    MakeFinished(d);
    const Qvz_Summary s = Qvz_Summary::Of(d);
    ASSERT_TRUE(s.hasBlock);
    EXPECT_EQ(s.loc, "GT10_X5Y1");
    EXPECT_EQ(s.role, "MASTER");
    ASSERT_EQ(s.ports.size(), 2u);
    EXPECT_EQ(s.ports[1].direction, "out");
    ASSERT_EQ(s.copies.size(), 1u);
    EXPECT_EQ(s.copies[0].loc, "GT10_X4Y1");

    const QString text = s.ToText(false);
    for (const char* line :
         {"Primitive:     GT10_CUSTOM (instance GT10_CUSTOM_INST1)", "Data width:    2 byte(s)",
          "Placement:     GT10_X5Y1", "Bonding role:  MASTER",
          "  in    TXDATA -> TXDATA_IN (16 bits)", "  out   RXDATA -> RXDATA_OUT (16 bits)",
          "  LOOPBACK = 0", "  POWERDOWN = 1", "Bit-wise:      RXCHARISK",
          "Internal signals: RXCHARISK_INT", "  GT10_CUSTOM_INST2 GT10_X4Y1 SLAVE_1_HOP"})
        EXPECT_TRUE(text.contains(line)) << line << "\n" << text.toStdString();
    EXPECT_FALSE(text.contains("STALE"));
    EXPECT_FALSE(text.contains("OTHER"));
    // The command line's short form leaves out the per-pin lists but keeps
    // the placement and names the copies.
    const QString brief = s.ToText(true);
    EXPECT_FALSE(brief.contains("TXDATA_IN"));
    EXPECT_FALSE(brief.contains("LOOPBACK"));
    for (const char* line : {"Placement:     GT10_X5Y1", "Bonding role:  MASTER",
                             "Bonded copies: 1\n  GT10_CUSTOM_INST2 GT10_X4Y1 SLAVE_1_HOP\n"})
        EXPECT_TRUE(brief.contains(line)) << line << "\n" << brief.toStdString();

    const QString html = s.ToHtml(true);
    EXPECT_TRUE(html.contains("10G &lt;Custom&gt;")) << html.toStdString();
    for (const char* part : {"TXDATA_IN", "GT10_X4Y1", "SLAVE_1_HOP", "LOOPBACK", "POWERDOWN"})
        EXPECT_TRUE(html.contains(part)) << part;
    // Before the finish routine has completed only the block is told.
    const QString unfinished = s.ToHtml(false);
    EXPECT_TRUE(unfinished.contains("GT10_CUSTOM_INST1"));
    EXPECT_FALSE(unfinished.contains("TXDATA_IN"));
}

TEST(Summary, WithoutActiveBlock) {
    Qvz_WizData d;
    const Qvz_Summary s = Qvz_Summary::Of(d);
    EXPECT_FALSE(s.hasBlock);
    EXPECT_EQ(s.ToText(false), "No transceiver block is active.\n");
    EXPECT_TRUE(s.ToHtml(true).contains("No transceiver block"));
}
