#pragma once
// The one QApplication of a test program. Made on first use and never
// destroyed: tearing Qt's GUI down from static destructors at exit crashes.

#include <QApplication>

inline QApplication& TestApp() {
    static int argc = 1;
    static char name[] = "velomux-test";
    static char* argv[] = {name, nullptr};
    static QApplication* app =
        qobject_cast<QApplication*>(QCoreApplication::instance())
            ? qobject_cast<QApplication*>(QCoreApplication::instance())
            : new QApplication(argc, argv);
    return *app;
}
