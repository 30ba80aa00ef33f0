#include "platform/feeds/ScheduleUpdater.h"

#include "platform/feeds/schedule/TestSchedules.h"
#include "platform/foundation/Environment.h"
#include "platform/foundation/NSDate.h"
#include "support/LogCapture.h"
#include "support/SmallSchedule.h"
#include "support/TemporaryProfile.h"
#include "support/TestClock.h"

#include <gmock/gmock.h>
#include <gtest/gtest.h>

#include <future>
#include <map>
#include <mutex>

namespace orvo {
namespace {

using ::testing::ElementsAre;
using ::testing::HasSubstr;
using ::testing::IsEmpty;
using Outcome = ScheduleUpdate::Outcome;

/// A feed whose schedule is a folder, and one whose schedule is got over HTTP; what the network
/// says and what is kept is the test's.
class ScheduleUpdaterTest : public ::testing::Test {
protected:
    static constexpr double Hour = 3600;
    static constexpr double Day = 24 * Hour;

    ScheduleUpdaterTest() {
        local.name = "local";
        local.schedule.location =
            testing::writeSchedule(profile.path() / "schedule", {"1", "2"}).string();
        remote.name = "remote";
        remote.schedule.location = "https://city.example/gtfs.zip";
    }

    static std::shared_ptr<NSData> zip(const std::vector<std::string>& routes) {
        return testing::zipOf(testing::scheduleWithRoutes(routes));
    }
    void networkGives(std::shared_ptr<NSData> bytes, SourceBody::Outcome outcome) {
        network = {};
        network.outcome = outcome;
        network.bytes = std::move(bytes);
        network.fetchedAt = now();
        network.receivedAt = outcome == SourceBody::Outcome::Whole ? now() : kept.receivedAt;
    }
    static double now() { return NSDate::date()->timeIntervalSince1970(); }

