#include "HostRunner.h"
#include "Qvz_DesignJson.h"

#include <QJsonArray>
#include <QTemporaryDir>
#include <gtest/gtest.h>

#include <csignal>
#include <sys/resource.h>

namespace {

Qvz_WizData LoadOrFail(const QString& path) {
    Qvz_WizData d;
    QString err;
    EXPECT_TRUE(Qvz_DesignJson::LoadFile(path, d, err)) << err.toStdString();
    return d;
}

} // namespace

TEST(Host, InformationalOptions) {
    HostResult help = RunHost({"--help"});
    EXPECT_EQ(help.exitCode, 0);
    EXPECT_TRUE(help.out.contains("Usage:"));
    EXPECT_TRUE(help.out.contains("--batch"));
    EXPECT_TRUE(help.out.contains("Exit status"));
    HostResult version = RunHost({"--version"});
    EXPECT_EQ(version.exitCode, 0);
    EXPECT_TRUE(version.out.startsWith("velomux-wizard "));
    HostResult list = RunHost({"--list-targets"});
    EXPECT_EQ(list.exitCode, 0);
    for (const char* t : {"gt ", "gt10", "gt11"})
        EXPECT_TRUE(list.out.contains(t)) << t;
}

TEST(Host, UsageErrorsExitTwo) {
    const QString design = TestData("two_blocks_gt10.json");
    const QStringList cases[] = {
        {"--no-such-option"},
        {"--batch", "--width", "4"},
        {"--batch", "--set", "NOEQUALS"},
        {"--batch", "--set", "=VALUE"},
        {"--check", "--batch"},
        {"--check", "--type", "OC48"},
        {"--batch", design, design},
        {"--batch", "--target", "gt12"},
        {"--batch", "--target", "gt", design},
        {"--batch", "--target", "gt", "--target", "gt10"},
        {"--batch", "--type"},
    };
    for (const QStringList& args : cases) {
        HostResult r = RunHost(args);
        EXPECT_EQ(r.exitCode, 2) << args.join(' ').toStdString() << "\n" << r.err.toStdString();
        EXPECT_TRUE(r.err.contains("velomux-wizard: ")) << args.join(' ').toStdString();
    }
}

TEST(Host, InputErrorsExitThreeNamingTheFault) {
    QTemporaryDir tmp;
    const QString design = TestData("two_blocks_gt10.json");
    const struct {
        QStringList args;
        const char* mustContain;
    } cases[] = {
        {{"--batch", tmp.filePath("missing.json")}, "missing.json"},
        {{"--batch", tmp.path()}, "directory"},
        {{"--batch", TestData("invalid_syntax.json")}, "invalid_syntax.json:3:"},
        {{"--check", TestData("invalid_syntax.json")}, "invalid_syntax.json:3:"},
        {{"--batch", "--type", "Nonexistent", design}, "Nonexistent"},
        {{"--batch", "--set", "NO_SUCH_ATTR=1", design}, "NO_SUCH_ATTR"},
        {{"--batch", "--set", "MGT_DISPLAY_NAME=x", TestData("no_active_block.json")},
         "no active block"},
    };
    for (const auto& c : cases) {
        HostResult r = RunHost(c.args);
        EXPECT_EQ(r.exitCode, 3) << c.args.join(' ').toStdString() << "\n" << r.err.toStdString();
        EXPECT_TRUE(r.err.contains(c.mustContain)) << r.err.toStdString();
    }
}

