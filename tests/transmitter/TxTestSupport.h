#pragma once
// Helpers shared by the transmitter tests: fixtures, a wizard main driving
// the page in either mode, and batch runs of the program.

#include "HostRunner.h"
#include "PageGuiSupport.h"
#include "Qvz_DesignJson.h"
#include "Qvz_MGTTransmitter.h"
#include "Qvz_MGTWizMain.h"
#include "TestApp.h"

#include <QApplication>
#include <QJsonArray>
#include <QJsonDocument>
#include <QJsonObject>
#include <gtest/gtest.h>

#include <map>
#include <memory>
#include <string>
#include <vector>

namespace txtest {

inline QApplication& App() {
    return TestApp();
}

inline QString Fixture(const char* name) {
    return TestData(QString("transmitter/") + name);
}

inline Qvz_WizData LoadFixture(const char* name) {
    Qvz_WizData d;
    QString err;
    EXPECT_TRUE(Qvz_DesignJson::LoadFile(Fixture(name), d, err)) << err.toStdString();
    return d;
}

// A wizard main over data with the transmitter page alone, made for the
// given mode, and the messages recorded. The other pages are left out: the
// General Setup page looks the block up and clears its pin signals as it is
// made, which is not this page's business.
struct Wizard {
    explicit Wizard(Qvz_WizData& data, Qvz_RunMode mode) : main("w", false) {
        main.SetWizData(&data);
        main.SetRunMode(mode);
        main.m_batchMode = mode == Qvz_RunMode::Batch;
        main.SetMessageSink(&sink);
        page = std::make_unique<Qvz_MGTTransmitter>(&main);
    }
    Qvz_MGTTransmitter* Page() const { return page.get(); }
    std::vector<std::string> Messages() const { return MessageTexts(sink); }
    Qvz_RecordingSink sink;
    Qvz_MGTWizMain main;
    std::unique_ptr<Qvz_MGTTransmitter> page;
};

// Attribute name -> value of the first block of a design-data document.
inline std::map<std::string, std::string> Attributes(const QJsonObject& doc) {
    std::map<std::string, std::string> out;
    const QJsonArray attrs = doc["blocks"].toArray().at(0).toObject()["attributes"].toArray();
    for (const QJsonValue& v : attrs) {
        const QJsonObject a = v.toObject();
        out[a["name"].toString().toStdString()] = a["value"].toString().toStdString();
    }
    return out;
}

// Sets value (and, when given, default) of attributes of the first block;
// an attribute the block lacks is appended.
struct AttrEdit {
    const char* name;
    const char* value;
    const char* defaultValue; // nullptr: leave the default alone
};

inline QJsonObject EditFixture(const char* name, const std::vector<AttrEdit>& edits) {
    QJsonObject doc = QJsonDocument::fromJson(ReadAll(Fixture(name))).object();
    QJsonArray blocks = doc["blocks"].toArray();
    QJsonObject block = blocks.at(0).toObject();
    QJsonArray attrs = block["attributes"].toArray();
    for (const AttrEdit& e : edits) {
        bool found = false;
        for (int i = 0; i < attrs.size(); ++i) {
            QJsonObject a = attrs.at(i).toObject();
            if (a["name"].toString() != e.name)
                continue;
            a["value"] = e.value;
            if (e.defaultValue)
                a["default"] = e.defaultValue;
            attrs[i] = a;
            found = true;
        }
        if (!found) {
            QJsonObject a{{"name", e.name}, {"value", e.value}};
            if (e.defaultValue)
                a["default"] = e.defaultValue;
            attrs.append(a);
        }
    }
    block["attributes"] = attrs;
    blocks[0] = block;
    doc["blocks"] = blocks;
    return doc;
}

struct BatchRun {
    int exitCode = -1;
    QJsonObject input;
    QJsonObject output;
    QJsonObject report;
    std::vector<std::string> messages;
};

// Runs the program in batch mode on doc and collects its output and report.
inline BatchRun RunBatch(const QJsonObject& doc) {
    QTemporaryDir tmp;
    const QString in = tmp.filePath("in.json");
    EXPECT_TRUE(WriteAll(in, QJsonDocument(doc).toJson()));
    const BatchOutcome run = RunBatchHost(in);
    BatchRun r;
    r.input = doc;
    r.exitCode = run.host.exitCode;
    r.output = run.output;
    r.report = run.report;
    for (const QJsonValue& m : r.report["messages"].toArray())
        r.messages.push_back(m.toObject()["text"].toString().toStdString());
    return r;
}

inline BatchRun RunBatchOn(const char* fixture) {
    return RunBatch(QJsonDocument::fromJson(ReadAll(Fixture(fixture))).object());
}

} // namespace txtest

namespace txtest {

// Design data from an edited fixture document.
inline Qvz_WizData LoadDoc(const QJsonObject& doc) {
    Qvz_WizData d;
    QString err;
    EXPECT_TRUE(Qvz_DesignJson::Load(QJsonDocument(doc).toJson(), "doc", d, err))
        << err.toStdString();
    return d;
}

inline Qvz_Attribute* Attr(Qvz_WizData& d, const char* name) {
    Qvz_Block* b = d.GetActiveBlock();
    return b ? b->GetNamedAttribute(name) : nullptr;
}

inline std::string Value(Qvz_WizData& d, const char* name) {
    Qvz_Attribute* a = Attr(d, name);
    return a ? a->GetValue().str() : "<absent>";
}

} // namespace txtest
