// Consistency of the sample targets and the examples: every value the pages
// will meet is legal and readable, every pin the finish routine decides is
// there with its direction and width, and every offered type exists at each
// of its widths.

#include "Qvz_DesignJson.h"
#include "Qvz_MGTWizPage.h"
#include "TargetsCommon.h"

#include <QRegularExpression>
#include <gtest/gtest.h>

#include <algorithm>
#include <functional>
#include <map>
#include <set>
#include <vector>

using Port::StringBase;

namespace {

struct Loaded {
    DesignFile file;
    Qvz_WizData data;
};

std::vector<Loaded> LoadAll() {
    std::vector<Loaded> all;
    auto load = [&all](const DesignFile& f) {
        Loaded l{f, {}};
        QString err;
        EXPECT_TRUE(Qvz_DesignJson::LoadFile(SourcePath(f.path), l.data, err)) << err.toStdString();
        all.push_back(std::move(l));
    };
    for (const DesignFile& f : kTargets)
        load(f);
    for (const DesignFile& f : kExamples)
        load(f);
    return all;
}

const std::vector<Loaded>& All() {
    static const std::vector<Loaded> all = LoadAll();
    return all;
}

// Walks every block of every file, with a trace naming file and block.
void ForEachBlock(const std::function<void(const Loaded&, Qvz_Block&)>& fn) {
    for (const Loaded& l : All())
        for (const auto& b : l.data.GetBlocks()) {
            SCOPED_TRACE(std::string(l.file.path) + ": " + b->GetName().str());
            fn(l, *b);
        }
}

std::string Value(const Qvz_Block& b, const char* name) {
    return b.GetAttributeValue(name).str();
}

std::string DisplayName(const Qvz_Block& b) {
    const std::string d = Value(b, "MGT_DISPLAY_NAME");
    return d.empty() ? Value(b, "QVZ_OLD_DISPLAY_NAME") : d;
}

// The data-width attribute as the General Setup page reads it (older files
// use the first family's name on every family).
Qvz_Attribute* WidthAttr(const Qvz_Block& b) {
    if (Qvz_Attribute* a =
            b.GetNamedAttribute(b.SupportsMGT3() ? "RX_DATA_WIDTH" : "QVZ_RX_DATA_WIDTH"))
        return a;
    return b.GetNamedAttribute("RX_DATA_WIDTH");
}

bool IsLegal(const Qvz_Attribute& a, const StringBase& v) {
    for (const StringBase& entry : a.GetLegalValues().Items()) {
        int low = 0, high = 0;
        if (Qvz_Attribute::GetRangeValues(entry, low, high)) {
            int n = 0;
            const std::string& s = v.str();
            if (!s.empty() && std::all_of(s.begin(), s.end(), ::isdigit)) {
                n = UT_STR::AToI(v);
                if (n >= low && n <= high)
                    return true;
            }
        } else if (entry == v) {
            return true;
        }
    }
    return false;
}

int MaxLegal(const Qvz_Attribute& a) {
    int m = 0;
    for (const StringBase& e : a.GetLegalValues().Items())
        m = std::max(m, UT_STR::AToI(e));
    return m;
}

} // namespace

TEST(TargetData, EachFileHasItsFamilyAndOneActiveBlock) {
    for (const Loaded& l : All()) {
        SCOPED_TRACE(l.file.path);
        const Qvz_Target& t = l.data.Target();
        const std::string fam = l.file.family;
        EXPECT_EQ(t.supportsGT, fam == "GT");
        EXPECT_EQ(t.supportsGT10, fam == "GT10");
        EXPECT_EQ(t.supportsGT11, fam == "GT11");
        // The bonding page refuses a family whose maximum is 0.
        const int maxBond = fam == "GT"     ? t.maxBondGT
                            : fam == "GT10" ? t.maxBondGT10
                                            : t.maxBondGT11;
        EXPECT_GE(maxBond, 4);
        EXPECT_FALSE(t.fileName.IsEmpty());
        int used = 0;
        for (const auto& b : l.data.GetBlocks()) {
            used += b->IsUsed();
            EXPECT_EQ(Qvz_FamilyName(b->GetFamily()), fam) << b->GetName().str();
            // The superseded-block lookup finds blocks by "<primitive>_INST".
            EXPECT_EQ(b->GetName(), b->GetPrimitiveName() + "_INST");
        }
        EXPECT_EQ(used, 1);
        ASSERT_NE(l.data.GetActiveBlock(), nullptr);
        EXPECT_EQ(l.data.GetActiveBlock()->GetName(), l.file.activeBlock);
        EXPECT_TRUE(l.data.GetSignals().empty());
    }
}

