#include "Qvz_MGTRX.h"
#include "Qvz_MGTRXGui.h"
#include "Qvz_MGTRXWidget.h"
#include "Qvz_MGTWizMain.h"
#include "TestApp.h"
#include "Wg_WizardPage.h"

#include <QApplication>
#include <QWidget>
#include <gtest/gtest.h>

#include <initializer_list>
#include <memory>
#include <string>
#include <vector>

namespace {

struct Attr {
    const char* name;
    const char* value;
    const char* def = nullptr; // nullptr: the value
    bool editable = true;
    std::vector<const char*> legal = {};
};

// One wizard main over design data with one active block of the given primitive.
struct Fixture {
    Qvz_WizData data;
    Qvz_RecordingSink sink;
    Qvz_MGTWizMain main{"test", false};
    Qvz_Block* block = nullptr;

    explicit Fixture(std::initializer_list<Attr> attrs, const char* prim = "GT10_CUSTOM",
                     bool gt = false, bool gt10 = true, bool gt11 = false) {
        data.Target().supportsGT = gt;
        data.Target().supportsGT10 = gt10;
        data.Target().supportsGT11 = gt11;
        auto b = std::make_unique<Qvz_Block>("INST", prim, Qvz_FamilyOfPrimitive(prim));
        b->SetIsUsed(true);
        block = data.AddBlock(std::move(b));
        for (const Attr& a : attrs)
            Add(a);
        main.SetWizData(&data);
        main.SetMessageSink(&sink);
        main.m_batchMode = true;
    }
    void Add(const Attr& a) {
        Qvz_Attribute* x = block->AddAttribute(a.name, a.value);
        if (a.def)
            x->SetDefaultValue(a.def);
        x->SetEditable(a.editable);
        for (const char* l : a.legal)
            x->GetLegalValues().Add(l);
    }
    std::vector<std::string> Messages() const {
        std::vector<std::string> out;
        for (const auto& m : sink.messages) {
            EXPECT_FALSE(m.flag1 || m.flag2 || m.flag3) << m.text.str();
            out.push_back(m.text.str());
        }
        return out;
    }
    std::string Value(const char* name) const { return block->GetAttributeValue(name).str(); }
};

QApplication& App() {
    return TestApp();
}

const char* kThresholdMessage = "The value of RX_LOS_THRESHOLD must be at least as big as the "
                                "value of RX_LOS_INVLID_INCR.";

} // namespace

TEST(RxPage, KeepsTheDeviceFlagsTheMainHadAtConstruction) {
    Fixture f({}, "GT11_CUSTOM", true, false, true);
    Qvz_MGTRX page(&f.main);
    f.main.m_supportsMGT3 = false;
    f.main.m_supportsMGT10 = true;
    EXPECT_TRUE(page.m_supportsMGT3);
    EXPECT_FALSE(page.m_supportsMGT10);
    EXPECT_TRUE(page.m_supportsMGT11);
}

TEST(RxPage, WithoutDataOrBlock) {
    Qvz_MGTWizMain noData("test", false);
    Qvz_MGTRX idle(&noData);
    EXPECT_TRUE(idle.ReadWizData());
    EXPECT_TRUE(idle.WriteWizData());
    EXPECT_TRUE(idle.DoBatchPage());

    Fixture f({{"RX_LOS_THRESHOLD", "8"}});
    f.block->SetIsUsed(false);
    Qvz_MGTRX page(&f.main);
    EXPECT_FALSE(page.ReadWizData());
    EXPECT_EQ(f.Messages(), std::vector<std::string>{"Tessel Wizard internal data error."});
    // The write fails silently.
    EXPECT_FALSE(page.WriteWizData());
    EXPECT_EQ(f.sink.messages.size(), 1u);
    EXPECT_FALSE(page.DoBatchPage());
}

