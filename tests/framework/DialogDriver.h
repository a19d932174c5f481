#pragma once
// Clicks through a modal dialog from inside its own event loop.
//
// Each step is posted before the previous one runs, so a step that opens a
// nested loop (a message box) does not stop the next step from closing it.

#include "TestApp.h"
#include "Wg_Wizard.h"

#include <QApplication>
#include <QPushButton>
#include <QTimer>

#include <functional>
#include <vector>

inline Wg_Wizard* FindWizard() {
    for (QWidget* w : QApplication::topLevelWidgets())
        if (auto* wiz = qobject_cast<Wg_Wizard*>(w); wiz && wiz->isVisible())
            return wiz;
    return nullptr;
}

inline void Click(const char* button) {
    if (Wg_Wizard* wiz = FindWizard())
        if (auto* b = wiz->findChild<QPushButton*>(button); b && b->isEnabled())
            b->click();
}

inline QString CurrentPageName() {
    Wg_Wizard* wiz = FindWizard();
    return wiz && wiz->currentPage() ? wiz->currentPage()->pageName() : QString();
}

class DialogDriver {
public:
    using Step = std::function<void()>;
    explicit DialogDriver(std::vector<Step> steps) : m_steps(std::move(steps)) {}

    // Call before entering the dialog's loop.
    void Start() {
        QTimer::singleShot(0, &m_context, [this] { Run(0); });
        // A run that hangs closes whatever is open instead of blocking the suite.
        QTimer::singleShot(20000, &m_context, [this] {
            m_timedOut = true;
            for (QWidget* w : QApplication::topLevelWidgets())
                if (auto* d = qobject_cast<QDialog*>(w); d && d->isVisible())
                    d->done(QDialog::Rejected);
        });
    }
    bool Done() const { return m_next >= m_steps.size(); }
    bool TimedOut() const { return m_timedOut; }

private:
    void Run(std::size_t i) {
        if (i >= m_steps.size())
            return;
        m_next = i + 1;
        QTimer::singleShot(5, &m_context, [this, i] { Run(i + 1); });
        m_steps[i]();
    }

    QObject m_context; // timers die with the driver
    std::vector<Step> m_steps;
    std::size_t m_next = 0;
    bool m_timedOut = false;
};