TEST(TargetData, EveryValueAndDefaultIsLegal) {
    ForEachBlock([](const Loaded&, Qvz_Block& b) {
        for (const auto& a : b.GetAttributes()) {
            if (a->GetLegalValues().IsEmpty())
                continue;
            EXPECT_TRUE(IsLegal(*a, a->GetValue()))
                << a->GetName().str() << " = " << a->GetValue().str();
            EXPECT_TRUE(IsLegal(*a, a->GetDefaultValue()))
                << a->GetName().str() << " default " << a->GetDefaultValue().str();
        }
    });
}

// Pages take numeric limits from the legal list: the channel-bonding page from
// its last entry (a plain entry there pins the range to one value), the other
// pages from the last range entry. The value must lie in the range so read.
TEST(TargetData, NumericValuesLieInTheRangeThePagesRead) {
    const struct {
        const char* attr;
        bool lastEntryDecides;
    } cases[] = {
        {"CHAN_BOND_LIMIT", true},  {"CHAN_BOND_OFFSET", true},    {"CHAN_BOND_WAIT", true},
        {"SH_CNT_MAX", false},      {"SH_INVALID_CNT_MAX", false}, {"CLK_COR_REPEAT_WAIT", false},
        {"CLK_COR_MIN_LAT", false}, {"CLK_COR_MAX_LAT", false},    {"TX_PREEMPHASIS", false},
    };
    ForEachBlock([&](const Loaded&, Qvz_Block& b) {
        for (const auto& c : cases) {
            const Qvz_Attribute* a = b.GetNamedAttribute(c.attr);
            if (!a)
                continue;
            int low = INT_MIN, high = INT_MIN;
            for (const StringBase& e : a->GetLegalValues().Items()) {
                int l = 0, h = 0;
                if (Qvz_Attribute::GetRangeValues(e, l, h))
                    low = l, high = h;
                else if (c.lastEntryDecides)
                    low = high = UT_STR::AToI(e);
            }
            ASSERT_NE(low, INT_MIN) << c.attr << " has no range";
            for (const StringBase& v : {a->GetValue(), a->GetDefaultValue()}) {
                const int n = UT_STR::AToI(v);
                EXPECT_TRUE(n >= low && n <= high) << c.attr << " = " << v.str();
            }
        }
        // The pages refuse these pairs before writing anything.
        if (b.GetNamedAttribute("RX_LOS_INVALID_INCR") && b.GetNamedAttribute("RX_LOS_THRESHOLD")) {
            EXPECT_LE(UT_STR::AToI(b.GetAttributeValue("RX_LOS_INVALID_INCR")),
                      UT_STR::AToI(b.GetAttributeValue("RX_LOS_THRESHOLD")));
        }
        if (b.GetNamedAttribute("CLK_COR_MIN_LAT")) {
            EXPECT_GT(UT_STR::AToI(b.GetAttributeValue("CLK_COR_MAX_LAT")),
                      UT_STR::AToI(b.GetAttributeValue("CLK_COR_MIN_LAT")));
        }
    });
}

