#include "Qvz_MGTWizMain.h"
#include "Qvz_MGTWizPage.h"
#include "TestApp.h"

#include <QApplication>
#include <QComboBox>
#include <gtest/gtest.h>

TEST(SizedLiteral, FormatsBinaryAndHexadecimal) {
    const struct {
        const char* digits;
        int radix;
        const char* expected;
    } cases[] = {
        {"0101", 0, "4'b0101"}, {"1C", 1, "8'h1C"}, {"1C", 7, "8'h1C"},
        {"", 0, "0'b"},         {"", 1, "0'h"},     {"0000000000", 0, "10'b0000000000"},
        {"17C", 2, "12'h17C"},
    };
    for (const auto& c : cases)
        EXPECT_EQ(Qvz_MGTWizPage::GetSizedLiteral(c.digits, c.radix), c.expected) << c.digits;
}

TEST(SizedLiteral, StripsAfterTheFirstMarker) {
    const struct {
        const char* value;
        int radix;
        const char* expected;
    } cases[] = {
        {"4'b0101", 0, "0101"},     {"4'b0101", 1, "4'b0101"},
        {"8'h1C", 1, "1C"},         {"8'h1C", 0, "8'h1C"}, // radix 0 looks for 'b only
        {"8'h1C", 2, "8'h1C"},                             // only radix 1 means hexadecimal
        {"0101", 0, "0101"},        {"'b", 0, ""},
        {"2'b01'b10", 0, "01'b10"}, {"", 1, ""},
    };
    for (const auto& c : cases)
        EXPECT_EQ(Qvz_MGTWizPage::StripSizedLiteral(c.value, c.radix), c.expected) << c.value;
}

TEST(SeqMask, CountsZerosAgainstTheLength) {
    const struct {
        const char* mask;
        const char* len;
        bool ok;
    } cases[] = {
        {"1111", "0", true},           {"0011", "1", false}, {"0011", "2", true},
        {"0000", "4", true},           {"0000", "3", false}, {"", "0", true},
        {"0x0y", "2", true},           {"00", "abc", false}, {"00", "-1", false},
        {"0", "99999999999999", true},
    };
    for (const auto& c : cases)
        EXPECT_EQ(Qvz_MGTWizPage::ValidateSeqMask(c.mask, c.len), c.ok) << c.mask << "/" << c.len;
}

TEST(BinaryValue, DigitsTestAndSizedWrites) {
    const struct {
        const char* text;
        bool digits;
    } digitCases[] = {{"0123456789", true}, {"", false},   {"12a", false},
                      {" 12", false},       {"-1", false}, {"7", true}};
    for (const auto& c : digitCases)
        EXPECT_EQ(Qvz_MGTWizPage::IsAllDigits(c.text), c.digits) << c.text;

    const struct {
        const char* digits;
        bool sized;
        const char* written;
    } writeCases[] = {{"0101", true, "4'b0101"}, {"0101", false, "0101"}, {"", true, "0'b"}};
    for (const auto& c : writeCases) {
        Qvz_Attribute a("CHAN_BOND_SEQ_1_MASK", "x");
        Qvz_MGTWizPage::SetBinaryValue(&a, c.digits, c.sized);
        EXPECT_EQ(a.GetValue(), c.written) << c.digits;
        // What is written reads back as the same digits.
        EXPECT_EQ(Qvz_MGTWizPage::GetBinaryValue(&a), c.digits) << c.digits;
    }
    Qvz_MGTWizPage::SetBinaryValue(nullptr, "1", true); // no attribute: nothing to write
}

// Reading the last N digits, or the text after a prefix, counts bytes; a cut
// inside a multi-byte character would leave a stray byte in the value that
// the page writes back, and a design no file can hold.
TEST(BinaryValue, CutsNeverSplitACharacter) {
    const struct {
        const char* value;
        const char* digits;
    } reads[] = {
        {"2'b\xc3\xa9", "\xc3\xa9"},           // the whole character
        {"1'b\xc3\xa9", ""},                   // its second byte only: nothing
        {"2'b10\xe2\x82\xac", ""},             // inside a three-byte character
        {"3'b10\xe2\x82\xac", "\xe2\x82\xac"}, // whole again
        {"4'b10\xe2\x82\xac", "0\xe2\x82\xac"},
        {"2'b\xc3\xa9"
         "1",
         "1"},
    };
    for (const auto& c : reads) {
        Qvz_Attribute a("RXAFEEQ", c.value);
        EXPECT_EQ(Qvz_MGTWizPage::GetBinaryValue(&a), c.digits) << c.value;
    }

    const struct {
        const char* text;
        std::size_t pos;
        const char* rest;
    } cuts[] = {
        {"abc", 1, "bc"},
        {"abc", 3, ""},
        {"abc", 99, ""},
        {"\xc3\xa9x", 1, "x"},
        {"\xc3\xa9x", 0, "\xc3\xa9x"},
        {"a\xe2\x82\xac", 2, ""},
        {"a\xe2\x82\xac"
         "b",
         3, "b"},
    };
    for (const auto& c : cuts)
        EXPECT_EQ(Qvz_MGTWizPage::TextFrom(c.text, c.pos), c.rest) << c.text << " @" << c.pos;
}