TEST(Host, CheckValidatesAndWritesNormalized) {
    QTemporaryDir tmp;
    const QString out = tmp.filePath("norm.json");
    HostResult r = RunHost({"--check", "-o", out, TestData("two_blocks_gt10.json")});
    ASSERT_EQ(r.exitCode, 0) << r.err.toStdString();
    EXPECT_EQ(ReadAll(out), Qvz_DesignJson::Save(LoadOrFail(TestData("two_blocks_gt10.json"))));
    // Normalized output checks again and stays the same.
    const QString again = tmp.filePath("again.json");
    EXPECT_EQ(RunHost({"--check", "-o", again, out}).exitCode, 0);
    EXPECT_EQ(ReadAll(again), ReadAll(out));
    // Every embedded target is valid.
    for (const char* t : {"gt", "gt10", "gt11"})
        EXPECT_EQ(RunHost({"--check", "--target", t}).exitCode, 0) << t;
    HostResult toStdout = RunHost({"--check", "-o", "-", TestData("two_blocks_gt10.json")});
    EXPECT_EQ(toStdout.exitCode, 0);
    EXPECT_TRUE(toStdout.out.startsWith("{\n  \"format\": \"velomux-design-data\""));
}

TEST(Host, BatchRunOnDefaultTargetWritesDesignAndReport) {
    QTemporaryDir tmp;
    const QString out = tmp.filePath("out.json"), report = tmp.filePath("r.json");
    HostResult r = RunHost({"--batch", "--target", "gt10", "-o", out, "--report", report});
    ASSERT_EQ(r.exitCode, 0) << r.err.toStdString();
    EXPECT_TRUE(r.out.contains("GT10_CUSTOM"));
    EXPECT_TRUE(r.out.contains(out.toUtf8()));
    LoadOrFail(out);
    const QJsonObject rep = ReadJson(report);
    EXPECT_EQ(rep["format"].toString(), "velomux-run-report");
    EXPECT_EQ(rep["version"].toInt(), 1);
    EXPECT_EQ(rep["mode"].toString(), "batch");
    EXPECT_TRUE(rep["ok"].toBool());
    EXPECT_EQ(rep["exit_code"].toInt(), 0);
    EXPECT_TRUE(rep["failed_page"].isNull());
    EXPECT_TRUE(rep["messages"].isArray());
}

TEST(Host, WithoutOutputNothingIsWrittenButASummaryIsPrinted) {
    HostResult r = RunHost({"--batch"});
    EXPECT_EQ(r.exitCode, 0);
    EXPECT_TRUE(r.out.contains("Primitive:"));
    EXPECT_TRUE(r.out.contains("(none; use -o FILE)"));
}

TEST(Host, TypeAndWidthChooseTheActiveBlock) {
    QTemporaryDir tmp;
    const QString design = TestData("two_blocks_gt10.json");
    const struct {
        QStringList extra;
        const char* active;
        const char* width;
    } cases[] = {
        {{"--type", "OC48", "--width", "4"}, "GT10_OC48_4_INST", "4"},
        {{"--type", "OC48", "--width", "2"}, "GT10_OC48_2_INST", "2"},
        // No block of that width: looked up again with any width; an illegal
        // width is not written.
        {{"--type", "OC48", "--width", "8"}, "GT10_OC48_2_INST", "2"},
        // Custom types ignore the width in the lookup but take a legal one.
        {{"--type", "10G Custom", "--width", "8"}, "GT10_CUSTOM_INST", "8"},
        {{"--type", "10G Custom"}, "GT10_CUSTOM_INST", "4"},
    };
    for (const auto& c : cases) {
        const QString out = tmp.filePath("out.json");
        QStringList args = {"--batch", "-o", out};
        args << c.extra << design;
        HostResult r = RunHost(args);
        ASSERT_EQ(r.exitCode, 0) << args.join(' ').toStdString() << r.err.toStdString();
        Qvz_WizData d = LoadOrFail(out);
        ASSERT_NE(d.GetActiveBlock(), nullptr);
        EXPECT_EQ(d.GetActiveBlock()->GetName(), c.active) << args.join(' ').toStdString();
        EXPECT_EQ(d.GetActiveBlock()->GetAttributeValue("QVZ_RX_DATA_WIDTH"), c.width)
            << args.join(' ').toStdString();
        int used = 0;
        for (const auto& b : d.GetBlocks())
            used += b->IsUsed();
        EXPECT_EQ(used, 1);
    }
}

