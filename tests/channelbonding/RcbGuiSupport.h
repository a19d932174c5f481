#pragma once
// The bonding page in a window run with its controller created, and a way to
// answer modal dialogs from inside their own event loops.

#include "HostRunner.h"
#include "Qvz_DesignJson.h"
#include "Qvz_MGTRCB.h"
#include "Qvz_MGTRCBGui.h"
#include "Qvz_MGTWizMain.h"
#include "TestApp.h"

#include <QApplication>
#include <QLineEdit>
#include <QPointer>
#include <QTimer>
#include <QWidget>
#include <gtest/gtest.h>

#include <functional>
#include <memory>
#include <string>
#include <vector>

struct RcbRecordingHelp : Qvz_HelpHandler {
    void Open(const Port::StringBase& key) override { keys.push_back(key.str()); }
    std::vector<std::string> keys;
};

inline Qvz_WizData LoadRcbFixture(const char* name) {
    TestApp();
    Qvz_WizData d;
    QString err;
    EXPECT_TRUE(Qvz_DesignJson::LoadFile(TestData(QString("channelbonding/") + name), d, err))
        << err.toStdString();
    return d;
}

// Makes blockName the only active block.
inline void Activate(Qvz_WizData& d, const char* blockName) {
    d.SetAllBlksIsActive(false);
    Qvz_Block* b = d.GetNamedBlock(blockName);
    ASSERT_NE(b, nullptr) << blockName;
    b->SetIsUsed(true);
}

struct RcbGui {
    RcbGui(const char* fixture, const char* blockName = nullptr) : data(LoadRcbFixture(fixture)) {
        if (blockName)
            Activate(data, blockName);
        main.SetWizData(&data);
        main.SetRunMode(Qvz_RunMode::Window);
        main.SetMessageSink(&sink);
        main.SetHelpHandler(&help);
        main.Prepare();
        page = static_cast<Qvz_MGTRCB*>(main.GetPage(Qvz_MGTWizMain::kChannelBonding));
        EXPECT_TRUE(page->CreateGuiDlg(&parent));
        gui = static_cast<Qvz_MGTRCBGui*>(page->GetGuiDlg());
    }

    // Shows the page as the dialog would.
    RcbGui& Activated() {
        gui->onActive();
        return *this;
    }
    template <class T = QWidget> T* W(const char* name) {
        T* w = gui->pageWidget()->findChild<T*>(name);
        EXPECT_NE(w, nullptr) << name;
        return w;
    }
    bool Shown(const char* name) { return !W(name)->isHidden(); }
    // Enabled as the user sees it (a disabled group disables its children).
    bool Enabled(const char* name) { return W(name)->isEnabled(); }
    std::string Value(const char* name) {
        const Qvz_Attribute* a = data.GetActiveBlock()->GetNamedAttribute(name);
        return a ? a->GetValue().str() : "<absent>";
    }
    std::vector<std::string> Messages() const {
        std::vector<std::string> out;
        for (const Qvz_Message& m : sink.messages)
            out.push_back(m.text.str());
        return out;
    }

    Qvz_WizData data;
    Qvz_RecordingSink sink;
    RcbRecordingHelp help;
    QWidget parent;
    Qvz_MGTWizMain main{"w", false};
    Qvz_MGTRCB* page = nullptr;
    Qvz_MGTRCBGui* gui = nullptr;
};

// The first visible top-level widget of type T, or null.
template <class T> T* FindTopLevel() {
    for (QWidget* w : QApplication::topLevelWidgets())
        if (auto* t = qobject_cast<T*>(w); t && t->isVisible())
            return t;
    return nullptr;
}

// Runs answer on the first visible T once it is up (polling, so that it also
// works for a dialog opened inside another dialog's loop). A dialog that
// never comes leaves a failure instead of a hang; one that stays open after
// answer is closed so that the test ends.
template <class T> void WhenShown(std::function<void(T*)> answer) {
    auto* poll = new QTimer;
    auto tries = std::make_shared<int>(0);
    QObject::connect(poll, &QTimer::timeout, [poll, tries, answer] {
        T* t = FindTopLevel<T>();
        if (!t && ++*tries < 400)
            return;
        poll->stop();
        poll->deleteLater();
        if (!t) {
            ADD_FAILURE() << "no dialog of the expected kind was shown";
            return;
        }
        answer(t);
        QTimer::singleShot(200, [t = QPointer<T>(t)] {
            if (t && t->isVisible()) {
                ADD_FAILURE() << "the dialog stayed open";
                t->reject();
            }
        });
    });
    poll->start(5);
}
