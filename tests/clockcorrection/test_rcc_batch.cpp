// Batch runs of the program on clock-correction fixtures: what it writes into
// the block and what the run report says.

#include "HostRunner.h"

#include <QJsonArray>
#include <QMap>
#include <QTemporaryDir>
#include <gtest/gtest.h>

namespace {

struct BatchRun {
    int exitCode = -1;
    QString err;
    QMap<QString, QString> attrs; // of the first block of the output
    QJsonObject report;
    QStringList messages;
};

BatchRun RunBatch(const QString& fixture, const QStringList& sets = {}) {
    QStringList extra;
    for (const QString& s : sets)
        extra << "--set" << s;
    const BatchOutcome r = RunBatchHost(TestData("clockcorrection/" + fixture), extra);
    BatchRun run;
    run.exitCode = r.host.exitCode;
    run.err = QString::fromUtf8(r.host.err);
    const QJsonArray blocks = r.output["blocks"].toArray();
    if (!blocks.isEmpty())
        for (const QJsonValue& a : blocks[0].toObject()["attributes"].toArray())
            run.attrs[a["name"].toString()] = a["value"].toString();
    run.report = r.report;
    run.messages = PlainMessages(run.report);
    return run;
}

void ExpectAttrs(const BatchRun& run, const QMap<QString, QString>& expected, const char* what) {
    for (auto it = expected.begin(); it != expected.end(); ++it)
        EXPECT_EQ(run.attrs.value(it.key(), "(absent)").toStdString(), it.value().toStdString())
            << what << ": " << it.key().toStdString();
}

const char* const kEqualLatencies =
    "The Maximum Latency (CLK_COR_MAX_LAT) value must be greater than the Minimum Latency "
    "(CLK_COR_MIN_LAT) value.  The wizard cannot continue.";

} // namespace

TEST(RccBatchRun, Gt11WritesSizedLiterals) {
    const BatchRun run = RunBatch("gt11.json");
    ASSERT_EQ(run.exitCode, 0) << run.err.toStdString();
    EXPECT_TRUE(run.messages.isEmpty()) << run.messages.join('\n').toStdString();
    ExpectAttrs(run,
                {{"CLK_COR_SEQ_1_1", "11'b00110111100"},
                 {"CLK_COR_SEQ_1_2", "11'b00010010101"},
                 {"CLK_COR_SEQ_1_3", "11'b00010110101"},
                 {"CLK_COR_SEQ_1_4", "4'b1011"}, // digits are carried over unchecked
                 {"CLK_COR_SEQ_2_2", "11'b01010000011"},
                 {"CLK_COR_SEQ_1_MASK", "4'b0000"},
                 {"CLK_COR_SEQ_2_MASK", "4'b0011"},
                 {"CLK_COR_SEQ_LEN", "4"},
                 {"CLK_COR_SEQ_2_USE", "TRUE"},
                 {"CLK_CORRECT_USE", "TRUE"},
                 {"CLK_COR_KEEP_IDLE", "TRUE"},
                 {"CLK_COR_INSERT_IDLE_FLAG", "FALSE"},
                 {"RX_BUFFER_USE", "TRUE"},
                 {"CLK_COR_REPEAT_WAIT", "0"},
                 {"CLK_COR_MIN_LAT", "24"},
                 {"CLK_COR_MAX_LAT", "48"},
                 {"CLK_COR_SEQ_DROP", "FALSE"},
                 {"CLK_COR_8B10B_DE", "TRUE"}},
                "gt11");
}

TEST(RccBatchRun, Gt10ReplacesMasksThatDoNotFitTheLength) {
    const BatchRun run = RunBatch("gt10.json");
    ASSERT_EQ(run.exitCode, 0) << run.err.toStdString();
    EXPECT_EQ(run.messages,
              QStringList{"The CLK_COR_SEQ_1_MASK value of 1000 is not valid.  It can have only 2 "
                          "zeros (the length of the clock correction sequence).  The wizard will "
                          "use the default length 4 and the CLK_COR_SEQ_1_MASK default 1111 "
                          "instead of the current values."});
    ExpectAttrs(run,
                {{"CLK_COR_SEQ_LEN", "4"},
                 {"CLK_COR_SEQ_1_MASK", "1111"},
                 {"CLK_COR_SEQ_2_MASK", "1111"},
                 {"CLK_COR_SEQ_1_1", "00110111100"},
                 {"CLK_COR_SEQ_1_4", "00000000001"},
                 // General Setup deletes these from every GT10 block.
                 {"CLK_COR_INSERT_IDLE_FLAG", "(absent)"},
                 {"CLK_COR_KEEP_IDLE", "(absent)"},
                 {"CLK_COR_SEQ_DROP", "TRUE"},
                 {"CLK_COR_8B10B_DE", "FALSE"},
                 {"RX_BUFFER_USE", "TRUE"},
                 {"CLK_COR_MIN_LAT", "28"},
                 {"CLK_COR_MAX_LAT", "36"}},
                "gt10");
    // The first family's repeat wait is not part of a GT10 block, nor added.
    EXPECT_FALSE(run.attrs.contains("CLK_COR_REPEAT_WAIT"));
}

