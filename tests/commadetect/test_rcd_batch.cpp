// Batch runs of the program on one block of each family.
#include "HostRunner.h"
#include "Qvz_DesignJson.h"

#include <QJsonArray>
#include <QTemporaryDir>
#include <gtest/gtest.h>

#include <utility>
#include <vector>

namespace {

using Values = std::vector<std::pair<const char*, const char*>>;

struct BatchCase {
    const char* fixture;
    QStringList sets; // NAME=VALUE, applied before the run
    Values expected;
    std::vector<const char*> absent;
};

// Every comma attribute of the GT fixture as it is written back.
const Values kGtWritten = {
    {"QVZX_ONLY_TURNOFF_COMMA", "FALSE"},
    {"DEC_PCOMMA_DETECT", "TRUE"},
    {"DEC_MCOMMA_DETECT", "TRUE"},
    {"ALIGN_COMMA_MSB", "TRUE"},
    {"DEC_VALID_COMMA_ONLY", "TRUE"},
    {"PCOMMA_10B_VALUE", "0101111100"},
    {"PCOMMA_DETECT", "TRUE"},
    {"QVZX_ONLY_PCOMMA_CTRL", "DYNAMIC"},
    {"MCOMMA_10B_VALUE", "1010000011"},
    {"MCOMMA_DETECT", "TRUE"},
    {"QVZX_ONLY_MCOMMA_CTRL", "ALWAYS"},
    {"COMMA_10B_MASK", "1111111000"},
    {"ALIGN_COMMA_WORD", "2"},
};

const BatchCase kCases[] = {
    // First family: binary patterns go back unchanged, without a size.
    {"gt.json", {}, kGtWritten, {"PCOMMA_32B_VALUE", "MCOMMA_32B_VALUE"}},
    {"gt.json",
     {"QVZX_ONLY_TURNOFF_COMMA=TRUE"},
     {{"QVZX_ONLY_TURNOFF_COMMA", "TRUE"},
      {"DEC_PCOMMA_DETECT", "FALSE"},
      {"DEC_MCOMMA_DETECT", "FALSE"},
      {"ALIGN_COMMA_MSB", "FALSE"},
      {"DEC_VALID_COMMA_ONLY", "TRUE"},
      {"QVZX_ONLY_PCOMMA_CTRL", "DISABLE"},
      {"PCOMMA_DETECT", "FALSE"},
      {"QVZX_ONLY_MCOMMA_CTRL", "DISABLE"},
      {"MCOMMA_DETECT", "FALSE"},
      {"PCOMMA_10B_VALUE", "0101111100"},
      {"MCOMMA_10B_VALUE", "1010000011"},
      {"COMMA_10B_MASK", "0000000000"}},
     {}},
    // A hexadecimal literal on a binary family keeps its bits.
    {"gt.json",
     {"COMMA_10B_MASK=10'h0F8", "PCOMMA_10B_VALUE=10'h17C"},
     {{"COMMA_10B_MASK", "0011111000"}, {"PCOMMA_10B_VALUE", "0101111100"}},
     {}},
    {"gt.json",
     {"QVZX_ONLY_MCOMMA_CTRL=SOMETIMES", "QVZX_ONLY_PCOMMA_CTRL=DISABLE"},
     {{"QVZX_ONLY_MCOMMA_CTRL", "ALWAYS"},
      {"MCOMMA_DETECT", "TRUE"},
      {"QVZX_ONLY_PCOMMA_CTRL", "DISABLE"},
      {"PCOMMA_DETECT", "FALSE"}},
     {}},

    // GT10: PCOMMA_DETECT "FALSE" wins over "ALWAYS"; the fixed plus-comma
    // goes back to its default; the minus-comma control has no detect
    // attribute and is never written.
    {"gt10.json",
     {},
     {{"QVZX_ONLY_TURNOFF_COMMA", "FALSE"},
      {"DEC_PCOMMA_DETECT", "FALSE"},
      {"DEC_MCOMMA_DETECT", "TRUE"},
      {"DEC_VALID_COMMA_ONLY", "FALSE"},
      {"PCOMMA_10B_VALUE", "0011111000"},
      {"QVZX_ONLY_PCOMMA_CTRL", "DISABLE"},
      {"PCOMMA_DETECT", "FALSE"},
      {"MCOMMA_10B_VALUE", "1100000101"},
      {"QVZX_ONLY_MCOMMA_CTRL", "DYNAMIC"},
      {"COMMA_10B_MASK", "0001111111"},
      {"ALIGN_COMMA_WORD", "1"}},
     {"ALIGN_COMMA_MSB", "MCOMMA_DETECT", "PCOMMA_32B_VALUE", "MCOMMA_32B_VALUE"}},
    {"gt10.json",
     {"QVZX_ONLY_TURNOFF_COMMA=TRUE", "DEC_PCOMMA_DETECT=TRUE"},
     {{"QVZX_ONLY_TURNOFF_COMMA", "TRUE"},
      {"DEC_PCOMMA_DETECT", "FALSE"},
      {"DEC_MCOMMA_DETECT", "FALSE"},
      {"DEC_VALID_COMMA_ONLY", "FALSE"},
      {"QVZX_ONLY_PCOMMA_CTRL", "DISABLE"},
      {"PCOMMA_DETECT", "FALSE"},
      {"QVZX_ONLY_MCOMMA_CTRL", "DYNAMIC"},
      {"COMMA_10B_MASK", "0000000000"}},
     {"ALIGN_COMMA_MSB", "MCOMMA_DETECT"}},
    {"gt10.json",
     {"PCOMMA_DETECT=TRUE", "PCOMMA_10B_VALUE=1111111111"},
     {{"QVZX_ONLY_PCOMMA_CTRL", "ALWAYS"},
      {"PCOMMA_DETECT", "TRUE"},
      {"PCOMMA_10B_VALUE", "0011111000"}},
     {}},

    // GT11: the 10'h value reads as eight digits and is written back in
    // both attributes (the 32-bit one added or replaced).
    {"gt11.json",
     {},
     {{"QVZX_ONLY_TURNOFF_COMMA", "FALSE"},
      {"DEC_PCOMMA_DETECT", "TRUE"},
      {"DEC_MCOMMA_DETECT", "TRUE"},
      {"ALIGN_COMMA_MSB", "FALSE"},
      {"DEC_VALID_COMMA_ONLY", "TRUE"},
      {"PCOMMA_10B_VALUE", "10'h17C"},
      {"PCOMMA_32B_VALUE", "32'h0000017C"},
      {"QVZX_ONLY_PCOMMA_CTRL", "DYNAMIC"},
      {"PCOMMA_DETECT", "TRUE"},
      {"MCOMMA_10B_VALUE", "10'h283"},
      {"MCOMMA_32B_VALUE", "32'h00000283"},
      {"MCOMMA_DETECT", "TRUE"},
      {"COMMA_10B_MASK", "10'h3FF"},
      {"ALIGN_COMMA_WORD", "1"}},
     {"QVZX_ONLY_MCOMMA_CTRL"}},
    {"gt11.json",
     {"QVZX_ONLY_TURNOFF_COMMA=TRUE", "ALIGN_COMMA_MSB=TRUE"},
     {{"QVZX_ONLY_TURNOFF_COMMA", "TRUE"},
      {"DEC_PCOMMA_DETECT", "FALSE"},
      {"DEC_MCOMMA_DETECT", "FALSE"},
      {"ALIGN_COMMA_MSB", "FALSE"},
      {"DEC_VALID_COMMA_ONLY", "TRUE"},
      {"QVZX_ONLY_PCOMMA_CTRL", "DISABLE"},
      {"PCOMMA_DETECT", "FALSE"},
      {"MCOMMA_DETECT", "TRUE"},
      {"PCOMMA_10B_VALUE", "10'h17C"},
      {"PCOMMA_32B_VALUE", "32'h0000017C"},
      {"COMMA_10B_MASK", "000"}},
     {"QVZX_ONLY_MCOMMA_CTRL"}},
    // Fewer digits than the notation holds: widened with zeros.
    {"gt11.json",
     {"PCOMMA_10B_VALUE=10'h7C", "COMMA_10B_MASK=10'hF"},
     {{"PCOMMA_10B_VALUE", "10'h07C"},
      {"PCOMMA_32B_VALUE", "32'h0000007C"},
      {"COMMA_10B_MASK", "10'h00F"}},
     {}},
    // More digits than a 32-bit attribute holds: its low-order eight.
    {"gt11.json",
     {"PCOMMA_10B_VALUE=36'h1F800017C", "COMMA_10B_MASK=10'h03FF"},
     {{"PCOMMA_10B_VALUE", "10'h17C"},
      {"PCOMMA_32B_VALUE", "32'hF800017C"},
      {"COMMA_10B_MASK", "10'h3FF"}},
     {}},
};

} // namespace

