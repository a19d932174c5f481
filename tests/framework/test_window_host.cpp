// The program's window run, driven in-process through its own dialog.
#include "DialogDriver.h"
#include "Host.h"
#include "HostRunner.h"
#include "Qvz_DesignJson.h"

#include <QTemporaryDir>
#include <gtest/gtest.h>

namespace {

// Presses Next until the summary is shown (or nothing moves any more).
void NextToSummary(QStringList& seen) {
    for (int i = 0; i < 12 && CurrentPageName() != "Summary"; ++i) {
        seen << CurrentPageName();
        Click("buttonNext");
    }
    seen << CurrentPageName();
}

} // namespace

TEST(WindowHost, FinishAtTheSummaryWritesTheOutput) {
    TestApp();
    QTemporaryDir tmp;
    const QString out = tmp.filePath("out.json");
    const QString report = tmp.filePath("report.json");
    QStringList seen;
    QString caption;
    DialogDriver driver({
        [&] { caption = FindWizard() ? FindWizard()->windowTitle() : ""; },
        [&] { NextToSummary(seen); },
        [] { Click("buttonFinish"); },
    });
    driver.Start();
    const int status =
        VelomuxHost::Run({"velomux-wizard", "--target", "gt10", "-o", out, "--report", report});
    EXPECT_FALSE(driver.TimedOut());
    EXPECT_EQ(status, VelomuxHost::kExitCompleted);
    EXPECT_EQ(caption, "Velomux Wizard");
    ASSERT_FALSE(seen.isEmpty());
    EXPECT_EQ(seen.first(), "General Setup");
    EXPECT_EQ(seen.last(), "Summary");

    Qvz_WizData written;
    QString error;
    EXPECT_TRUE(Qvz_DesignJson::LoadFile(out, written, error)) << error.toStdString();
    ASSERT_NE(written.GetActiveBlock(), nullptr);
    const QJsonObject rep = ReadJson(report);
    EXPECT_EQ(rep["mode"].toString(), "window");
    EXPECT_TRUE(rep["ok"].toBool());
    EXPECT_EQ(rep["exit_code"].toInt(), 0);
}

TEST(WindowHost, CancelExitsOneAndWritesNothing) {
    TestApp();
    QTemporaryDir tmp;
    const QString out = tmp.filePath("out.json");
    const QString report = tmp.filePath("report.json");
    DialogDriver driver({
        [] { Click("buttonNext"); },
        [] { Click("buttonCancel"); },
    });
    driver.Start();
    const int status =
        VelomuxHost::Run({"velomux-wizard", "--target", "gt10", "-o", out, "--report", report});
    EXPECT_FALSE(driver.TimedOut());
    EXPECT_EQ(status, VelomuxHost::kExitRefused);
    EXPECT_FALSE(QFile::exists(out));
    const QJsonObject rep = ReadJson(report);
    EXPECT_EQ(rep["mode"].toString(), "window");
    EXPECT_FALSE(rep["ok"].toBool());
    EXPECT_EQ(rep["exit_code"].toInt(), 1);
}

TEST(WindowHost, ADesignFileOpensTheDialogToo) {
    TestApp();
    QTemporaryDir tmp;
    const QString out = tmp.filePath("out.json");
    // Finish is refused on the first page until Next has chosen the block.
    DialogDriver driver({[] { Click("buttonNext"); }, [] { Click("buttonFinish"); }});
    driver.Start();
    const int status = VelomuxHost::Run(
        {"velomux-wizard", QDir(VELOMUX_TARGETS).filePath("gt11.json"), "-o", out});
    EXPECT_FALSE(driver.TimedOut());
    EXPECT_EQ(status, VelomuxHost::kExitCompleted);
    EXPECT_TRUE(QFile::exists(out));
}
