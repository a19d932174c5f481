// Batch runs of the velomux-wizard program on bonding fixtures: what ends up
// in the written design data and in the run report.

#include "HostRunner.h"

#include <QJsonArray>
#include <gtest/gtest.h>

#include <map>
#include <string>

namespace {

struct BatchRun {
    int exitCode = -1;
    QJsonObject report;
    QJsonObject out;
    std::string err;

    QJsonArray Messages() const { return report.value("messages").toArray(); }
    std::string Message(int i) const {
        return Messages().at(i).toObject().value("text").toString().toStdString();
    }
    bool IsError(int i) const {
        return Messages().at(i).toObject().value("flags").toArray().at(0).toBool();
    }
    // Attribute values of the named block in the written design data. A
    // bonded master carries the name followed by 1 after the finish.
    std::map<std::string, std::string> Attrs(const char* block) const {
        std::map<std::string, std::string> m;
        QString name = block;
        if (!HasBlock(name) && HasBlock(name + "1"))
            name += "1";
        for (const QJsonValue& b : out.value("blocks").toArray()) {
            if (b.toObject().value("name").toString() != name)
                continue;
            for (const QJsonValue& a : b.toObject().value("attributes").toArray())
                m[a.toObject().value("name").toString().toStdString()] =
                    a.toObject().value("value").toString().toStdString();
        }
        return m;
    }
    bool HasBlock(const QString& name) const;
};

bool BatchRun::HasBlock(const QString& name) const {
    for (const QJsonValue& b : out.value("blocks").toArray())
        if (b.toObject().value("name").toString() == name)
            return true;
    return false;
}

BatchRun Batch(const char* fixture, const QStringList& extra = {}) {
    const BatchOutcome h = RunBatchHost(TestData(QString("channelbonding/") + fixture), extra);
    BatchRun r;
    r.exitCode = h.host.exitCode;
    r.report = h.report;
    r.out = h.output;
    r.err = h.host.err.toStdString();
    return r;
}

const char* const kRangeMessage = "The allowable range for the number of channel bonded "
                                  "transceivers is between 0 and 20, excluding 1.";

} // namespace

TEST(BondingBatch, GtWritesMasterRoleAndCheckedValues) {
    BatchRun r = Batch("gt.json");
    ASSERT_EQ(r.exitCode, 0) << r.err;
    EXPECT_EQ(r.Messages().size(), 0) << r.err; // no mask check on GT
    auto a = r.Attrs("GT_CUSTOM_INST");
    EXPECT_EQ(a["QVZ_CHAN_BOND_NUMBER"], "4");
    EXPECT_EQ(a["CHAN_BOND_MODE"], "MASTER");
    EXPECT_EQ(a["LOC"], "GT_X5Y1");
    EXPECT_EQ(a["CHAN_BOND_LIMIT"], "16");  // 40 is out of range: the default
    EXPECT_EQ(a["CHAN_BOND_SEQ_LEN"], "1"); // 3 is not legal: the default
    EXPECT_EQ(a["CHAN_BOND_ONE_SHOT"], "TRUE");
    EXPECT_EQ(a["CHAN_BOND_SEQ_2_USE"], "FALSE"); // locked: its default
    EXPECT_EQ(a["CHAN_BOND_SEQ_1_4"], "00000000000");
    EXPECT_EQ(a["CHAN_BOND_SEQ_1_1"], "00101111100");
    EXPECT_EQ(a["CHAN_BOND_SEQ_1_MASK"], "0000");

    BatchRun bottom = Batch("gt.json", {"--set", "QVZ_CHAN_BOND_PRIMARY_ROW=0"});
    ASSERT_EQ(bottom.exitCode, 0) << bottom.err;
    EXPECT_EQ(bottom.Attrs("GT_CUSTOM_INST")["LOC"], "GT_X5Y0");
    EXPECT_EQ(bottom.Attrs("GT_CUSTOM_INST")["QVZ_CHAN_BOND_PRIMARY_ROW"], "0");
}