TEST(RccBatchRun, Gt10MessagesByLengthAndMasks) {
    const struct {
        const char* name;
        QStringList sets;
        QString message;
        QMap<QString, QString> attrs;
    } cases[] = {
        {"length 1 says zero",
         {"CLK_COR_SEQ_LEN=1", "CLK_COR_SEQ_1_MASK=1100", "CLK_COR_SEQ_2_MASK=0000"},
         "The CLK_COR_SEQ_1_MASK(=1100) and CLK_COR_SEQ_2_MASK(=0000) values are not valid.  They "
         "each can have only 1 zero (the length of the clock correction sequence).  The wizard "
         "will use the defaults (1111 and 1111, respectively, using default length 4) instead of "
         "the current values.",
         {{"CLK_COR_SEQ_LEN", "4"},
          {"CLK_COR_SEQ_1_MASK", "1111"},
          {"CLK_COR_SEQ_2_MASK", "1111"}}},
        {"an illegal length reads as the default",
         {"CLK_COR_SEQ_LEN=5", "CLK_COR_SEQ_1_MASK=0000"},
         "",
         {{"CLK_COR_SEQ_LEN", "4"}, {"CLK_COR_SEQ_1_MASK", "0000"}}},
    };
    for (const auto& c : cases) {
        const BatchRun run = RunBatch("gt10.json", c.sets);
        ASSERT_EQ(run.exitCode, 0) << c.name << "\n" << run.err.toStdString();
        EXPECT_EQ(run.messages.join('\n').toStdString(), c.message.toStdString()) << c.name;
        ExpectAttrs(run, c.attrs, c.name);
    }
}

TEST(RccBatchRun, RefusalsNameThePageAndWriteNothing) {
    const QString gt10Note =
        "The CLK_COR_SEQ_1_MASK value of 1000 is not valid.  It can have only 2 zeros (the length "
        "of the clock correction sequence).  The wizard will use the default length 4 and the "
        "CLK_COR_SEQ_1_MASK default 1111 instead of the current values.";
    const struct {
        const char* fixture;
        QStringList sets;
        QStringList messages;
    } cases[] = {
        // The note of the read comes before the refusal of the write.
        {"gt10.json", {"CLK_COR_MIN_LAT=36"}, {gt10Note, kEqualLatencies}},
        {"gt11.json", {"CLK_COR_MIN_LAT=40", "CLK_COR_MAX_LAT=30"}, {kEqualLatencies}},
        {"gt.json",
         {"CLK_COR_REPEAT_WAIT=32"},
         {"The allowable range for the minimum number of RXUSRCLK cycles is between 0 and 31."}},
    };
    for (const auto& c : cases) {
        const BatchRun run = RunBatch(c.fixture, c.sets);
        const std::string what = c.sets.join(' ').toStdString();
        EXPECT_EQ(run.exitCode, 1) << what;
        EXPECT_EQ(run.report["ok"].toBool(true), false) << what;
        EXPECT_EQ(run.report["failed_page"].toString(), "Receiver Clock Correction Setup") << what;
        EXPECT_EQ(run.messages.join('\n').toStdString(), c.messages.join('\n').toStdString())
            << what;
        EXPECT_TRUE(run.attrs.isEmpty()) << what << ": no output on refusal";
    }
}

TEST(RccBatchRun, FirstFamilyWritesBareDigitsWithoutMaskCheck) {
    const BatchRun run = RunBatch("gt.json");
    ASSERT_EQ(run.exitCode, 0) << run.err.toStdString();
    EXPECT_TRUE(run.messages.isEmpty()) << run.messages.join('\n').toStdString();
    ExpectAttrs(run,
                {{"CLK_COR_SEQ_LEN", "1"},
                 {"CLK_COR_SEQ_1_MASK", "0000"},
                 {"CLK_COR_SEQ_2_MASK", "0000"},
                 {"CLK_COR_SEQ_1_1", "00110111100"},
                 {"CLK_COR_SEQ_2_1", "00010010101"},
                 {"CLK_COR_REPEAT_WAIT", "1"},
                 {"RX_BUFFER_USE", "TRUE"},
                 {"CLK_CORRECT_USE", "FALSE"}},
                "gt");
    // Latencies and the GT10/GT11 flags are not part of the block and stay out.
    for (const char* absent :
         {"CLK_COR_MIN_LAT", "CLK_COR_MAX_LAT", "CLK_COR_SEQ_DROP", "CLK_COR_8B10B_DE"})
        EXPECT_FALSE(run.attrs.contains(absent)) << absent;
}
