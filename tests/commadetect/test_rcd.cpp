#include "Qvz_MGTRCD.h"
#include "Qvz_MGTWizMain.h"
#include "TestApp.h"
#include "Wg_WizardPage.h"

#include <QApplication>
#include <QWidget>
#include <gtest/gtest.h>

#include <memory>
#include <ostream>
#include <string>

namespace Port {
// Readable values in failure messages.
void PrintTo(const StringBase& s, std::ostream* os) {
    *os << '"' << s.str() << '"';
}
} // namespace Port

namespace {

QApplication& App() {
    return TestApp();
}

// One active block of a primitive, and the page on top of it.
struct PageOn {
    explicit PageOn(const char* primitive) {
        auto b = std::make_unique<Qvz_Block>("B", primitive, Qvz_FamilyOfPrimitive(primitive));
        b->SetIsUsed(true);
        block = data.AddBlock(std::move(b));
        main.SetWizData(&data);
        page = std::make_unique<Qvz_MGTRCD>(&main);
    }
    Qvz_Attribute* Add(const char* name, const char* value, bool editable = true,
                       const char* def = nullptr) {
        Qvz_Attribute* a = block->AddAttribute(name, value);
        a->SetEditable(editable);
        if (def)
            a->SetDefaultValue(def);
        return a;
    }
    std::string Value(const char* name) const { return block->GetAttributeValue(name).str(); }
    std::string Names() const {
        std::string out;
        for (const auto& a : block->GetAttributes())
            out += a->GetName().str() + " ";
        return out;
    }

    Qvz_WizData data;
    Qvz_MGTWizMain main{"w", false};
    Qvz_Block* block = nullptr;
    std::unique_ptr<Qvz_MGTRCD> page;
};

} // namespace

TEST(CommaDetect, WithoutDataOrActiveBlockNothingHappens) {
    // No design data: the data error, for the read, the write and the batch step.
    Qvz_MGTWizMain main("w", false);
    Qvz_MGTRCD noData(&main);
    EXPECT_FALSE(noData.ReadWizData());
    EXPECT_FALSE(noData.WriteWizData());
    EXPECT_FALSE(noData.DoBatchPage());
    ASSERT_EQ(main.GetMessages().size(), 3u);
    for (const Qvz_Message& m : main.GetMessages()) {
        EXPECT_EQ(m.text, "Tessel Wizard internal data error.");
        EXPECT_FALSE(m.flag1 || m.flag2 || m.flag3);
    }

    // Data but no active block: silently refused, block untouched.
    PageOn p("GT10_CUSTOM");
    p.block->SetIsUsed(false);
    p.Add("DEC_PCOMMA_DETECT", "TRUE");
    p.page->m_decPcommaDetect = 0;
    EXPECT_FALSE(p.page->ReadWizData());
    EXPECT_FALSE(p.page->WriteWizData());
    EXPECT_FALSE(p.page->DoBatchPage());
    EXPECT_TRUE(p.main.GetMessages().empty());
    EXPECT_EQ(p.Value("DEC_PCOMMA_DETECT"), "TRUE");
    EXPECT_EQ(p.page->m_decPcommaDetect, 0);
}