TEST(BondingBatch, NumberZeroAndUnusedReceiverWriteNoBonding) {
    const struct {
        const char* fixture;
        const char* block;
        const char* set;
        const char* mode;
    } cases[] = {
        {"gt.json", "GT_CUSTOM_INST", "QVZ_BOOL_RX_USE=FALSE", "OFF"},
        {"gt.json", "GT_CUSTOM_INST", "QVZ_CHAN_BOND_NUMBER=0", "OFF"},
        {"gt10.json", "GT10_CUSTOM_INST", "QVZ_CHAN_BOND_NUMBER=0", "OFF"},
        {"gt11.json", "GT11_CUSTOM_INST", "QVZ_CHAN_BOND_NUMBER=0", "NONE"},
        {"gt11.json", "GT11_CUSTOM_INST", "QVZ_BOOL_RX_USE=FALSE", "NONE"},
    };
    for (const auto& c : cases) {
        BatchRun r = Batch(c.fixture, {"--set", c.set});
        ASSERT_EQ(r.exitCode, 0) << c.fixture << " " << c.set << "\n" << r.err;
        auto a = r.Attrs(c.block);
        EXPECT_EQ(a["QVZ_CHAN_BOND_NUMBER"], "0") << c.set;
        EXPECT_EQ(a["CHAN_BOND_MODE"], c.mode) << c.set;
        EXPECT_EQ(a.count("LOC"), 0u) << c.set;
    }
}

TEST(BondingBatch, NumberOneAndTooManyAreRefused) {
    for (const char* set : {"QVZ_CHAN_BOND_NUMBER=1", "QVZ_CHAN_BOND_NUMBER=21"}) {
        for (const char* fixture : {"gt.json", "gt10.json"}) {
            BatchRun r = Batch(fixture, {"--set", set});
            EXPECT_EQ(r.exitCode, 1) << fixture << set;
            EXPECT_FALSE(r.report.value("ok").toBool());
            EXPECT_EQ(r.report.value("failed_page").toString(), "Receiver Channel Bonding Setup");
            ASSERT_EQ(r.Messages().size(), 1) << r.err;
            EXPECT_EQ(r.Message(0), kRangeMessage);
            EXPECT_FALSE(r.IsError(0));
            EXPECT_TRUE(r.out.isEmpty()); // nothing written
        }
    }
}

TEST(BondingBatch, XauiForcesFourLanes) {
    BatchRun r = Batch("gt10.json", {"--type", "XAUI"});
    ASSERT_EQ(r.exitCode, 0) << r.err;
    auto a = r.Attrs("GT10_XAUI_INST");
    EXPECT_EQ(a["QVZ_CHAN_BOND_NUMBER"], "4"); // stored 0
    EXPECT_EQ(a["CHAN_BOND_MODE"], "MASTER");
    EXPECT_EQ(a["LOC"], "GT10_X5Y0"); // Bottom
    // With the receiver off the page still writes 4, but finishing bonds
    // nothing without a receiver.
    BatchRun off = Batch("gt10.json", {"--type", "XAUI", "--set", "QVZ_BOOL_RX_USE=FALSE"});
    ASSERT_EQ(off.exitCode, 0) << off.err;
    EXPECT_EQ(off.Attrs("GT10_XAUI_INST")["QVZ_CHAN_BOND_NUMBER"], "0");
    EXPECT_EQ(off.Attrs("GT10_XAUI_INST2").size(), 0u);
}

TEST(BondingBatch, Gt11OddNumberLoweredWithSizedLiterals) {
    BatchRun r = Batch("gt11.json");
    ASSERT_EQ(r.exitCode, 0) << r.err;
    ASSERT_EQ(r.Messages().size(), 1) << r.err;
    EXPECT_EQ(r.Message(0), "Because dual GT11s will be generated, the number of channel bonded "
                            "transceivers must be an even number.  The current number of 5 has "
                            "been changed to be 4.");
    EXPECT_FALSE(r.IsError(0));
    auto a = r.Attrs("GT11_CUSTOM_INST");
    EXPECT_EQ(a["QVZ_CHAN_BOND_NUMBER"], "4");
    EXPECT_EQ(a["CHAN_BOND_MODE"], "MASTER");
    EXPECT_EQ(a["LOC"], "GT11_X1Y3"); // maximum 13 counts as 12
    EXPECT_EQ(a["CHAN_BOND_SEQ_1_MASK"], "4'b1111");
    EXPECT_EQ(a["CHAN_BOND_SEQ_2_MASK"], "4'b1100");
    EXPECT_EQ(a["CHAN_BOND_SEQ_1_1"], "11'b00101111100");
    EXPECT_EQ(a["CHAN_BOND_SEQ_1_2"], "4'b0101");
    EXPECT_EQ(a["CHAN_BOND_SEQ_1_3"], "4'b1010");
    EXPECT_EQ(a["CHAN_BOND_SEQ_1_4"], "2'b10");
    EXPECT_EQ(a["CHAN_BOND_SEQ_2_1"], "11'b00000000000");
}

