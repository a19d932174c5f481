// The README's main command: the run it makes prints the summary the README
// shows, and writes design data and a report that hold what they should.

#include "DesignChecks.h"
#include "HostRunner.h"
#include "Qvz_DesignJson.h"

#include <QRegularExpression>
#include <QTemporaryDir>
#include <gtest/gtest.h>

namespace {

QString SourceFile(const char* rel) {
    return QString::fromUtf8(ReadAll(QDir(VELOMUX_SOURCE_DIR).filePath(rel)));
}

} // namespace

TEST(MainCommand, PrintsTheSummaryTheReadmeShowsAndWritesWhatItNames) {
    // The arguments the script gives the program.
    const QString script = SourceFile("scripts/run-example.sh");
    const QRegularExpressionMatch m =
        QRegularExpression("args=\\(--batch (.*) -o \"\\$design\" --report \"\\$report\" "
                           "\"\\$@\"\\)")
            .match(script);
    ASSERT_TRUE(m.hasMatch()) << script.toStdString();
    const QStringList choices = m.captured(1).split(' ', Qt::SkipEmptyParts);

    QTemporaryDir tmp;
    const QString design = tmp.filePath("gt10-design.json");
    const QString report = tmp.filePath("gt10-report.json");
    const HostResult r =
        RunHost(QStringList{"--batch"} + choices + QStringList{"-o", design, "--report", report});
    ASSERT_EQ(r.exitCode, 0) << r.err.toStdString();
    EXPECT_TRUE(r.err.isEmpty()) << r.err.toStdString();

    // The README's sample, from "Primitive:" up to the output line.
    const QString readme = SourceFile("README.md");
    const int from = readme.indexOf("    Primitive:");
    const int to = readme.indexOf("    Output:", from);
    ASSERT_GE(from, 0);
    ASSERT_GT(to, from);
    QString shown = readme.mid(from, to - from);
    shown.replace(QRegularExpression("^    ", QRegularExpression::MultilineOption), "");
    const QString printed = QString::fromUtf8(r.out);
    EXPECT_TRUE(printed.startsWith(shown)) << "README:\n"
                                           << shown.toStdString() << "program:\n"
                                           << printed.toStdString();

    Qvz_WizData d;
    QString err;
    ASSERT_TRUE(Qvz_DesignJson::LoadFile(design, d, err)) << err.toStdString();
    EXPECT_EQ(DesignChecks::PlacedBlocks(d).size(), 4u);
    const QStringList faults = DesignChecks::AllFaults(d);
    EXPECT_TRUE(faults.isEmpty()) << faults.join('\n').toStdString();
    const QJsonObject rep = ReadJson(report);
    EXPECT_TRUE(rep["ok"].toBool());
    EXPECT_EQ(rep["mode"].toString(), "batch");
}
