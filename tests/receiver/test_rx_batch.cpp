// Batch runs of the program on receiver fixtures: what the Receiver Setup
// page writes back, and what it refuses.

#include "HostRunner.h"

#include <QJsonArray>
#include <QMap>
#include <gtest/gtest.h>

namespace {

const char* kPage = "Receiver Setup";
const QString kThreshold = "The value of RX_LOS_THRESHOLD must be at least as big as the value "
                           "of RX_LOS_INVLID_INCR.";

struct BatchRun {
    HostResult host;
    bool written = false;
    QMap<QString, QString> attrs; // the active block's attributes after the run
    QJsonObject report;
    QStringList messages;
};

BatchRun Batch(const QString& fixture, const QStringList& sets = {}) {
    QStringList extra;
    for (const QString& s : sets)
        extra << "--set" << s;
    const BatchOutcome run = RunBatchHost(TestData("receiver/" + fixture), extra);
    BatchRun r;
    r.host = run.host;
    r.written = run.written;
    for (const QJsonValue& b : run.output["blocks"].toArray()) {
        if (!b["used"].toBool())
            continue;
        for (const QJsonValue& a : b["attributes"].toArray())
            r.attrs[a["name"].toString()] = a["value"].toString();
        break;
    }
    r.report = run.report;
    r.messages = PlainMessages(r.report);
    return r;
}

std::string Describe(const BatchRun& r) {
    return r.host.err.toStdString() + r.messages.join('\n').toStdString();
}

// Every receiver message the run issued, in order.
QStringList ReceiverMessages(const QStringList& all) {
    QStringList out;
    for (const QString& m : all)
        if (m.contains("SH_CNT_MAX") || m.contains("SH_INVALID_CNT_MAX") ||
            m.contains("RX_LOS_THRESHOLD") || m.contains("internal data error"))
            out << m;
    return out;
}

void ExpectAccepted(const BatchRun& r, const std::string& what) {
    EXPECT_EQ(r.host.exitCode, 0) << what << "\n" << Describe(r);
    EXPECT_TRUE(r.written) << what;
    EXPECT_TRUE(r.report["ok"].toBool()) << what;
    EXPECT_TRUE(r.report["failed_page"].isNull()) << what;
    EXPECT_TRUE(ReceiverMessages(r.messages).isEmpty()) << what << "\n" << Describe(r);
}

void ExpectRefused(const BatchRun& r, const QString& message, const std::string& what) {
    EXPECT_EQ(r.host.exitCode, 1) << what << "\n" << Describe(r);
    EXPECT_FALSE(r.written) << what;
    EXPECT_FALSE(r.report["ok"].toBool()) << what;
    EXPECT_EQ(r.report["failed_page"].toString(), kPage) << what;
    // The page stops at its first failed check: one message, the run's last.
    EXPECT_EQ(ReceiverMessages(r.messages), QStringList{message}) << what << "\n" << Describe(r);
    EXPECT_FALSE(r.messages.isEmpty() || r.messages.last() != message) << what;
    EXPECT_TRUE(r.host.err.contains(("note: " + message).toUtf8())) << what;
}

using Expected = QMap<QString, QString>;

void ExpectAttrs(const BatchRun& r, const Expected& expected, const std::string& what) {
    for (auto it = expected.begin(); it != expected.end(); ++it) {
        if (it.value().isNull())
            EXPECT_FALSE(r.attrs.contains(it.key())) << what << ": " << it.key().toStdString();
        else
            EXPECT_EQ(r.attrs.value(it.key()), it.value())
                << what << ": " << it.key().toStdString();
    }
}

} // namespace

TEST(RxBatch, FirstFamilyReadsDynamicDecodingAsStatic) {
    const BatchRun r = Batch("rx_gt.json");
    ExpectAccepted(r, "gt");
    ExpectAttrs(r,
                {{"QVZX_ONLY_DECODING", "STATIC"},
                 {"RX_DECODE_USE", "TRUE"},
                 {"QVZX_ONLY_DEC_STATIC", "8B10B"},
                 {"RX_CRC_USE", "TRUE"},
                 {"RX_LOSS_OF_SYNC_FSM", "TRUE"},
                 {"RX_LOS_INVALID_INCR", "1"},
                 {"RX_LOS_THRESHOLD", "4"},
                 // Nothing the block lacks is added.
                 {"SH_CNT_MAX", QString()},
                 {"RXAFEEQ", QString()},
                 {"RXCRCINITVAL", QString()},
                 {"QVZ_RXCRC_USE", QString()}},
                "gt");
}

