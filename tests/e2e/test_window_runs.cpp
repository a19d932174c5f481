// Window runs of the program, driven in-process from the first page through
// every enabled page to the summary and Finish, each page's values left as
// loaded: they complete without a message, and what they write is what the
// batch run of the same input writes, apart from the differences stated.

#include "DesignChecks.h"
#include "DialogDriver.h"
#include "Host.h"
#include "HostRunner.h"
#include "Qvz_DesignJson.h"

#include <QJsonArray>
#include <QMessageBox>
#include <QTemporaryDir>
#include <gtest/gtest.h>

namespace {

// Closes any message box, so that a run that issues one still ends (the
// report tells what it said).
void CloseMessageBoxes() {
    for (QWidget* w : QApplication::topLevelWidgets())
        if (auto* box = qobject_cast<QMessageBox*>(w); box && box->isVisible())
            box->done(QMessageBox::Ok);
}

struct WindowRun {
    int status = -1;
    QStringList pages; // the pages shown, in order
    QJsonArray messages;
    bool timedOut = false;
};

// Presses Next until the summary shows, then Finish.
WindowRun RunWindow(const QStringList& input, const QString& out, const QString& report) {
    TestApp();
    WindowRun run;
    DialogDriver driver({
        [&] {
            for (int i = 0; i < 12 && CurrentPageName() != "Summary"; ++i) {
                run.pages << CurrentPageName();
                Click("buttonNext");
            }
            run.pages << CurrentPageName();
        },
        CloseMessageBoxes,
        [] { Click("buttonFinish"); },
        CloseMessageBoxes,
    });
    driver.Start();
    run.status = VelomuxHost::Run(QStringList{"velomux-wizard"} + input +
                                  QStringList{"-o", out, "--report", report});
    run.timedOut = driver.TimedOut();
    run.messages = ReadJson(report)["messages"].toArray();
    return run;
}

int RunBatch(const QStringList& input, const QString& out) {
    return VelomuxHost::Run(QStringList{"velomux-wizard", "--batch"} + input +
                            QStringList{"-o", out});
}

QJsonObject BlockNamed(QJsonObject design, const QString& name, QJsonArray& blocks, int& index) {
    blocks = design["blocks"].toArray();
    for (index = 0; index < blocks.size(); ++index)
        if (blocks[index].toObject()["name"].toString() == name)
            return blocks[index].toObject();
    index = -1;
    return {};
}

// The paths at which two JSON values differ (at most a screenful).
void Differences(const QJsonValue& a, const QJsonValue& b, const QString& path, QStringList& out) {
    if (out.size() >= 20 || a == b)
        return;
    if (a.isObject() && b.isObject()) {
        const QJsonObject x = a.toObject(), y = b.toObject();
        QStringList keys = x.keys();
        for (const QString& k : y.keys())
            if (!keys.contains(k))
                keys << k;
        for (const QString& k : keys)
            Differences(x[k], y[k], path + "." + k, out);
    } else if (a.isArray() && b.isArray() && !a.toArray().isEmpty() &&
               !a.toArray()[0].toObject()["name"].toString().isEmpty()) {
        // Named entries (blocks, attributes, pins, signals) are matched by name.
        const QJsonArray x = a.toArray(), y = b.toArray();
        auto find = [](const QJsonArray& list, const QString& name) {
            for (const QJsonValue& v : list)
                if (v.toObject()["name"].toString() == name)
                    return v;
            return QJsonValue(QJsonValue::Undefined);
        };
        for (const QJsonValue& v : x) {
            const QString name = v.toObject()["name"].toString();
            const QJsonValue other = find(y, name);
            if (other.isUndefined())
                out << QString("%1[%2]: only in the window run's output").arg(path, name);
            else
                Differences(v, other, path + "[" + name + "]", out);
        }
        for (const QJsonValue& v : y) {
            const QString name = v.toObject()["name"].toString();
            if (find(x, name).isUndefined())
                out << QString("%1[%2]: only in the batch run's output").arg(path, name);
        }
    } else {
        out << QString("%1: window %2, batch %3")
                   .arg(path,
                        QString::fromUtf8(
                            QJsonDocument(QJsonArray{a}).toJson(QJsonDocument::Compact))
                            .left(120),
                        QString::fromUtf8(
                            QJsonDocument(QJsonArray{b}).toJson(QJsonDocument::Compact))
                            .left(120));
    }
}

// An attribute the batch run writes and the window run does not.
struct BatchOnly {
    const char* block;
    const char* attribute;
    const char* value;
};

// The batch output with the stated batch-only attributes taken out; each
// must be there as stated.
QJsonObject WithoutBatchOnly(QJsonObject batch, const std::vector<BatchOnly>& extra) {
    for (const BatchOnly& e : extra) {
        QJsonArray blocks;
        int bi = 0;
        QJsonObject block = BlockNamed(batch, e.block, blocks, bi);
        EXPECT_GE(bi, 0) << e.block;
        if (bi < 0)
            continue;
        QJsonArray attrs = block["attributes"].toArray();
        bool found = false;
        for (int i = 0; i < attrs.size(); ++i) {
            if (attrs[i].toObject()["name"].toString() != e.attribute)
                continue;
            EXPECT_EQ(attrs[i].toObject()["value"].toString(), e.value) << e.attribute;
            attrs.removeAt(i);
            found = true;
            break;
        }
        EXPECT_TRUE(found) << e.block << " " << e.attribute << " is not written by the batch run";
        block["attributes"] = attrs;
        blocks[bi] = block;
        batch["blocks"] = blocks;
    }
    return batch;
}

QStringList Input(const char* target, const char* type, const char* width, QStringList sets) {
    QStringList a = {"--target", target, "--type", type, "--width", width};
    for (const QString& s : sets)
        a << "--set" << s;
    return a;
}

} // namespace

