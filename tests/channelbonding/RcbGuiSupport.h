#pragma once
// The bonding page in a window run with its controller created, and a way to
// answer modal dialogs from inside their own event loops.

#include "HostRunner.h"
#include "PageGuiSupport.h"
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

inline Qvz_WizData LoadRcbFixture(const char* name) {
    return LoadFixtureFile(QString("channelbonding/") + name);
}

// Makes blockName the only active block.
inline void Activate(Qvz_WizData& d, const char* blockName) {
    d.SetAllBlksIsActive(false);
    Qvz_Block* b = d.GetNamedBlock(blockName);
    ASSERT_NE(b, nullptr) << blockName;
    b->SetIsUsed(true);
}

// The fixture with blockName (when given) as its only active block.
inline Qvz_WizData LoadRcbFixture(const char* name, const char* blockName) {
    Qvz_WizData d = LoadRcbFixture(name);
    if (blockName)
        Activate(d, blockName);
    return d;
}

struct RcbGui : PageGuiRig<Qvz_MGTRCB, Qvz_MGTRCBGui> {
    RcbGui(const char* fixture, const char* blockName = nullptr)
        : PageGuiRig(LoadRcbFixture(fixture, blockName), Qvz_MGTWizMain::kChannelBonding) {}

    // Shows the page as the dialog would.
    RcbGui& Activated() {
        gui->onActive();
        return *this;
    }
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