// Masks hold no more "0" than their sequence is long, so neither the clock
// correction nor the bonding page replaces them on reading.
TEST(TargetData, SequenceMasksFitTheirLength) {
    const struct {
        const char* len;
        const char* masks[2];
    } cases[] = {
        {"CLK_COR_SEQ_LEN", {"CLK_COR_SEQ_1_MASK", "CLK_COR_SEQ_2_MASK"}},
        {"CHAN_BOND_SEQ_LEN", {"CHAN_BOND_SEQ_1_MASK", "CHAN_BOND_SEQ_2_MASK"}},
    };
    ForEachBlock([&](const Loaded&, Qvz_Block& b) {
        for (const auto& c : cases) {
            const Qvz_Attribute* len = b.GetNamedAttribute(c.len);
            ASSERT_NE(len, nullptr) << c.len;
            for (const char* m : c.masks) {
                const Qvz_Attribute* mask = b.GetNamedAttribute(m);
                if (b.SupportsMGT3()) {
                    EXPECT_EQ(mask, nullptr) << m; // the first family has no masks
                    continue;
                }
                ASSERT_NE(mask, nullptr) << m;
                EXPECT_TRUE(Qvz_MGTWizPage::ValidateSeqMask(
                    Qvz_MGTWizPage::StripSizedLiteral(mask->GetValue(), 0), len->GetValue()))
                    << m << " = " << mask->GetValue().str();
                EXPECT_TRUE(Qvz_MGTWizPage::ValidateSeqMask(
                    Qvz_MGTWizPage::StripSizedLiteral(mask->GetDefaultValue(), 0),
                    len->GetDefaultValue()))
                    << m << " default";
            }
        }
    });
}

// Bit vectors are kept in the form each family's pages read and write: plain
// digits on GT and GT10, sized literals on GT11.
TEST(TargetData, BitVectorsAreInTheirFamilysForm) {
    const struct {
        const char* pattern; // attribute names
        const char* gt;      // GT and GT10 form; null: not on these families
        const char* gt11;    // null: not on GT11
    } cases[] = {
        {"^(CLK_COR|CHAN_BOND)_SEQ_[12]_[1-4]$", "[01]{11}", "11'b[01]{11}"},
        {"^(CLK_COR|CHAN_BOND)_SEQ_[12]_MASK$", "[01]{4}", "4'b[01]{4}"},
        {"^(PCOMMA|MCOMMA)_10B_VALUE$|^COMMA_10B_MASK$", "[01]{10}", "10'h[0-9A-F]{3}"},
        {"^(PCOMMA|MCOMMA)_32B_VALUE$|^COMMA_32B_MASK$", nullptr, "32'h[0-9A-F]{8}"},
        {"^(TX|RX)CRCINITVAL$", nullptr, "32'h[0-9A-F]{8}"},
        {"^TX(PRE|DAT|POST)_TAP_DAC$", nullptr, "5'b[01]{5}"},
        {"^RXAFEEQ$", nullptr, "9'b000000[01]{3}"},
        {"^TX_CRC_FORCE_VALUE$", "[01]{8}", nullptr},
        {"^LANE_ID$", "[01]{11}", nullptr},
    };
    std::vector<QRegularExpression> names, gt, gt11;
    for (const auto& c : cases) {
        names.emplace_back(c.pattern);
        gt.emplace_back(QRegularExpression::anchoredPattern(c.gt ? c.gt : ""));
        gt11.emplace_back(QRegularExpression::anchoredPattern(c.gt11 ? c.gt11 : ""));
    }
    ForEachBlock([&](const Loaded&, Qvz_Block& b) {
        for (const auto& a : b.GetAttributes()) {
            const QString name = a->GetName().ToQString();
            for (size_t i = 0; i < std::size(cases); ++i) {
                if (!names[i].match(name).hasMatch())
                    continue;
                const char* form = b.SupportsMGT11() ? cases[i].gt11 : cases[i].gt;
                ASSERT_NE(form, nullptr) << name.toStdString() << " is not of this family";
                const QRegularExpression& re = b.SupportsMGT11() ? gt11[i] : gt[i];
                EXPECT_TRUE(re.match(a->GetValue().ToQString()).hasMatch())
                    << name.toStdString() << " = " << a->GetValue().str();
                EXPECT_TRUE(re.match(a->GetDefaultValue().ToQString()).hasMatch())
                    << name.toStdString() << " default " << a->GetDefaultValue().str();
            }
        }
    });
}