TEST(RxPage, DecodingResolution) {
    struct Case {
        const char* what;
        const char* decodeUse; // nullptr: absent
        bool decodeUseEditable;
        const char* decoding;  // QVZX_ONLY_DECODING, nullptr: absent
        const char* decStatic; // QVZX_ONLY_DEC_STATIC, nullptr: absent
        const char* speed;     // PMA_SPEED, nullptr: absent
        // PMA speeds listed for none / 8B10B / 64B66B; "-" leaves the list out.
        const char* encNone;
        const char* enc8;
        const char* enc64;
        bool deviceGT;
        int mode;
        int stat;
    };
    const Case cases[] = {
        {"disable, none allowed", nullptr, true, "DISABLE", nullptr, nullptr, "-", "-", "-", false,
         0, 0},
        {"disable, none forbidden", nullptr, true, "DISABLE", "64B66B", "S1", "", "-", "-", false,
         2, 1},
        {"dynamic, both allowed", nullptr, true, "DYNAMIC", nullptr, nullptr, "-", "-", "-", false,
         1, 0},
        {"dynamic, only 8B10B", nullptr, true, "DYNAMIC", "64B66B", "S1", "-", "S1", "", false, 2,
         1},
        {"dynamic, neither", nullptr, true, "DYNAMIC", nullptr, "S1", "-", "", "", false, 0, 0},
        {"dynamic on a first-family device", nullptr, true, "DYNAMIC", nullptr, nullptr, "-", "-",
         "-", true, 2, 0},
        {"static 64B66B", nullptr, true, "STATIC", "64B66B", nullptr, "-", "-", "-", false, 2, 1},
        {"static 8B10B", nullptr, true, "STATIC", "8B10B", nullptr, "-", "-", "-", false, 2, 0},
        {"static, neither allowed", nullptr, true, "STATIC", "8B10B", "S1", "-", "", "", false, 0,
         0},
        {"static 8B10B not allowed", nullptr, true, "STATIC", "8B10B", "S1", "-", "", "S1", false,
         2, 1},
        {"static 64B66B not allowed", nullptr, true, "STATIC", "64B66B", "S1", "-", "S1", "", false,
         2, 0},
        {"speed lists match case-sensitively", nullptr, true, "STATIC", "64B66B", "s1", "-", "s1",
         "S1", false, 2, 0},
        {"other static text means 64B66B", nullptr, true, "STATIC", "8b10b", nullptr, "-", "-", "-",
         false, 2, 1},
        {"editable FALSE wins", "FALSE", true, "STATIC", "64B66B", nullptr, "-", "-", "-", false, 0,
         0},
        {"fixed FALSE is ignored", "FALSE", false, "STATIC", "64B66B", nullptr, "-", "-", "-",
         false, 2, 1},
        {"TRUE changes nothing", "TRUE", true, "DISABLE", nullptr, nullptr, "-", "-", "-", false, 0,
         0},
        {"no decoding attribute keeps the mode", nullptr, true, nullptr, "64B66B", nullptr, "-",
         "-", "-", false, 0, 1},
    };
    for (const Case& c : cases) {
        Fixture f({}, "GT10_CUSTOM", c.deviceGT, true, false);
        if (c.decodeUse)
            f.Add({"RX_DECODE_USE", c.decodeUse, nullptr, c.decodeUseEditable});
        if (c.decoding)
            f.Add({"QVZX_ONLY_DECODING", c.decoding});
        if (c.decStatic)
            f.Add({"QVZX_ONLY_DEC_STATIC", c.decStatic});
        if (c.speed)
            f.Add({"PMA_SPEED", c.speed});
        const std::pair<const char*, const char*> lists[] = {{"QVZ_PMASPD_ENC_NONE", c.encNone},
                                                             {"QVZ_PMASPD_ENC_8B10B", c.enc8},
                                                             {"QVZ_PMASPD_ENC_64B66B", c.enc64}};
        for (const auto& [name, speeds] : lists) {
            if (std::string(speeds) == "-")
                continue;
            Attr a{name, ""};
            if (*speeds)
                a.legal.push_back(speeds);
            f.Add(a);
        }
        Qvz_MGTRX page(&f.main);
        ASSERT_TRUE(page.ReadWizData()) << c.what;
        EXPECT_EQ(page.m_decodingMode, c.mode) << c.what;
        EXPECT_EQ(page.m_staticDecoding, c.stat) << c.what;
        EXPECT_TRUE(f.sink.messages.empty()) << c.what;
    }
}

