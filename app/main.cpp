#include "Host.h"
#include "SafeWrite.h"

#include <QApplication>
#include <QCoreApplication>
#include <memory>

int main(int argc, char** argv) {
    // Before anything is written: an interrupted write must clean up after itself.
    VelomuxHost::InstallSignalHandlers();
    QStringList args;
    for (int i = 0; i < argc; ++i)
        args << QString::fromLocal8Bit(argv[i]);
    // A window run needs a GUI application; batch runs must work without a display.
    std::unique_ptr<QCoreApplication> app;
    if (VelomuxHost::WantsWindow(args))
        app = std::make_unique<QApplication>(argc, argv);
    else
        app = std::make_unique<QCoreApplication>(argc, argv);
    QCoreApplication::setApplicationName("velomux-wizard");
    QCoreApplication::setApplicationVersion(VELOMUX_VERSION);
    return VelomuxHost::Run(args);
}
