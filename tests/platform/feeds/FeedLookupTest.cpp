#include "platform/feeds/FeedLookup.h"

#include "platform/feeds/FeedLookupFixture.h"
#include "platform/foundation/DispatchQueue.h"

#include <gmock/gmock.h>

#include <algorithm>

namespace orvo {
namespace {

using testing::alertMessage;
using ::testing::ElementsAre;
using ::testing::HasSubstr;
using ::testing::IsEmpty;
using ::testing::UnorderedElementsAre;

class FeedLookupTest : public testing::FeedLookupFixture {
protected:
    static std::vector<std::string> names(const FeedLookup::Answer& answer) {
        std::vector<std::string> names;
        for (const auto& item : answer.items)
            names.push_back(item->name().value_or("(null)"));
        return names;
    }
};

TEST_F(FeedLookupTest, NoLinesAreAnEmptyAnswerAndNothingIsAsked) {
    feedsError = NSError::errorWithMessage("Test", 1, "never read");
    const auto answer = lookUp({});
    EXPECT_EQ(answer.error, nullptr);
    EXPECT_THAT(answer.items, IsEmpty());
    EXPECT_THAT(asked, IsEmpty());
    EXPECT_EQ(answer.at, Now);
}

TEST_F(FeedLookupTest, ItemsComeInTheOrderAsked) {
    addCoast();
    EXPECT_THAT(names(lookUp({coast("B"), city("3"), coast("A"), city("1")})),
                ElementsAre("Line B", "Line 3", "Line A", "Line 1"));
}

TEST_F(FeedLookupTest, ALineAskedTwiceIsAnsweredTwice) {
    answerWith("city/alerts", alertMessage(NowTimestamp, {{.routes = {"1"}}}));
    EXPECT_THAT(statuses(lookUp({city("1"), city("2"), city("1")})),
                ElementsAre("Works", "clear", "Works"));
}

TEST_F(FeedLookupTest, AnItemIsItsLineWithItsIncidents) {
    const auto item = lookUp({city("1")}).items.at(0);
    EXPECT_EQ(item->muid(), city("1"));
    EXPECT_EQ(item->identifier()->muid(), city("1"));
    EXPECT_EQ(item->origin(), (FeedLineOrigin{"city", "1"}));
    EXPECT_EQ(item->system()->name(), "City Transit");
    EXPECT_TRUE(item->hasIncidentComponent());
    EXPECT_EQ(item->incidents()->count(), 0U);
}

TEST_F(FeedLookupTest, OnlyTheFeedsOfTheLinesAreAsked) {
    addCoast();
    (void)lookUp({coast("A"), coast("B")});
    EXPECT_THAT(asked, ElementsAre("coast/alerts"));
}

TEST_F(FeedLookupTest, EverySourceOfAFeedIsAskedBeforeAnyAnswered) {
    addFeed("two", {"X"}, {"two/first", "two/second"});
    // Sources that answer only when all were asked: one after the other, this would never end.
    auto held = ground();
    std::vector<std::function<void()>> waiting;
    const auto load = held.load;
    held.load = [&](const SourceRequest& request, std::function<void(SourceBody)> completion) {
        waiting.push_back([load, request, completion] { load(request, completion); });
        if (waiting.size() == 3)
            for (const auto& answer : waiting)
                answer();
    };
    std::promise<FeedLookup::Answer> answer;
    FeedLookup::make(held)->lookUpLines(
        {city("1"), lineMuid("two", "X")},
        [&](const FeedLookup::Answer& given) { answer.set_value(given); });
    EXPECT_THAT(statuses(answer.get_future().get()), ElementsAre("clear", "clear"));
}

TEST_F(FeedLookupTest, AnswersOnAWorkerQueueAndNeverInsideTheCall) {
    // Shared with the answer, which may still be at its end when the test goes on.
    const auto held = std::make_shared<std::mutex>();
    const auto onWorker = std::make_shared<std::promise<bool>>();
    auto answered = onWorker->get_future();
    {
        // An answer inside the call would wait here for ever.
        const std::lock_guard lock(*held);
        FeedLookup::make(ground())->lookUpLines({}, [held, onWorker](const FeedLookup::Answer&) {
            const std::lock_guard inside(*held);
            onWorker->set_value(DispatchQueue::globalQueue()->isCurrent());
        });
    }
    EXPECT_TRUE(answered.get());
}

TEST_F(FeedLookupTest, FeedsThatCannotBeReadEndTheLookup) {
    feedsError = NSError::errorWithMessage("Test", 1, "feeds.plist: damaged");
    EXPECT_EQ(lookUp({city("1")}).error, feedsError);
}

TEST_F(FeedLookupTest, SchedulesThatCannotBeOpenedEndTheLookup) {
    schedulesError = NSError::errorWithMessage("Test", 1, "schedules.sqlite: no room");
    const auto answer = lookUp({city("1")});
    EXPECT_EQ(answer.error, schedulesError);
    EXPECT_THAT(answer.items, IsEmpty());
    EXPECT_THAT(asked, IsEmpty());
}

TEST_F(FeedLookupTest, ThePersonsLanguageIsReadAtEachLookup) {
    answerWith("city/alerts",
               alertMessage(NowTimestamp,
                            {{.routes = {"1"}, .header = "Works", .headerLanguage = "en"},
                             {.routes = {"1"}, .header = "Bauarbeiten", .headerLanguage = "de"}}));
    EXPECT_THAT(statuses(lookUp({city("1")})), ElementsAre("Works"));
    const auto german = Text::locale().overrideWith("de");
    EXPECT_THAT(statuses(lookUp({city("1")})), ElementsAre("Bauarbeiten"));
}

TEST_F(FeedLookupTest, TheStepFreePreferenceIsReadAtEachLookup) {
    constexpr std::int32_t AccessibilityIssue = 11;
    answerWith("city/alerts",
               alertMessage(NowTimestamp,
                            {{.routes = {"1"}, .header = "Lift", .effect = AccessibilityIssue}}));
    EXPECT_THAT(statuses(lookUp({city("1")})), ElementsAre("clear"));
    stepFree = true;
    EXPECT_THAT(statuses(lookUp({city("1")})), ElementsAre("Lift"));
}

TEST_F(FeedLookupTest, AllLinesComeByFeedAndInTheSchedulesOrder) {
    addFeed("coast", {"B", "A"}, {"coast/alerts"});
    EXPECT_THAT(names(lookUpFeeds()),
                ElementsAre("Line 1", "Line 2", "Line 3", "Line B", "Line A"));
}

TEST_F(FeedLookupTest, LinesOfNamedFeedsComeInTheOrderOfTheNames) {
    addCoast();
    addFeed("third", {"T"}, {"third/alerts"});
    EXPECT_THAT(names(lookUpFeeds({{"third", "city"}})),
                ElementsAre("Line T", "Line 1", "Line 2", "Line 3"));
    EXPECT_THAT(asked, UnorderedElementsAre("third/alerts", "city/alerts"));
}

TEST_F(FeedLookupTest, AnUnknownFeedIsAnErrorThatNamesIt) {
    const auto answer = lookUpFeeds({{"city", "nowhere"}});
    ASSERT_NE(answer.error, nullptr);
    EXPECT_EQ(answer.error->code(), static_cast<std::int64_t>(FeedErrorCode::UnknownFeed));
    EXPECT_THAT(answer.error->localizedDescription(), HasSubstr("nowhere"));
    EXPECT_THAT(asked, IsEmpty());
}

TEST_F(FeedLookupTest, AllLinesOfNoFeedsAreNone) {
    feeds.clear();
    const auto answer = lookUpFeeds();
    EXPECT_EQ(answer.error, nullptr);
    EXPECT_THAT(answer.items, IsEmpty());
}

TEST_F(FeedLookupTest, GathersTheStatisticsOfEachFeed) {
    addFeed("two", {"X", "Y"}, {"two/first", "two/second"});
    answerWith("two/first",
               alertMessage(NowTimestamp - 60,
                            {{.id = "a", .routes = {"X", "gone"}}, {.id = "b", .header = "?"}}));
    failWith("two/second", "no answer", body(nullptr, 0));
    const auto answer = lookUpFeeds({{"two"}});
    ASSERT_EQ(answer.feeds.size(), 1U);
    const auto& feed = answer.feeds[0];
    EXPECT_EQ(feed.feed, "two");
    EXPECT_TRUE(feed.hasSchedule);
    EXPECT_EQ(feed.lines, 2U);
    EXPECT_EQ(feed.linesWithIncidents, 1U);
    EXPECT_EQ(feed.unknownLines, 1U);
    EXPECT_EQ(feed.error, nullptr);
    EXPECT_EQ(feed.alerts.count(AlertCount::UnknownRoutes), 1U);
    ASSERT_EQ(feed.sources.size(), 2U);
    EXPECT_EQ(feed.sources[0].headerTime, Now - 60);
    EXPECT_NE(feed.sources[1].error, nullptr);
    EXPECT_THAT(feed.description(), HasSubstr("lines with incidents: 1\nunknown lines: 1\n"));
    EXPECT_THAT(feed.description(),
                HasSubstr("source 1: read, fetched 2025-06-15T15:06:40Z,"
                          " made 2025-06-15T15:05:40Z\n"));
    EXPECT_THAT(feed.description(), HasSubstr("no answer"));
}

TEST_F(FeedLookupTest, StatisticsAreGivenWithAnErrorToo) {
    failWith("city/alerts", "no answer");
    const auto answer = lookUpFeeds();
    ASSERT_NE(answer.error, nullptr);
    ASSERT_EQ(answer.feeds.size(), 1U);
    EXPECT_EQ(answer.feeds[0].error, answer.error);
    EXPECT_EQ(answer.feeds[0].unknownLines, 3U);
}

TEST_F(FeedLookupTest, ManyLookupsAtOnceAreEachAnsweredWhole) {
    addCoast();
    const auto lookup = FeedLookup::make(ground());
    std::vector<std::promise<FeedLookup::Answer>> promises(20);
    for (auto& promise : promises)
        lookup->lookUpLines({city("1"), coast("A")},
                            [&](const FeedLookup::Answer& answer) { promise.set_value(answer); });
    for (auto& promise : promises)
        EXPECT_THAT(statuses(promise.get_future().get()), ElementsAre("clear", "clear"));
}

} // namespace
} // namespace orvo