TEST(RxBatch, Gt10KeepsStaticDecodingAndCounters) {
    const BatchRun r = Batch("rx_gt10.json");
    ExpectAccepted(r, "gt10");
    ExpectAttrs(r,
                {{"QVZX_ONLY_DECODING", "STATIC"},
                 {"RX_DECODE_USE", "TRUE"},
                 {"QVZX_ONLY_DEC_STATIC", "64B66B"},
                 {"RX_LOS_INVALID_INCR", "2"},
                 {"RX_LOS_THRESHOLD", "8"},
                 {"SH_CNT_MAX", "64"},
                 {"SH_INVALID_CNT_MAX", "16"},
                 {"RX_CRC_USE", QString()}},
                "gt10");

    // The PMA speed decides which decodings remain: dynamic decoding with
    // only 64B/66B allowed becomes static, and a static 8B/10B choice that
    // the speed forbids becomes 64B/66B.
    const BatchRun dyn = Batch("rx_gt10.json", {"PMA_SPEED=2_32", "QVZX_ONLY_DECODING=DYNAMIC"});
    ExpectAccepted(dyn, "dynamic at 2_32");
    ExpectAttrs(dyn, {{"QVZX_ONLY_DECODING", "STATIC"}, {"QVZX_ONLY_DEC_STATIC", "64B66B"}},
                "dynamic at 2_32");
    const BatchRun stat = Batch("rx_gt10.json", {"PMA_SPEED=2_32", "QVZX_ONLY_DEC_STATIC=8B10B"});
    ExpectAccepted(stat, "static 8B10B at 2_32");
    ExpectAttrs(stat, {{"QVZX_ONLY_DEC_STATIC", "64B66B"}}, "static 8B10B at 2_32");
}

TEST(RxBatch, EditableDecoderSwitchedOffDisablesDecoding) {
    const BatchRun r = Batch("rx_gt10.json", {"RX_DECODE_USE=FALSE"});
    ExpectAccepted(r, "gt10 RX_DECODE_USE FALSE");
    ExpectAttrs(r, {{"QVZX_ONLY_DECODING", "DISABLE"}, {"RX_DECODE_USE", "FALSE"}},
                "gt10 RX_DECODE_USE FALSE");

    // On the GT11 fixture RX_DECODE_USE is FALSE but not editable: ignored.
    const BatchRun fixed = Batch("rx_gt11.json");
    ExpectAccepted(fixed, "gt11");
    ExpectAttrs(fixed, {{"QVZX_ONLY_DECODING", "STATIC"}, {"RX_DECODE_USE", "TRUE"}}, "gt11");
}

TEST(RxBatch, Gt11CrcAndEqualisationRoundTrip) {
    const BatchRun r = Batch("rx_gt11.json");
    ExpectAccepted(r, "gt11");
    ExpectAttrs(r,
                {{"RXAFEEQ", "9'b000000101"},
                 {"RXCRCINITVAL", "32'hDEADBEEF"},
                 {"RXCRCCLOCKDOUBLE", "TRUE"},
                 {"QVZ_RXCRC_USE", "TRUE"},
                 {"QVZ_RXCRC_DATAWIDTH", "32"},
                 {"RX_LOSS_OF_SYNC_FSM", "FALSE"},
                 {"QVZX_ONLY_DEC_STATIC", "8B10B"},
                 {"QVZX_ONLY_BYPASS_PCS", "FALSE"},
                 {"SH_CNT_MAX", QString()}},
                "gt11");

    const struct {
        const char* set;
        const char* afeEq;
    } afe[] = {
        {"RXAFEEQ=9'b000000011", "9'b000000011"},
        // Shorter than the stored prefix: still written back well-formed.
        {"RXAFEEQ=3'b110", "9'b000000110"},
        {"RXAFEEQ=1", "9'b000000001"},
        {"RXAFEEQ=", "9'b000000000"},
    };
    for (const auto& c : afe) {
        const BatchRun a = Batch("rx_gt11.json", {c.set});
        ExpectAccepted(a, c.set);
        ExpectAttrs(a, {{"RXAFEEQ", c.afeEq}}, c.set);
    }
    // An initial value without its size marker gets one.
    const BatchRun bare = Batch("rx_gt11.json", {"RXCRCINITVAL=0000ABCD"});
    ExpectAccepted(bare, "bare CRC value");
    ExpectAttrs(bare, {{"RXCRCINITVAL", "32'h0000ABCD"}}, "bare CRC value");
}