// The pins whose width follows the data width, and how wide they are: GT11
// primitives are always the full 8-byte transceiver (the width is chosen
// through RXDATAWIDTH/TXDATAWIDTH); a custom block serves every width at the
// widest; any other block is as wide as its own data width (the first
// family's protocol blocks are resized when written, so they follow it too).
TEST(TargetData, DataWidthPinsFollowTheBlocksDataWidth) {
    const std::set<std::string> dataPins = {
        "TXDATA",    "RXDATA",       "TXCHARISK",     "TXCHARDISPMODE", "TXCHARDISPVAL",
        "TXKERR",    "TXRUNDISP",    "TXBYPASS8B10B", "RXCHARISK",      "RXCHARISCOMMA",
        "RXDISPERR", "RXNOTINTABLE", "RXRUNDISP"};
    ForEachBlock([&](const Loaded&, Qvz_Block& b) {
        const Qvz_Attribute* w = WidthAttr(b);
        ASSERT_NE(w, nullptr);
        const bool custom = b.SupportsMGT3() ? b.GetPrimitiveName() == "GT_CUSTOM"
                                             : DisplayName(b).find("Custom") != std::string::npos;
        const int bytes = b.SupportsMGT11() ? 8
                          : custom          ? MaxLegal(*w)
                                            : UT_STR::AToI(w->GetDefaultValue());
        std::set<std::string> seen;
        for (const auto& p : b.GetPins()) {
            if (!p->SupportsDataWidth())
                continue;
            const std::string n = p->GetName().str();
            seen.insert(n);
            const bool dataBus = n == "TXDATA" || n == "RXDATA";
            EXPECT_EQ(p->GetWidth(), dataBus ? 8 * bytes : bytes) << n;
            EXPECT_EQ(p->GetDirection(),
                      n.rfind("TX", 0) == 0 && n != "TXKERR" && n != "TXRUNDISP" ? "IN" : "OUT")
                << n;
        }
        EXPECT_EQ(seen, dataPins);
    });
}

