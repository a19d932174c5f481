#pragma once
// Runs the velomux-wizard program the way a user or script does.

#include <QByteArray>
#include <QDir>
#include <QFile>
#include <QJsonArray>
#include <QJsonDocument>
#include <QJsonObject>
#include <QProcess>
#include <QString>
#include <QStringList>
#include <QTemporaryDir>
#include <gtest/gtest.h>

#include <functional>

struct HostResult {
    int exitCode = -1;
    QByteArray out;
    QByteArray err;
};

inline HostResult RunHost(const QStringList& args,
                          const std::function<void()>& childSetup = nullptr) {
    QProcess p;
    p.setProgram(VELOMUX_WIZARD_EXE);
    p.setArguments(args);
    QProcessEnvironment env = QProcessEnvironment::systemEnvironment();
    env.insert("QT_QPA_PLATFORM", "offscreen");
    p.setProcessEnvironment(env);
    if (childSetup)
        p.setChildProcessModifier(childSetup);
    p.start();
    p.closeWriteChannel();
    p.waitForFinished(120000);
    HostResult r;
    r.exitCode = p.exitStatus() == QProcess::NormalExit ? p.exitCode() : -1;
    r.out = p.readAllStandardOutput();
    r.err = p.readAllStandardError();
    return r;
}

inline QByteArray ReadAll(const QString& path) {
    QFile f(path);
    return f.open(QIODevice::ReadOnly) ? f.readAll() : QByteArray();
}

inline bool WriteAll(const QString& path, const QByteArray& bytes) {
    QFile f(path);
    return f.open(QIODevice::WriteOnly | QIODevice::Truncate) && f.write(bytes) == bytes.size();
}

inline QJsonObject ReadJson(const QString& path) {
    return QJsonDocument::fromJson(ReadAll(path)).object();
}

inline QString TestData(const QString& name) {
    return QDir(VELOMUX_TEST_DATA).filePath(name);
}

// A batch run: what the program did, whether it wrote its output, the
// output document and the run report.
struct BatchOutcome {
    HostResult host;
    bool written = false;
    QJsonObject output;
    QJsonObject report;
};

// Runs "--batch -o <out> --report <report> <extra...> <input>" with output
// and report in a folder of their own.
inline BatchOutcome RunBatchHost(const QString& input, const QStringList& extra = {}) {
    QTemporaryDir tmp;
    const QString out = tmp.filePath("out.json"), report = tmp.filePath("report.json");
    QStringList args{"--batch", "-o", out, "--report", report};
    args << extra << input;
    BatchOutcome r;
    r.host = RunHost(args);
    r.written = QFile::exists(out);
    r.output = ReadJson(out);
    r.report = ReadJson(report);
    return r;
}

// The texts of a run report's messages; each must be a plain message (no
// flag set).
inline QStringList PlainMessages(const QJsonObject& report) {
    QStringList texts;
    for (const QJsonValue& m : report["messages"].toArray()) {
        texts << m["text"].toString();
        EXPECT_EQ(m["flags"].toArray(), (QJsonArray{false, false, false}))
            << m["text"].toString().toStdString();
    }
    return texts;
}
