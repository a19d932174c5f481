// Batch runs of velomux-wizard on General Setup fixtures: what the page
// leaves in the design and what the run report says.

#include "HostRunner.h"
#include "Qvz_DesignJson.h"

#include <QJsonArray>
#include <QTemporaryDir>
#include <gtest/gtest.h>

#include <string>
#include <vector>

using Strings = std::vector<std::string>;

namespace {

struct BatchResult {
    int exitCode = -1;
    std::string err;
    bool written = false;
    Qvz_WizData out;
    QJsonObject report;

    Strings Messages() const {
        Strings m;
        for (const QJsonValue& v : report["messages"].toArray())
            m.push_back(v.toObject()["text"].toString().toStdString());
        return m;
    }
    bool AllNotes() const {
        for (const QJsonValue& v : report["messages"].toArray())
            if (v.toObject()["flags"].toArray() != QJsonArray{false, false, false})
                return false;
        return true;
    }
    const Qvz_Block* Block(const char* name) const { return out.GetNamedBlock(name); }
    Strings Active() const {
        Strings a;
        for (const auto& b : out.GetBlocks())
            if (b->IsUsed())
                a.push_back(b->GetName().str());
        return a;
    }
};

BatchResult BatchRun(const QString& design, const QStringList& extra = {}) {
    QTemporaryDir tmp;
    const QString out = tmp.filePath("out.json"), report = tmp.filePath("report.json");
    QStringList args = {"--batch", "-o", out, "--report", report};
    args << extra << design;
    HostResult h = RunHost(args);
    BatchResult r;
    r.exitCode = h.exitCode;
    r.err = h.err.toStdString();
    r.report = ReadJson(report);
    QString error;
    r.written = QFile::exists(out) && Qvz_DesignJson::LoadFile(out, r.out, error);
    return r;
}

// A fixture with the edits of a test, written to dir.
QString Variant(const QTemporaryDir& dir, const char* fixture,
                const std::function<void(QJsonObject&)>& edit) {
    QJsonObject o = ReadJson(TestData(QString("general/") + fixture));
    edit(o);
    const QString path = dir.filePath(fixture);
    WriteAll(path, QJsonDocument(o).toJson());
    return path;
}

QString Fixture(const char* name) {
    return TestData(QString("general/") + name);
}

struct AttrValue {
    const char* name;
    const char* value; // null: the attribute must be gone
};

void ExpectAttributes(const Qvz_Block* b, std::initializer_list<AttrValue> expected) {
    ASSERT_NE(b, nullptr);
    for (const auto& e : expected) {
        if (!e.value) {
            EXPECT_EQ(b->GetNamedAttribute(e.name), nullptr) << e.name;
            continue;
        }
        ASSERT_NE(b->GetNamedAttribute(e.name), nullptr) << e.name;
        EXPECT_EQ(b->GetAttributeValue(e.name), e.value) << e.name;
    }
}

int PinWidth(const Qvz_Block* b, const char* pin) {
    const Qvz_Pin* p = b ? b->GetNamedPin(pin) : nullptr;
    return p ? p->GetWidth() : -1;
}

const char* const kFileNameWarning =
    "The name of a Velomux transceiver primitive you selected is the same as your file name.  "
    "This will cause an error during synthesis.  Please select a different transceiver, or cancel "
    "out from the wizard and choose another file name.";

} // namespace

TEST(GeneralBatch, GtBlockGetsItsWidthDirectionsClocksAndPinWidths) {
    BatchResult r = BatchRun(Fixture("gt_fibre_chan.json"));
    ASSERT_EQ(r.exitCode, 0) << r.err;
    ASSERT_TRUE(r.written);
    EXPECT_TRUE(r.report["ok"].toBool());
    EXPECT_EQ(r.Messages(), Strings{});
    EXPECT_EQ(r.Active(), Strings{"GT_FIBRE_CHAN_INST"});
    const Qvz_Block* b = r.Block("GT_FIBRE_CHAN_INST");
    ExpectAttributes(b, {{"RX_DATA_WIDTH", "2"},
                         {"TX_DATA_WIDTH", "2"},
                         {"QVZ_BOOL_TX_USE", "TRUE"},
                         {"QVZ_BOOL_RX_USE", "TRUE"},
                         {"SERDES_10B", "TRUE"},
                         {"TERMINATION_IMP", "75"},
                         {"REF_CLK_V_SEL", "1"},
                         {"QVZX_ONLY_REFCLK", "REFCLK"},
                         {"QVZX_ONLY_REFCLK_DYN", ""},
                         {"QVZX_ONLY_BREFCLK", ""},
                         {"QVZX_ONLY_BREFCLK_DYN", ""},
                         {"QVZ_CHAN_BOND_NUMBER", "0"},
                         {"QVZ_RX_DATA_WIDTH", nullptr},
                         {"QVZX_ONLY_USE_REFCLK", nullptr}});
    EXPECT_EQ(PinWidth(b, "TXDATA"), 16);
    EXPECT_EQ(PinWidth(b, "RXDATA"), 16);
    EXPECT_EQ(PinWidth(b, "TXCHARISK"), 2);
    EXPECT_EQ(PinWidth(b, "RXCHARISK"), 2);
    EXPECT_EQ(PinWidth(b, "LOOPBACK"), 2);
    // The other block is left as the library has it.
    EXPECT_EQ(PinWidth(r.Block("GT_CUSTOM_INST"), "TXDATA"), 32);
    EXPECT_EQ(r.Block("GT_CUSTOM_INST")->GetNamedAttribute("QVZ_BOOL_TX_USE"), nullptr);
}

