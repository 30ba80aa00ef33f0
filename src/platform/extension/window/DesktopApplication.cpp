#include "platform/extension/window/DesktopApplication.h"

#include "platform/extension/ToolkitRemarks.h"
#include "platform/settings/DesktopDisplay.h"

#include <QGuiApplication>

#include <array>
#include <cstdlib>
#include <filesystem>
#include <string>

namespace orvo {

namespace {

constexpr int KeepGiven = 0;

bool isSet(const char* variable) {
    const char* const value = std::getenv(variable);
    return value && *value;
}

/// Without an address, and without the usual socket, the bus's library would start a bus by itself.
void nameNoBusWhereThereIsNone() {
    if (isSet("DBUS_SESSION_BUS_ADDRESS"))
        return;
    std::error_code unreadable;
    const char* const runtime = std::getenv("XDG_RUNTIME_DIR");
    if (!runtime || !std::filesystem::exists(std::filesystem::path(runtime) / "bus", unreadable))
        setenv("DBUS_SESSION_BUS_ADDRESS", "disabled:", KeepGiven);
}

} // namespace

void makeDesktopApplication(const std::string& desktopFile) {
    if (QCoreApplication::instance())
        return;
    static std::string name = "orvo-transit-widget";
    static std::array<char*, 2> words = {name.data(), nullptr};
    static int count = 1;
    nameNoBusWhereThereIsNone();
    logToolkitRemarks();
    DesktopDisplay::useNoGraphicsDrivers();
    QGuiApplication::setDesktopSettingsAware(false);
    QGuiApplication::setDesktopFileName(
        QString::fromUtf8(desktopFile.data(), static_cast<qsizetype>(desktopFile.size())));
    // Never destroyed: it would go after what it stands on.
    new QGuiApplication(count, words.data()); // NOLINT(clang-analyzer-cplusplus.NewDeleteLeaks)
    QGuiApplication::setQuitOnLastWindowClosed(false);
}

} // namespace orvo
