#include "platform/demo/DemoVisit.h"

#include "platform/demo/DemoIncidents.h"
#include "platform/demo/DemoProfile.h"
#include "support/TemporaryProfile.h"
#include "support/TestClock.h"

#include <gtest/gtest.h>

#include <fstream>

namespace orvo {
namespace {

constexpr double Written = 1750000000;

class DemoVisitTest : public ::testing::Test {
protected:
    // The demonstration's folders follow the base directories, which belong to the process.
    void SetUp() override {
        setenv("XDG_DATA_HOME", (folder.path() / "data").c_str(), 1);
        setenv("XDG_CACHE_HOME", (folder.path() / "cache").c_str(), 1);
        setenv("XDG_STATE_HOME", (folder.path() / "state").c_str(), 1);
    }
    void TearDown() override {
        for (const char* name : {"XDG_DATA_HOME", "XDG_CACHE_HOME", "XDG_STATE_HOME"})
            unsetenv(name);
    }

    static std::filesystem::path inUse() { return Environment::profile().get().data; }

    testing::TemporaryFolder folder;
    testing::StoppedClock clock{Written};
};

TEST_F(DemoVisitTest, WritesTheCityWhereItIsNotCurrent) {
    const auto before = inUse();
    {
        const auto visit = DemoVisit::begin(DemoVisit::Purpose::Look, nullptr);
        ASSERT_TRUE(visit);
        EXPECT_EQ(inUse(), ProfileFolders::demonstration().data);
        EXPECT_TRUE(DemoProfile::isCurrent());
    }
    EXPECT_EQ(inUse(), before);
    EXPECT_TRUE(std::filesystem::exists(folder.path() / "data"));
}

TEST_F(DemoVisitTest, WhereNothingMayBeKeptTheCityStandsAsideAndIsGoneAtTheEnd) {
    const auto inMemory = Environment::keepsWritesInMemory().overrideWith(true);
    std::filesystem::path aside;
    {
        const auto visit = DemoVisit::begin(DemoVisit::Purpose::Change, nullptr);
        ASSERT_TRUE(visit);
        aside = inUse();
        EXPECT_NE(aside, ProfileFolders::demonstration().data);
        EXPECT_TRUE(DemoProfile::isCurrent());
    }
    EXPECT_FALSE(std::filesystem::exists(aside));
    EXPECT_FALSE(std::filesystem::exists(folder.path() / "data"));
}

TEST_F(DemoVisitTest, ACityOfTheRightTimeIsReadWhereItIs) {
    ASSERT_TRUE(DemoVisit::begin(DemoVisit::Purpose::Look, nullptr));
    const auto inMemory = Environment::keepsWritesInMemory().overrideWith(true);
    const auto visit = DemoVisit::begin(DemoVisit::Purpose::Look, nullptr);
    EXPECT_EQ(inUse(), ProfileFolders::demonstration().data);
}

TEST_F(DemoVisitTest, SettingsComeAlongAside) {
    const auto data = ProfileFolders::demonstration().data;
    std::filesystem::create_directories(data);
    std::ofstream(data / "settings.plist") << "kept";
    std::ofstream(data / "feeds.plist") << "of another time";
    const auto inMemory = Environment::keepsWritesInMemory().overrideWith(true);
    const auto visit = DemoVisit::begin(DemoVisit::Purpose::Look, nullptr);
    ASSERT_TRUE(visit);
    std::string content;
    std::getline(std::ifstream(inUse() / "settings.plist"), content);
    EXPECT_EQ(content, "kept");
}

TEST_F(DemoVisitTest, ACityWhoseHourIsOverIsWrittenAnewWhereItStands) {
    const auto visit = DemoVisit::begin(DemoVisit::Purpose::Look, nullptr);
    clock->advance(DemoIncidents::LifetimeSeconds);
    ASSERT_FALSE(DemoProfile::isCurrent());
    EXPECT_EQ(visit->renew(), nullptr);
    EXPECT_TRUE(DemoProfile::isCurrent());
    EXPECT_EQ(inUse(), ProfileFolders::demonstration().data);
}

TEST_F(DemoVisitTest, WhereNothingMayBeKeptItIsRenewedAside) {
    ASSERT_TRUE(DemoVisit::begin(DemoVisit::Purpose::Look, nullptr));
    const auto inMemory = Environment::keepsWritesInMemory().overrideWith(true);
    const auto visit = DemoVisit::begin(DemoVisit::Purpose::Look, nullptr);
    ASSERT_EQ(inUse(), ProfileFolders::demonstration().data);
    for (int hour = 0; hour < 2; ++hour) {
        clock->advance(DemoIncidents::LifetimeSeconds);
        EXPECT_EQ(visit->renew(), nullptr);
        EXPECT_NE(inUse(), ProfileFolders::demonstration().data);
        EXPECT_TRUE(DemoProfile::isCurrent());
    }
}

TEST_F(DemoVisitTest, OnlyWhoeverLooksCanDoWithoutWriting) {
    std::filesystem::create_directories(folder.path());
    std::ofstream(folder.path() / "data") << "a file where the folder should be";
    EXPECT_TRUE(DemoVisit::begin(DemoVisit::Purpose::Look, nullptr));
    std::shared_ptr<NSError> error;
    EXPECT_FALSE(DemoVisit::begin(DemoVisit::Purpose::Change, &error));
    ASSERT_TRUE(error);
    EXPECT_NE(error->localizedDescription().find("data"), std::string::npos);
    EXPECT_NE(error->localizedDescription().find("cannot be written: "), std::string::npos)
        << error->localizedDescription();
}

} // namespace
} // namespace orvo
