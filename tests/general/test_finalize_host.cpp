// Finishing through velomux-wizard batch runs: what the pins of the written
// design data end as, and what the run prints.

#include "FinalizeSupport.h"
#include "HostRunner.h"
#include "Qvz_DesignJson.h"

#include <QJsonArray>
#include <QTemporaryDir>
#include <gtest/gtest.h>

#include <functional>

namespace {

struct Finished {
    int exitCode = -1;
    std::string out;
    std::string err;
    Qvz_WizData data;
    QJsonObject report;

    const Qvz_Block* Master() const { return data.GetActiveBlock(); }
    std::string Of(const char* pin) const {
        const Qvz_Block* b = Master();
        return b ? Describe(data, b->GetNamedPin(pin)) : "no block";
    }
    std::vector<std::string> Active() const {
        std::vector<std::string> names;
        for (const auto& b : data.GetBlocks())
            if (b->IsUsed())
                names.push_back(b->GetName().str());
        return names;
    }
    int Messages() const { return report["messages"].toArray().size(); }
};

QString Fixture(const char* name) {
    return TestData(QString("finish/") + name);
}

Finished FinishBatch(const QString& design, const QStringList& extra = {}) {
    QTemporaryDir tmp;
    const QString out = tmp.filePath("out.json"), report = tmp.filePath("report.json");
    QStringList args = {"--batch", "-o", out, "--report", report};
    args << extra << design;
    const HostResult h = RunHost(args);
    Finished f;
    f.exitCode = h.exitCode;
    f.out = h.out.toStdString();
    f.err = h.err.toStdString();
    f.report = ReadJson(report);
    QString error;
    if (!Qvz_DesignJson::LoadFile(out, f.data, error))
        ADD_FAILURE() << "no design written: " << error.toStdString() << "\n" << f.err;
    return f;
}

// A fixture with the edits of a test, written to dir.
QString Variant(const QTemporaryDir& dir, const char* fixture,
                const std::function<void(QJsonObject&)>& edit) {
    QJsonObject o = ReadJson(Fixture(fixture));
    edit(o);
    const QString path = dir.filePath(fixture);
    WriteAll(path, QJsonDocument(o).toJson());
    return path;
}

bool IsRxSidePin(const Qvz_MGTGeneralSetup& lists, const StringBase& name) {
    if (lists.IsInRxExtraPinList(name))
        return true;
    return name.GetIndexOfString("RX", Port::CompareSearch) == 0 &&
           !lists.IsInUserClockPinList(name);
}

} // namespace

TEST(FinishRun, ReceiverUnusedKeepsTheSerialInputsAndDropsTheReceiveSide) {
    const Finished f = FinishBatch(Fixture("gt10_custom.json"), {"--set", "QVZ_BOOL_RX_USE=FALSE"});
    ASSERT_EQ(f.exitCode, 0) << f.err;
    ASSERT_NE(f.Master(), nullptr);
    EXPECT_EQ(f.Master()->GetAttributeValue("QVZ_CHAN_BOND_NUMBER"), "0");
    EXPECT_EQ(f.Of("RXN"), "port RXN_IN/1");
    EXPECT_EQ(f.Of("RXP"), "port RXP_IN/1");
    EXPECT_EQ(f.Of("RXUSRCLK"), "port RXUSRCLK_IN/1");
    EXPECT_EQ(f.Of("RXUSRCLK2"), "port RXUSRCLK2_IN/1");
    EXPECT_EQ(f.Of("TXDATA"), "port TXDATA_IN/32");

    // Everything else of the receive side is no port: outputs unconnected,
    // inputs (left with nothing) tied 0.
    Qvz_MGTWizMain main("w", false);
    const Qvz_MGTGeneralSetup lists(&main);
    int checked = 0;
    for (const auto& pin : f.Master()->GetPins()) {
        const StringBase& name = pin->GetName();
        if (!IsRxSidePin(lists, name) || name == "RXN" || name == "RXP")
            continue;
        ++checked;
        const bool input = pin->GetDirection() == "IN";
        EXPECT_EQ(Describe(f.data, pin.get()), input ? "tie 0" : "unconnected") << name.str();
    }
    EXPECT_GE(checked, 20);
    EXPECT_EQ(f.Of("LOOPBACK"), "tie 0");
}