TEST(GeneralBatch, FileNamedLikeThePrimitiveWarnsAndStillCompletes) {
    QTemporaryDir tmp;
    const QString design = Variant(tmp, "gt_fibre_chan.json", [](QJsonObject& o) {
        QJsonObject t = o["target"].toObject();
        t["file_name"] = "GT_FIBRE_CHAN_2";
        o["target"] = t;
    });
    BatchResult r = BatchRun(design);
    ASSERT_EQ(r.exitCode, 0) << r.err;
    ASSERT_TRUE(r.written);
    EXPECT_EQ(r.Messages(), Strings{kFileNameWarning});
    EXPECT_TRUE(r.AllNotes());
    EXPECT_NE(r.err.find(std::string("note: ") + kFileNameWarning), std::string::npos) << r.err;
    EXPECT_EQ(r.Block("GT_FIBRE_CHAN_INST")->GetAttributeValue("RX_DATA_WIDTH"), "2");
    EXPECT_EQ(PinWidth(r.Block("GT_FIBRE_CHAN_INST"), "TXDATA"), 16);
}

TEST(GeneralBatch, Gt10BlockIsMigratedRenamedAndPruned) {
    BatchResult r = BatchRun(Fixture("gt10_oc48.json"));
    ASSERT_EQ(r.exitCode, 0) << r.err;
    ASSERT_TRUE(r.written);
    EXPECT_EQ(r.Messages(), Strings{});
    // The digit-first instance gets its letters; the width picks it over OC48_2.
    EXPECT_EQ(r.Active(), Strings{"GT4_OC48_INST"});
    EXPECT_EQ(r.Block("4_OC48_INST"), nullptr);
    const Qvz_Block* b = r.Block("GT4_OC48_INST");
    ExpectAttributes(b, {{"QVZ_RX_DATA_WIDTH", "4"},
                         {"QVZ_TX_DATA_WIDTH", "4"},
                         {"RX_DATA_WIDTH", nullptr},
                         {"BOOL_TX_USE", nullptr},
                         {"BOOL_RX_USE", nullptr},
                         {"CHAN_BOND_NUMBER", nullptr},
                         {"QVZ_BOOL_TX_USE", "TRUE"},
                         {"QVZ_BOOL_RX_USE", "TRUE"},
                         {"QVZ_CHAN_BOND_NUMBER", "0"},
                         {"PMA_SPEED", "0_32"},
                         {"QVZX_ONLY_BYPASS_PCS", "FALSE"},
                         {"QVZX_ONLY_TX_8B10B_USE", nullptr},
                         {"QVZX_ONLY_USE_REFCLK", "TRUE"},
                         {"QVZX_ONLY_USE_BREFCLK", "TRUE"},
                         {"QVZX_ONLY_REFCLK", ""},
                         {"QVZX_ONLY_REFCLK_DYN", ""},
                         {"QVZX_ONLY_BREFCLK", nullptr},
                         {"SH_CNT_MAX", nullptr},
                         {"PMAVSEL", nullptr},
                         {"CHAN_BOND_LIMIT", nullptr},
                         // Pruned here; the bonding page's batch step then
                         // writes "no bonding" into it.
                         {"CHAN_BOND_MODE", "OFF"},
                         {"CLK_COR_SEQ_1_1", nullptr},
                         {"COMMA_10B_MASK", "1111111111"}});
    EXPECT_EQ(b->GetNamedPin("PMAPWRDN"), nullptr);
    EXPECT_EQ(PinWidth(b, "CHBONDI"), 5);
    EXPECT_EQ(PinWidth(b, "TXDATA"), 32);
    EXPECT_EQ(PinWidth(b, "TXKERR"), 4);
}

TEST(GeneralBatch, Gt11BlockGetsItsModeAndOldValueFormsConverted) {
    BatchResult r = BatchRun(Fixture("gt11_custom.json"));
    ASSERT_EQ(r.exitCode, 0) << r.err;
    ASSERT_TRUE(r.written);
    EXPECT_EQ(r.Messages(), Strings{});
    EXPECT_EQ(r.Active(), Strings{"GT11_CUSTOM_INST"});
    const Qvz_Block* b = r.Block("GT11_CUSTOM_INST");
    ExpectAttributes(b, {{"QVZ_RX_DATA_WIDTH", "2"},
                         {"QVZ_TX_DATA_WIDTH", "2"},
                         {"QVZ_GT11_MODE", "SINGLE"},
                         {"CHAN_BOND_MODE", "NONE"},
                         {"QVZ_GT11_USE_B", "FALSE"},
                         {"QVZ_CHAN_BOND_NUMBER", "0"},
                         {"CLK_COR_SEQ_1_MASK", "4'b1100"},
                         {"TXPLLNDIVSEL", "16"},
                         {"RXPLLNDIVSEL", "20"},
                         {"RXFDCAL_CLOCK_DIVIDE", "NONE"},
                         {"RX_LOS_THRESHOLD", nullptr},
                         {"COMMA_32B_MASK", nullptr},
                         {"QVZX_ONLY_USE_REFCLK", nullptr},
                         {"QVZX_ONLY_REFCLK", nullptr}});
    EXPECT_EQ(PinWidth(b, "TXDATA"), 16);
}

