#include "orvo/window/WindowApplication.h"

#include "orvo/window/WindowWorld.h"

#include <array>
#include <string>

namespace orvo {
namespace {

/// Whoever comes first in a process makes its application object, so CTest's processes count.
class WindowApplicationTest : public ::testing::Test {
protected:
    void SetUp() override {
        if (QCoreApplication::instance())
            GTEST_SKIP() << "another test has made the application object";
    }
};

TEST_F(WindowApplicationTest, WhereNobodyWouldSeeWindowsNothingIsMade) {
    WindowApplication::make(); // tests have a platform that nobody sees
    EXPECT_EQ(QCoreApplication::instance(), nullptr);
    EXPECT_FALSE(WindowApplication::isMade());
}

TEST_F(WindowApplicationTest, AnApplicationObjectThatIsThereStays) {
    ASSERT_TRUE(testing::haveWindowApplication());
    auto* const before = QCoreApplication::instance();
    WindowApplication::make();
    EXPECT_EQ(QCoreApplication::instance(), before);
    EXPECT_TRUE(WindowApplication::isMade());
}

TEST_F(WindowApplicationTest, AnApplicationObjectWithoutWindowsIsNone) {
    int count = 1;
    std::string name = "test";
    std::array<char*, 2> words = {name.data(), nullptr};
    const QCoreApplication withoutWindows(count, words.data());
    WindowApplication::make();
    EXPECT_FALSE(WindowApplication::isMade());
}

} // namespace
} // namespace orvo