// Every pin that a rule of the finish routine or of the bonded copies names
// for the family, as NAME:DIRECTION:WIDTH (data-width pins are checked above).
TEST(TargetData, EveryPinTheFinishRulesNameIsThere) {
    const char* common =
        "TXUSRCLK:IN:1 TXUSRCLK2:IN:1 RXUSRCLK:IN:1 RXUSRCLK2:IN:1 TXN:OUT:1 TXP:OUT:1 "
        "RXN:IN:1 RXP:IN:1 LOOPBACK:IN:2 ENCHANSYNC:IN:1 CHBONDDONE:OUT:1 ENPCOMMAALIGN:IN:1 "
        "ENMCOMMAALIGN:IN:1 RXCOMMADET:OUT:1 RXREALIGN:OUT:1 RXLOSSOFSYNC:OUT:2 "
        "RXCLKCORCNT:OUT:3";
    const char* coding = "TXENC8B10BUSE:IN:1 RXDEC8B10BUSE:IN:1 TXENC64B66BUSE:IN:1 "
                         "TXGEARBOX64B66BUSE:IN:1 TXSCRAM64B66BUSE:IN:1 RXDEC64B66BUSE:IN:1 "
                         "RXBLOCKSYNC64B66BUSE:IN:1 RXDESCRAM64B66BUSE:IN:1 RXIGNOREBTF:IN:1 "
                         "TXINTDATAWIDTH:IN:2 RXINTDATAWIDTH:IN:2 CHBONDI:IN:5 CHBONDO:OUT:5";
    const std::map<std::string, QString> perFamily = {
        {"GT", "REFCLK:IN:1 REFCLK2:IN:1 REFCLKSEL:IN:1 BREFCLK:IN:1 BREFCLK2:IN:1 "
               "CONFIGIN:IN:1 CONFIGENABLE:IN:1 CONFIGOUT:OUT:1 CHBONDI:IN:4 CHBONDO:OUT:4 "
               "TXFORCECRCERR:IN:1 RXCHECKINGCRC:OUT:1 RXCRCERR:OUT:1"},
        {"GT10", QString("REFCLK:IN:1 REFCLK2:IN:1 REFCLKSEL:IN:1 REFCLKBSEL:IN:1 "
                         "BREFCLKPIN:IN:1 BREFCLKNIN:IN:1 PMAINIT:IN:1 PMAREGADDR:IN:6 "
                         "PMAREGDATAIN:IN:8 PMAREGRW:IN:1 PMAREGSTROBE:IN:1 ") +
                     coding},
        {"GT11", QString("REFCLK1:IN:1 REFCLK2:IN:1 GREFCLK:IN:1 COMBUSIN:IN:16 "
                         "COMBUSOUT:OUT:16 TXDATAWIDTH:IN:2 RXDATAWIDTH:IN:2 RXMCLK:OUT:1 "
                         "RXCRCPD:IN:1 RXCRCDATAWIDTH:IN:3 RXCRCOUT:OUT:32 TXCRCPD:IN:1 "
                         "TXCRCDATAWIDTH:IN:3 TXCRCOUT:OUT:32 ") +
                     coding},
    };
    ForEachBlock([&](const Loaded& l, Qvz_Block& b) {
        const QString want = QString(common) + " " + perFamily.at(l.file.family);
        for (const QString& entry : want.split(' ', Qt::SkipEmptyParts)) {
            const QStringList f = entry.split(':');
            const std::string name = f[0].toStdString();
            const Qvz_Pin* pin = b.GetNamedPin(name);
            ASSERT_NE(pin, nullptr) << name;
            EXPECT_EQ(pin->GetDirection().ToQString(), f[1]) << name;
            EXPECT_EQ(pin->GetWidth(), f[2].toInt()) << name;
            EXPECT_FALSE(pin->SupportsDataWidth()) << name;
        }
        // A library block leaves every decision to the wizard.
        for (const auto& p : b.GetPins()) {
            EXPECT_TRUE(p->GetSigName().IsEmpty() && !p->IsGrounded() && !p->IsVcc() &&
                        p->GetAttributes().empty())
                << p->GetName().str();
            EXPECT_TRUE(p->GetDirection() == "IN" || p->GetDirection() == "OUT")
                << p->GetName().str();
        }
    });
}