    std::shared_ptr<ScheduleUpdater> updater() {
        ScheduleUpdater::Ground ground;
        ground.feeds = [this] {
            return feeds;
        };
        ground.schedules = [this](std::shared_ptr<NSError>*) {
            return store;
        };
        ground.load = [this](const SourceRequest& request,
                             const LoadOptions& options,
                             const SourceLoader::Completion& completion) {
            asked.push_back(request.location);
            whenAsked();
            proof = options.isWhole;
            if (!network.error)
                kept = network;
            completion(network);
        };
        ground.lastGoodBody = [this](const SourceRequest&) {
            return kept;
        };
        ground.noteCheck = [this](const std::string& feed, double seconds) {
            checks[feed] = seconds;
            for (auto& configuration : feeds)
                if (configuration.name == feed)
                    configuration.lastScheduleCheck = seconds;
        };
        return ScheduleUpdater::make(std::move(ground));
    }
    ScheduleUpdate update(const FeedConfiguration& feed, ScheduleUpdater::Options options = {}) {
        std::promise<ScheduleUpdate> answer;
        updater()->update(feed, std::move(options), [&](const ScheduleUpdate& given) {
            answer.set_value(given);
        });
        return answer.get_future().get();
    }
    std::size_t check() {
        std::promise<std::size_t> due;
        checker->checkSchedules([&](std::size_t count) { due.set_value(count); });
        return due.get_future().get();
    }
    testing::TemporaryProfile profile;
    // Files carry the machine's time, which is before that.
    testing::StoppedClock clock{4'000'000'000};
    std::shared_ptr<ScheduleStore> store =
        ScheduleStore::open(ScheduleStore::defaultPath(), nullptr);
    FeedConfiguration local;
    FeedConfiguration remote;
    std::vector<FeedConfiguration> feeds;
    SourceBody network;
    SourceBody kept;
    std::function<void()> whenAsked = [] {
    };
    std::vector<std::string> asked;
    decltype(LoadOptions::isWhole) proof; // of the last load
    std::map<std::string, double> checks;
    std::shared_ptr<ScheduleUpdater> checker = updater();
};

TEST_F(ScheduleUpdaterTest, ImportsWhatIsNotInTheStoreYet) {
    const auto result = update(local);
    EXPECT_EQ(result.feed, "local");
    EXPECT_EQ(result.outcome, Outcome::Imported);
    EXPECT_EQ(result.report.lines, 2U);
    EXPECT_EQ(result.error, nullptr);
    EXPECT_EQ(store->lines("local").size(), 2U);
}

TEST_F(ScheduleUpdaterTest, ALocalScheduleThatDidNotChangeIsNotReadAgain) {
    (void)update(local);
    EXPECT_EQ(update(local).outcome, Outcome::Unchanged);
}

TEST_F(ScheduleUpdaterTest, ALocalScheduleThatChangedSinceItsImportIsImported) {
    // Imported long ago, as the store sees it; the folder is of today.
    clock->setSince1970(1'000'000'000);
    (void)update(local);
    (void)testing::writeSchedule(profile.path() / "schedule", {"1", "2", "3"});
    EXPECT_EQ(update(local).outcome, Outcome::Imported);
    EXPECT_EQ(store->lines("local").size(), 3U);
}

TEST_F(ScheduleUpdaterTest, AnUnchangedScheduleIsImportedOnDemand) {
    (void)update(local);
    ScheduleUpdater::Options options;
    options.evenUnchanged = true;
    EXPECT_EQ(update(local, options).outcome, Outcome::Imported);
}

TEST_F(ScheduleUpdaterTest, ALocalScheduleThatIsGoneLeavesTheStoreAsItWas) {
    (void)update(local);
    std::filesystem::remove_all(profile.path() / "schedule");
    const auto result = update(local);
    EXPECT_EQ(result.outcome, Outcome::Failed);
    ASSERT_NE(result.error, nullptr);
    EXPECT_THAT(result.error->localizedDescription(), HasSubstr("schedule"));
    EXPECT_EQ(store->lines("local").size(), 2U);
}

TEST_F(ScheduleUpdaterTest, ARemoteScheduleIsImportedOnceAndThenOnlyWhenItIsAnother) {
    networkGives(zip({"1"}), SourceBody::Outcome::Whole);
    EXPECT_EQ(update(remote).outcome, Outcome::Imported);
    clock->advance(Day);
    networkGives(kept.bytes, SourceBody::Outcome::Validated);
    EXPECT_EQ(update(remote).outcome, Outcome::Unchanged);
    clock->advance(Day);
    // The same bytes again, from a server that validates nothing.
    networkGives(NSData::dataWithBytes(kept.bytes->bytes()), SourceBody::Outcome::Whole);
    EXPECT_EQ(update(remote).outcome, Outcome::Unchanged);
    clock->advance(Day);
    networkGives(zip({"1", "2"}), SourceBody::Outcome::Whole);
    EXPECT_EQ(update(remote).outcome, Outcome::Imported);
    EXPECT_EQ(store->lines("remote").size(), 2U);
}

TEST_F(ScheduleUpdaterTest, AKeptBodyThatNeverReachedTheStoreIsImported) {
    networkGives(zip({"1"}), SourceBody::Outcome::Whole);
    (void)update(remote);
    clock->advance(Day);
    // Another was got and kept, and then the process ended.
    networkGives(zip({"1", "2"}), SourceBody::Outcome::Whole);
    kept = network;
    clock->advance(Day);
    networkGives(kept.bytes, SourceBody::Outcome::Validated);
    EXPECT_EQ(update(remote).outcome, Outcome::Imported);
}

TEST_F(ScheduleUpdaterTest, AFailedRequestIsNotReplacedByTheKeptBody) {
    network.bytes = zip({"1"});
    network.error = NSError::errorWithMessage("Test", 1, "https://city.example: no answer");
    const auto result = update(remote);
    EXPECT_EQ(result.outcome, Outcome::Failed);
    EXPECT_EQ(result.error, network.error);
    EXPECT_THAT(store->lines("remote"), IsEmpty());
}

TEST_F(ScheduleUpdaterTest, ARefusedScheduleNamesItsSourceAndLeavesTheStoreAsItWas) {
    networkGives(zip({"1"}), SourceBody::Outcome::Whole);
    (void)update(remote);
    clock->advance(Day);
    networkGives(NSData::dataWithString("<html>"), SourceBody::Outcome::Whole);
    const auto result = update(remote);
    EXPECT_EQ(result.outcome, Outcome::Failed);
    EXPECT_THAT(result.error->localizedDescription(), HasSubstr("https://city.example/gtfs.zip"));
    EXPECT_EQ(store->lines("remote").size(), 1U);
}

TEST_F(ScheduleUpdaterTest, SchedulesAreCheckedOnceADay) {
    networkGives(zip({"1"}), SourceBody::Outcome::Whole);
    feeds = {local, remote};
    EXPECT_EQ(check(), 2U);
    EXPECT_THAT(asked, ElementsAre("https://city.example/gtfs.zip"));
    EXPECT_EQ(store->lines("local").size(), 2U);
    clock->advance(Day - 1);
    EXPECT_EQ(check(), 0U);
    clock->advance(1);
    EXPECT_EQ(check(), 2U);
}

TEST_F(ScheduleUpdaterTest, ACheckUnderAClockOfTheFutureDoesNotHold) {
    feeds = {local};
    feeds[0].lastScheduleCheck = now() + 5 * Day;
    EXPECT_EQ(check(), 1U);
}

TEST_F(ScheduleUpdaterTest, AClockThatWasSetBackALittleMakesNoScheduleDue) {
    feeds = {local};
    feeds[0].lastScheduleCheck = now() + 60;
    EXPECT_EQ(check(), 0U);
    feeds[0].lastScheduleCheck = now() + 61;
    EXPECT_EQ(check(), 1U);
}

TEST_F(ScheduleUpdaterTest, AnArchiveOfUntoldLengthIsWholeWhenItsEndIsThere) {
    networkGives(zip({"1"}), SourceBody::Outcome::Whole);
    (void)update(remote);
    const auto whole = zip({"1", "2"});
    EXPECT_TRUE(proof(whole));
    EXPECT_TRUE(proof(testing::zipOf({{"readme.txt", "no schedule"}})));
    for (std::size_t length = 0; length < whole->length(); ++length)
        EXPECT_FALSE(proof(NSData::dataWithBytes(whole->bytes().first(length)))) << length;
}

TEST_F(ScheduleUpdaterTest, AFailedCheckIsMadeAgainAfterAnHourAndSaidInTheLog) {
    const testing::LogCapture log;
    network.error = NSError::errorWithMessage("Test", 1, "https://city.example: no answer");
    feeds = {remote};
    EXPECT_EQ(check(), 1U);
    EXPECT_THAT(log.messages(),
                ElementsAre("remote: no newer schedule could be had: https://city.example: no"
                            " answer"));
    clock->advance(Hour - 1);
    EXPECT_EQ(check(), 0U);
    clock->advance(1);
    EXPECT_EQ(check(), 1U);
}

TEST_F(ScheduleUpdaterTest, AFeedIsNotedBeforeItsServerIsAsked) {
    networkGives(zip({"1"}), SourceBody::Outcome::Whole);
    feeds = {remote};
    double noted = 0;
    whenAsked = [&] {
        noted = checks["remote"];
    };
    EXPECT_EQ(check(), 1U);
    EXPECT_EQ(noted, now());
}

TEST_F(ScheduleUpdaterTest, NothingIsCheckedByAProgramThatEndsOrKeepsItsWrites) {
    feeds = {local};
    const auto notCalled = [](std::size_t) {
        FAIL();
    };
    {
        const auto ends = ScheduleUpdater::checksDaily().overrideWith(false);
        updater()->checkSchedules(notCalled);
    }
    {
        const auto keeps = Environment::keepsWritesInMemory().overrideWith(true);
        updater()->checkSchedules(notCalled);
    }
    EXPECT_EQ(check(), 1U);
}

TEST_F(ScheduleUpdaterTest, OneCheckAtATime) {
    networkGives(zip({"1"}), SourceBody::Outcome::Whole);
    feeds = {remote};
    const auto one = updater();
    std::promise<std::size_t> due;
    whenAsked = [&] {
        one->checkSchedules([](std::size_t) { FAIL(); });
    };
    one->checkSchedules([&](std::size_t count) { due.set_value(count); });
    EXPECT_EQ(due.get_future().get(), 1U);
    EXPECT_EQ(asked.size(), 1U);
}

} // namespace
} // namespace orvo
