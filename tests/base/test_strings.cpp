#include "Port_StringBase.h"
#include "Qvz_StrArray.h"

#include <climits>
#include <gtest/gtest.h>

using Port::StringBase;

TEST(AToI, ReadsDecimalPrefixAndSaturates) {
    const struct {
        const char* text;
        int expected;
    } cases[] = {
        {"0", 0},
        {"42", 42},
        {"  17", 17},
        {"\t-8", -8},
        {"+5", 5},
        {"12abc", 12},
        {"abc", 0},
        {"", 0},
        {"-", 0},
        {"+-3", 0},
        {"2147483647", INT_MAX},
        {"2147483648", INT_MAX},
        {"99999999999999999999999", INT_MAX},
        {"-2147483648", INT_MIN},
        {"-2147483649", INT_MIN},
        {"-99999999999999999999999", INT_MIN},
        {"0000000000000000000000012", 12},
        {"4 5", 4},
    };
    for (const auto& c : cases)
        EXPECT_EQ(UT_STR::AToI(c.text), c.expected) << '"' << c.text << '"';
    EXPECT_EQ(UT_STR::AToI(static_cast<const char*>(nullptr)), 0);
}

TEST(StringBase, CompareIsExactAndCaseSensitiveForBothTypes) {
    for (int type : {0, 1}) {
        EXPECT_EQ(StringBase("TRUE").Compare("TRUE", type), 0);
        EXPECT_NE(StringBase("TRUE").Compare("true", type), 0);
        EXPECT_NE(StringBase("TRUE").Compare("TRUE ", type), 0);
        EXPECT_NE(StringBase("").Compare("x", type), 0);
        EXPECT_EQ(StringBase("").Compare(StringBase(), type), 0);
    }
}

TEST(StringBase, IndexOfStringFindsFirstOccurrenceOrAllOnes) {
    const StringBase s("10G Custom Custom");
    EXPECT_EQ(s.GetIndexOfString("Custom", 0), 4u);
    EXPECT_EQ(s.GetIndexOfString("10G", 0), 0u);
    EXPECT_EQ(s.GetIndexOfString("custom", 0), StringBase::npos);
    EXPECT_EQ(StringBase::npos, static_cast<std::size_t>(-1));
    EXPECT_EQ(StringBase("x").GetIndexOfString("", 0), 0u);
}

TEST(StringBase, FormatTruncateAndSlices) {
    StringBase s;
    EXPECT_EQ(s.Format("%d'b%s", 4, "0101"), 7);
    EXPECT_EQ(s, "4'b0101");
    s.Truncate(3);
    EXPECT_EQ(s, "4'b");
    s.Truncate(10);
    EXPECT_EQ(s, "4'b");
    EXPECT_EQ(StringBase("abc").Mid(5), "");
    EXPECT_EQ(StringBase("abc").Mid(1, 99), "bc");
    EXPECT_EQ(StringBase("abc").Right(5), "abc");
    EXPECT_EQ(StringBase("abc").GetAt(3), '\0');
    StringBase long_;
    long_.Format("%0500d", 7);
    EXPECT_EQ(long_.GetLength(), 500u);
}

TEST(StrArray, OutOfRangeReadsEmptyAndWritesGrow) {
    Qvz_StrArray a;
    EXPECT_TRUE(a.IsEmpty());
    EXPECT_EQ(a.GetAt(0), "");
    EXPECT_EQ(a.GetAt(-1), "");
    a.SetAt(3, "d");
    ASSERT_EQ(a.GetSize(), 4);
    EXPECT_EQ(a.GetAt(0), "");
    EXPECT_EQ(a.GetAt(3), "d");
    a.SetAt(-2, "x");
    EXPECT_EQ(a.GetSize(), 4);
    EXPECT_EQ(a.Add("b"), 4);
    EXPECT_TRUE(a.Contains("b"));
    EXPECT_FALSE(a.Contains("B"));
    a.Sort();
    EXPECT_EQ(a.GetAt(4), "d");
    EXPECT_EQ(a.GetAt(3), "b");
}