// The attributes the pages read on a family, present on every block of it.
TEST(TargetData, EveryBlockCarriesWhatThePagesReadForItsFamily) {
    const char* all =
        "MGT_DISPLAY_NAME QVZ_BOOL_TX_USE QVZ_BOOL_RX_USE "
        // transmitter, receiver
        "TX_BUFFER_USE QVZX_ONLY_ENCODING QVZX_ONLY_ENC_STATIC RX_LOSS_OF_SYNC_FSM "
        "QVZX_ONLY_DECODING QVZX_ONLY_DEC_STATIC RX_BUFFER_USE "
        // comma detect
        "QVZX_ONLY_TURNOFF_COMMA DEC_PCOMMA_DETECT DEC_MCOMMA_DETECT DEC_VALID_COMMA_ONLY "
        "PCOMMA_10B_VALUE MCOMMA_10B_VALUE PCOMMA_DETECT MCOMMA_DETECT QVZX_ONLY_PCOMMA_CTRL "
        "QVZX_ONLY_MCOMMA_CTRL COMMA_10B_MASK ALIGN_COMMA_WORD "
        // clock correction
        "CLK_CORRECT_USE CLK_COR_SEQ_LEN CLK_COR_SEQ_2_USE CLK_COR_SEQ_1_1 CLK_COR_SEQ_1_2 "
        "CLK_COR_SEQ_1_3 CLK_COR_SEQ_1_4 CLK_COR_SEQ_2_1 CLK_COR_SEQ_2_2 CLK_COR_SEQ_2_3 "
        "CLK_COR_SEQ_2_4 "
        // channel bonding
        "QVZ_CHAN_BOND_NUMBER QVZ_CHAN_BOND_PRIMARY_ROW CHAN_BOND_MODE CHAN_BOND_ONE_SHOT "
        "CHAN_BOND_LIMIT CHAN_BOND_SEQ_LEN CHAN_BOND_SEQ_2_USE CHAN_BOND_SEQ_1_1 "
        "CHAN_BOND_SEQ_1_2 CHAN_BOND_SEQ_1_3 CHAN_BOND_SEQ_1_4 CHAN_BOND_SEQ_2_1 "
        "CHAN_BOND_SEQ_2_2 CHAN_BOND_SEQ_2_3 CHAN_BOND_SEQ_2_4";
    const char* newer = "SH_CNT_MAX SH_INVALID_CNT_MAX CLK_COR_SEQ_1_MASK CLK_COR_SEQ_2_MASK "
                        "CLK_COR_MIN_LAT CLK_COR_MAX_LAT CLK_COR_SEQ_DROP CLK_COR_8B10B_DE "
                        "CHAN_BOND_SEQ_1_MASK CHAN_BOND_SEQ_2_MASK";
    const std::map<std::string, QString> perFamily = {
        {"GT", "TX_DATA_WIDTH SERDES_10B TERMINATION_IMP REF_CLK_V_SEL QVZX_ONLY_REFCLK_DYN "
               "QVZX_ONLY_REFCLK QVZX_ONLY_BREFCLK_DYN QVZX_ONLY_BREFCLK QVZX_ONLY_BYPASS_PCS "
               "TX_PREEMPHASIS TX_DIFF_CTRL TX_CRC_USE CRC_FORMAT TX_CRC_FORCE_VALUE "
               "ALIGN_COMMA_MSB RX_LOS_INVALID_INCR RX_LOS_THRESHOLD RX_DECODE_USE RX_CRC_USE "
               "CLK_COR_KEEP_IDLE CLK_COR_INSERT_IDLE_FLAG CLK_COR_REPEAT_WAIT "
               "CHAN_BOND_OFFSET CHAN_BOND_WAIT"},
        {"GT10", QString("QVZ_TX_DATA_WIDTH PMA_SPEED QVZ_PMASPD_ENC_NONE QVZ_PMASPD_ENC_8B10B "
                         "QVZ_PMASPD_ENC_64B66B QVZX_ONLY_ENABLE_PMA QVZX_ONLY_USE_REFCLK "
                         "QVZX_ONLY_USE_BREFCLK QVZX_ONLY_REFCLK_DYN QVZX_ONLY_REFCLK "
                         "QVZX_ONLY_BYPASS_PCS RX_LOS_INVALID_INCR RX_LOS_THRESHOLD ") +
                     newer},
        {"GT11", QString("QVZ_TX_DATA_WIDTH QVZ_GT11_MODE QVZ_GT11_USE_B GT11_MODE "
                         "TXABPMACLKSEL RXPMACLKSEL QVZ_TXCRC_USE QVZ_TXCRC_DATAWIDTH "
                         "TXCRCCLOCKDOUBLE TXCRCINITVAL TXPRE_TAP_PD TXPOST_TAP_PD "
                         "TXPRE_TAP_DAC TXDAT_TAP_DAC TXPOST_TAP_DAC ALIGN_COMMA_MSB "
                         "PCOMMA_32B_VALUE MCOMMA_32B_VALUE QVZ_RXCRC_USE QVZ_RXCRC_DATAWIDTH "
                         "RXCRCCLOCKDOUBLE RXCRCINITVAL RXAFEEQ ") +
                     newer},
    };
    // A block saved by an older wizard may still use the names that the
    // General Setup page migrates.
    const std::map<std::string, const char*> oldNames = {{"QVZ_BOOL_RX_USE", "BOOL_RX_USE"},
                                                         {"QVZ_BOOL_TX_USE", "BOOL_TX_USE"},
                                                         {"QVZ_TX_DATA_WIDTH", "TX_DATA_WIDTH"}};
    ForEachBlock([&](const Loaded& l, Qvz_Block& b) {
        QStringList want =
            (QString(all) + " " + perFamily.at(l.file.family)).split(' ', Qt::SkipEmptyParts);
        if (!b.SupportsMGT11() && b.GetPrimitiveName() != "GT_FIBRE_CHAN")
            want << "CRC_START_OF_PKT"
                 << "CRC_END_OF_PKT";
        for (const QString& n : want) {
            const std::string name = n.toStdString();
            const auto old = oldNames.find(name);
            EXPECT_TRUE(b.GetNamedAttribute(name) ||
                        (old != oldNames.end() && b.GetNamedAttribute(old->second)))
                << name;
        }
        EXPECT_NE(WidthAttr(b), nullptr);
        // Fixed by the type: only the wizard's data decides it.
        EXPECT_FALSE(b.GetNamedAttribute("MGT_DISPLAY_NAME")->IsEditable());
        // LANE_IDs belong to Infiniband on the older families only.
        EXPECT_EQ(b.GetNamedAttribute("LANE_ID") != nullptr,
                  !b.SupportsMGT11() && DisplayName(b) == "Infiniband");
        // In a library block, names the General Setup page migrates would
        // overwrite the current ones.
        if (std::string(l.file.path).rfind("data/", 0) == 0) {
            for (const char* old :
                 {"BOOL_RX_USE", "BOOL_TX_USE", "CHAN_BOND_NUMBER", "CHAN_BOND_PRIMARY_ROW"}) {
                EXPECT_EQ(b.GetNamedAttribute(old), nullptr) << old;
            }
        }
    });
}

