#include "platform/feeds/http/RetryPauses.h"

#include "platform/foundation/Environment.h"
#include "platform/foundation/NSDictionary.h"
#include "platform/foundation/NSNumber.h"
#include "platform/foundation/NSString.h"
#include "platform/foundation/PropertyList.h"
#include "support/TemporaryProfile.h"

#include <gtest/gtest.h>

#include <chrono>
#include <filesystem>
#include <fstream>
#include <limits>
#include <utility>
#include <vector>

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

double systemNow() {
    return std::chrono::duration<double>(std::chrono::system_clock::now().time_since_epoch())
        .count();
}

class RetryPausesTest : public ::testing::Test {
protected:
    std::filesystem::path folder() const { return _temporary.path() / "made" / "pauses"; }
    std::filesystem::path file() const { return folder() / "a.plist"; }
    /// What another process noted, or somebody else wrote.
    void write(std::vector<std::pair<std::string, std::shared_ptr<NSObject>>> entries) const {
        std::filesystem::create_directories(folder());
        const auto list =
            PropertyList::write(*NSDictionary::dictionaryWithTextKeys(std::move(entries)), nullptr);
        std::ofstream(file(), std::ios::binary) << list->stringView();
    }
    void writePause(double until, double seconds, double status = 503) const {
        write({{"until", NSNumber::numberWithDouble(until)},
               {"seconds", NSNumber::numberWithDouble(seconds)},
               {"status", NSNumber::numberWithDouble(status)}});
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
    EXPECT_GT(pause->seconds, 1800);
    EXPECT_LE(pause->seconds, 3600);
    EXPECT_EQ(pause->status, 429);
}

TEST_F(RetryPausesTest, WhatAnotherProcessNotedIsCountedDownHere) {
    writePause(systemNow() + 1800, 3600);
    ASSERT_TRUE(pauses.pending("a", 1000));
    EXPECT_LE(pauses.pending("a", 1000)->seconds, 1800);
    EXPECT_FALSE(pauses.pending("a", 2800));
}

TEST_F(RetryPausesTest, ThoseOfThePastAreOver) {
    writePause(systemNow() - 1, 3600);
    EXPECT_FALSE(elsewhere());
}

TEST_F(RetryPausesTest, ALaterOneOfAnotherProcessHolds) {
    EXPECT_FALSE(pauses.note("a", 60, 503, 1000));
    EXPECT_FALSE(RetryPauses(folder()).note("a", 3600, 429, 0));
    const auto pause = pauses.pending("a", 1060);
    ASSERT_TRUE(pause);
    EXPECT_EQ(pause->status, 429);
}

TEST_F(RetryPausesTest, AClockThatWasSetBackMakesNoPauseLonger) {
    writePause(systemNow() + 7260, 60);
    EXPECT_FALSE(elsewhere());
    writePause(systemNow() + 90, 60); // by a little it may be
    ASSERT_TRUE(elsewhere());
    EXPECT_LE(elsewhere()->seconds, 60);
}

TEST_F(RetryPausesTest, FilesOfOthersAreNoPauseAndTakeNoneAway) {
    EXPECT_FALSE(pauses.note("a", 3600, 503, 1000));
    const auto expectNone = [&](const char* what) {
        EXPECT_FALSE(elsewhere()) << what;
        EXPECT_TRUE(pauses.pending("a", 1000)) << what;
    };
    std::ofstream(file(), std::ios::binary) << "pause";
    expectNone("no property list");
    const double until = systemNow() + 1000;
    const auto number = [](double value) {
        return NSNumber::numberWithDouble(value);
    };
    write({{"until", number(until)}, {"seconds", number(2000)}});
    expectNone("no status");
    write({{"until", number(until)}, {"status", number(503)}});
    expectNone("no seconds");
    write({{"seconds", number(2000)}, {"status", number(503)}});
    expectNone("no end");
    write(
        {{"until", NSString::string("soon")}, {"seconds", number(2000)}, {"status", number(503)}});
    expectNone("an end in words");
    constexpr double NaN = std::numeric_limits<double>::quiet_NaN();
    for (const double bad : {NaN, -1.0, RetryPauses::Longest + 1}) {
        writePause(until, bad);
        expectNone("bad seconds");
    }
    writePause(NaN, 2000);
    expectNone("a bad end");
    for (const double bad : {NaN, 0.0, 99999999999.0, 1e300}) {
        writePause(until, 2000, bad);
        expectNone("a bad status");
    }
    std::filesystem::remove(file());
    expectNone("no file");
}

TEST_F(RetryPausesTest, OneThatIsForgottenIsOverEverywhere) {
    EXPECT_FALSE(pauses.note("a", 3600, 503, 1000));
    pauses.forget("a");
    EXPECT_FALSE(pauses.pending("a", 1000));
    EXPECT_FALSE(elsewhere());
}

TEST_F(RetryPausesTest, FilesThatAreADayOldAreTakenAwayButNeverTheLock) {
    EXPECT_FALSE(pauses.note("a", 60, 503, 1000));
    EXPECT_FALSE(pauses.note("c", 60, 503, 1000));
    const auto now = std::filesystem::file_time_type::clock::now();
    std::filesystem::last_write_time(file(), now - std::chrono::hours(25));
    std::filesystem::last_write_time(folder() / "c.plist", now + std::chrono::hours(25));
    std::filesystem::last_write_time(folder() / "lock", now - std::chrono::hours(25));
    EXPECT_FALSE(pauses.note("b", 60, 503, 1000));
    EXPECT_FALSE(std::filesystem::exists(file()));
    EXPECT_FALSE(std::filesystem::exists(folder() / "c.plist"));
    EXPECT_TRUE(std::filesystem::exists(folder() / "b.plist"));
    EXPECT_TRUE(std::filesystem::exists(folder() / "lock"));
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
