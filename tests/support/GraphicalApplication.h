#pragma once

#include <QGuiApplication>

namespace orvo::testing {

/// Makes the graphical application object that fonts and drawing need, once a process. False where
/// another test of the process has made one without a screen: CTest gives each test a process.
inline bool haveGraphicalApplication() {
    if (!QCoreApplication::instance()) {
        static int count = 1;
        static char name[] = "test";
        static char* arguments[] = {name, nullptr};
        // Never destroyed: at the end of the process its platform would be gone before it.
        static auto* const application = new QGuiApplication(count, arguments);
        return application != nullptr;
    }
    return qobject_cast<QGuiApplication*>(QCoreApplication::instance()) != nullptr;
}

} // namespace orvo::testing