// The bonding number can take every value the bonding page may write: 0 and
// 2 up to the family's maximum (even only on GT11), never 1; XAUI bonds four.
TEST(TargetData, BondingNumbersCoverTheFamilyRange) {
    ForEachBlock([](const Loaded& l, Qvz_Block& b) {
        const Qvz_Target& t = l.data.Target();
        const int maxBond = b.SupportsMGT3()    ? t.maxBondGT
                            : b.SupportsMGT10() ? t.maxBondGT10
                                                : t.maxBondGT11;
        const Qvz_Attribute* n = b.GetNamedAttribute("QVZ_CHAN_BOND_NUMBER");
        ASSERT_NE(n, nullptr);
        Qvz_StrArray want;
        want.Add("0");
        for (int i = 2; i <= maxBond; ++i)
            if (!b.SupportsMGT11() || i % 2 == 0)
                want.Add(std::to_string(i));
        EXPECT_EQ(n->GetLegalValues(), want);
        if (DisplayName(b).find("XAUI") != std::string::npos) {
            EXPECT_EQ(n->GetDefaultValue(), "4");
        }
        const Qvz_Attribute* mode = b.GetNamedAttribute("CHAN_BOND_MODE");
        EXPECT_EQ(mode->GetLegalValues().GetAt(0), b.SupportsMGT11() ? "NONE" : "OFF");
        for (const char* role : {"MASTER", "SLAVE_1_HOP", "SLAVE_2_HOPS"})
            EXPECT_TRUE(mode->GetLegalValues().Contains(role)) << role;
    });
}