TEST(RxPage, SwitchesReadOnlyWhenTheBlockHasThem) {
    Fixture f({{"RX_LOSS_OF_SYNC_FSM", "TRUE"},
               {"RX_CRC_USE", "TRUE"},
               {"RXCRCCLOCKDOUBLE", "true"},
               {"QVZX_ONLY_BYPASS_PCS", "TRUE"},
               {"RX_LOS_INVALID_INCR", "16"},
               {"RX_LOS_THRESHOLD", ""},
               {"QVZ_RXCRC_DATAWIDTH", "32"},
               {"RXCRCINITVAL", "32'hDEADbeef"}});
    Qvz_MGTRX page(&f.main);
    page.m_crcUse = true;         // QVZ_RXCRC_USE is absent: kept
    page.m_crcClockDouble = true; // only "TRUE" is true
    ASSERT_TRUE(page.ReadWizData());
    EXPECT_EQ(page.m_lossOfSyncFsm, 1);
    EXPECT_TRUE(page.m_rxCrcUse);
    EXPECT_TRUE(page.m_crcUse);
    EXPECT_FALSE(page.m_crcClockDouble);
    EXPECT_TRUE(page.m_bypassPcs);
    EXPECT_EQ(page.m_losInvalidIncr, "16");
    EXPECT_EQ(page.m_losThreshold, "4"); // an empty value keeps the field
    EXPECT_EQ(page.m_crcDataWidth, "32");
    EXPECT_EQ(page.m_crcInitVal, "DEADbeef");

    // A block without the loss-of-sync switch reads it as off.
    Fixture bare({});
    Qvz_MGTRX other(&bare.main);
    ASSERT_TRUE(other.ReadWizData());
    EXPECT_EQ(other.m_lossOfSyncFsm, 0);
    EXPECT_FALSE(other.m_bypassPcs);
}

TEST(RxPage, AfeEqReadsThreeDigitsAndWritesAWellFormedValue) {
    const struct {
        const char* stored;
        const char* digits;
    } cases[] = {
        {"9'b000000101", "101"},
        {"9'b000000000", "000"},
        {"9'b000000", ""}, // the full prefix and nothing after it
        // Shorter than the prefix: a short literal or bare digits, widened.
        {"", "000"},
        {"101", "101"},
        {"3'b011", "011"},
        {"1'b1", "001"},
        {"2'b10", "010"},
        {"0", "000"},
        {"4'b1010", "000"},
        {"3'h7", "000"},
        {"1x", "000"},
        {"'b", "000"},
        // The prefix's length ends inside a two-byte character: the digits
        // start after it, or the value written back would not be UTF-8.
        {"9'b00000\xc3\xa9"
         "101",
         "101"},
        {"9'b0000000\xc3\xa9", "0\xc3\xa9"},
    };
    for (const auto& c : cases) {
        Fixture f({{"RXAFEEQ", c.stored}});
        Qvz_MGTRX page(&f.main);
        ASSERT_TRUE(page.ReadWizData()) << c.stored;
        EXPECT_EQ(page.m_rxAfeEq, c.digits) << c.stored;
        ASSERT_TRUE(page.WriteWizData()) << c.stored;
        EXPECT_EQ(f.Value("RXAFEEQ"), std::string("9'b000000") + c.digits) << c.stored;
    }
}