// One type per family, as loaded: every enabled page is shown, none has
// anything to say, and the design data is finished as a generator needs it.
TEST(WindowRuns, OneTypePerFamilyReachesTheSummaryWithoutAMessage) {
    const struct {
        QStringList input;
        QStringList pages;
    } cases[] = {
        {Input("gt", "Zephine", "1", {}),
         {"General Setup", "Transmitter Setup", "Receiver Setup", "Receiver Clock Correction Setup",
          "Receiver Channel Bonding Setup", "Summary"}},
        {Input("gt10", "Ethernet", "8", {}),
         {"General Setup", "Transmitter Setup", "Receiver Setup", "Receiver Clock Correction Setup",
          "Receiver Channel Bonding Setup", "Summary"}},
        {Input("gt11", "XAUI", "2", {}),
         {"General Setup", "Transmitter Setup", "Receiver Comma Detect Setup", "Receiver Setup",
          "Receiver Clock Correction Setup", "Receiver Channel Bonding Setup", "Summary"}},
    };
    QTemporaryDir tmp;
    for (const auto& c : cases) {
        SCOPED_TRACE(c.input.join(' ').toStdString());
        const QString out = tmp.filePath("window.json");
        QFile::remove(out);
        const WindowRun run = RunWindow(c.input, out, tmp.filePath("report.json"));
        EXPECT_FALSE(run.timedOut);
        EXPECT_EQ(run.status, VelomuxHost::kExitCompleted);
        EXPECT_EQ(run.pages, c.pages);
        EXPECT_TRUE(run.messages.isEmpty()) << QJsonDocument(run.messages).toJson().toStdString();
        Qvz_WizData d;
        QString err;
        ASSERT_TRUE(Qvz_DesignJson::LoadFile(out, d, err)) << err.toStdString();
        const QStringList faults = DesignChecks::AllFaults(d);
        EXPECT_TRUE(faults.isEmpty()) << faults.join('\n').toStdString();
    }
}

// A full interactive run against the batch run of the same input, bonded on
// every family. The embedded targets hold every value legal and in the form
// the pages write it, so no form falls back to a default or rewrites a value
// on reading, and with every page enabled the window run writes what the
// batch run writes: the files must match byte for byte. The one difference
// by design shows where a page is disabled (last case).
TEST(WindowRuns, AFullRunWritesWhatTheBatchRunWrites) {
    const struct {
        QStringList input;
        int copies;
        std::vector<BatchOnly> batchOnly;
    } cases[] = {
        {Input("gt", "Custom", "2", {"QVZ_CHAN_BOND_NUMBER=20"}), 19, {}},
        // Infiniband also hands each copy its LANE_ID.
        {Input("gt10", "Infiniband", "4", {"QVZ_CHAN_BOND_NUMBER=20"}), 19, {}},
        {Input("gt11", "Custom", "4", {"QVZ_GT11_MODE=DUAL", "QVZ_CHAN_BOND_NUMBER=24"}), 23, {}},
        // OC48 switches the clock-correction and bonding pages off, and the
        // GT10 pruning deletes its bonding attributes. A window run skips
        // disabled pages; a batch run runs every page, and the bonding
        // page's write adds CHAN_BOND_MODE "OFF" back.
        {Input("gt10", "OC48", "4", {}), 0, {{"GT10_OC48_4_INST", "CHAN_BOND_MODE", "OFF"}}},
    };
    QTemporaryDir tmp;
    for (const auto& c : cases) {
        SCOPED_TRACE(c.input.join(' ').toStdString());
        const QString window = tmp.filePath("window.json"), batch = tmp.filePath("batch.json");
        QFile::remove(window);
        QFile::remove(batch);
        const WindowRun run = RunWindow(c.input, window, tmp.filePath("report.json"));
        EXPECT_FALSE(run.timedOut);
        ASSERT_EQ(run.status, VelomuxHost::kExitCompleted);
        EXPECT_EQ(run.pages.last(), "Summary");
        EXPECT_TRUE(run.messages.isEmpty()) << QJsonDocument(run.messages).toJson().toStdString();
        ASSERT_EQ(RunBatch(c.input, batch), VelomuxHost::kExitCompleted);

        Qvz_WizData d;
        QString err;
        ASSERT_TRUE(Qvz_DesignJson::LoadFile(window, d, err)) << err.toStdString();
        EXPECT_EQ(int(DesignChecks::PlacedBlocks(d).size()) - 1, c.copies);

        if (c.batchOnly.empty()) {
            EXPECT_TRUE(ReadAll(window) == ReadAll(batch));
        }
        QStringList diffs;
        Differences(ReadJson(window), WithoutBatchOnly(ReadJson(batch), c.batchOnly), "", diffs);
        EXPECT_TRUE(diffs.isEmpty()) << diffs.join('\n').toStdString();
    }
}