TEST(FinishRun, Gt11DataWidthCodes) {
    const struct {
        const char* width;
        const char* code;
    } cases[] = {
        {"1", "tie 0"},
        {"2", "maps 1_1=GNDa[0:0],0_0=VCCa[0:0]"},
        {"4", "maps 1_1=VCCa[0:0],0_0=GNDa[0:0]"},
        {"8", "tie 1"},
    };
    for (const auto& c : cases) {
        const Finished f =
            FinishBatch(Fixture("gt11_custom.json"), {"--type", "Custom", "--width", c.width});
        ASSERT_EQ(f.exitCode, 0) << f.err;
        EXPECT_EQ(f.Master()->GetAttributeValue("QVZ_RX_DATA_WIDTH"), c.width);
        EXPECT_EQ(f.Of("RXDATAWIDTH"), c.code) << c.width;
        EXPECT_EQ(f.Of("TXDATAWIDTH"), c.code) << c.width;
        // The width constants exist when a code maps bits onto them.
        if (c.code[0] == 'm') {
            const Qvz_Signal* gnd = f.data.GetNamedSignal("GNDa");
            const Qvz_Signal* vcc = f.data.GetNamedSignal("VCCa");
            ASSERT_TRUE(gnd && vcc) << c.width;
            EXPECT_TRUE(gnd->IsConst0() && !gnd->IsExternal() && gnd->GetWidth() == 1);
            EXPECT_TRUE(vcc->IsConst1() && !vcc->IsExternal() && vcc->GetWidth() == 1);
        }
    }
}

TEST(FinishRun, Gt11ReceiveCrcWidthCode) {
    const struct {
        const char* width;
        const char* code;
    } cases[] = {
        {"32", "2_2=CRCDATAWIDTH_GND[0:0],1_1=CRCDATAWIDTH_VCC[0:0],0_0=CRCDATAWIDTH_VCC[0:0]"},
        {"8", "2_2=CRCDATAWIDTH_GND[0:0],1_1=CRCDATAWIDTH_GND[0:0],0_0=CRCDATAWIDTH_GND[0:0]"},
    };
    for (const auto& c : cases) {
        const Finished f = FinishBatch(Fixture("gt11_custom.json"),
                                       {"--set", QString("QVZ_RXCRC_DATAWIDTH=") + c.width});
        ASSERT_EQ(f.exitCode, 0) << f.err;
        EXPECT_EQ(f.Of("RXCRCDATAWIDTH"), std::string("port RXCRCDATAWIDTH_IN/3 + maps ") + c.code);
        EXPECT_EQ(f.Of("RXCRCPD"), "tie 1");
        // The transmit CRC is off.
        EXPECT_EQ(f.Of("TXCRCPD"), "tie 0");
        EXPECT_EQ(f.Of("TXCRCOUT"), "unconnected");
    }
}

TEST(FinishRun, GtWithoutEncoderBuildsTheTenBitBus) {
    const Finished f = FinishBatch(Fixture("gt_custom.json"));
    ASSERT_EQ(f.exitCode, 0) << f.err;
    EXPECT_EQ(f.Of("TXDATA"),
              "maps 7_0=TXDATA_IN[7:0],15_8=TXDATA_IN[17:10],31_16=TXDATA_GND[15:0]");
    const Qvz_Signal* bus = f.data.GetNamedSignal("TXDATA_IN");
    ASSERT_NE(bus, nullptr);
    EXPECT_EQ(bus->GetWidth(), 20);
    EXPECT_TRUE(bus->IsBus() && bus->IsExternal() && bus->IsUsed());
    EXPECT_EQ(bus->GetDirection(), "I");
    EXPECT_TRUE(f.data.GetNamedSignal("TXDATA_GND")->IsConst0());
    // Without an encoder its controls are tied.
    EXPECT_EQ(f.Of("TXBYPASS8B10B"), "tie 1");
    EXPECT_EQ(f.Of("TXCHARISK"), "tie 0");
    EXPECT_NE(f.out.find("Bit-wise:      TXDATA, TXCHARDISPMODE, TXCHARDISPVAL, RXDATA"),
              std::string::npos)
        << f.out;
}

TEST(FinishRun, TiedPinsNeverBecomePortsAndFloatingInputsAreGrounded) {
    const Finished f = FinishBatch(Fixture("gt10_custom.json"));
    ASSERT_EQ(f.exitCode, 0) << f.err;
    EXPECT_EQ(f.Messages(), 0) << f.err;
    const struct {
        const char* pin;
        const char* expect;
    } cases[] = {
        {"TXPOLARITY", "tie 0"}, // a tie of its own ("0")
        {"TXINHIBIT", "tie 1"},  // tied 1 in the data file
        {"RXPOLARITY", "tie 0"}, // tied 0 in the data file
        {"CHBONDI", "tie 0"},    // unconnected input
        {"ENCHANSYNC", "tie 0"}, // unconnected input without bonding
        {"BREFCLK", "tie 0"},    // BREFCLK not used
        {"CHBONDDONE", "unconnected"},  {"CONFIGOUT", "unconnected"},
        {"REFCLK", "port REFCLK_IN/1"}, {"REFCLK2", "tie 0"}, // static REFCLK1
        {"REFCLKSEL", "tie 0"},         {"SCANIO", "port SCANIO/2"},
    };
    for (const auto& c : cases)
        EXPECT_EQ(f.Of(c.pin), c.expect) << c.pin;
    for (const char* none : {"TXPOLARITY_IN", "TXINHIBIT_IN", "RXPOLARITY_IN", "CHBONDI_IN"})
        EXPECT_EQ(f.data.GetNamedSignal(none), nullptr) << none;
    // Every input of the block ends connected or tied.
    for (const auto& pin : f.Master()->GetPins()) {
        if (pin->GetDirection() == "IN") {
            EXPECT_NE(Describe(f.data, pin.get()), "unconnected") << pin->GetName().str();
        }
    }
    for (const char* line : {"Ports:", "Tied pins:", "Unconnected:   4", "Bonded copies: 0"})
        EXPECT_NE(f.out.find(line), std::string::npos) << line << "\n" << f.out;
}

