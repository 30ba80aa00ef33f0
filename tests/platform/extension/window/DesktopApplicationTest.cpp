#include "platform/extension/window/DesktopApplication.h"

#include "support/TemporaryProfile.h"

#include <QGuiApplication>
#include <gtest/gtest.h>

#include <cstdlib>
#include <fstream>
#include <string>

namespace orvo {
namespace {

/// Whoever comes first in a process makes its application object, so CTest's processes count.
class DesktopApplicationTest : public ::testing::Test {
protected:
    void SetUp() override {
        if (QCoreApplication::instance())
            GTEST_SKIP() << "another test has made the application object";
        setenv("XDG_RUNTIME_DIR", folder.path().c_str(), 1);
        unsetenv("DBUS_SESSION_BUS_ADDRESS");
    }
    static std::string busAddress() {
        const char* const value = std::getenv("DBUS_SESSION_BUS_ADDRESS");
        return value ? value : "";
    }

    testing::TemporaryFolder folder;
};

TEST_F(DesktopApplicationTest, IsMadeOnceAndOutlivesItsWindows) {
    makeDesktopApplication("a.desktop.file");
    auto* const made = qobject_cast<QGuiApplication*>(QCoreApplication::instance());
    ASSERT_NE(made, nullptr);
    EXPECT_EQ(QGuiApplication::desktopFileName(), "a.desktop.file");
    EXPECT_FALSE(QGuiApplication::quitOnLastWindowClosed());
    makeDesktopApplication("another.desktop.file");
    EXPECT_EQ(QCoreApplication::instance(), made);
    EXPECT_EQ(QGuiApplication::desktopFileName(), "a.desktop.file");
}

TEST_F(DesktopApplicationTest, ABusThatIsNotThereIsNotStarted) {
    makeDesktopApplication("a.desktop.file");
    EXPECT_EQ(busAddress(), "disabled:");
}

TEST_F(DesktopApplicationTest, ABusAtTheUsualPlaceIsLeftToBeFound) {
    std::ofstream(folder.path() / "bus").put('x');
    makeDesktopApplication("a.desktop.file");
    EXPECT_EQ(busAddress(), "");
}

TEST_F(DesktopApplicationTest, ABusThatIsNamedStaysTheBus) {
    setenv("DBUS_SESSION_BUS_ADDRESS", "unix:path=/nonexistent", 1);
    makeDesktopApplication("a.desktop.file");
    EXPECT_EQ(busAddress(), "unix:path=/nonexistent");
}

} // namespace
} // namespace orvo