TEST(RxPage, CountersTakeTheirRangeFromTheLegalValues) {
    struct Case {
        const char* what;
        const char* value;
        const char* def;
        std::vector<const char*> legal;
        int expected;
        int low, high;
        const char* stored; // the attribute's value after the read
    };
    const Case cases[] = {
        {"plain", "20", "64", {}, 20, 1, 255, "20"},
        {"range", "20", "64", {"1..63"}, 20, 1, 63, "20"},
        {"last range wins", "20", "64", {"1..10", "7", "5..40", "x..9"}, 20, 5, 40, "20"},
        {"discrete legal values leave the default range", "8", "64", {"4", "8"}, 8, 1, 255, "8"},
        {"range written high to low", "20", "64", {"63..2"}, 20, 2, 63, "20"},
        {"eight characters take the default", "00000032", "48", {}, 48, 1, 255, "48"},
        {"eight-character number too", "12345678", "48", {}, 48, 1, 255, "48"},
        {"out of range is read as is", "300", "64", {}, 300, 1, 255, "300"},
        {"not a number takes the default", "abc", "24", {}, 24, 1, 255, "24"},
        {"trailing text takes the default", "12abc", "24", {}, 24, 1, 255, "24"},
        {"empty takes the default", "", "24", {}, 24, 1, 255, "24"},
        {"no number anywhere", "abc", "def", {}, 0, 1, 255, "abc"},
        {"signed number", "-3", "24", {}, -3, 1, 255, "-3"},
    };
    for (const Case& c : cases) {
        for (const char* name : {"SH_CNT_MAX", "SH_INVALID_CNT_MAX"}) {
            Fixture f({});
            Attr a{name, c.value, c.def};
            a.legal = c.legal;
            f.Add(a);
            Qvz_MGTRX page(&f.main);
            ASSERT_TRUE(page.ReadWizData()) << c.what;
            const bool cnt = std::string(name) == "SH_CNT_MAX";
            EXPECT_EQ(cnt ? page.m_shCntMax : page.m_shInvalidCntMax, c.expected) << c.what;
            EXPECT_EQ(cnt ? page.m_shCntMaxText : page.m_shInvalidCntMaxText,
                      std::to_string(c.expected))
                << c.what;
            EXPECT_EQ(cnt ? page.m_shCntMaxMin : page.m_shInvalidCntMaxMin, c.low) << c.what;
            EXPECT_EQ(cnt ? page.m_shCntMaxMax : page.m_shInvalidCntMaxMax, c.high) << c.what;
            EXPECT_EQ(f.Value(name), c.stored) << c.what;
            // The other counter is untouched.
            EXPECT_EQ(cnt ? page.m_shInvalidCntMaxText : page.m_shCntMaxText, cnt ? "16" : "64");
        }
    }
}

