#include "platform/settings/DesktopDisplay.h"

#include "platform/foundation/FileDescriptor.h"

#include <cerrno>
#include <charconv>
#include <cstddef>
#include <cstdlib>
#include <cstring>
#include <filesystem>
#include <string>
#include <string_view>
#include <sys/socket.h>
#include <sys/un.h>

namespace orvo::DesktopDisplay {

namespace {

constexpr int KeepGiven = 0;
/// Where a program of the platform for Wayland looks when nothing is named.
constexpr std::string_view UsualWayland = "wayland-0";

/// Empty where it is not set.
std::string_view variable(const char* name) {
    const char* const value = std::getenv(name);
    return value ? value : std::string_view();
}

/// Whether somebody serves the socket. A name in the abstract namespace begins with a zero byte.
bool isServed(std::string_view name) {
    sockaddr_un address{};
    address.sun_family = AF_UNIX;
    if (name.size() >= sizeof address.sun_path)
        return false;
    std::memcpy(address.sun_path, name.data(), name.size());
    const FileDescriptor connection(socket(AF_UNIX, SOCK_STREAM | SOCK_CLOEXEC | SOCK_NONBLOCK, 0));
    if (!connection.isOpen())
        return false;
    const auto length = static_cast<socklen_t>(offsetof(sockaddr_un, sun_path) + name.size());
    return connect(connection.number(), reinterpret_cast<const sockaddr*>(&address), length) == 0 ||
           errno == EAGAIN; // somebody, who is busy
}

/// @param unnamed the display where none is named; empty for none
bool haveWayland(std::string_view unnamed) {
    const auto named = variable("WAYLAND_DISPLAY");
    const std::filesystem::path display = named.empty() ? unnamed : named;
    // Joined with one that is absolute, the folder is not looked at.
    return !display.empty() &&
           isServed((std::filesystem::path(variable("XDG_RUNTIME_DIR")) / display).native());
}

/// `:1`, `:1.0` and `unix:1` are displays of this machine; others are believed.
bool haveX11() {
    const auto display = variable("DISPLAY");
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

} // namespace

bool isThere() {
    const auto platform = variable("QT_QPA_PLATFORM"); // perhaps several, the first that works
    if (platform.empty())
        return haveWayland({}) || haveX11();
    if (platform.starts_with("offscreen") || platform.starts_with("minimal"))
        return false;
    const bool mayBeWayland = platform.find("wayland") != std::string_view::npos;
    const bool mayBeX11 = platform.find("xcb") != std::string_view::npos;
    if (!mayBeWayland && !mayBeX11)
        return true;
    return (mayBeWayland && haveWayland(UsualWayland)) || (mayBeX11 && haveX11());
}

void useNoGraphicsDrivers() {
    setenv("QT_WAYLAND_CLIENT_BUFFER_INTEGRATION", "none", KeepGiven);
    setenv("QT_XCB_GL_INTEGRATION", "none", KeepGiven);
}

} // namespace orvo::DesktopDisplay