TEST(BondingBatch, InvalidMaskOnReadFallsBackToDefaults) {
    BatchRun r =
        Batch("gt10.json", {"--set", "CHAN_BOND_SEQ_1_MASK=0001", "--set", "CHAN_BOND_SEQ_LEN=2"});
    ASSERT_EQ(r.exitCode, 0) << r.err;
    ASSERT_EQ(r.Messages().size(), 1) << r.err;
    EXPECT_EQ(r.Message(0),
              "The mask for channel bonding sequence 1 (CHAN_BOND_SEQ_1_MASK=0001) is not valid.  "
              "It can have only 2 zeros (the length of the channel bonding sequence "
              "(CHAN_BOND_SEQ_LEN)).  The wizard will use the default length 4 and the "
              "CHAN_BOND_SEQ_1_MASK default 1111 instead of the current values.");
    EXPECT_FALSE(r.IsError(0));
    auto a = r.Attrs("GT10_CUSTOM_INST");
    EXPECT_EQ(a["CHAN_BOND_SEQ_1_MASK"], "1111");
    EXPECT_EQ(a["CHAN_BOND_SEQ_LEN"], "4");
}

TEST(BondingBatch, InvalidMaskOnWriteRefuses) {
    // The block's own default mask is too long for its default length.
    BatchRun r = Batch("gt10.json", {"--type", "Amberlane"});
    EXPECT_EQ(r.exitCode, 1) << r.err;
    EXPECT_EQ(r.report.value("failed_page").toString(), "Receiver Channel Bonding Setup");
    ASSERT_EQ(r.Messages().size(), 2) << r.err;
    EXPECT_EQ(r.Message(0),
              "The mask for channel bonding sequence 1 (CHAN_BOND_SEQ_1_MASK=0000) is not valid.  "
              "It can have only 1 zero (the length of the channel bonding sequence "
              "(CHAN_BOND_SEQ_LEN)).  The wizard will use the default length 1 and the "
              "CHAN_BOND_SEQ_1_MASK default 0000 instead of the current values.");
    EXPECT_FALSE(r.IsError(0));
    EXPECT_EQ(r.Message(1),
              "The mask for channel bonding sequence 1 (CHAN_BOND_SEQ_1_MASK=0000) is not valid.  "
              "It can have only 1 zero (the length of the channel bonding sequence).  Please "
              "change the value to be valid.");
    EXPECT_TRUE(r.IsError(1));
}

TEST(BondingBatch, InfinibandLaneIdFillsItsSequences) {
    BatchRun r = Batch("gt10.json", {"--type", "Infiniband"});
    ASSERT_EQ(r.exitCode, 0) << r.err;
    auto a = r.Attrs("GT10_INFINIBAND_INST");
    EXPECT_EQ(a["LANE_ID"], "00000000011");
    EXPECT_EQ(a["CHAN_BOND_SEQ_1_2"], "00000000011");
    EXPECT_EQ(a["CHAN_BOND_SEQ_2_2"], "00000000011");
    EXPECT_EQ(a["CHAN_BOND_SEQ_1_1"], "00101111100");
    EXPECT_EQ(a["CHAN_BOND_MODE"], "MASTER");
    // Another lane's block is read, not written.
    EXPECT_EQ(r.Attrs("GT10_INFINIBAND_INST3")["LANE_ID"], "00000000101");
}