TEST(Host, SetAppliesInOrderAfterType) {
    QTemporaryDir tmp;
    const QString out = tmp.filePath("out.json");
    HostResult r = RunHost({"--batch", "-o", out, "--type", "OC48", "--width", "4", "--set",
                            "PMA_SPEED=x", "--set", "QVZ_RX_DATA_WIDTH=2", "--set",
                            "QVZ_RX_DATA_WIDTH=4=4", TestData("two_blocks_gt10.json")});
    // PMA_SPEED belongs to the custom block, not to the chosen OC48 block.
    EXPECT_EQ(r.exitCode, 3);
    r = RunHost({"--batch", "-o", out, "--type", "OC48", "--width", "4", "--set",
                 "QVZ_RX_DATA_WIDTH=2", "--set", "QVZ_RX_DATA_WIDTH=4=4",
                 TestData("two_blocks_gt10.json")});
    ASSERT_EQ(r.exitCode, 0) << r.err.toStdString();
    Qvz_WizData d = LoadOrFail(out);
    EXPECT_EQ(d.GetNamedBlock("GT10_OC48_4_INST")->GetAttributeValue("QVZ_RX_DATA_WIDTH"), "4=4");
}

TEST(Host, OutputToStandardOutputIsTheDesignAlone) {
    HostResult r = RunHost({"--batch", "-o", "-"});
    ASSERT_EQ(r.exitCode, 0);
    Qvz_WizData d;
    QString err;
    EXPECT_TRUE(Qvz_DesignJson::Load(r.out, "stdout", d, err)) << err.toStdString();
}

TEST(Host, FailedWritesExitFourAndKeepTheEarlierFile) {
    QTemporaryDir tmp;
    const QString out = tmp.filePath("out.json"), report = tmp.filePath("r.json");
    ASSERT_TRUE(WriteAll(out, "previous"));
    // A file-size limit smaller than the design makes the write fail midway.
    HostResult r = RunHost({"--batch", "-o", out, "--report", report}, [] {
        std::signal(SIGXFSZ, SIG_IGN);
        rlimit lim{2000, 2000};
        setrlimit(RLIMIT_FSIZE, &lim);
    });
    EXPECT_EQ(r.exitCode, 4) << r.err.toStdString();
    EXPECT_TRUE(r.err.contains("cannot write")) << r.err.toStdString();
    EXPECT_EQ(ReadAll(out), "previous");
    const QJsonObject rep = ReadJson(report);
    EXPECT_FALSE(rep["ok"].toBool());
    EXPECT_EQ(rep["exit_code"].toInt(), 4);
    EXPECT_EQ(QDir(tmp.path()).entryList(QDir::Files | QDir::Hidden).size(), 2)
        << "no temporary file left behind";

    // A folder that does not exist.
    r = RunHost({"--batch", "-o", tmp.filePath("no/such/dir/out.json")});
    EXPECT_EQ(r.exitCode, 4);
    // A parent that is a file.
    r = RunHost({"--batch", "-o", out + "/child.json"});
    EXPECT_EQ(r.exitCode, 4);
    EXPECT_EQ(ReadAll(out), "previous");
    // The output is a directory.
    r = RunHost({"--batch", "-o", tmp.path()});
    EXPECT_EQ(r.exitCode, 4);
}

TEST(Host, InputAndOutputMayBeTheSameFile) {
    QTemporaryDir tmp;
    const QString path = tmp.filePath("design.json");
    ASSERT_TRUE(WriteAll(path, ReadAll(TestData("two_blocks_gt10.json"))));
    HostResult r = RunHost({"--batch", "-o", path, path});
    ASSERT_EQ(r.exitCode, 0) << r.err.toStdString();
    LoadOrFail(path);
}
