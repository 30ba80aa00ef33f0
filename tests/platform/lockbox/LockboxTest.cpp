#include "platform/lockbox/Lockbox.h"

#include "support/MockBusService.h"
#include "support/PrivateBus.h"

#include <gtest/gtest.h>

#include <chrono>
#include <cstdlib>
#include <cstring>
#include <dlfcn.h>
#include <optional>
#include <sys/socket.h>
#include <sys/un.h>
#include <unistd.h>

namespace orvo {
namespace {

using testing::MockBusService;
using testing::PrivateBus;
using testing::TemporaryFolder;

constexpr const char* Login = "org.freedesktop.login1";
constexpr const char* OwnSession = "/org/freedesktop/login1/session/auto";
constexpr const char* SessionInterface = "org.freedesktop.login1.Session";

class LockboxTest : public ::testing::Test {
protected:
    void SetUp() override {
        library = dlopen(ORVO_LOCKBOX, RTLD_NOW | RTLD_LOCAL);
        ASSERT_TRUE(library) << dlerror();
        function = reinterpret_cast<int (*)(const void*)>(dlsym(library, "LBXGetDeviceLockState"));
        ASSERT_TRUE(function);
    }
    void TearDown() override {
        unsetenv("DBUS_SYSTEM_BUS_ADDRESS");
        dlclose(library);
    }

    static void useBus(const std::string& address) {
        setenv("DBUS_SYSTEM_BUS_ADDRESS", address.c_str(), 1);
    }
    int state() { return function(nullptr); }

    void* library = nullptr;
    int (*function)(const void*) = nullptr;
};

/// A bus with a logind on it.
class LockboxWithLoginTest : public LockboxTest {
protected:
    void SetUp() override {
        LockboxTest::SetUp();
        useBus(bus.address());
    }

    PrivateBus bus;
    MockBusService login{bus.address(), Login};
};

/// Whether a question is answered in a time that a person would not notice in a test of it all.
bool isSoon(std::chrono::steady_clock::time_point begin) {
    return std::chrono::steady_clock::now() - begin < std::chrono::seconds(10);
}

TEST_F(LockboxWithLoginTest, FollowsTheHintOfItsOwnSession) {
    login.set(OwnSession, SessionInterface, "LockedHint", true);
    EXPECT_EQ(state(), LBXDeviceLockStateLocked);
    login.set(OwnSession, SessionInterface, "LockedHint", false);
    EXPECT_EQ(state(), LBXDeviceLockStateUnlocked);
    login.set(OwnSession, SessionInterface, "LockedHint", true);
    EXPECT_EQ(state(), LBXDeviceLockStateLocked);
    EXPECT_EQ(login.calls(), 3);
}

TEST_F(LockboxWithLoginTest, ProcessWithoutASessionIsUnlocked) {
    login.set("/org/freedesktop/login1/session/c1", SessionInterface, "LockedHint", true);
    EXPECT_EQ(state(), LBXDeviceLockStateUnlocked);
    EXPECT_EQ(login.calls(), 1);
}

TEST_F(LockboxWithLoginTest, AnswerOfAnotherTypeIsUnlocked) {
    login.set(OwnSession, SessionInterface, "LockedHint", std::uint32_t{1});
    EXPECT_EQ(state(), LBXDeviceLockStateUnlocked);
}

TEST_F(LockboxWithLoginTest, SilentLoginIsUnlockedSoon) {
    login.fallSilent();
    const auto begin = std::chrono::steady_clock::now();
    EXPECT_EQ(state(), LBXDeviceLockStateUnlocked);
    EXPECT_TRUE(isSoon(begin));
    EXPECT_EQ(login.calls(), 1);
}

TEST_F(LockboxTest, WithoutLoginIsUnlocked) {
    const PrivateBus bus;
    useBus(bus.address());
    EXPECT_EQ(state(), LBXDeviceLockStateUnlocked);
}

TEST_F(LockboxTest, WithoutABusIsUnlocked) {
    const TemporaryFolder folder;
    useBus("unix:path=" + (folder.path() / "none").string());
    EXPECT_EQ(state(), LBXDeviceLockStateUnlocked);
    useBus("no address");
    EXPECT_EQ(state(), LBXDeviceLockStateUnlocked);
}

TEST_F(LockboxTest, BusThatNeverGreetsIsUnlockedSoon) {
    const TemporaryFolder folder;
    const auto path = (folder.path() / "bus").string();
    sockaddr_un address{.sun_family = AF_UNIX, .sun_path = {}};
    ASSERT_LT(path.size(), sizeof address.sun_path);
    std::memcpy(address.sun_path, path.c_str(), path.size() + 1);
    const int listener = socket(AF_UNIX, SOCK_STREAM | SOCK_CLOEXEC, 0);
    ASSERT_EQ(bind(listener, reinterpret_cast<const sockaddr*>(&address), sizeof address), 0);
    ASSERT_EQ(listen(listener, 1), 0);
    useBus("unix:path=" + path);
    const auto begin = std::chrono::steady_clock::now();
    EXPECT_EQ(state(), LBXDeviceLockStateUnlocked);
    EXPECT_TRUE(isSoon(begin));
    close(listener);
}

} // namespace
} // namespace orvo
