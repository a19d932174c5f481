// Batch runs of the program for every transceiver type at every data width of
// every embedded target, transmitter and receiver used, once as loaded and
// once bonded at the family's largest number: each run must complete and
// leave design data a generator can use as it is.

#include "DesignChecks.h"
#include "HostRunner.h"
#include "Qvz_DesignJson.h"

#include <QTemporaryDir>
#include <gtest/gtest.h>

#include <set>

namespace {

struct Case {
    QString target;
    QString type;
    QString width;
    int bond = -1; // -1: the bonding number as loaded
    bool dual = false;
    QString Name() const {
        QString n = QString("%1 \"%2\" width %3").arg(target, type, width);
        if (bond >= 0)
            n += QString(" bonded %1%2").arg(bond).arg(dual ? " dual" : "");
        return n;
    }
};

QString DisplayName(const Qvz_Block& b) {
    const StringBase d = b.GetAttributeValue("MGT_DISPLAY_NAME");
    return (d.IsEmpty() ? b.GetAttributeValue("QVZ_OLD_DISPLAY_NAME") : d).ToQString();
}

const char* WidthAttr(const Qvz_Block& b) {
    return b.SupportsMGT3() ? "RX_DATA_WIDTH" : "QVZ_RX_DATA_WIDTH";
}

int MaxLegal(const Qvz_Attribute* a) {
    int m = 0;
    if (a)
        for (const StringBase& e : a->GetLegalValues().Items())
            m = std::max(m, UT_STR::AToI(e));
    return m;
}

// Types whose General Setup leaves no bonding to choose: the bonding page is
// switched off for them (first-family FibreChannel and Ethernet blocks, GT10
// OC48 and OC192), or XAUI, which always bonds four (its run as loaded
// already covers that).
bool OffersBonding(const Qvz_Block& b) {
    const QString type = DisplayName(b);
    const QString prim = b.GetPrimitiveName().ToQString();
    if (prim == "GT_FIBRE_CHAN" || prim == "GT_ETHERNET")
        return false;
    if (b.SupportsMGT10() && (type == "OC48" || type == "OC192"))
        return false;
    return !type.contains("XAUI");
}

// Every type at every width a target offers, read from the target itself so
// that a type added to it is covered at once.
std::vector<Case> CasesOf(const QString& target) {
    Qvz_WizData d;
    QString err;
    EXPECT_TRUE(Qvz_DesignJson::LoadFile(QDir(VELOMUX_TARGETS).filePath(target + ".json"), d, err))
        << err.toStdString();
    std::vector<Case> cases;
    std::set<std::pair<QString, QString>> seen;
    for (const auto& b : d.GetBlocks()) {
        const Qvz_Attribute* w = b->GetNamedAttribute(WidthAttr(*b));
        if (!w)
            continue;
        for (const StringBase& width : w->GetLegalValues().Items()) {
            const Case c{target, DisplayName(*b), width.ToQString()};
            if (!seen.insert({c.type, c.width}).second)
                continue;
            cases.push_back(c);
            if (!OffersBonding(*b))
                continue;
            Case bonded = c;
            bonded.bond = MaxLegal(b->GetNamedAttribute("QVZ_CHAN_BOND_NUMBER"));
            // GT11 bonds in dual mode only.
            bonded.dual = b->SupportsMGT11();
            cases.push_back(bonded);
        }
    }
    return cases;
}

QStringList Args(const Case& c, const QString& out) {
    QStringList a = {"--batch",
                     "--target",
                     c.target,
                     "--type",
                     c.type,
                     "--width",
                     c.width,
                     "--set",
                     "QVZ_BOOL_TX_USE=TRUE",
                     "--set",
                     "QVZ_BOOL_RX_USE=TRUE",
                     "-o",
                     out};
    if (c.dual)
        a << "--set"
          << "QVZ_GT11_MODE=DUAL";
    if (c.bond >= 0)
        a << "--set" << QString("QVZ_CHAN_BOND_NUMBER=%1").arg(c.bond);
    return a;
}

// Runs one case; the faults it finds, or none.
QStringList RunCase(const Case& c, const QString& out) {
    QFile::remove(out);
    const HostResult r = RunHost(Args(c, out));
    if (r.exitCode != 0)
        return {QString("exit %1: %2").arg(r.exitCode).arg(QString::fromUtf8(r.err).trimmed())};
    Qvz_WizData d;
    QString err;
    if (!Qvz_DesignJson::LoadFile(out, d, err))
        return {"output unreadable: " + err};
    QStringList faults = DesignChecks::AllFaults(d);
    if (const Qvz_Block* b = d.GetActiveBlock()) {
        if (DisplayName(*b) != c.type || b->GetAttributeValue(WidthAttr(*b)).ToQString() != c.width)
            faults << QString("configured \"%1\" width %2 instead")
                          .arg(DisplayName(*b), b->GetAttributeValue(WidthAttr(*b)).ToQString());
        if (c.bond >= 0) {
            const int copies = int(DesignChecks::PlacedBlocks(d).size()) - 1;
            if (b->GetAttributeValue("QVZ_CHAN_BOND_NUMBER").ToQString() !=
                    QString::number(c.bond) ||
                copies != c.bond - 1)
                faults << QString("bonding number %1 with %2 copies")
                              .arg(b->GetAttributeValue("QVZ_CHAN_BOND_NUMBER").ToQString())
                              .arg(copies);
        }
    }
    return faults;
}

void RunAll(const QString& target, int minCases) {
    QTemporaryDir tmp;
    const QString out = tmp.filePath("out.json");
    const std::vector<Case> cases = CasesOf(target);
    EXPECT_GE(int(cases.size()), minCases);
    QStringList report;
    int bad = 0;
    for (const Case& c : cases) {
        const QStringList faults = RunCase(c, out);
        if (faults.isEmpty())
            continue;
        ++bad;
        report << c.Name() + ":";
        for (const QString& f : faults)
            report << "    " + f;
    }
    EXPECT_EQ(bad, 0) << bad << " of " << cases.size() << " cases fail:\n"
                      << report.join('\n').toStdString();
}

} // namespace