TEST(CommaDetect, ReadCommaValueByFamily) {
    const struct {
        const char* primitive;
        const char* value; // nullptr: no attribute
        bool pad;
        const char* expected;
    } cases[] = {
        // GT11 patterns: eight hexadecimal digits.
        {"GT11_CUSTOM", "10'h17C", true, "0000017C"},
        {"GT11_CUSTOM", "32'hF800017C", true, "F800017C"},
        {"GT11_CUSTOM", "17C", true, "0000017C"},
        {"GT11_CUSTOM", "10'h", true, "00000000"},
        // A literal wider than the attribute keeps its low-order digits.
        {"GT11_CUSTOM", "36'h0F800017C", true, "F800017C"},
        {"GT11_CUSTOM", "40'h12F800017C", true, "F800017C"},
        {"GT11_CUSTOM", "10'h17C", false, "17C"},
        {"GT11_CUSTOM", "10'h3FF", false, "3FF"},
        {"GT11_CUSTOM", "x'hAB'hCD", false, "AB'hCD"},
        // Text that is not hexadecimal is never cut (a cut could split a
        // multi-byte character): it stays whole for the user to see.
        {"GT11_CUSTOM", "32'h\xc3\xa9\xc3\xa9\xc3\xa9\xc3\xa9" "10'h17C", true,
         "\xc3\xa9\xc3\xa9\xc3\xa9\xc3\xa9" "10'h17C"},
        {"GT11_CUSTOM", "32'hGG", true, "GG"},
        // Binary families: ten binary digits, kept as they are.
        {"GT10_CUSTOM", "0011111000", true, "0011111000"},
        {"GT_CUSTOM", "0011111000", false, "0011111000"},
        {"GT10_CUSTOM", "0011111", true, "0011111"},
        {"GT_CUSTOM", "10'b0011111000", true, "10'b0011111000"},
        // A hexadecimal literal there is read as the same ten bits.
        {"GT10_CUSTOM", "10'h17C", true, "0101111100"},
        {"GT_CUSTOM", "10'h0F8", false, "0011111000"},
        {"GT10_CUSTOM", "10'h7", false, "0000000111"},
        {"GT10_CUSTOM", "12'hFFF", false, "1111111111"},
        {"GT10_CUSTOM", "10'h3ff", false, "1111111111"},
        // Not hexadecimal: only the marker goes.
        {"GT10_CUSTOM", "10'hXYZ", false, "XYZ"},
        {"GT10_CUSTOM", "10'h", false, ""},
        {"GT10_CUSTOM", nullptr, true, ""},
        {"GT11_CUSTOM", nullptr, true, ""},
    };
    for (const auto& c : cases) {
        PageOn p(c.primitive);
        Qvz_Attribute* a = c.value ? p.Add("PCOMMA_10B_VALUE", c.value) : nullptr;
        ASSERT_TRUE(p.page->ReadWizData());
        EXPECT_EQ(p.page->ReadCommaValue(a, c.pad), c.expected)
            << c.primitive << " " << (c.value ? c.value : "(none)") << " pad " << c.pad;
    }
}

TEST(CommaDetect, FormatCommaValueByFamily) {
    const struct {
        const char* primitive;
        const char* value;
        bool tenBit;
        const char* expected;
    } cases[] = {
        {"GT11_CUSTOM", "0000017C", true, "10'h17C"},
        {"GT11_CUSTOM", "0000017C", false, "32'h0000017C"},
        {"GT11_CUSTOM", "3FF", true, "10'h3FF"},
        // Fewer than three digits: padded, never read before the start.
        {"GT11_CUSTOM", "7C", true, "10'h07C"},
        {"GT11_CUSTOM", "F", true, "10'h00F"},
        {"GT11_CUSTOM", "", true, "10'h000"},
        // The 32-bit literal always carries eight digits.
        {"GT11_CUSTOM", "7C", false, "32'h0000007C"},
        {"GT11_CUSTOM", "1F800017C", false, "32'hF800017C"},
        {"GT10_CUSTOM", "0011111000", true, "0011111000"},
        {"GT10_CUSTOM", "0011111000", false, "0011111000"},
        {"GT_CUSTOM", "01", true, "01"},
    };
    for (const auto& c : cases) {
        PageOn p(c.primitive);
        Qvz_Attribute* a = p.Add("X", "old");
        ASSERT_TRUE(p.page->ReadWizData());
        p.page->FormatCommaValue(a, c.value, c.tenBit);
        EXPECT_EQ(a->GetValue(), c.expected) << c.primitive << " " << c.value << " " << c.tenBit;
    }
    PageOn p("GT11_CUSTOM");
    p.page->FormatCommaValue(nullptr, "1", true); // skipped, no crash
}

TEST(CommaDetect, FamilyDefaultsAtEveryRead) {
    PageOn p("GT11_CUSTOM");
    auto b10 = std::make_unique<Qvz_Block>("B10", "GT10_CUSTOM", Qvz_Family::GT10);
    Qvz_Block* gt10 = p.data.AddBlock(std::move(b10));

    ASSERT_TRUE(p.page->ReadWizData());
    EXPECT_TRUE(p.page->m_isGT11);
    EXPECT_FALSE(p.page->m_isGT || p.page->m_isGT10);
    EXPECT_EQ(p.page->m_pcommaValue, "11111000");
    EXPECT_EQ(p.page->m_mcommaValue, "00000000");
    EXPECT_EQ(p.page->m_commaMask, "000");

    // Edited fields do not survive the next read.
    p.page->m_pcommaValue = "ABCDEF01";
    p.block->SetIsUsed(false);
    gt10->SetIsUsed(true);
    ASSERT_TRUE(p.page->ReadWizData());
    EXPECT_TRUE(p.page->m_isGT10);
    EXPECT_FALSE(p.page->m_isGT || p.page->m_isGT11);
    EXPECT_EQ(p.page->m_pcommaValue, "0011111000");
    EXPECT_EQ(p.page->m_mcommaValue, "1100000000");
    EXPECT_EQ(p.page->m_commaMask, "0000000000");
    EXPECT_TRUE(p.page->m_isBatch);
}