TEST(RxBatch, LossOfSyncThresholdMustReachTheIncrement) {
    for (const char* fixture : {"rx_gt.json", "rx_gt10.json"}) {
        const std::string f = fixture;
        const BatchRun equal = Batch(fixture, {"RX_LOS_INVALID_INCR=8", "RX_LOS_THRESHOLD=8"});
        ExpectAccepted(equal, f + " equal");
        ExpectAttrs(equal, {{"RX_LOS_INVALID_INCR", "8"}, {"RX_LOS_THRESHOLD", "8"}}, f);
        const BatchRun above = Batch(fixture, {"RX_LOS_INVALID_INCR=16", "RX_LOS_THRESHOLD=8"});
        ExpectRefused(above, kThreshold, f + " above");
        // Compared as numbers.
        const BatchRun numeric = Batch(fixture, {"RX_LOS_INVALID_INCR=64", "RX_LOS_THRESHOLD=512"});
        ExpectAccepted(numeric, f + " numeric");
    }
    // General Setup deletes both attributes from a GT11 block before this page
    // reads it, so nothing is left to refuse.
    const BatchRun gt11 = Batch("rx_gt11.json", {"RX_LOS_INVALID_INCR=16", "RX_LOS_THRESHOLD=8"});
    ExpectAccepted(gt11, "gt11 above");
    ExpectAttrs(gt11, {{"RX_LOS_INVALID_INCR", QString()}, {"RX_LOS_THRESHOLD", QString()}},
                "gt11 above");
}

TEST(RxBatch, SyncHeaderCountersAreCheckedInOrder) {
    const QString cnt = "The allowable range for the attribute SH_CNT_MAX is between 1 and 255.";
    const QString inv =
        "The allowable range for the attribute SH_INVALID_CNT_MAX is between 1 and 32.";
    const struct {
        QStringList sets;
        QString message; // empty: accepted
        const char* cntValue;
        const char* invValue;
    } cases[] = {
        {{"SH_CNT_MAX=0"}, cnt, "", ""},
        {{"SH_CNT_MAX=0", "SH_INVALID_CNT_MAX=0"}, cnt, "", ""},
        {{"SH_CNT_MAX=256"}, cnt, "", ""},
        {{"SH_INVALID_CNT_MAX=33"}, inv, "", ""},
        // Beyond the range, and the loss-of-sync order wrong too: the counters come first.
        {{"SH_INVALID_CNT_MAX=0", "RX_LOS_INVALID_INCR=128"}, inv, "", ""},
        {{"SH_CNT_MAX=255", "SH_INVALID_CNT_MAX=32"}, "", "255", "32"},
        {{"SH_CNT_MAX=1", "SH_INVALID_CNT_MAX=1"}, "", "1", "1"},
        // Eight characters, or no number: the attribute's default stands in.
        {{"SH_INVALID_CNT_MAX=00000005"}, "", "64", "24"},
        {{"SH_INVALID_CNT_MAX=7x"}, "", "64", "24"},
        {{"SH_CNT_MAX=many"}, "", "64", "16"},
    };
    for (const auto& c : cases) {
        const std::string what = c.sets.join(' ').toStdString();
        const BatchRun r = Batch("rx_gt10.json", c.sets);
        if (c.message.isEmpty()) {
            ExpectAccepted(r, what);
            ExpectAttrs(r, {{"SH_CNT_MAX", c.cntValue}, {"SH_INVALID_CNT_MAX", c.invValue}}, what);
        } else {
            ExpectRefused(r, c.message, what);
        }
    }
}
