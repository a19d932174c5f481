#include "Qvz_WizData.h"

#include <gtest/gtest.h>

namespace {

Qvz_WizData TwoBlocks() {
    Qvz_WizData d;
    auto a = std::make_unique<Qvz_Block>("A_INST", "GT10_CUSTOM", Qvz_Family::GT10);
    a->AddAttribute("X", "1");
    a->AddPin("TXDATA", "IN")->SetWidth(32);
    d.AddBlock(std::move(a));
    d.AddBlock(std::make_unique<Qvz_Block>("B_INST", "GT10_ETHERNET_4", Qvz_Family::GT10));
    return d;
}

} // namespace

TEST(Block, SetAttributeValueAddsButPlainLookupDoesNot) {
    Qvz_Block b("I", "GT_CUSTOM", Qvz_Family::GT);
    EXPECT_EQ(b.GetAttributeValue("MISSING"), "");
    EXPECT_EQ(b.GetNamedAttribute("MISSING"), nullptr);
    b.SetAttributeValue("NEW", "v");
    const Qvz_Attribute* a = b.GetNamedAttribute("NEW");
    ASSERT_NE(a, nullptr);
    EXPECT_EQ(a->GetDefaultValue(), "v");
    EXPECT_TRUE(a->IsEditable());
    EXPECT_FALSE(a->IsChanged());
    EXPECT_TRUE(a->GetLegalValues().IsEmpty());
}

TEST(Block, AddAttributeReplacesValueOfExistingAndKeepsTheRest) {
    Qvz_Block b("I", "GT_CUSTOM", Qvz_Family::GT);
    Qvz_Attribute* a = b.AddAttribute("A", "1");
    a->SetDefaultValue("0");
    a->SetEditable(false);
    a->GetLegalValues().Add("0");
    Qvz_Attribute* again = b.AddAttribute("A", "2");
    EXPECT_EQ(again, a);
    EXPECT_EQ(a->GetValue(), "2");
    EXPECT_EQ(a->GetDefaultValue(), "0");
    EXPECT_FALSE(a->IsEditable());
    EXPECT_EQ(b.GetAttributes().size(), 1u);
}

TEST(Block, RemovingMissingThingsDoesNothing) {
    Qvz_Block b("I", "GT_CUSTOM", Qvz_Family::GT);
    b.AddAttribute("A", "1");
    b.AddPin("P", "IN");
    b.RemoveAttribute("B");
    b.DeleteAttribute(nullptr);
    b.DeletePin(nullptr);
    Qvz_Pin other("P", "IN");
    b.DeletePin(&other);
    EXPECT_EQ(b.GetAttributes().size(), 1u);
    EXPECT_EQ(b.GetPins().size(), 1u);
    b.RemoveAttribute("A");
    EXPECT_TRUE(b.GetAttributes().empty());
}

TEST(Block, AddPinOfExistingNameReturnsThatPinUnchanged) {
    Qvz_Block b("I", "GT11_CUSTOM", Qvz_Family::GT11);
    Qvz_Pin* p = b.AddPin("COMBUSIN", "IN");
    p->SetWidth(16);
    Qvz_Pin* q = b.AddPin("COMBUSIN", "OUT");
    EXPECT_EQ(p, q);
    EXPECT_EQ(q->GetDirection(), "IN");
    EXPECT_EQ(q->GetWidth(), 16);
    EXPECT_EQ(b.GetPins().size(), 1u);
}

TEST(Block, PrefixTestAndFamily) {
    Qvz_Block b("I", "GT11_CUSTOM", Qvz_Family::GT11);
    EXPECT_FALSE(b.HasAttrWPrefix("CLK_COR"));
    b.AddAttribute("CLK_COR_SEQ_1_1", "x");
    EXPECT_TRUE(b.HasAttrWPrefix("CLK_COR"));
    EXPECT_FALSE(b.HasAttrWPrefix("COR"));
    EXPECT_TRUE(b.SupportsMGT11());
    EXPECT_FALSE(b.SupportsMGT10());
    EXPECT_EQ(Qvz_FamilyOfPrimitive("GT_CUSTOM"), Qvz_Family::GT);
    EXPECT_EQ(Qvz_FamilyOfPrimitive("GT10_OC48_4"), Qvz_Family::GT10);
    EXPECT_EQ(Qvz_FamilyOfPrimitive("GT11_CUSTOM"), Qvz_Family::GT11);
    EXPECT_EQ(Qvz_FamilyOfPrimitive("GTX_FOO"), Qvz_Family::Unknown);
}