TEST(CommaDetect, ReadFlagsOnlyForExactTrue) {
    const struct {
        const char* value; // nullptr: no attribute
        int32_t expected;
    } cases[] = {{"TRUE", 1}, {"FALSE", 0}, {"true", 0}, {"", 0}, {nullptr, 0}};
    const char* flags[] = {"QVZX_ONLY_TURNOFF_COMMA", "DEC_PCOMMA_DETECT", "DEC_MCOMMA_DETECT",
                           "ALIGN_COMMA_MSB", "DEC_VALID_COMMA_ONLY"};
    for (const auto& c : cases) {
        PageOn p("GT10_CUSTOM");
        if (c.value)
            for (const char* f : flags)
                p.Add(f, c.value);
        p.page->m_decPcommaDetect = p.page->m_decMcommaDetect = p.page->m_alignCommaMsb =
            p.page->m_decValidCommaOnly = p.page->m_turnOffComma = 7;
        ASSERT_TRUE(p.page->ReadWizData());
        const char* v = c.value ? c.value : "(none)";
        EXPECT_EQ(p.page->m_turnOffComma, c.expected) << v;
        EXPECT_EQ(p.page->m_decPcommaDetect, c.expected) << v;
        EXPECT_EQ(p.page->m_decMcommaDetect, c.expected) << v;
        EXPECT_EQ(p.page->m_alignCommaMsb, c.expected) << v;
        EXPECT_EQ(p.page->m_decValidCommaOnly, c.expected) << v;
    }
}

TEST(CommaDetect, ReadDetectionModes) {
    const struct {
        const char* turnOff;
        const char* detect; // nullptr: no attribute
        const char* ctrl;   // nullptr: no attribute
        int32_t expected;   // the field starts at 5
    } cases[] = {
        {"FALSE", "TRUE", "DYNAMIC", 0},
        {"FALSE", "TRUE", "ALWAYS", 1},
        {"FALSE", "TRUE", "DISABLE", 2},
        // The detect attribute wins over the control choice.
        {"FALSE", "FALSE", "ALWAYS", 2},
        {"FALSE", "FALSE", "DYNAMIC", 2},
        {"FALSE", "FALSE", nullptr, 2},
        {"FALSE", nullptr, "DYNAMIC", 0},
        {"FALSE", "false", "ALWAYS", 1},
        // Turned off: disabled whatever the block says.
        {"TRUE", "TRUE", "ALWAYS", 2},
        {"TRUE", nullptr, nullptr, 2},
        // Nothing to go by: the field keeps its value.
        {"FALSE", "TRUE", nullptr, 5},
        {"FALSE", nullptr, nullptr, 5},
        {"FALSE", "TRUE", "always", 5},
        {"FALSE", "TRUE", "", 5},
    };
    for (const auto& c : cases) {
        PageOn p("GT_CUSTOM");
        p.Add("QVZX_ONLY_TURNOFF_COMMA", c.turnOff);
        for (const char* side : {"P", "M"}) {
            if (c.detect)
                p.Add((std::string(side) + "COMMA_DETECT").c_str(), c.detect);
            if (c.ctrl)
                p.Add((std::string("QVZX_ONLY_") + side + "COMMA_CTRL").c_str(), c.ctrl);
        }
        p.page->m_pcommaMode = p.page->m_mcommaMode = 5;
        ASSERT_TRUE(p.page->ReadWizData());
        const std::string label = std::string(c.turnOff) + "/" + (c.detect ? c.detect : "-") + "/" +
                                  (c.ctrl ? c.ctrl : "-");
        EXPECT_EQ(p.page->m_pcommaMode, c.expected) << label;
        EXPECT_EQ(p.page->m_mcommaMode, c.expected) << label;
    }
}

