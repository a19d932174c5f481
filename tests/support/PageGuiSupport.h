#pragma once
// What the page GUI tests share: a help handler that records its keys,
// design data from a fixture, the slots a controller declares, the texts of
// the recorded messages, and a window run with one page's controller made.

#include "HostRunner.h"
#include "Qvz_DesignJson.h"
#include "Qvz_MGTWizMain.h"
#include "Qvz_Messages.h"
#include "TestApp.h"

#include <QLineEdit>
#include <QMetaMethod>
#include <QWidget>
#include <gtest/gtest.h>

#include <string>
#include <utility>
#include <vector>

struct RecordingHelp : Qvz_HelpHandler {
    void Open(const Port::StringBase& key) override { keys.push_back(key.str()); }
    std::vector<std::string> keys;
};

// Design data of the fixture at path below the test data folder; a file
// that does not load fails the test.
inline Qvz_WizData LoadFixtureFile(const QString& path) {
    TestApp();
    Qvz_WizData d;
    QString err;
    EXPECT_TRUE(Qvz_DesignJson::LoadFile(TestData(path), d, err)) << err.toStdString();
    return d;
}

// The signatures of the methods a class declares itself, in order; any that
// is not a slot fails the test.
inline std::vector<std::string> OwnSlots(const QMetaObject& mo) {
    std::vector<std::string> names;
    for (int i = mo.methodOffset(); i < mo.methodCount(); ++i) {
        const QMetaMethod m = mo.method(i);
        EXPECT_EQ(m.methodType(), QMetaMethod::Slot) << m.methodSignature().toStdString();
        names.push_back(m.methodSignature().toStdString());
    }
    return names;
}

inline std::vector<std::string> MessageTexts(const Qvz_RecordingSink& sink) {
    std::vector<std::string> out;
    for (const Qvz_Message& m : sink.messages)
        out.push_back(m.text.str());
    return out;
}

// The value of the active block's attribute, "<absent>" without one.
inline std::string ActiveValue(Qvz_WizData& d, const char* name) {
    const Qvz_Block* b = d.GetActiveBlock();
    const Qvz_Attribute* a = b ? b->GetNamedAttribute(name) : nullptr;
    return a ? a->GetValue().str() : "<absent>";
}

// A window-run wizard main over data with the page at pageIndex and its
// controller created (not yet activated).
template <class Page, class Gui> struct PageGuiRig {
    PageGuiRig(Qvz_WizData d, int pageIndex) : data(std::move(d)) {
        main.SetWizData(&data);
        main.SetRunMode(Qvz_RunMode::Window);
        main.SetMessageSink(&sink);
        main.SetHelpHandler(&help);
        main.Prepare();
        page = static_cast<Page*>(main.GetPage(pageIndex));
        EXPECT_TRUE(page->CreateGuiDlg(&parent));
        gui = static_cast<Gui*>(page->GetGuiDlg());
    }

    template <class T = QWidget> T* W(const char* name) {
        T* w = gui->pageWidget()->template findChild<T*>(name);
        EXPECT_NE(w, nullptr) << name;
        return w;
    }
    bool Shown(const char* name) { return !W(name)->isHidden(); }
    // Enabled as the user sees it (a disabled group disables its children).
    bool Enabled(const char* name) { return W(name)->isEnabled(); }
    void SetText(const char* name, const char* text) { W<QLineEdit>(name)->setText(text); }
    std::string Value(const char* name) { return ActiveValue(data, name); }
    std::vector<std::string> Messages() const { return MessageTexts(sink); }

    // Widgets need the application before any of them is made.
    QApplication& app = TestApp();
    Qvz_WizData data;
    Qvz_RecordingSink sink;
    RecordingHelp help;
    QWidget parent;
    Qvz_MGTWizMain main{"w", false};
    Page* page = nullptr;
    Gui* gui = nullptr;
};
