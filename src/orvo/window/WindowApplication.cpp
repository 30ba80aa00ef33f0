#include "orvo/window/WindowApplication.h"

#include "platform/settings/DesktopDisplay.h"

#include <QApplication>
#include <QIcon>

#include <array>
#include <string>

namespace orvo::WindowApplication {

void make() {
    if (QCoreApplication::instance() || !DesktopDisplay::isThere())
        return;
    static std::string name = "orvo";
    static std::array<char*, 2> words = {name.data(), nullptr};
    static int count = 1;
    DesktopDisplay::useNoGraphicsDrivers();
    QGuiApplication::setDesktopFileName("com.zentu.Orvo");
    // Never destroyed: it would go after what it stands on.
    new QApplication(count, words.data()); // NOLINT(clang-analyzer-cplusplus.NewDeleteLeaks)
    QGuiApplication::setQuitOnLastWindowClosed(false); // who made the windows ends the program
    QGuiApplication::setApplicationDisplayName("Orvo");
    QApplication::setWindowIcon(QIcon::fromTheme("com.zentu.Orvo"));
}

bool isMade() {
    return qobject_cast<QApplication*>(QCoreApplication::instance()) != nullptr;
}

} // namespace orvo::WindowApplication