TEST(CommaDetect, ReadResetsPatternsAndMaskTheBlockForbidsChanging) {
    const struct {
        const char* primitive;
        bool editable;
        const char* p10; // nullptr: no attribute
        const char* p32;
        const char* mask;
        const char *expP, *expMask;
        const char *blockP, *blockMask; // the block's values after the read
    } cases[] = {
        {"GT10_CUSTOM", false, "0101010101", nullptr, "0000011111", "0011111000", "1111111111",
         "0011111000", "1111111111"},
        {"GT10_CUSTOM", true, "0101010101", nullptr, "0000011111", "0101010101", "0000011111",
         "0101010101", "0000011111"},
        // The 32-bit pattern is the fallback when the 10-bit one is missing.
        {"GT11_CUSTOM", false, nullptr, "32'h12345678", "10'h001", "0000017C", "3FF",
         "32'h0000017C", "10'h3FF"},
        {"GT11_CUSTOM", true, nullptr, "32'h12345678", "10'h001", "12345678", "001", "32'h12345678",
         "10'h001"},
        {"GT11_CUSTOM", true, "10'h0AB", "32'h12345678", "10'hF", "000000AB", "00F", "10'h0AB",
         "10'hF"},
        // Neither pattern attribute: the family default stays.
        {"GT11_CUSTOM", true, nullptr, nullptr, nullptr, "11111000", "000", "", ""},
    };
    for (const auto& c : cases) {
        PageOn p(c.primitive);
        const bool gt11 = std::string(c.primitive) == "GT11_CUSTOM";
        const char* pDefault = gt11 ? "32'h0000017C" : "0011111000";
        const char* mDefault = gt11 ? "10'h3FF" : "1111111111";
        if (c.p10)
            p.Add("PCOMMA_10B_VALUE", c.p10, c.editable, gt11 ? "10'h17C" : pDefault);
        if (c.p32)
            p.Add("PCOMMA_32B_VALUE", c.p32, c.editable, pDefault);
        if (c.mask)
            p.Add("COMMA_10B_MASK", c.mask, c.editable, mDefault);
        ASSERT_TRUE(p.page->ReadWizData());
        const std::string label = std::string(c.primitive) + (c.editable ? " editable" : " fixed");
        EXPECT_EQ(p.page->m_pcommaValue, c.expP) << label;
        EXPECT_EQ(p.page->m_commaMask, c.expMask) << label;
        EXPECT_EQ(p.Value(c.p10 ? "PCOMMA_10B_VALUE" : "PCOMMA_32B_VALUE"), c.blockP) << label;
        EXPECT_EQ(p.Value("COMMA_10B_MASK"), c.blockMask) << label;
        if (c.p10 && c.p32) {
            EXPECT_EQ(p.Value("PCOMMA_32B_VALUE"), c.p32) << label;
        }
    }
}

TEST(CommaDetect, ReadAlignCommaWordOnlyWhenPresent) {
    PageOn p("GT10_CUSTOM");
    p.page->m_alignCommaWord = "4";
    ASSERT_TRUE(p.page->ReadWizData());
    EXPECT_EQ(p.page->m_alignCommaWord, "4");
    p.Add("ALIGN_COMMA_WORD", "2");
    ASSERT_TRUE(p.page->ReadWizData());
    EXPECT_EQ(p.page->m_alignCommaWord, "2");
}

