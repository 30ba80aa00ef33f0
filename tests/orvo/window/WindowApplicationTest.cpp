#include "orvo/window/WindowApplication.h"

#include "orvo/window/WindowWorld.h"

#include <cstdlib>
#include <cstring>
#include <map>
#include <sys/socket.h>
#include <sys/un.h>
#include <unistd.h>

namespace orvo {
namespace {

/// The variables that tell of displays; as they were at the end.
class WindowApplicationTest : public ::testing::Test {
protected:
    void SetUp() override {
        for (const char* name :
             {"DISPLAY", "WAYLAND_DISPLAY", "XDG_RUNTIME_DIR", "QT_QPA_PLATFORM"}) {
            const char* value = std::getenv(name);
            before[name] = value ? std::optional<std::string>(value) : std::nullopt;
            unsetenv(name);
        }
    }
    void TearDown() override {
        for (const auto& [name, value] : before)
            value ? setenv(name.c_str(), value->c_str(), 1) : unsetenv(name.c_str());
    }

    /// A compositor's socket of that name, as long as it is open.
    void listenAt(const std::string& name) {
        sockaddr_un address{};
        address.sun_family = AF_UNIX;
        const auto path = (folder.path() / name).string();
        ASSERT_LT(path.size(), sizeof(address.sun_path));
        std::memcpy(address.sun_path, path.data(), path.size());
        listener = socket(AF_UNIX, SOCK_STREAM | SOCK_CLOEXEC, 0);
        ASSERT_EQ(bind(listener, reinterpret_cast<const sockaddr*>(&address), sizeof(address)), 0);
        ASSERT_EQ(listen(listener, 1), 0);
        setenv("XDG_RUNTIME_DIR", folder.path().c_str(), 1);
        setenv("WAYLAND_DISPLAY", name.c_str(), 1);
    }

    std::map<std::string, std::optional<std::string>> before;
    testing::TemporaryFolder folder;
    int listener = -1;
};

TEST_F(WindowApplicationTest, WithoutAVariableThereIsNoDisplay) {
    EXPECT_FALSE(WindowApplication::haveDisplay());
}

TEST_F(WindowApplicationTest, ADisplayThatAnswersIsOne) {
    listenAt("wayland-7");
    EXPECT_TRUE(WindowApplication::haveDisplay());
    setenv("WAYLAND_DISPLAY", (folder.path() / "wayland-7").c_str(), 1);
    EXPECT_TRUE(WindowApplication::haveDisplay());
    close(listener);
    EXPECT_FALSE(WindowApplication::haveDisplay());
}

TEST_F(WindowApplicationTest, ADisplayThatHasGoneIsNone) {
    setenv("XDG_RUNTIME_DIR", folder.path().c_str(), 1);
    setenv("WAYLAND_DISPLAY", "wayland-8", 1);
    setenv("DISPLAY", ":94321", 1);
    EXPECT_FALSE(WindowApplication::haveDisplay());
}

TEST_F(WindowApplicationTest, ADisplayOnAnotherMachineIsTakenAtItsWord) {
    setenv("DISPLAY", "there:10.0", 1);
    EXPECT_TRUE(WindowApplication::haveDisplay());
}

TEST_F(WindowApplicationTest, WhereNothingIsSeenThereIsNoDisplay) {
    listenAt("wayland-7");
    setenv("QT_QPA_PLATFORM", "offscreen", 1);
    EXPECT_FALSE(WindowApplication::haveDisplay());
    close(listener);
}

} // namespace
} // namespace orvo