TEST(CommaDetectBatch, WritesEachFamilysNotation) {
    QTemporaryDir tmp;
    const QString out = tmp.filePath("out.json"), report = tmp.filePath("report.json");
    for (const BatchCase& c : kCases) {
        QStringList args = {"--batch", "-o", out, "--report", report};
        for (const QString& s : c.sets)
            args << "--set" << s;
        args << TestData(QString("commadetect/") + c.fixture);
        const std::string label = args.mid(5).join(' ').toStdString();
        QFile::remove(out);

        HostResult r = RunHost(args);
        ASSERT_EQ(r.exitCode, 0) << label << "\n" << r.err.toStdString();

        const QJsonObject rep = ReadJson(report);
        EXPECT_TRUE(rep["ok"].toBool()) << label;
        EXPECT_TRUE(rep["failed_page"].isNull()) << label;
        EXPECT_EQ(rep["messages"].toArray(), QJsonArray()) << label;

        Qvz_WizData d;
        QString err;
        ASSERT_TRUE(Qvz_DesignJson::LoadFile(out, d, err)) << err.toStdString();
        const Qvz_Block* b = d.GetActiveBlock();
        ASSERT_NE(b, nullptr) << label;
        for (const auto& [name, value] : c.expected) {
            ASSERT_NE(b->GetNamedAttribute(name), nullptr) << label << ": " << name;
            EXPECT_EQ(b->GetAttributeValue(name), value) << label << ": " << name;
        }
        for (const char* name : c.absent)
            EXPECT_EQ(b->GetNamedAttribute(name), nullptr) << label << ": " << name;
    }
}