TEST(EveryType, SizedLiteralsAreRecognisedOnlyWhenTheirSizeFits) {
    const struct {
        const char* text;
        bool sized;
    } cases[] = {
        {"11'b00000000000", true}, {"4'b0101", true},  {"10'h17C", true},  {"32'h0000ABCD", true},
        {"3'b0101", false},        {"4'b0121", false}, {"13'h17C", false}, {"8'h17C", false},
        {"0101", false},           {"'b01", false},    {"4'b", false},
    };
    for (const auto& c : cases)
        EXPECT_EQ(DesignChecks::IsSizedLiteral(c.text), c.sized) << c.text;
}

// The checks themselves: a finished design with each kind of fault put in.
TEST(EveryType, TheChecksFindEachKindOfFault) {
    auto design = [] {
        auto d = std::make_unique<Qvz_WizData>();
        auto b = std::make_unique<Qvz_Block>("GT10_X_INST", "GT10_X", Qvz_Family::GT10);
        b->SetIsUsed(true);
        Qvz_Attribute* a = b->AddAttribute("PMA_SPEED", "6");
        a->GetLegalValues().Add("1..8");
        Qvz_Pin* in = b->AddPin("TXDATA", "IN");
        in->SetWidth(16);
        in->SetSigName("TXDATA_IN");
        b->AddPin("RXN", "IN")->SetIsGrounded(true);
        b->AddPin("CONFIGOUT", "OUT");
        Qvz_Signal* s = d->AddSignal("TXDATA_IN", true, "I");
        s->SetIsBus(true, 16);
        d->AddBlock(std::move(b));
        return d;
    };
    EXPECT_TRUE(DesignChecks::AllFaults(*design()).isEmpty())
        << DesignChecks::AllFaults(*design()).join('\n').toStdString();

    const struct {
        const char* fault;
        std::function<void(Qvz_WizData&, Qvz_Block&)> put;
    } cases[] = {
        {"is not legal", [](Qvz_WizData&, Qvz_Block& b) { b.SetAttributeValue("PMA_SPEED", "9"); }},
        {"input left floating",
         [](Qvz_WizData&, Qvz_Block& b) { b.GetNamedPin("RXN")->SetIsGrounded(false); }},
        {"does not exist",
         [](Qvz_WizData&, Qvz_Block& b) { b.GetNamedPin("CONFIGOUT")->SetSigName("NOWHERE"); }},
        {"16 bits wide, its pins use 8",
         [](Qvz_WizData& d, Qvz_Block&) {
             d.GetNamedSignal("TXDATA_IN")->SetAttributeValue("BUS_ONLY_USE_BITS", "8");
         }},
        {"direction", [](Qvz_WizData& d,
                         Qvz_Block&) { d.GetNamedSignal("TXDATA_IN")->SetIsExternal(true, ""); }},
        {"no pin uses it", [](Qvz_WizData& d, Qvz_Block&) { d.AddSignal("SPARE_IN", true, "I"); }},
        {"input bits left out",
         [](Qvz_WizData& d, Qvz_Block& b) {
             d.AddSignal("TXDATA_GND", false, "")->SetIsConst0(true);
             Qvz_Pin* p = b.GetNamedPin("TXDATA");
             p->SetSigName("");
             p->SetPinSigBitProp("TXDATA_GND", 0, 0, 0, 0);
         }},
        {"bits out of place",
         [](Qvz_WizData&, Qvz_Block& b) {
             b.GetNamedPin("TXDATA")->SetPinSigBitProp("TXDATA_IN", 16, 1, 16, 1);
         }},
        {"an input driven by an output pin",
         [](Qvz_WizData&, Qvz_Block& b) {
             Qvz_Pin* p = b.AddPin("RXDATA", "OUT");
             p->SetWidth(16);
             p->SetSigName("TXDATA_IN");
         }},
    };
    for (const auto& c : cases) {
        auto d = design();
        c.put(*d, *d->GetActiveBlock());
        const QString faults = DesignChecks::AllFaults(*d).join('\n');
        EXPECT_TRUE(faults.contains(c.fault)) << c.fault << " not found in:\n"
                                              << faults.toStdString();
    }
}

TEST(EveryType, FirstFamily) {
    RunAll("gt", 15);
}

TEST(EveryType, Gt10) {
    RunAll("gt10", 26);
}

TEST(EveryType, Gt11) {
    RunAll("gt11", 6);
}