// GT10: a PMA speed list for every width the block serves, each drawn from
// PMA_SPEED's list, and at each width's default speed the block's own
// encoding and decoding are allowed, so that no page replaces them.
TEST(TargetData, Gt10PmaSpeedsAllowTheBlocksCoding) {
    ForEachBlock([](const Loaded&, Qvz_Block& b) {
        if (!b.SupportsMGT10())
            return;
        Qvz_Attribute* pma = b.GetNamedAttribute("PMA_SPEED");
        ASSERT_NE(pma, nullptr);
        const Qvz_Attribute* w = WidthAttr(b);
        const bool custom = DisplayName(b).find("Custom") != std::string::npos;
        std::vector<StringBase> widths;
        if (custom)
            widths = w->GetLegalValues().Items();
        else
            widths = {w->GetValue()};
        for (const char* enc :
             {"QVZ_PMASPD_ENC_NONE", "QVZ_PMASPD_ENC_8B10B", "QVZ_PMASPD_ENC_64B66B"})
            for (const StringBase& s : b.GetNamedAttribute(enc)->GetLegalValues().Items())
                EXPECT_TRUE(pma->GetLegalValues().Contains(s)) << enc << " " << s.str();
        const StringBase saved = pma->GetValue();
        ASSERT_TRUE(b.GetNamedAttribute("QVZ_PMA_SPEED_" + w->GetValue()));
        EXPECT_TRUE(b.GetNamedAttribute("QVZ_PMA_SPEED_" + w->GetValue())
                        ->GetLegalValues()
                        .Contains(saved));
        for (const StringBase& width : widths) {
            SCOPED_TRACE("width " + width.str());
            const Qvz_Attribute* list = b.GetNamedAttribute("QVZ_PMA_SPEED_" + width);
            ASSERT_NE(list, nullptr);
            for (const StringBase& s : list->GetLegalValues().Items())
                EXPECT_TRUE(pma->GetLegalValues().Contains(s)) << s.str();
            // The default is what the General Setup page falls back to.
            pma->SetValue(list->GetDefaultValue());
            bool none = false, b8 = false, b64 = false;
            Qvz_MGTWizPage::GetGT10EncodingChoices(&b, none, b8, b64);
            for (const char* side : {"ENCODING", "DECODING"}) {
                const std::string mode = Value(b, (std::string("QVZX_ONLY_") + side).c_str());
                const std::string stat =
                    Value(b, side[0] == 'E' ? "QVZX_ONLY_ENC_STATIC" : "QVZX_ONLY_DEC_STATIC");
                const bool ok = mode == "DISABLE"   ? none
                                : mode == "DYNAMIC" ? b8 && b64
                                : stat == "8B10B"   ? b8
                                                    : b64;
                EXPECT_TRUE(ok) << side << " " << mode << " " << stat << " at "
                                << pma->GetValue().str();
            }
        }
        pma->SetValue(saved);
    });
}

// The types each family offers (as the General Setup page lists them) and a
// block for each at each of its widths, found the way the wizard finds it.
TEST(TargetData, EveryTypeIsOfferedAtEachOfItsWidths) {
    for (const DesignFile& f : kTargets) {
        SCOPED_TRACE(f.path);
        const Qvz_WizData* data = nullptr;
        for (const Loaded& l : All())
            if (std::string(l.file.path) == f.path)
                data = &l.data;
        ASSERT_NE(data, nullptr);
        std::set<std::string> offered, expected;
        for (const auto& b : data->GetBlocks())
            offered.insert(DisplayName(*b));
        for (const OfferedType& o : kOffered) {
            if (std::string(o.family) != f.family)
                continue;
            expected.insert(o.type);
            const bool anyWidth = std::string(o.family) == "GT" ||
                                  std::string(o.type).find("Custom") != std::string::npos;
            for (const QString& w : o.widths) {
                SCOPED_TRACE(std::string(o.type) + " width " + w.toStdString());
                const StringBase width = StringBase::FromQString(w);
                int found = 0;
                for (const auto& b : data->GetBlocks()) {
                    if (DisplayName(*b) != o.type)
                        continue;
                    const Qvz_Attribute* wa = WidthAttr(*b);
                    // Every block of the type offers all of the type's widths.
                    EXPECT_EQ(wa->GetLegalValues().Items().size(), size_t(o.widths.size()));
                    if (!anyWidth && wa->GetValue() != width)
                        continue;
                    ++found;
                    EXPECT_TRUE(wa->GetLegalValues().Contains(width));
                }
                EXPECT_EQ(found, 1);
            }
        }
        EXPECT_EQ(offered, expected);
    }
}