TEST(CommaDetect, WriteDetectionModes) {
    const struct {
        bool hasCtrl, hasDetect;
        int32_t mode;
        bool off;
        const char* ctrl; // expected values; "old" means left alone
        const char* detect;
    } cases[] = {
        {true, true, 0, false, "DYNAMIC", "TRUE"},
        {true, true, 1, false, "ALWAYS", "TRUE"},
        {true, true, 2, false, "DISABLE", "FALSE"},
        {true, true, 3, false, "old", "old"},
        {true, true, -1, false, "old", "old"},
        {true, true, 0, true, "DISABLE", "FALSE"},
        {true, true, 7, true, "DISABLE", "FALSE"},
        // Never one without the other.
        {true, false, 0, false, "old", nullptr},
        {true, false, 1, true, "old", nullptr},
        {false, true, 1, false, nullptr, "old"},
        {false, true, 2, true, nullptr, "old"},
    };
    for (const auto& c : cases) {
        PageOn p("GT10_CUSTOM");
        for (const char* side : {"P", "M"}) {
            if (c.hasCtrl)
                p.Add((std::string("QVZX_ONLY_") + side + "COMMA_CTRL").c_str(), "old");
            if (c.hasDetect)
                p.Add((std::string(side) + "COMMA_DETECT").c_str(), "old");
        }
        p.page->m_pcommaMode = p.page->m_mcommaMode = c.mode;
        p.page->m_turnOffComma = c.off;
        ASSERT_TRUE(p.page->WriteWizData());
        const std::string label = std::to_string(c.mode) + (c.off ? " off" : "") +
                                  (c.hasCtrl ? " ctrl" : "") + (c.hasDetect ? " detect" : "");
        for (const char* side : {"P", "M"}) {
            Qvz_Attribute* ctrl = p.block->GetNamedAttribute(
                (std::string("QVZX_ONLY_") + side + "COMMA_CTRL").c_str());
            Qvz_Attribute* detect =
                p.block->GetNamedAttribute((std::string(side) + "COMMA_DETECT").c_str());
            ASSERT_EQ(ctrl != nullptr, c.ctrl != nullptr) << label;
            ASSERT_EQ(detect != nullptr, c.detect != nullptr) << label;
            if (ctrl) {
                EXPECT_EQ(ctrl->GetValue(), c.ctrl) << side << " " << label;
            }
            if (detect) {
                EXPECT_EQ(detect->GetValue(), c.detect) << side << " " << label;
            }
        }
    }
}

TEST(CommaDetect, WriteFlagsAndTurnOff) {
    const struct {
        bool off;
        int32_t pdec, mdec, msb, valid;
        const char *expP, *expM, *expMsb, *expValid, *expOff;
    } cases[] = {
        {false, 1, 0, 1, 0, "TRUE", "FALSE", "TRUE", "FALSE", "FALSE"},
        {false, 0, 1, 0, 1, "FALSE", "TRUE", "FALSE", "TRUE", "FALSE"},
        // Any non-zero value counts as set.
        {false, 2, -1, 9, 3, "TRUE", "TRUE", "TRUE", "TRUE", "FALSE"},
        // Off clears the decoder flags and the MSB alignment, never the
        // valid-comma flag.
        {true, 1, 1, 1, 1, "FALSE", "FALSE", "FALSE", "TRUE", "TRUE"},
        {true, 0, 0, 0, 0, "FALSE", "FALSE", "FALSE", "FALSE", "TRUE"},
    };
    for (const auto& c : cases) {
        PageOn p("GT_CUSTOM");
        for (const char* f : {"QVZX_ONLY_TURNOFF_COMMA", "DEC_PCOMMA_DETECT", "DEC_MCOMMA_DETECT",
                              "ALIGN_COMMA_MSB", "DEC_VALID_COMMA_ONLY", "COMMA_10B_MASK"})
            p.Add(f, "old");
        p.page->m_turnOffComma = c.off;
        p.page->m_decPcommaDetect = c.pdec;
        p.page->m_decMcommaDetect = c.mdec;
        p.page->m_alignCommaMsb = c.msb;
        p.page->m_decValidCommaOnly = c.valid;
        p.page->m_commaMask = "1111100000";
        ASSERT_TRUE(p.page->WriteWizData());
        EXPECT_EQ(p.Value("QVZX_ONLY_TURNOFF_COMMA"), c.expOff);
        EXPECT_EQ(p.Value("DEC_PCOMMA_DETECT"), c.expP) << c.off;
        EXPECT_EQ(p.Value("DEC_MCOMMA_DETECT"), c.expM) << c.off;
        EXPECT_EQ(p.Value("ALIGN_COMMA_MSB"), c.expMsb) << c.off;
        EXPECT_EQ(p.Value("DEC_VALID_COMMA_ONLY"), c.expValid) << c.off;
        EXPECT_EQ(p.Value("COMMA_10B_MASK"), c.off ? "0000000000" : "1111100000");
    }
}