TEST(Attribute, RangesAreTwoDecimalIntegers) {
    const struct {
        const char* text;
        bool range;
        int low, high;
    } cases[] = {
        {"0..15", true, 0, 15},   {"-4..4", true, -4, 4}, {"1..", false, 0, 0},
        {"..3", false, 0, 0},     {"a..3", false, 0, 0},  {"1...3", false, 0, 0},
        {"1..3x", false, 0, 0},   {"15", false, 0, 0},    {"", false, 0, 0},
        {"1..99999999999", true, 1, 2147483647},
    };
    for (const auto& c : cases) {
        int lo = -77, hi = -77;
        EXPECT_EQ(Qvz_Attribute::IsValueRange(c.text), c.range) << c.text;
        EXPECT_EQ(Qvz_Attribute::GetRangeValues(c.text, lo, hi), c.range) << c.text;
        if (c.range) {
            EXPECT_EQ(lo, c.low) << c.text;
            EXPECT_EQ(hi, c.high) << c.text;
        } else {
            EXPECT_EQ(lo, -77) << c.text;
        }
    }
}

TEST(Pin, BitMapsAreAttributesReplacedByPinRange) {
    Qvz_Pin p("TXDATA", "IN");
    p.SetAttributeValue("QVZ_PIN_TIE", "");
    EXPECT_FALSE(p.HasPinSigBitProp());
    p.SetPinSigBitProp("TXDATA_IN", 15, 8, 17, 10);
    p.SetPinSigBitProp("TXDATA_IN", 7, 0, 7, 0);
    EXPECT_TRUE(p.HasPinSigBitProp());
    EXPECT_EQ(p.GetAttributeValue("QVZX_ONLY_PIN_SIG_BIT_15_8"), "TXDATA_IN[17:10]");
    p.SetPinSigBitProp("OTHER", 15, 8, 1, 0);
    EXPECT_EQ(p.GetAttributeValue("QVZX_ONLY_PIN_SIG_BIT_15_8"), "OTHER[1:0]");
    EXPECT_EQ(p.GetAttributes().size(), 3u);
    p.RemoveAllPinSigBitProps();
    EXPECT_FALSE(p.HasPinSigBitProp());
    ASSERT_EQ(p.GetAttributes().size(), 1u);
    EXPECT_EQ(p.GetAttributes()[0].name, "QVZ_PIN_TIE");
}

TEST(Pin, ClearAllConnectionsLeavesNothingConnected) {
    Qvz_Pin p("TXDATA", "IN");
    p.SetSigName("S");
    p.SetIsGrounded(true);
    p.SetIsVcc(true);
    p.SetPinSigBitProp("S", 1, 0, 1, 0);
    p.ClearAllConnections();
    EXPECT_EQ(p.GetSigName(), "");
    EXPECT_FALSE(p.IsGrounded());
    EXPECT_FALSE(p.IsVcc());
    EXPECT_FALSE(p.HasPinSigBitProp());
    p.SetWidth(0);
    EXPECT_EQ(p.GetWidth(), 1);
    p.SetWidth(-5);
    EXPECT_EQ(p.GetWidth(), 1);
}

TEST(WizData, ActiveBlockIsFirstUsed) {
    Qvz_WizData d = TwoBlocks();
    EXPECT_EQ(d.GetActiveBlock(), nullptr);
    d.GetNamedBlock("B_INST")->SetIsUsed(true);
    EXPECT_EQ(d.GetActiveBlock()->GetName(), "B_INST");
    d.SetAllBlksIsActive(true);
    EXPECT_EQ(d.GetActiveBlock()->GetName(), "A_INST");
    d.SetAllBlksIsActive(false);
    EXPECT_EQ(d.GetActiveBlock(), nullptr);
    EXPECT_EQ(d.GetPrimitiveBlock("GT10_ETHERNET_4")->GetName(), "B_INST");
    EXPECT_EQ(d.GetPrimitiveBlock("GT10_ZEPHINE_4"), nullptr);
}

