#include "platform/settings/DesktopDisplay.h"

#include "support/TemporaryProfile.h"

#include <gtest/gtest.h>

#include <array>
#include <cstdlib>
#include <map>
#include <optional>
#include <string>
#include <sys/socket.h>
#include <sys/un.h>
#include <unistd.h>

namespace orvo {
namespace {

/// A socket that somebody serves, for the scope of a test.
class ServedSocket {
public:
    explicit ServedSocket(const std::string& path) {
        sockaddr_un address{};
        address.sun_family = AF_UNIX;
        path.copy(address.sun_path, sizeof address.sun_path - 1);
        bind(_socket, reinterpret_cast<const sockaddr*>(&address), sizeof address);
        listen(_socket, 1);
    }
    ServedSocket(const ServedSocket&) = delete;
    ServedSocket& operator=(const ServedSocket&) = delete;
    ~ServedSocket() { close(_socket); }

private:
    int _socket = socket(AF_UNIX, SOCK_STREAM | SOCK_CLOEXEC, 0);
};

class DesktopDisplayTest : public ::testing::Test {
protected:
    static constexpr std::array Names{"QT_QPA_PLATFORM",
                                      "DISPLAY",
                                      "WAYLAND_DISPLAY",
                                      "XDG_RUNTIME_DIR",
                                      "QT_WAYLAND_CLIENT_BUFFER_INTEGRATION",
                                      "QT_XCB_GL_INTEGRATION"};

    void SetUp() override {
        for (const char* name : Names) {
            _earlier[name] = valueOf(name);
            unsetenv(name);
        }
        set("XDG_RUNTIME_DIR", folder.path().string());
    }
    void TearDown() override {
        for (const auto& [name, value] : _earlier) {
            if (value)
                set(name, *value);
            else
                unsetenv(name);
        }
    }
    static void set(const char* name, const std::string& value) { setenv(name, value.c_str(), 1); }
    static std::optional<std::string> valueOf(const char* name) {
        const char* const value = std::getenv(name);
        return value ? std::optional<std::string>(value) : std::nullopt;
    }

    testing::TemporaryFolder folder;

private:
    std::map<const char*, std::optional<std::string>> _earlier;
};

TEST_F(DesktopDisplayTest, WithoutVariablesThereIsNone) {
    EXPECT_FALSE(DesktopDisplay::isThere());
    set("WAYLAND_DISPLAY", "");
    set("DISPLAY", "");
    EXPECT_FALSE(DesktopDisplay::isThere());
}

TEST_F(DesktopDisplayTest, AWaylandDisplayIsOneWhileItIsServed) {
    set("WAYLAND_DISPLAY", "wayland-7");
    EXPECT_FALSE(DesktopDisplay::isThere());
    {
        const ServedSocket served((folder.path() / "wayland-7").string());
        EXPECT_TRUE(DesktopDisplay::isThere());
        set("WAYLAND_DISPLAY", (folder.path() / "wayland-7").string());
        unsetenv("XDG_RUNTIME_DIR");
        EXPECT_TRUE(DesktopDisplay::isThere()) << "by its whole path";
    }
    EXPECT_FALSE(DesktopDisplay::isThere()) << "the socket was left behind";
}

TEST_F(DesktopDisplayTest, AnX11DisplayOfThisMachineThatNobodyServesIsNone) {
    for (const char* display : {":64999", "unix:64999.0", ":94321", "here"}) {
        set("DISPLAY", display);
        EXPECT_FALSE(DesktopDisplay::isThere()) << display;
    }
}

TEST_F(DesktopDisplayTest, AnX11DisplayOfAnotherMachineIsBelieved) {
    set("DISPLAY", "elsewhere:10.0");
    EXPECT_TRUE(DesktopDisplay::isThere());
}

TEST_F(DesktopDisplayTest, APlatformThatNobodySeesIsNone) {
    const ServedSocket served((folder.path() / "wayland-7").string());
    set("WAYLAND_DISPLAY", "wayland-7");
    set("DISPLAY", "elsewhere:0");
    set("QT_QPA_PLATFORM", "offscreen");
    EXPECT_FALSE(DesktopDisplay::isThere());
    set("QT_QPA_PLATFORM", "minimal:enable_fonts");
    EXPECT_FALSE(DesktopDisplay::isThere());
}

TEST_F(DesktopDisplayTest, APlatformThatNeedsNoDisplayIsBelieved) {
    set("QT_QPA_PLATFORM", "linuxfb:fb=/dev/fb0");
    EXPECT_TRUE(DesktopDisplay::isThere());
}

TEST_F(DesktopDisplayTest, APlatformWithADisplayNeedsThatDisplay) {
    set("QT_QPA_PLATFORM", "wayland");
    set("DISPLAY", "elsewhere:0");
    EXPECT_FALSE(DesktopDisplay::isThere()) << "as in a shell from another machine";
    set("QT_QPA_PLATFORM", "wayland;xcb");
    EXPECT_TRUE(DesktopDisplay::isThere()) << "either";
    const ServedSocket served((folder.path() / "wayland-0").string());
    set("QT_QPA_PLATFORM", "wayland");
    EXPECT_TRUE(DesktopDisplay::isThere()) << "unnamed, the usual one";
    unsetenv("DISPLAY");
    set("QT_QPA_PLATFORM", "xcb");
    EXPECT_FALSE(DesktopDisplay::isThere());
    unsetenv("QT_QPA_PLATFORM");
    EXPECT_FALSE(DesktopDisplay::isThere()) << "without a choice, only what is named";
}

TEST_F(DesktopDisplayTest, GraphicsDriversAreLoadedOnlyWhereTheEnvironmentAsksForThem) {
    set("QT_XCB_GL_INTEGRATION", "xcb_egl");
    DesktopDisplay::useNoGraphicsDrivers();
    EXPECT_EQ(valueOf("QT_XCB_GL_INTEGRATION"), "xcb_egl");
    EXPECT_EQ(valueOf("QT_WAYLAND_CLIENT_BUFFER_INTEGRATION"), "none");
}

} // namespace
} // namespace orvo