TEST(RxPage, WriteChecksCountersThenLossOfSyncOrder) {
    const std::string cntMsg = "The allowable range for the attribute SH_CNT_MAX is between ";
    const std::string invMsg =
        "The allowable range for the attribute SH_INVALID_CNT_MAX is between ";
    struct Case {
        const char* cnt;
        int cntLo, cntHi;
        const char* inv;
        int invLo, invHi;
        const char* incr;
        const char* thr;
        std::string message; // empty: accepted
    };
    const Case cases[] = {
        {"64", 1, 255, "16", 1, 255, "4", "4", ""},
        {"1", 1, 255, "255", 1, 255, "16", "128", ""}, // compared as numbers, not as text
        {"0", 1, 255, "16", 1, 255, "1", "4", cntMsg + "1 and 255."},
        {"256", 1, 255, "16", 1, 255, "1", "4", cntMsg + "1 and 255."},
        {"0", 1, 255, "0", 1, 255, "8", "4", cntMsg + "1 and 255."},
        {"64", 1, 255, "40", 2, 32, "8", "4", invMsg + "2 and 32."},
        {"64", 1, 255, "16", 1, 255, "8", "4", kThresholdMessage},
        {"64", 1, 255, "16", 1, 255, "512", "256", kThresholdMessage},
        {"0", 0, 255, "16", 1, 255, "1", "4", ""},
        {"abc", 0, 255, "16", 1, 255, "1", "4", cntMsg + "0 and 255."},
        {"12x", 1, 255, "16", 1, 255, "1", "4", cntMsg + "1 and 255."},
        {"", 1, 255, "16", 1, 255, "1", "4", cntMsg + "1 and 255."},
    };
    for (const Case& c : cases) {
        Fixture f({{"RX_LOS_INVALID_INCR", "1"},
                   {"RX_LOS_THRESHOLD", "4"},
                   {"SH_CNT_MAX", "64"},
                   {"SH_INVALID_CNT_MAX", "16"}});
        Qvz_MGTRX page(&f.main);
        page.m_shCntMaxText = c.cnt;
        page.m_shCntMaxMin = c.cntLo;
        page.m_shCntMaxMax = c.cntHi;
        page.m_shInvalidCntMaxText = c.inv;
        page.m_shInvalidCntMaxMin = c.invLo;
        page.m_shInvalidCntMaxMax = c.invHi;
        page.m_losInvalidIncr = c.incr;
        page.m_losThreshold = c.thr;
        const bool ok = page.WriteWizData();
        const std::string label = std::string(c.cnt) + "/" + c.inv + "/" + c.incr + "/" + c.thr;
        EXPECT_EQ(ok, c.message.empty()) << label;
        if (c.message.empty()) {
            EXPECT_TRUE(f.sink.messages.empty()) << label;
            EXPECT_EQ(f.Value("SH_CNT_MAX"), c.cnt) << label;
            EXPECT_EQ(f.Value("RX_LOS_THRESHOLD"), c.thr) << label;
        } else {
            EXPECT_EQ(f.Messages(), std::vector<std::string>{c.message}) << label;
            // Nothing is written.
            EXPECT_EQ(f.Value("RX_LOS_INVALID_INCR"), "1") << label;
            EXPECT_EQ(f.Value("RX_LOS_THRESHOLD"), "4") << label;
            EXPECT_EQ(f.Value("SH_CNT_MAX"), "64") << label;
            EXPECT_EQ(f.Value("SH_INVALID_CNT_MAX"), "16") << label;
        }
    }
    // The checks run even without design data.
    Qvz_MGTWizMain noData("test", false);
    Qvz_RecordingSink sink;
    noData.SetMessageSink(&sink);
    Qvz_MGTRX idle(&noData);
    idle.m_losInvalidIncr = "8";
    EXPECT_FALSE(idle.WriteWizData());
    ASSERT_EQ(sink.messages.size(), 1u);
    EXPECT_EQ(sink.messages[0].text, kThresholdMessage);
}