TEST(WizData, AddSignalNeverDuplicatesAndKeepsExistingFlags) {
    Qvz_WizData d;
    Qvz_Signal* gnd = d.AddSignal("GND", false, "");
    EXPECT_TRUE(gnd->IsUsed());
    gnd->SetIsConst0(true);
    gnd->SetIsBus(true, 8);
    gnd->SetIsUsed(false);
    Qvz_Signal* again = d.AddSignal("GND", true, "I");
    EXPECT_EQ(again, gnd);
    EXPECT_TRUE(gnd->IsUsed());
    EXPECT_FALSE(gnd->IsExternal());
    EXPECT_EQ(gnd->GetDirection(), "");
    EXPECT_EQ(gnd->GetWidth(), 8);
    EXPECT_TRUE(gnd->IsConst0());
    Qvz_Signal copy("GND");
    EXPECT_EQ(d.AddSignal(copy), gnd);
    Qvz_Signal other("TXDATA_IN");
    other.SetIsBus(true, 20);
    Qvz_Signal* added = d.AddSignal(other);
    EXPECT_EQ(added->GetWidth(), 20);
    EXPECT_EQ(d.GetSignals().size(), 2u);
    d.SetAllSigsIsActive(false);
    EXPECT_FALSE(gnd->IsUsed());
    EXPECT_FALSE(added->IsUsed());
}

TEST(WizData, CopyBlockAppendsOrRefreshesTheNamedBlock) {
    Qvz_WizData d = TwoBlocks();
    Qvz_Block* src = d.GetNamedBlock("A_INST");
    Qvz_Block* c1 = d.CopyBlock(src, "A_INST2");
    ASSERT_NE(c1, nullptr);
    EXPECT_EQ(d.GetBlocks().back().get(), c1);
    EXPECT_EQ(c1->GetPrimitiveName(), "GT10_CUSTOM");
    EXPECT_EQ(c1->GetAttributeValue("X"), "1");
    EXPECT_EQ(c1->GetNamedPin("TXDATA")->GetWidth(), 32);
    // A deep copy: changing the copy leaves the source alone.
    c1->SetAttributeValue("X", "2");
    c1->GetNamedPin("TXDATA")->SetSigName("S");
    EXPECT_EQ(src->GetAttributeValue("X"), "1");
    EXPECT_EQ(src->GetNamedPin("TXDATA")->GetSigName(), "");

    src->SetAttributeValue("X", "3");
    Qvz_Block* c2 = d.CopyBlock(src, "A_INST2");
    EXPECT_EQ(c2, c1);
    EXPECT_EQ(d.GetBlocks().size(), 3u);
    EXPECT_EQ(c2->GetAttributeValue("X"), "3");
    EXPECT_EQ(c2->GetNamedPin("TXDATA")->GetSigName(), "");
    EXPECT_EQ(d.CopyBlock(nullptr, "Z"), nullptr);
    EXPECT_EQ(d.CopyBlock(src, "A_INST"), src);
    EXPECT_EQ(d.GetBlocks().size(), 3u);

    d.DeleteBlock(c2);
    EXPECT_EQ(d.GetBlocks().size(), 2u);
    EXPECT_EQ(d.GetNamedBlock("A_INST2"), nullptr);
}

TEST(WizData, CopiesAreDeep) {
    Qvz_WizData d = TwoBlocks();
    Qvz_WizData e = d;
    EXPECT_TRUE(d == e);
    e.GetNamedBlock("A_INST")->SetAttributeValue("X", "9");
    EXPECT_FALSE(d == e);
    EXPECT_EQ(d.GetNamedBlock("A_INST")->GetAttributeValue("X"), "1");
}
