#include "platform/extension/window/DesktopApplication.h"

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

class DisplayTest : public ::testing::Test {
protected:
    static constexpr std::array Names{
        "QT_QPA_PLATFORM", "DISPLAY", "WAYLAND_DISPLAY", "XDG_RUNTIME_DIR"};

    void SetUp() override {
        for (const char* name : Names) {
            const char* const value = std::getenv(name);
            _earlier[name] = value ? std::optional<std::string>(value) : std::nullopt;
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

    testing::TemporaryFolder folder;

private:
    std::map<const char*, std::optional<std::string>> _earlier;
};

TEST_F(DisplayTest, WithoutVariablesThereIsNone) {
    EXPECT_FALSE(haveDisplay());
    set("WAYLAND_DISPLAY", "");
    set("DISPLAY", "");
    EXPECT_FALSE(haveDisplay());
}

TEST_F(DisplayTest, AWaylandDisplayIsOneWhileItIsServed) {
    set("WAYLAND_DISPLAY", "wayland-7");
    EXPECT_FALSE(haveDisplay());
    {
        const ServedSocket served((folder.path() / "wayland-7").string());
        EXPECT_TRUE(haveDisplay());
        set("WAYLAND_DISPLAY", (folder.path() / "wayland-7").string());
        unsetenv("XDG_RUNTIME_DIR");
        EXPECT_TRUE(haveDisplay()) << "by its whole path";
    }
    EXPECT_FALSE(haveDisplay()) << "the socket was left behind";
}

TEST_F(DisplayTest, AnX11DisplayOfThisMachineThatNobodyServesIsNone) {
    set("DISPLAY", ":64999");
    EXPECT_FALSE(haveDisplay());
    set("DISPLAY", "unix:64999.0");
    EXPECT_FALSE(haveDisplay());
    set("DISPLAY", "here");
    EXPECT_FALSE(haveDisplay());
    set("DISPLAY", "elsewhere:0");
    EXPECT_TRUE(haveDisplay()) << "another machine's is believed";
}

TEST_F(DisplayTest, APlatformThatNobodySeesIsNone) {
    set("DISPLAY", "elsewhere:0");
    set("QT_QPA_PLATFORM", "offscreen");
    EXPECT_FALSE(haveDisplay());
    set("QT_QPA_PLATFORM", "minimal:enable_fonts");
    EXPECT_FALSE(haveDisplay());
    unsetenv("DISPLAY");
    set("QT_QPA_PLATFORM", "wayland");
    EXPECT_TRUE(haveDisplay());
}

} // namespace
} // namespace orvo