TEST(CommaDetectBatch, AddedThirtyTwoBitPatternGoesLast) {
    QTemporaryDir tmp;
    const QString out = tmp.filePath("out.json");
    HostResult r = RunHost({"--batch", "-o", out, TestData("commadetect/gt11.json")});
    ASSERT_EQ(r.exitCode, 0) << r.err.toStdString();
    Qvz_WizData in, done;
    QString err;
    ASSERT_TRUE(Qvz_DesignJson::LoadFile(TestData("commadetect/gt11.json"), in, err));
    ASSERT_TRUE(Qvz_DesignJson::LoadFile(out, done, err)) << err.toStdString();
    const auto& before = in.GetActiveBlock()->GetAttributes();
    const auto& after = done.GetActiveBlock()->GetAttributes();
    // The page adds PCOMMA_32B_VALUE after every attribute the block had;
    // finishing then adds GT11_MODE for the pair's second transceiver.
    ASSERT_EQ(after.size(), before.size() + 2);
    for (std::size_t i = 0; i < before.size(); ++i)
        EXPECT_EQ(after[i]->GetName(), before[i]->GetName()) << i;
    EXPECT_EQ(after[before.size()]->GetName(), "PCOMMA_32B_VALUE");
    EXPECT_EQ(after.back()->GetName(), "GT11_MODE");
}
