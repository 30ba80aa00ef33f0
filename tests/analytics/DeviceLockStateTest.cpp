#include "analytics/DeviceLockState.h"

#include "support/MockBusService.h"
#include "support/PrivateBus.h"

#include <gtest/gtest.h>

#include <cstdlib>
#include <optional>
#include <syslog.h>

namespace orvo {
namespace {

constexpr const char* Path = "System/Library/PrivateFrameworks/Lockbox.framework/Lockbox";
constexpr const char* InternalPath =
    "ZentuInternal/Library/PrivateFrameworks/Lockbox.framework/Lockbox";
constexpr const char* Complaint = "### Failed to Soft Linked: "
                                  "/System/Library/PrivateFrameworks/Lockbox.framework/Lockbox";

/// Below a system root of its own; what goes to the system log is caught on standard error.
class DeviceLockStateTest : public ::testing::Test {
protected:
    DeviceLockStateTest() { openlog("lock", LOG_PERROR, LOG_USER); }
    ~DeviceLockStateTest() override { closelog(); }

    void install(const char* library, const char* path) const {
        std::filesystem::create_directories((folder.path() / path).parent_path());
        std::filesystem::copy_file(library, folder.path() / path);
    }
    /// What the library answers; nothing where there is no function to ask.
    std::optional<int> loadedState() {
        ::testing::internal::CaptureStderr();
        const auto function = SoftLinkDeviceLockState();
        logged = ::testing::internal::GetCapturedStderr();
        return function ? std::optional(function()) : std::nullopt;
    }

    testing::TemporaryFolder folder;
    EnvironmentSlot<std::filesystem::path>::Override root =
        DeviceLockStateSystemRoot().overrideWith(folder.path());
    std::string logged;
};

TEST_F(DeviceLockStateTest, FirstPathComesBeforeTheInternalOne) {
    install(ORVO_LOCKBOX_ANSWERING_7, Path);
    install(ORVO_LOCKBOX_ANSWERING_9, InternalPath);
    EXPECT_EQ(loadedState(), 7);
    EXPECT_EQ(logged, "");
}

TEST_F(DeviceLockStateTest, InternalPathIsTakenWithoutTheFirstAndNotComplainedAbout) {
    install(ORVO_LOCKBOX_ANSWERING_9, InternalPath);
    EXPECT_EQ(loadedState(), 9);
    EXPECT_EQ(logged, "");
}

TEST_F(DeviceLockStateTest, InternalPathIsTakenWhenTheFirstCannotBeOpened) {
    std::filesystem::create_directories(folder.path() / Path);
    install(ORVO_LOCKBOX_ANSWERING_9, InternalPath);
    EXPECT_EQ(loadedState(), 9);
}

TEST_F(DeviceLockStateTest, AbsentLibraryIsLoggedByItsFirstPathWithoutTheSystemRoot) {
    EXPECT_EQ(loadedState(), std::nullopt);
    EXPECT_EQ(logged, std::string("lock: ") + Complaint + "\n");
}

TEST_F(DeviceLockStateTest, LibraryWithoutTheFunctionHasNothingToAsk) {
    install(ORVO_EMPTY_LIBRARY, Path);
    EXPECT_EQ(loadedState(), std::nullopt);
    EXPECT_EQ(logged, "");
}

TEST_F(DeviceLockStateTest, FirstLibraryWithoutTheFunctionHidesTheInternalOne) {
    install(ORVO_EMPTY_LIBRARY, Path);
    install(ORVO_LOCKBOX_ANSWERING_9, InternalPath);
    EXPECT_EQ(loadedState(), std::nullopt);
}

/// The library is opened once in a process; here each has one of its own.
class DeviceLockStateDeathTest : public DeviceLockStateTest {};

TEST_F(DeviceLockStateDeathTest, IsZeroWithoutALibraryAndComplainsOnce) {
    EXPECT_EXIT(
        {
            const auto first = DeviceLockState();
            const auto second = DeviceLockState();
            std::exit(first + second);
        },
        ::testing::ExitedWithCode(0),
        "^lock: ### Failed to Soft Linked: [^\n]*\n$");
}

TEST_F(DeviceLockStateDeathTest, LibraryIsOpenedOnceAndKept) {
    install(ORVO_LOCKBOX_ANSWERING_7, Path);
    EXPECT_EXIT(
        {
            const auto first = DeviceLockState();
            std::filesystem::remove(folder.path() / Path);
            std::exit(first * 10 + DeviceLockState());
        },
        ::testing::ExitedWithCode(77),
        "^$");
}

TEST(SoftLinkDeathTest, RootIsWhatTheEnvironmentSays) {
    EXPECT_EXIT(
        {
            setenv("ORVO_SYSTEM_ROOT", "/somewhere", 1);
            std::exit(DeviceLockStateSystemRoot().get() == "/somewhere" ? 0 : 1);
        },
        ::testing::ExitedWithCode(0),
        "");
}

TEST(SoftLink, BuildTreesOwnLibraryAsksLogind) {
    const testing::PrivateBus bus;
    testing::MockBusService login(bus.address(), "org.freedesktop.login1");
    login.set("/org/freedesktop/login1/session/auto",
              "org.freedesktop.login1.Session",
              "LockedHint",
              true);
    unsetenv("ORVO_SYSTEM_ROOT");
    setenv("DBUS_SYSTEM_BUS_ADDRESS", bus.address().c_str(), 1);
    const auto function = SoftLinkDeviceLockState();
    ASSERT_TRUE(function);
    EXPECT_EQ(function(), 1);
    unsetenv("DBUS_SYSTEM_BUS_ADDRESS");
}

} // namespace
} // namespace orvo