TEST(CommaDetect, WriteAddsNoAttributeTheBlockLacks) {
    for (const char* prim : {"GT_CUSTOM", "GT10_CUSTOM", "GT11_CUSTOM"}) {
        PageOn p(prim);
        p.Add("MGT_DISPLAY_NAME", "Custom");
        ASSERT_TRUE(p.page->ReadWizData());
        p.page->m_turnOffComma = 1;
        ASSERT_TRUE(p.page->WriteWizData());
        EXPECT_EQ(p.Names(), "MGT_DISPLAY_NAME ") << prim;
    }
}

TEST(CommaDetect, WritePatternsInTheFamilyNotation) {
    const struct {
        const char* primitive;
        const char* existing; // attributes the block has, in order
        const char *p, *m, *mask;
        const char* names;  // the block's attributes afterwards
        const char* values; // their values
    } cases[] = {
        // GT11: the 32-bit attributes are added (in write order) or replaced.
        {"GT11_CUSTOM", "PCOMMA_10B_VALUE MCOMMA_10B_VALUE COMMA_10B_MASK", "0000017C", "00000283",
         "3FF",
         "PCOMMA_10B_VALUE MCOMMA_10B_VALUE COMMA_10B_MASK PCOMMA_32B_VALUE MCOMMA_32B_VALUE ",
         "10'h17C 10'h283 10'h3FF 32'h0000017C 32'h00000283 "},
        {"GT11_CUSTOM", "MCOMMA_32B_VALUE PCOMMA_10B_VALUE MCOMMA_10B_VALUE", "F800017C",
         "07FFFE83", "3FF", "MCOMMA_32B_VALUE PCOMMA_10B_VALUE MCOMMA_10B_VALUE PCOMMA_32B_VALUE ",
         "32'h07FFFE83 10'h17C 10'hE83 32'hF800017C "},
        // Only the 32-bit ones: written, the 10-bit ones not added.
        {"GT11_CUSTOM", "PCOMMA_32B_VALUE MCOMMA_32B_VALUE", "0000017C", "00000283", "3FF",
         "PCOMMA_32B_VALUE MCOMMA_32B_VALUE ", "32'h0000017C 32'h00000283 "},
        // Short fields (edited elsewhere) are widened, not read past.
        {"GT11_CUSTOM", "PCOMMA_10B_VALUE COMMA_10B_MASK", "7C", "0", "F",
         "PCOMMA_10B_VALUE COMMA_10B_MASK PCOMMA_32B_VALUE ", "10'h07C 10'h00F 32'h0000007C "},
        // Binary families: digits unchanged, nothing added.
        {"GT10_CUSTOM", "PCOMMA_10B_VALUE MCOMMA_10B_VALUE COMMA_10B_MASK", "0011111000",
         "1100000000", "1111111000", "PCOMMA_10B_VALUE MCOMMA_10B_VALUE COMMA_10B_MASK ",
         "0011111000 1100000000 1111111000 "},
        {"GT_CUSTOM", "PCOMMA_10B_VALUE PCOMMA_32B_VALUE", "0101111100", "1010000011", "1111111000",
         "PCOMMA_10B_VALUE PCOMMA_32B_VALUE ", "0101111100 old "},
        {"GT10_CUSTOM", "PCOMMA_32B_VALUE", "0101111100", "1", "1", "PCOMMA_32B_VALUE ", "old "},
    };
    for (const auto& c : cases) {
        PageOn p(c.primitive);
        for (const QString& n : QString(c.existing).split(' '))
            p.Add(n.toStdString().c_str(), "old");
        ASSERT_TRUE(p.page->ReadWizData());
        p.page->m_pcommaValue = c.p;
        p.page->m_mcommaValue = c.m;
        p.page->m_commaMask = c.mask;
        ASSERT_TRUE(p.page->WriteWizData());
        EXPECT_EQ(p.Names(), c.names) << c.primitive << " " << c.existing;
        std::string values;
        for (const auto& a : p.block->GetAttributes())
            values += a->GetValue().str() + " ";
        EXPECT_EQ(values, c.values) << c.primitive << " " << c.existing;
    }
}

