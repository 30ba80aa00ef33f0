#include "platform/extension/window/DesktopApplication.h"

#include "platform/extension/ToolkitRemarks.h"

#include <QGuiApplication>

#include <array>
#include <cerrno>
#include <charconv>
#include <cstddef>
#include <cstdlib>
#include <cstring>
#include <filesystem>
#include <optional>
#include <string>
#include <string_view>
#include <sys/socket.h>
#include <sys/un.h>
#include <unistd.h>

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

/// Whether somebody serves the socket. A name in the abstract namespace begins with a zero byte.
bool isServed(std::string_view name) {
    sockaddr_un address{};
    address.sun_family = AF_UNIX;
    if (name.size() >= sizeof address.sun_path)
        return false;
    std::memcpy(address.sun_path, name.data(), name.size());
    const int connection = socket(AF_UNIX, SOCK_STREAM | SOCK_CLOEXEC | SOCK_NONBLOCK, 0);
    if (connection < 0)
        return false;
    const auto length = static_cast<socklen_t>(offsetof(sockaddr_un, sun_path) + name.size());
    const bool served =
        connect(connection, reinterpret_cast<const sockaddr*>(&address), length) == 0 ||
        errno == EAGAIN; // somebody, who is busy
    close(connection);
    return served;
}

bool haveWaylandDisplay() {
    if (!isSet("WAYLAND_DISPLAY"))
        return false;
    const std::filesystem::path display = std::getenv("WAYLAND_DISPLAY");
    const char* const runtime = std::getenv("XDG_RUNTIME_DIR");
    // Joined with one that is absolute, the folder is not looked at.
    return isServed((std::filesystem::path(runtime ? runtime : "") / display).native());
}

/// `:1`, `:1.0` and `unix:1` are displays of this machine; others are believed.
bool haveX11Display() {
    if (!isSet("DISPLAY"))
        return false;
    const std::string_view display = std::getenv("DISPLAY");
    const auto colon = display.rfind(':');
    if (colon == std::string_view::npos)
        return false;
    const auto host = display.substr(0, colon);
    if (!host.empty() && host != "unix")
        return true;
    const auto digits = display.substr(colon + 1);
    unsigned number = 0;
    if (std::from_chars(digits.data(), digits.data() + digits.size(), number).ec != std::errc())
        return false;
    const auto path = "/tmp/.X11-unix/X" + std::to_string(number);
    return isServed('\0' + path) || isServed(path);
}

/// A platform that somebody chose, but for those that nobody sees; nothing where none was chosen.
std::optional<bool> chosenPlatformIsSeen() {
    if (!isSet("QT_QPA_PLATFORM"))
        return std::nullopt;
    const std::string_view platform = std::getenv("QT_QPA_PLATFORM");
    return !platform.starts_with("offscreen") && !platform.starts_with("minimal");
}

} // namespace

bool haveDisplay() {
    return chosenPlatformIsSeen().value_or(haveWaylandDisplay() || haveX11Display());
}

void makeDesktopApplication(const std::string& desktopFile) {
    if (QCoreApplication::instance())
        return;
    static std::string name = "orvo-transit-widget";
    static std::array<char*, 2> words = {name.data(), nullptr};
    static int count = 1;
    nameNoBusWhereThereIsNone();
    logToolkitRemarks();
    // A card is pixels: no graphics driver has to be loaded for it, nor a theme of the desktop's.
    setenv("QT_WAYLAND_CLIENT_BUFFER_INTEGRATION", "none", KeepGiven);
    setenv("QT_XCB_GL_INTEGRATION", "none", KeepGiven);
    QGuiApplication::setDesktopSettingsAware(false);
    QGuiApplication::setDesktopFileName(
        QString::fromUtf8(desktopFile.data(), static_cast<qsizetype>(desktopFile.size())));
    // Never destroyed: it would go after what it stands on.
    auto* const application = new QGuiApplication(count, words.data());
    application->setQuitOnLastWindowClosed(false);
}

} // namespace orvo
