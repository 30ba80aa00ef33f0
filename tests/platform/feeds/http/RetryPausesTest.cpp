#include "platform/feeds/http/RetryPauses.h"

#include "platform/foundation/Environment.h"
#include "support/TemporaryProfile.h"

#include <gtest/gtest.h>

#include <chrono>
#include <filesystem>
#include <fstream>

namespace orvo {
namespace {

constexpr double Now = 784111777; // Sun, 06 Nov 1994 08:49:37 GMT

TEST(RetryDelay, SecondsAreTakenAsTheyStand) {
    EXPECT_EQ(retryDelay("120", "", Now), 120);
    EXPECT_EQ(retryDelay("0", "", Now), 0);
}

TEST(RetryDelay, DatesCountFromTheServersOwnDate) {
    EXPECT_EQ(retryDelay("Sun, 06 Nov 1994 09:00:00 GMT", "Sun, 06 Nov 1994 08:59:00 GMT", 5), 60);
}

TEST(RetryDelay, WithoutTheServersDateTheyCountFromNow) {
    EXPECT_EQ(retryDelay("Sun, 06 Nov 1994 08:50:37 GMT", "", Now), 60);
    EXPECT_EQ(retryDelay("Sun, 06 Nov 1994 08:50:37 GMT", "yesterday", Now), 60);
}

TEST(RetryDelay, PastDatesAreNoDelay) {
    EXPECT_EQ(retryDelay("Sun, 06 Nov 1994 08:00:00 GMT", "", Now), 0);
}

TEST(RetryDelay, IsADayAtMost) {
    EXPECT_EQ(retryDelay("100000", "", Now), RetryPauses::Longest);
    EXPECT_EQ(retryDelay("99999999999999999999999", "", Now), RetryPauses::Longest);
    EXPECT_EQ(retryDelay("Sun, 06 Nov 2094 08:00:00 GMT", "", Now), RetryPauses::Longest);
}

TEST(RetryDelay, OtherWordsAreNothing) {
    EXPECT_EQ(retryDelay("", "", Now), std::nullopt);
    EXPECT_EQ(retryDelay("soon", "", Now), std::nullopt);
    EXPECT_EQ(retryDelay("-5", "", Now), std::nullopt);
    EXPECT_EQ(retryDelay("1.5", "", Now), std::nullopt);
}

class RetryPausesTest : public ::testing::Test {
protected:
    std::filesystem::path folder() const { return _temporary.path() / "made" / "pauses"; }
    std::filesystem::path file() const { return folder() / "a.plist"; }
    /// As if the file had been written so long ago.
    void age(std::chrono::seconds seconds) const {
        std::filesystem::last_write_time(file(),
                                         std::filesystem::file_time_type::clock::now() - seconds);
    }
    /// What another process finds.
    std::optional<RetryPauses::Pause> elsewhere() const {
        return RetryPauses(folder()).pending("a", 0);
    }

    testing::TemporaryFolder _temporary;
    RetryPauses pauses{folder()};
};

TEST_F(RetryPausesTest, PendUntilTheirEnd) {
    EXPECT_FALSE(pauses.pending("a", 0));
    EXPECT_FALSE(pauses.note("a", 60, 503, 1000));
    const auto pause = pauses.pending("a", 1059);
    ASSERT_TRUE(pause);
    EXPECT_EQ(pause->seconds, 1);
    EXPECT_EQ(pause->status, 503);
    EXPECT_FALSE(pauses.pending("b", 1059));
    EXPECT_FALSE(pauses.pending("a", 1060));
}

TEST_F(RetryPausesTest, TheLastWordHolds) {
    EXPECT_FALSE(pauses.note("a", 60, 503, 1000));
    EXPECT_FALSE(pauses.note("a", 10, 429, 1000));
    EXPECT_FALSE(pauses.pending("a", 1010));
}

TEST_F(RetryPausesTest, AnotherProcessKnowsThem) {
    EXPECT_FALSE(pauses.note("a", 3600, 429, 1000));
    const auto pause = elsewhere();
    ASSERT_TRUE(pause);
    EXPECT_LE(pause->seconds, 3600);
    EXPECT_EQ(pause->status, 429);
    age(std::chrono::seconds(3601));
    EXPECT_FALSE(elsewhere());
}

TEST_F(RetryPausesTest, ALaterOneOfAnotherProcessHolds) {
    EXPECT_FALSE(pauses.note("a", 60, 503, 1000));
    age(std::chrono::seconds(30)); // so that the next file has another time
    EXPECT_FALSE(RetryPauses(folder()).note("a", 3600, 429, 0));
    const auto pause = pauses.pending("a", 1060);
    ASSERT_TRUE(pause);
    EXPECT_EQ(pause->status, 429);
}

TEST_F(RetryPausesTest, AClockThatWasTurnedBackMakesNoPauseLonger) {
    EXPECT_FALSE(pauses.note("a", 60, 503, 1000));
    age(std::chrono::seconds(-7200));
    const auto pause = elsewhere();
    ASSERT_TRUE(pause);
    EXPECT_EQ(pause->seconds, 60);
}

TEST_F(RetryPausesTest, DamagedFilesAreNoPause) {
    EXPECT_FALSE(pauses.note("a", 60, 503, 1000));
    for (const char* const text : {"", "pause", "<plist><dict/></plist>"}) {
        std::ofstream(file(), std::ios::binary) << text;
        EXPECT_FALSE(elsewhere()) << text;
    }
}

TEST_F(RetryPausesTest, NoFileMakesAPauseLongerThanADay) {
    EXPECT_FALSE(pauses.note("a", RetryPauses::Longest + 1, 503, 1000));
    EXPECT_FALSE(elsewhere());
}

TEST_F(RetryPausesTest, ThoseThatEndedLongAgoAreTakenAway) {
    EXPECT_FALSE(pauses.note("a", 60, 503, 1000));
    age(std::chrono::hours(25));
    EXPECT_FALSE(pauses.note("b", 60, 503, 1000));
    EXPECT_FALSE(std::filesystem::exists(file()));
    EXPECT_TRUE(std::filesystem::exists(folder() / "b.plist"));
}

TEST_F(RetryPausesTest, WhereNothingIsWrittenTheyAreKeptHere) {
    const auto inMemory = Environment::keepsWritesInMemory().overrideWith(true);
    EXPECT_FALSE(pauses.note("a", 60, 503, 1000));
    EXPECT_TRUE(pauses.pending("a", 1059));
    EXPECT_FALSE(std::filesystem::exists(folder()));
}

TEST_F(RetryPausesTest, WhereTheFolderCannotBeMadeTheyAreKeptHereAndThatIsSaid) {
    std::ofstream(_temporary.path() / "made") << "in the way";
    EXPECT_TRUE(pauses.note("a", 60, 503, 1000));
    EXPECT_TRUE(pauses.pending("a", 1059));
}

} // namespace
} // namespace orvo