TEST(RxPage, WritesEveryAttributeTheBlockHas) {
    const char* all[] = {"RX_LOS_INVALID_INCR", "RX_LOS_THRESHOLD", "RX_LOSS_OF_SYNC_FSM",
                         "QVZX_ONLY_DECODING",  "RX_DECODE_USE",    "QVZX_ONLY_DEC_STATIC",
                         "RX_CRC_USE",          "QVZ_RXCRC_USE",    "QVZ_RXCRC_DATAWIDTH",
                         "RXCRCCLOCKDOUBLE",    "RXCRCINITVAL",     "SH_CNT_MAX",
                         "SH_INVALID_CNT_MAX",  "RXAFEEQ"};
    struct Case {
        int mode, stat;
        bool flags;
        const char* decoding;
        const char* decodeUse;
        const char* decStatic;
    };
    const Case cases[] = {
        {0, 0, false, "DISABLE", "FALSE", "8B10B"},
        {1, 1, true, "DYNAMIC", "TRUE", "64B66B"},
        {2, 0, true, "STATIC", "TRUE", "8B10B"},
        {5, 3, false, "STATIC", "TRUE", "64B66B"},
    };
    for (const Case& c : cases) {
        Fixture f({});
        for (const char* name : all)
            f.Add({name, "old"});
        Qvz_MGTRX page(&f.main);
        page.m_losInvalidIncr = "2";
        page.m_losThreshold = "8";
        page.m_lossOfSyncFsm = c.flags;
        page.m_decodingMode = c.mode;
        page.m_staticDecoding = c.stat;
        page.m_rxCrcUse = c.flags;
        page.m_crcUse = !c.flags;
        page.m_crcDataWidth = "16";
        page.m_crcClockDouble = c.flags;
        page.m_crcInitVal = "1234ABCD";
        page.m_shCntMaxText = "32";
        page.m_shInvalidCntMaxText = "8";
        page.m_rxAfeEq = "110";
        ASSERT_TRUE(page.WriteWizData());
        const char* t = c.flags ? "TRUE" : "FALSE";
        const char* nt = c.flags ? "FALSE" : "TRUE";
        EXPECT_EQ(f.Value("RX_LOS_INVALID_INCR"), "2");
        EXPECT_EQ(f.Value("RX_LOS_THRESHOLD"), "8");
        EXPECT_EQ(f.Value("RX_LOSS_OF_SYNC_FSM"), t);
        EXPECT_EQ(f.Value("QVZX_ONLY_DECODING"), c.decoding);
        EXPECT_EQ(f.Value("RX_DECODE_USE"), c.decodeUse);
        EXPECT_EQ(f.Value("QVZX_ONLY_DEC_STATIC"), c.decStatic);
        EXPECT_EQ(f.Value("RX_CRC_USE"), t);
        EXPECT_EQ(f.Value("QVZ_RXCRC_USE"), nt);
        EXPECT_EQ(f.Value("QVZ_RXCRC_DATAWIDTH"), "16");
        EXPECT_EQ(f.Value("RXCRCCLOCKDOUBLE"), t);
        EXPECT_EQ(f.Value("RXCRCINITVAL"), "32'h1234ABCD");
        EXPECT_EQ(f.Value("SH_CNT_MAX"), "32");
        EXPECT_EQ(f.Value("SH_INVALID_CNT_MAX"), "8");
        EXPECT_EQ(f.Value("RXAFEEQ"), "9'b000000110");
        EXPECT_EQ(f.block->GetAttributes().size(), std::size(all));
    }

    // Missing attributes stay missing; RX_DECODE_USE follows the decoding
    // attribute only.
    Fixture f({{"RX_DECODE_USE", "TRUE"}});
    Qvz_MGTRX page(&f.main);
    ASSERT_TRUE(page.WriteWizData());
    EXPECT_EQ(f.Value("RX_DECODE_USE"), "TRUE");
    EXPECT_EQ(f.block->GetAttributes().size(), 1u);
}

TEST(RxPage, WindowRunReadsTheSameFieldsAndFillsTheForm) {
    App();
    Fixture f({{"RX_LOS_THRESHOLD", "16"}, {"SH_CNT_MAX", "40"}});
    f.main.m_batchMode = false;
    Qvz_MGTRX page(&f.main);
    EXPECT_FALSE(page.CreateGuiDlg(nullptr));
    EXPECT_EQ(page.GetGuiDlg(), nullptr);
    QWidget parent;
    ASSERT_TRUE(page.CreateGuiDlg(&parent));
    ASSERT_NE(page.GetGuiDlg(), nullptr);
    EXPECT_EQ(page.GetGuiDlg()->pageName(), "Receiver Setup");
    ASSERT_TRUE(page.ReadWizData());
    EXPECT_FALSE(page.m_isBatch);
    EXPECT_EQ(page.m_losThreshold, "16");
    EXPECT_EQ(page.m_shCntMax, 40);
    EXPECT_EQ(page.GuiDlg()->Form()->sbSHMax->value(), 40);
    EXPECT_TRUE(f.sink.messages.empty());
}
