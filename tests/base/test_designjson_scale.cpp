// Design data a host hands over through the API rather than a file: text that
// is not UTF-8 must still save to something readable, and big designs must
// read without a name lookup per item.

#include "Qvz_DesignJson.h"

#include <gtest/gtest.h>

#include <string>

namespace {

Qvz_WizData Reload(const Qvz_WizData& d) {
    Qvz_WizData back;
    QString err;
    EXPECT_TRUE(Qvz_DesignJson::Load(Qvz_DesignJson::Save(d), "saved", back, err))
        << err.toStdString();
    return back;
}

} // namespace

TEST(DesignJsonText, SavedTextAlwaysReloadsAndKeepsValidUtf8) {
    const struct {
        const char* text;
        bool valid;
    } cases[] = {
        {"plain", true},
        {"\xc3\xa9t\xc3\xa9 \xce\xa9", true}, // two-byte characters
        {"\xe2\x82\xac", true},               // three bytes
        {"\xf4\x8f\xbf\xbf", true},           // the last code point
        {"Latin-1 \xe9t\xe9", false},         // a host's 8-bit text
        {"cut \xe2\x82", false},              // a character cut short
        {"\xc0\xaf", false},                  // overlong
        {"\xed\xa0\x80", false},              // an encoded surrogate
        {"\xf5\x80\x80\x80", false},          // past the last code point
        {"\xff\xfe", false},
        {"\x80 lone continuation", false},
    };
    for (const auto& c : cases) {
        Qvz_WizData d;
        d.Target().fileName = c.text;
        auto b = std::make_unique<Qvz_Block>(c.text, "GT10_CUSTOM", Qvz_Family::GT10);
        b->AddAttribute(c.text, c.text)->GetLegalValues().Add(c.text);
        b->AddPin(c.text, "IN")->SetAttributeValue(c.text, c.text);
        d.AddBlock(std::move(b));
        d.AddSignal(c.text, false, "")->SetAttributeValue(c.text, c.text);

        const Qvz_WizData back = Reload(d);
        ASSERT_EQ(back.GetBlocks().size(), 1u) << c.text;
        const StringBase name = back.GetBlocks()[0]->GetName();
        if (c.valid) {
            EXPECT_TRUE(back == d) << c.text;
        } else {
            EXPECT_NE(name.str().find("\xef\xbf\xbd"), std::string::npos) << c.text;
            EXPECT_EQ(back.GetBlocks()[0]->GetAttributeValue(name), name) << c.text;
            // The repaired text is stable from then on.
            EXPECT_TRUE(Reload(back) == back) << c.text;
        }
    }
}

TEST(DesignJsonText, AppendNewKeepsOrderAndFlags) {
    Qvz_WizData d;
    EXPECT_EQ(d.AppendNewBlock(nullptr), nullptr);
    EXPECT_EQ(d.AppendNewSignal(nullptr), nullptr);
    d.AddSignal("FIRST", false, "");
    auto s = std::make_unique<Qvz_Signal>("SECOND");
    s->SetIsConst1(true); // not used: AddSignal would have set that
    Qvz_Signal* added = d.AppendNewSignal(std::move(s));
    ASSERT_EQ(d.GetSignals().size(), 2u);
    EXPECT_EQ(d.GetSignals()[1].get(), added);
    EXPECT_FALSE(added->IsUsed());
    EXPECT_TRUE(added->IsConst1());
    Qvz_Block* b = d.AppendNewBlock(std::make_unique<Qvz_Block>("B", "GT_CUSTOM", Qvz_Family::GT));
    EXPECT_EQ(d.GetNamedBlock("B"), b);
}

TEST(DesignJsonText, DuplicateNamesAmongManyAreStillFound) {
    // The last name repeats the first: found by the set, not by neighbours.
    std::string sigs, blocks;
    const int n = 3000;
    for (int i = 0; i < n; ++i) {
        const std::string k = std::to_string(i % (n - 1));
        sigs += (i ? "," : "") + std::string("{\"name\": \"S") + k + "\"}";
        blocks +=
            (i ? "," : "") + std::string("{\"name\": \"B") + k + "\", \"primitive\": \"GT_X\"}";
    }
    const std::string head = "{\"format\": \"velomux-design-data\", \"version\": 1, ";
    Qvz_WizData d;
    QString err;
    EXPECT_FALSE(Qvz_DesignJson::Load(
        QByteArray::fromStdString(head + "\"signals\": [" + sigs + "]}"), "in.json", d, err));
    EXPECT_TRUE(err.contains("$.signals[2999].name: duplicate signal name \"S0\""))
        << err.toStdString();
    EXPECT_FALSE(Qvz_DesignJson::Load(
        QByteArray::fromStdString(head + "\"blocks\": [" + blocks + "]}"), "in.json", d, err));
    EXPECT_TRUE(err.contains("$.blocks[2999].name: duplicate block name \"B0\""))
        << err.toStdString();
}

TEST(DesignJsonText, EscapedAndPlainKeysAreTheSameKey) {
    Qvz_WizData d;
    QString err;
    const QByteArray text = R"({"format": "velomux-design-data", "version": 1, "\u0076ersion": 1})";
    EXPECT_FALSE(Qvz_DesignJson::Load(text, "in.json", d, err));
    EXPECT_TRUE(err.contains("duplicate key \"version\"")) << err.toStdString();
    // Keys differing only by an escape that decodes differently are not duplicates.
    EXPECT_TRUE(Qvz_DesignJson::Load(
        R"({"format": "velomux-design-data", "version": 1, "blocks": [], "target": {"file_name": "a\"b"}})",
        "in.json", d, err))
        << err.toStdString();
}

TEST(DesignJsonText, TheEarliestRepeatedKeyIsReported) {
    const struct {
        const char* text;
        const char* mustContain;
    } cases[] = {
        // The outer object's repeat comes first, though the inner object closes first.
        {"{\"format\": 1, \"format\": 2, \"target\": {\"file_name\": 1,\n\"file_name\": 2}}",
         "in.json:1:15: duplicate key \"format\""},
        {"{\"target\": {\"file_name\": 1,\n\"file_name\": 2}, \"format\": 1, \"format\": 2}",
         "in.json:2:1: duplicate key \"file_name\""},
        {"{\"a\": 1, \"b\": 2, \"a\": 3, \"a\": 4}", "in.json:1:18: duplicate key \"a\""},
        {"[{\"x\": 1}, {\"x\": 2}, {\"y\": 1, \"\\u0079\": 2}]",
         "in.json:1:31: duplicate key \"y\""},
        {"{\"k\": {\"k\": {\"k\": 1}}, \"v\": [\"v\", \"v\"], \"w\": 1,\n \"w\": 2}",
         "in.json:2:2: duplicate key \"w\""},
    };
    for (const auto& c : cases) {
        Qvz_WizData d;
        QString err;
        EXPECT_FALSE(Qvz_DesignJson::Load(c.text, "in.json", d, err)) << c.text;
        EXPECT_TRUE(err.contains(c.mustContain))
            << err.toStdString() << "\nexpected " << c.mustContain;
    }
}
