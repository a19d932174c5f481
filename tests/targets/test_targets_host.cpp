// The sample targets and the examples through the program, as a user runs
// them: each loads, each configures in a batch run, and every offered type at
// each of its widths becomes the active block it names.

#include "HostRunner.h"
#include "Qvz_DesignJson.h"
#include "TargetsCommon.h"

#include <QTemporaryDir>
#include <gtest/gtest.h>

namespace {

bool LoadOut(const QString& path, Qvz_WizData& d) {
    QString err;
    const bool ok = Qvz_DesignJson::LoadFile(path, d, err);
    EXPECT_TRUE(ok) << err.toStdString();
    return ok;
}

} // namespace

TEST(TargetHost, TargetsAndExamplesLoadAndConfigure) {
    QTemporaryDir tmp;
    struct Run {
        QString name;
        QStringList source; // --target NAME, or the file
        const char* active;
    };
    std::vector<Run> runs;
    for (const char* t : {"gt", "gt10", "gt11"})
        runs.push_back({t, {"--target", t}, nullptr});
    for (const DesignFile& f : kExamples)
        runs.push_back({f.path, {SourcePath(f.path)}, f.activeBlock});
    for (const Run& run : runs) {
        SCOPED_TRACE(run.name.toStdString());
        HostResult check = RunHost(QStringList{"--check"} + run.source);
        EXPECT_EQ(check.exitCode, 0) << check.err.toStdString();

        const QString out = tmp.filePath("out.json"), report = tmp.filePath("report.json");
        QFile::remove(out);
        HostResult r = RunHost(QStringList{"--batch", "-o", out, "--report", report} + run.source);
        ASSERT_EQ(r.exitCode, 0) << r.err.toStdString();
        const QJsonObject rep = ReadJson(report);
        EXPECT_TRUE(rep["ok"].toBool());
        EXPECT_TRUE(rep["failed_page"].isNull());
        Qvz_WizData d;
        ASSERT_TRUE(LoadOut(out, d));
        ASSERT_NE(d.GetActiveBlock(), nullptr);
        EXPECT_TRUE(r.out.contains(d.GetActiveBlock()->GetPrimitiveName().c_str()));
    }
}

TEST(TargetHost, EveryTypeAtEachWidthBecomesTheActiveBlock) {
    QTemporaryDir tmp;
    const QString out = tmp.filePath("out.json");
    for (const OfferedType& o : kOffered) {
        for (const QString& w : o.widths) {
            const QStringList args = {"--batch", "--target", o.target, "--type", o.type,
                                      "--width", w,          "-o",     out};
            SCOPED_TRACE(args.join(' ').toStdString());
            QFile::remove(out);
            HostResult r = RunHost(args);
            ASSERT_EQ(r.exitCode, 0) << r.err.toStdString();
            Qvz_WizData d;
            ASSERT_TRUE(LoadOut(out, d));
            const Qvz_Block* b = d.GetActiveBlock();
            ASSERT_NE(b, nullptr);
            EXPECT_EQ(b->GetAttributeValue("MGT_DISPLAY_NAME").ToQString(), o.type);
            const char* widthAttr = b->SupportsMGT3() ? "RX_DATA_WIDTH" : "QVZ_RX_DATA_WIDTH";
            EXPECT_EQ(b->GetAttributeValue(widthAttr).ToQString(), w);
            // Every other used block is a bonded copy of the active one (GT11
            // always gets the pair's second transceiver).
            for (const auto& blk : d.GetBlocks()) {
                if (blk->IsUsed() && blk.get() != b) {
                    EXPECT_EQ(blk->GetPrimitiveName(), b->GetPrimitiveName())
                        << blk->GetName().str();
                }
            }
        }
    }
}