TEST(CommaDetect, ApplyTurnOffClearsAndRestores) {
    for (const char* prim : {"GT10_CUSTOM", "GT11_CUSTOM"}) {
        const bool gt11 = std::string(prim) == "GT11_CUSTOM";
        PageOn p(prim);
        p.Add("DEC_PCOMMA_DETECT", "TRUE");
        p.Add("DEC_MCOMMA_DETECT", "FALSE");
        p.Add("ALIGN_COMMA_MSB", "TRUE");
        p.Add("COMMA_10B_MASK", gt11 ? "10'h1F" : "0001111111");
        ASSERT_TRUE(p.page->ReadWizData());
        p.page->m_decValidCommaOnly = 1;

        p.page->m_turnOffComma = 1;
        p.page->ApplyTurnOffComma();
        EXPECT_EQ(p.page->m_decPcommaDetect, 0) << prim;
        EXPECT_EQ(p.page->m_decMcommaDetect, 0) << prim;
        EXPECT_EQ(p.page->m_alignCommaMsb, 0) << prim;
        EXPECT_EQ(p.page->m_commaMask, gt11 ? "000" : "0000000000") << prim;
        EXPECT_EQ(p.page->m_decValidCommaOnly, 1) << prim;

        p.page->m_turnOffComma = 0;
        p.page->ApplyTurnOffComma();
        EXPECT_EQ(p.page->m_decPcommaDetect, 1) << prim;
        EXPECT_EQ(p.page->m_decMcommaDetect, 0) << prim;
        EXPECT_EQ(p.page->m_alignCommaMsb, 1) << prim;
        EXPECT_EQ(p.page->m_commaMask, gt11 ? "01F" : "0001111111") << prim;
    }
    // Attributes the block lacks leave their fields alone.
    PageOn p("GT10_CUSTOM");
    ASSERT_TRUE(p.page->ReadWizData());
    p.page->m_decPcommaDetect = 1;
    p.page->m_alignCommaMsb = 1;
    p.page->m_commaMask = "1010101010";
    p.page->ApplyTurnOffComma();
    EXPECT_EQ(p.page->m_decPcommaDetect, 1);
    EXPECT_EQ(p.page->m_alignCommaMsb, 1);
    EXPECT_EQ(p.page->m_commaMask, "1010101010");
}

TEST(CommaDetect, BatchStepLeavesWrittenFormUnchanged) {
    // A block already in the written form is a fixed point of read and write.
    PageOn p("GT11_CUSTOM");
    const char* attrs[][2] = {{"QVZX_ONLY_TURNOFF_COMMA", "FALSE"},
                              {"DEC_PCOMMA_DETECT", "TRUE"},
                              {"DEC_MCOMMA_DETECT", "FALSE"},
                              {"ALIGN_COMMA_MSB", "TRUE"},
                              {"DEC_VALID_COMMA_ONLY", "FALSE"},
                              {"QVZX_ONLY_PCOMMA_CTRL", "DYNAMIC"},
                              {"PCOMMA_DETECT", "TRUE"},
                              {"QVZX_ONLY_MCOMMA_CTRL", "DISABLE"},
                              {"MCOMMA_DETECT", "FALSE"},
                              {"PCOMMA_10B_VALUE", "10'h17C"},
                              {"PCOMMA_32B_VALUE", "32'h0000017C"},
                              {"MCOMMA_10B_VALUE", "10'h283"},
                              {"MCOMMA_32B_VALUE", "32'h00000283"},
                              {"COMMA_10B_MASK", "10'h3FF"},
                              {"ALIGN_COMMA_WORD", "2"}};
    for (const auto& a : attrs)
        p.Add(a[0], a[1]);
    const Qvz_Block before(*p.block);
    for (int run = 0; run < 2; ++run) {
        ASSERT_TRUE(p.page->DoBatchPage());
        EXPECT_TRUE(*p.block == before) << run;
    }
    EXPECT_TRUE(p.main.GetMessages().empty());
}

TEST(CommaDetect, GuiControllerFollowsTheCommonPattern) {
    App();
    PageOn p("GT10_CUSTOM");
    EXPECT_FALSE(p.page->CreateGuiDlg(nullptr));
    EXPECT_EQ(p.page->GetGuiDlg(), nullptr);
    QWidget parent;
    ASSERT_TRUE(p.page->CreateGuiDlg(&parent));
    ASSERT_NE(p.page->GetGuiDlg(), nullptr);
    EXPECT_EQ(p.page->GetGuiDlg()->parent(), &parent);
    EXPECT_EQ(p.page->GetGuiDlg()->pageName(), "Receiver Comma Detect Setup");
    EXPECT_TRUE(p.main.GetMessages().empty());
}