TEST(AttributeFlags, ReadTrueOnlyAndWriteOnlyPresent) {
    Qvz_Block b("GT_CUSTOM", "GT_CUSTOM", Qvz_Family::GT);
    b.AddAttribute("ON", "TRUE");
    b.AddAttribute("LOWER", "true");
    b.AddAttribute("OFF", "FALSE");
    EXPECT_TRUE(Qvz_MGTWizPage::IsTrue(&b, "ON"));
    EXPECT_FALSE(Qvz_MGTWizPage::IsTrue(&b, "LOWER"));
    EXPECT_FALSE(Qvz_MGTWizPage::IsTrue(&b, "OFF"));
    EXPECT_FALSE(Qvz_MGTWizPage::IsTrue(&b, "MISSING"));
    EXPECT_FALSE(Qvz_MGTWizPage::IsTrue(nullptr, "ON"));

    Qvz_MGTWizPage::SetIfPresent(&b, "OFF", Qvz_MGTWizPage::BoolText(true));
    Qvz_MGTWizPage::SetIfPresent(&b, "MISSING", "TRUE");
    Qvz_MGTWizPage::SetIfPresent(nullptr, "OFF", "FALSE");
    EXPECT_EQ(b.GetAttributeValue("OFF"), "TRUE");
    EXPECT_EQ(b.GetNamedAttribute("MISSING"), nullptr);
    EXPECT_STREQ(Qvz_MGTWizPage::BoolText(false), "FALSE");
}

namespace {

struct EncodingCase {
    const char* name;
    const char* speed;
    const char* speedDefault;
    // Legal lists per encoding; nullptr: attribute absent.
    const char* none;
    const char* b8b10;
    const char* b64b66;
    bool result, allowNone, allow8, allow64;
};

void AddList(Qvz_Block& b, const char* attr, const char* list) {
    if (!list)
        return;
    Qvz_Attribute* a = b.AddAttribute(attr, "");
    QString l(list);
    for (const QString& v : l.split(',', Qt::SkipEmptyParts))
        a->GetLegalValues().Add(StringBase::FromQString(v));
}

} // namespace

TEST(EncodingChoices, FollowThePmaSpeedLists) {
    const EncodingCase cases[] = {
        {"no lists", "0_32", "0_32", nullptr, nullptr, nullptr, true, true, true, true},
        {"changed speed", "1_32", "0_32", nullptr, nullptr, nullptr, false, true, true, true},
        {"empty 64b list", "0_32", "0_32", nullptr, nullptr, "", true, true, true, false},
        {"listed", "1_32", "0_32", "1_32", "0_32,1_32", "0_32", false, true, true, false},
        {"case counts", "1_32", "1_32", "1_32", "1_32", "1_32", true, true, true, true},
        {"case differs", "a_32", "a_32", "A_32", "a_32", "", true, false, true, false},
    };
    for (const auto& c : cases) {
        Qvz_Block b("I", "GT10_CUSTOM", Qvz_Family::GT10);
        Qvz_Attribute* s = b.AddAttribute("PMA_SPEED", c.speed);
        s->SetDefaultValue(c.speedDefault);
        AddList(b, "QVZ_PMASPD_ENC_NONE", c.none);
        AddList(b, "QVZ_PMASPD_ENC_8B10B", c.b8b10);
        AddList(b, "QVZ_PMASPD_ENC_64B66B", c.b64b66);
        bool n = false, e8 = false, e64 = false;
        EXPECT_EQ(Qvz_MGTWizPage::GetGT10EncodingChoices(&b, n, e8, e64), c.result) << c.name;
        EXPECT_EQ(n, c.allowNone) << c.name;
        EXPECT_EQ(e8, c.allow8) << c.name;
        EXPECT_EQ(e64, c.allow64) << c.name;
    }
    bool n = false, e8 = false, e64 = false;
    EXPECT_FALSE(Qvz_MGTWizPage::GetGT10EncodingChoices(nullptr, n, e8, e64));
    EXPECT_TRUE(n && e8 && e64);
    Qvz_Block noSpeed("I", "GT10_CUSTOM", Qvz_Family::GT10);
    AddList(noSpeed, "QVZ_PMASPD_ENC_64B66B", "");
    n = e8 = e64 = false;
    EXPECT_FALSE(Qvz_MGTWizPage::GetGT10EncodingChoices(&noSpeed, n, e8, e64));
    EXPECT_TRUE(n && e8 && e64);
}

TEST(ComboHelpers, SelectOnlyExactText) {
    TestApp();
    QComboBox combo;
    combo.addItems({"1", "2", "4", "Custom"});
    combo.setCurrentIndex(1);
    EXPECT_EQ(Qvz_WizPage::GetComboBoxIndex(&combo, "4"), 2);
    EXPECT_EQ(Qvz_WizPage::GetComboBoxIndex(&combo, "custom"), -1);
    EXPECT_EQ(Qvz_WizPage::GetComboBoxIndex(nullptr, "4"), -1);
    EXPECT_FALSE(Qvz_WizPage::SetComboBoxText(&combo, "8"));
    EXPECT_EQ(combo.currentIndex(), 1);
    EXPECT_TRUE(Qvz_WizPage::SetComboBoxText(&combo, "Custom"));
    EXPECT_EQ(combo.currentIndex(), 3);
}
