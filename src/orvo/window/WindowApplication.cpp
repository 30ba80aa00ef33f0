#include "orvo/window/WindowApplication.h"

#include <QApplication>
#include <QIcon>

#include <array>
#include <cstddef>
#include <cstdlib>
#include <cstring>
#include <string>
#include <sys/socket.h>
#include <sys/un.h>
#include <unistd.h>

namespace orvo::WindowApplication {

namespace {

constexpr int KeepGiven = 0;

std::string variable(const char* name) {
    const char* const value = std::getenv(name);
    return value ? value : "";
}

/// @param path of a socket in the file system, or beginning with a zero byte for an abstract one
bool answers(const std::string& path) {
    sockaddr_un address{};
    if (path.empty() || path.size() >= sizeof(address.sun_path))
        return false;
    address.sun_family = AF_UNIX;
    std::memcpy(static_cast<char*>(address.sun_path), path.data(), path.size());
    const int socket = ::socket(AF_UNIX, SOCK_STREAM | SOCK_CLOEXEC, 0);
    if (socket < 0)
        return false;
    const auto length = static_cast<socklen_t>(offsetof(sockaddr_un, sun_path) + path.size());
    const bool connected =
        connect(socket, reinterpret_cast<const sockaddr*>(&address), length) == 0;
    close(socket);
    return connected;
}

bool waylandAnswers() {
    const auto name = variable("WAYLAND_DISPLAY");
    if (name.empty())
        return false;
    return answers(name.starts_with('/') ? name : variable("XDG_RUNTIME_DIR") + "/" + name);
}

/// `:1`, `:1.0`, `unix:1`, or `host:1`.
bool x11Answers() {
    const auto display = variable("DISPLAY");
    const auto colon = display.rfind(':');
    if (colon == std::string::npos)
        return false;
    const auto host = display.substr(0, colon);
    if (!host.empty() && host != "unix")
        return true;
    const auto number = display.substr(colon + 1, display.find('.', colon) - colon - 1);
    const auto path = "/tmp/.X11-unix/X" + number;
    return answers(path) || answers(std::string(1, '\0') + path);
}

} // namespace

bool haveDisplay() {
    const auto platform = variable("QT_QPA_PLATFORM");
    if (platform.starts_with("offscreen") || platform.starts_with("minimal"))
        return false;
    return waylandAnswers() || x11Answers();
}

void make() {
    if (QCoreApplication::instance())
        return;
    static std::string name = "orvo";
    static std::array<char*, 2> words = {name.data(), nullptr};
    static int count = 1;
    // Texts and shields are pixels: no graphics driver has to be loaded for them.
    setenv("QT_WAYLAND_CLIENT_BUFFER_INTEGRATION", "none", KeepGiven);
    setenv("QT_XCB_GL_INTEGRATION", "none", KeepGiven);
    QGuiApplication::setDesktopFileName("com.zentu.Orvo");
    // Never destroyed: it would go after what it stands on.
    auto* const application = new QApplication(count, words.data());
    application->setQuitOnLastWindowClosed(false); // who made the windows ends the program
    QGuiApplication::setApplicationDisplayName("Orvo");
    QApplication::setWindowIcon(QIcon::fromTheme("com.zentu.Orvo"));
}

bool isMade() {
    return qobject_cast<QApplication*>(QCoreApplication::instance()) != nullptr;
}

} // namespace orvo::WindowApplication
