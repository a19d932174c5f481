#pragma once
// What both fuzz programs do with design data that loaded: a full batch run
// (every page's batch step, then finish) as the host performs it, then the
// result must survive a save and a reload unchanged.

#include "Qvz_DesignJson.h"
#include "Qvz_MGTWizMain.h"
#include "Qvz_Messages.h"
#include "Qvz_WizData.h"

#include <QCoreApplication>

#include <cstdio>
#include <cstdlib>

namespace VelomuxFuzz {

// Batch runs need no display, but the host still has a core application.
inline void InitApplication(int* argc, char*** argv) {
    static QCoreApplication* app = new QCoreApplication(*argc, *argv);
    (void)app;
}

[[noreturn]] inline void Finding(const char* what, const QByteArray& detail) {
    std::fprintf(stderr, "velomux fuzz finding: %s\n%.*s\n", what, int(detail.size()),
                 detail.constData());
    std::abort();
}

// Runs the wizard over data in batch mode and checks that what it leaves is
// valid design data: a saved copy reloads, equal to it and saved alike.
inline void RunAndRoundTrip(Qvz_WizData& data) {
    Qvz_RecordingSink sink;
    {
        Qvz_MGTWizMain wiz("Velomux Wizard", false);
        wiz.SetWizData(&data);
        wiz.SetMessageSink(&sink);
        wiz.SetRunMode(Qvz_RunMode::Batch);
        const int result = wiz.Run();
        if (result != Qvz_RunCompleted && result != Qvz_RunRefused)
            Finding("Run returned neither completed nor refused", QByteArray::number(result));
        if (result == Qvz_RunRefused && wiz.GetMessages().empty() &&
            wiz.GetFailedPageTitle().IsEmpty())
            Finding("a run was refused without a failed page or a message", QByteArray());
        if (wiz.GetMessages().size() != sink.messages.size())
            Finding("the sink was not shown every recorded message", QByteArray());
    }

    const QByteArray saved = Qvz_DesignJson::Save(data);
    Qvz_WizData reloaded;
    QString error;
    if (!Qvz_DesignJson::Load(saved, "saved", reloaded, error))
        Finding("the design data the run left does not reload", error.toUtf8() + "\n" + saved);
    if (Qvz_DesignJson::Save(reloaded) != saved)
        Finding("saving the reloaded design data gives other text", saved);
    // Both programs hand the run valid UTF-8 only, so this also catches a
    // page that cuts a value inside a character: Save writes the stray byte
    // as U+FFFD and the reloaded data differs.
    if (!(reloaded == data))
        Finding("the reloaded design data differs from what was saved", saved);
}

} // namespace VelomuxFuzz
