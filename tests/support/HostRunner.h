#pragma once
// Runs the velomux-wizard program the way a user or script does.

#include <QByteArray>
#include <QDir>
#include <QFile>
#include <QJsonDocument>
#include <QJsonObject>
#include <QProcess>
#include <QString>
#include <QStringList>
#include <QTemporaryDir>

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