TEST(FinishRun, Gt11XauiLosesItsStatusPins) {
    const QStringList noCrc = {"--set", "QVZ_RXCRC_USE=FALSE"};
    const Finished xaui =
        FinishBatch(Fixture("gt11_custom.json"), QStringList{"--type", "XAUI"} + noCrc);
    const Finished custom = FinishBatch(Fixture("gt11_custom.json"), noCrc);
    ASSERT_EQ(xaui.exitCode, 0) << xaui.err;
    ASSERT_EQ(custom.exitCode, 0) << custom.err;
    EXPECT_EQ(xaui.Master()->GetPrimitiveName(), "GT11_XAUI");
    for (const char* pin :
         {"RXLOSSOFSYNC", "RXRUNDISP", "TXRUNDISP", "RXCRCOUT", "TXCRCOUT", "RXMCLK"})
        EXPECT_EQ(xaui.Of(pin), "unconnected") << pin;
    EXPECT_EQ(custom.Of("RXLOSSOFSYNC"), "port RXLOSSOFSYNC_OUT/2");
    EXPECT_EQ(custom.Of("RXMCLK"), "port RXMCLK_OUT/1");
    EXPECT_EQ(custom.Of("RXRUNDISP"), "port RXRUNDISP_OUT/4");
}

TEST(FinishRun, BondedCopiesByBondingNumberAndFamily) {
    QTemporaryDir tmp;
    // A device that cannot bond GT10s leaves a stored bonding number of 1.
    const QString noBonding = Variant(tmp, "gt10_custom.json", [](QJsonObject& o) {
        QJsonObject t = o["target"].toObject();
        t["max_bond"] = QJsonObject{{"GT10", 0}};
        o["target"] = t;
    });
    const Finished one = FinishBatch(
        noBonding, {"--set", "QVZ_CHAN_BOND_NUMBER=1", "--set", "CHAN_BOND_MODE=MASTER"});
    ASSERT_EQ(one.exitCode, 0) << one.err;
    EXPECT_EQ(one.Master()->GetAttributeValue("QVZ_CHAN_BOND_NUMBER"), "1");
    EXPECT_EQ(one.Active(), std::vector<std::string>{"GT10_CUSTOM_INST"});
    EXPECT_EQ(one.Of("CHBONDO"), "unconnected");
    EXPECT_EQ(one.Of("CHBONDDONE"), "port CHBONDDONE_OUT/1");

    const Finished four =
        FinishBatch(Fixture("gt10_custom.json"), {"--set", "QVZ_CHAN_BOND_NUMBER=4"});
    ASSERT_EQ(four.exitCode, 0) << four.err;
    EXPECT_EQ(four.Active(), (std::vector<std::string>{"GT10_CUSTOM_INST1", "GT10_CUSTOM_INST2",
                                                       "GT10_CUSTOM_INST3", "GT10_CUSTOM_INST4"}));
    EXPECT_EQ(four.Of("CHBONDO"), "wire CHANBOND_M_S1_OUT/5");
    EXPECT_EQ(four.Of("CHBONDDONE"), "port CHBONDDONE_OUT/1");
    EXPECT_NE(four.out.find("Bonded copies: 3"), std::string::npos) << four.out;

    // GT11 always gets the other transceiver of its tile, bonded or not.
    const Finished gt11 = FinishBatch(Fixture("gt11_custom.json"));
    ASSERT_EQ(gt11.exitCode, 0) << gt11.err;
    EXPECT_EQ(gt11.Active(), (std::vector<std::string>{"GT11_CUSTOM_INST1", "GT11_CUSTOM_INST2"}));
    EXPECT_EQ(gt11.Of("CHBONDO"), "unconnected");
    EXPECT_EQ(gt11.Of("COMBUSIN"), "wire COMBUSOUT_BLK2/16");
    EXPECT_EQ(gt11.Of("COMBUSOUT"), "wire COMBUSOUT/16");
}