TEST(GeneralBatch, ObsoleteZephine8RunsAsZephine4) {
    BatchResult r = BatchRun(Fixture("gt10_zephine8.json"));
    ASSERT_EQ(r.exitCode, 0) << r.err;
    ASSERT_TRUE(r.written);
    EXPECT_EQ(r.Messages(),
              Strings{"The primitive GT10_ZEPHINE_8 is obsolete.  The wizard will use "
                      "GT10_ZEPHINE_4 instead."});
    EXPECT_TRUE(r.AllNotes());
    EXPECT_EQ(r.Active(), Strings{"GT10_ZEPHINE_4_INST"});
    ExpectAttributes(r.Block("GT10_ZEPHINE_4_INST"), {{"QVZ_RX_DATA_WIDTH", "4"},
                                                      {"SH_CNT_MAX", nullptr},
                                                      {"COMMA_10B_MASK", "1111111111"},
                                                      {"QVZ_CHAN_BOND_NUMBER", "2"}});
    // The obsolete block itself is not written.
    ExpectAttributes(r.Block("GT10_ZEPHINE_8_INST"),
                     {{"SH_CNT_MAX", "64"}, {"QVZ_BOOL_TX_USE", nullptr}});
}

TEST(GeneralBatch, Zephine8WithoutZephine4FallsBackToTheDefaultType) {
    QTemporaryDir tmp;
    const QString design = Variant(tmp, "gt10_zephine8.json", [](QJsonObject& o) {
        QJsonArray blocks = o["blocks"].toArray();
        blocks.removeAt(1);
        o["blocks"] = blocks;
    });
    BatchResult r = BatchRun(design);
    ASSERT_EQ(r.exitCode, 0) << r.err;
    EXPECT_EQ(r.Messages(), Strings{"Tessel Wizard internal data error"});
    EXPECT_EQ(r.Active(), Strings{"GT10_CUSTOM_INST"});
    EXPECT_EQ(r.Block("GT10_CUSTOM_INST")->GetAttributeValue("QVZ_RX_DATA_WIDTH"), "4");
}

TEST(GeneralBatch, Gt10_3GIOBlockRunsAsPciExpressWithItsValues) {
    BatchResult r = BatchRun(Fixture("gt10_3gio.json"));
    ASSERT_EQ(r.exitCode, 0) << r.err;
    ASSERT_TRUE(r.written);
    EXPECT_EQ(r.Messages(), Strings{"The primitive GT10_3GIO_2 has been changed to "
                                    "GT10_PCI_EXPRESS_2.  The wizard will use GT10_PCI_EXPRESS_2 "
                                    "instead."});
    EXPECT_EQ(r.Active(), Strings{"GT10_PCI_EXPRESS_2_INST"});
    ExpectAttributes(r.Block("GT10_PCI_EXPRESS_2_INST"), {{"MGT_DISPLAY_NAME", "PCI Express"},
                                                          {"PMA_SPEED", "1_32"},
                                                          {"TERMINATION_IMP", "75"},
                                                          {"QVZ_BOOL_RX_USE", "FALSE"},
                                                          {"QVZ_BOOL_TX_USE", "TRUE"},
                                                          {"QVZ_CHAN_BOND_NUMBER", "0"},
                                                          {"ONLY_IN_3GIO", nullptr},
                                                          {"SH_CNT_MAX", nullptr}});
}

TEST(GeneralBatch, NeitherTransmitterNorReceiverRefusesTheRun) {
    QTemporaryDir tmp;
    const QString out = tmp.filePath("out.json"), report = tmp.filePath("report.json");
    HostResult h = RunHost({"--batch", "-o", out, "--report", report, "--set", "BOOL_TX_USE=FALSE",
                            "--set", "BOOL_RX_USE=FALSE", Fixture("gt10_oc48.json")});
    EXPECT_EQ(h.exitCode, 1) << h.err.toStdString();
    EXPECT_FALSE(QFile::exists(out));
    const QJsonObject rep = ReadJson(report);
    EXPECT_FALSE(rep["ok"].toBool());
    EXPECT_EQ(rep["exit_code"].toInt(), 1);
    EXPECT_EQ(rep["failed_page"].toString(), "General Setup");
    const QJsonArray messages = rep["messages"].toArray();
    ASSERT_EQ(messages.size(), 1);
    EXPECT_EQ(messages[0].toObject()["text"].toString(),
              "Please select transmitter mode and/or receiver mode.");
    EXPECT_EQ(messages[0].toObject()["flags"].toArray(), (QJsonArray{false, false, false}));
}
