#pragma once
// The velomux-wizard program, callable with its arguments (tests call it too).

#include <QStringList>

namespace VelomuxHost {

enum ExitStatus {
    kExitCompleted = 0,
    kExitRefused = 1,
    kExitUsage = 2,
    kExitInput = 3,
    kExitOutput = 4
};

// True when the arguments ask for the wizard dialog (so a GUI application is needed).
bool WantsWindow(const QStringList& args);

// Runs the program; args[0] is the program name.
int Run(const QStringList& args);

} // namespace VelomuxHost
