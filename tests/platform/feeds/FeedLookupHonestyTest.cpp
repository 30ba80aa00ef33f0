#include "platform/feeds/FeedLookupFixture.h"
#include "platform/sqlite/SQLiteDatabase.h"
#include "support/LogCapture.h"

#include <gmock/gmock.h>

#include <algorithm>

namespace orvo {
namespace {

using testing::AlertEntity;
using testing::alertMessage;
using ::testing::ElementsAre;
using ::testing::HasSubstr;
using ::testing::IsEmpty;

// Each test is one sentence about when a line may be called clear, and what stands in its place.
class FeedLookupHonesty : public testing::FeedLookupFixture {};

TEST_F(FeedLookupHonesty, ALineIsClearWhenEverySourceWasFetchedWhole) {
    addFeed("two", {"X"}, {"two/first", "two/second"});
    EXPECT_THAT(statuses(lookUp({city("1"), lineMuid("two", "X")})), ElementsAre("clear", "clear"));
}

TEST_F(FeedLookupHonesty, ALineIsClearWhenItsSourceWasValidatedAtMostTenMinutesAgo) {
    addCoast();
    answers["city/alerts"] = body(alertMessage(NowTimestamp - 600), Now - 10 * Minute);
    answers["coast/alerts"] = body(alertMessage(NowTimestamp - 600), Now - 10 * Minute - 1);
    EXPECT_THAT(statuses(lookUp({city("1"), coast("A")})), ElementsAre("clear", "unknown"));
}

TEST_F(FeedLookupHonesty, AFailedSourceStandsOnItsLastGoodBodyForTenMinutes) {
    addCoast();
    const auto last = alertMessage(NowTimestamp - 600, {{.routes = {"1", "A"}}});
    failWith("city/alerts", "no answer", body(last, Now - 10 * Minute));
    failWith("coast/alerts", "no answer", body(last, Now - 10 * Minute - 1));
    EXPECT_THAT(statuses(lookUp({city("1"), city("2"), coast("A")})),
                ElementsAre("Works", "clear", "unknown"));
}

TEST_F(FeedLookupHonesty, EachLookupAsksItsSourcesAnew) {
    EXPECT_THAT(statuses(lookUp({city("1")})), ElementsAre("clear"));
    answerWith("city/alerts", alertMessage(NowTimestamp, {{.routes = {"1"}}}));
    EXPECT_THAT(statuses(lookUp({city("1")})), ElementsAre("Works"));
    EXPECT_THAT(asked, ElementsAre("city/alerts", "city/alerts"));
}

TEST_F(FeedLookupHonesty, ProofIsJudgedWhenTheLookupAnswersNotWhenItBegan) {
    addCoast();
    // The sources answer slowly: what was eight minutes old at the start is too old at the end.
    answers["city/alerts"] = body(alertMessage(NowTimestamp), Now - 8 * Minute);
    answers["coast/alerts"] = body(alertMessage(NowTimestamp), Now + 2 * Minute);
    whenAsked = [this] {
        clock->advance(1.5 * Minute);
    };
    const auto answer = lookUp({city("1"), coast("A")});
    EXPECT_EQ(answer.at, Now + 3 * Minute);
    EXPECT_THAT(statuses(answer), ElementsAre("unknown", "clear"));
}

TEST_F(FeedLookupHonesty, ALineIsNotClearWhenOneOfItsSourcesFailed) {
    addFeed("two", {"X"}, {"two/first", "two/second"});
    failWith("two/second", "no answer");
    EXPECT_THAT(statuses(lookUp({lineMuid("two", "X")})), ElementsAre("unknown"));
}

TEST_F(FeedLookupHonesty, AMessageThatCannotBeWalkedIsAFailedFetch) {
    addCoast();
    const auto whole = alertMessage(NowTimestamp, {{.routes = {"1"}}});
    for (const auto& bytes : {NSData::dataWithBytes(whole->bytes().first(whole->length() - 1)),
                              NSData::dataWithString("<html>Not found</html>"),
                              NSData::dataWithString("{\"error\": 404}"),
                              NSData::dataWithString("")}) {
        answerWith("city/alerts", bytes);
        EXPECT_THAT(statuses(lookUp({city("1"), city("2"), coast("A")})),
                    ElementsAre("unknown", "unknown", "clear"));
    }
}

TEST_F(FeedLookupHonesty, AMessageOfNothingButAHeaderSaysThatThereIsNothingToReport) {
    answerWith("city/alerts", alertMessage(NowTimestamp));
    EXPECT_THAT(statuses(lookUp({city("1")})), ElementsAre("clear"));
}

TEST_F(FeedLookupHonesty, AnUnreadableSelectorLeavesLinesWithoutAnIncidentUnknown) {
    answerWith("city/alerts",
               alertMessage(NowTimestamp,
                            {{.id = "a", .routes = {"1"}, .header = "Readable"},
                             {.id = "b", .header = "Broken", .breaksOffInSelector = true}}));
    EXPECT_THAT(statuses(lookUp({city("1"), city("2")})), ElementsAre("Readable", "unknown"));
}

TEST_F(FeedLookupHonesty, AHeaderOfMoreThanADayAgoCountsAsUnknown) {
    addCoast();
    constexpr std::uint64_t Day = 24 * 3600;
    answerWith("city/alerts", alertMessage(NowTimestamp - Day));
    answerWith("coast/alerts", alertMessage(NowTimestamp - Day - 1));
    EXPECT_THAT(statuses(lookUp({city("1"), coast("A")})), ElementsAre("clear", "unknown"));
}

TEST_F(FeedLookupHonesty, AnOldHeaderIsUnknownAndNoErrorWhereNoOtherFeedIsAsked) {
    answerWith("city/alerts", alertMessage(NowTimestamp - 2 * 24 * 3600));
    const auto answer = lookUp({city("1")});
    EXPECT_FALSE(answer.error);
    EXPECT_THAT(statuses(answer), ElementsAre("unknown"));
}

TEST_F(FeedLookupHonesty, AHeaderWithoutTimeOrOfTheFutureIsOfTheTimeOfItsFetch) {
    addCoast();
    answerWith("city/alerts", alertMessage(0, {{.routes = {"1"}}}));
    answerWith("coast/alerts", alertMessage(NowTimestamp + 86400, {{.routes = {"A"}}}));
    const auto answer = lookUp({city("1"), coast("A")});
    EXPECT_THAT(statuses(answer), ElementsAre("Works", "Works"));
    for (const auto& item : answer.items)
        EXPECT_EQ(incidents(item).front()->lastUpdated()->timeIntervalSince1970(), Now);
}

TEST_F(FeedLookupHonesty, TheOtherFeedsShowWhatIsKnown) {
    addCoast();
    failWith("city/alerts", "no answer");
    answerWith("coast/alerts", alertMessage(NowTimestamp, {{.routes = {"A"}}}));
    EXPECT_THAT(statuses(lookUp({city("1"), coast("A"), coast("B")})),
                ElementsAre("unknown", "Works", "clear"));
}

TEST_F(FeedLookupHonesty, ALineWithAnIncidentFromASourceThatWorkedNeedsNoUnknownOne) {
    addFeed("two", {"X", "Y"}, {"two/first", "two/second"});
    answerWith("two/first", alertMessage(NowTimestamp, {{.routes = {"X"}}}));
    failWith("two/second", "no answer");
    EXPECT_THAT(statuses(lookUp({lineMuid("two", "X"), lineMuid("two", "Y")})),
                ElementsAre("Works", "unknown"));
}

TEST_F(FeedLookupHonesty, ALineWithNothingButAComingIncidentIsNotClearNow) {
    addFeed("two", {"X"}, {"two/first", "two/second"});
    answerWith("two/first",
               alertMessage(NowTimestamp, {{.routes = {"X"}, .start = NowTimestamp + 3600}}));
    failWith("two/second", "no answer");
    const auto answer = lookUp({lineMuid("two", "X")});
    EXPECT_TRUE(incidents(answer.items.at(0)).front()->details().isUnknown);
}

TEST_F(FeedLookupHonesty, TheUnknownIncidentNamesTheSystemAndTheAgeOfWhatWasLastKnown) {
    addCoast();
    failWith("city/alerts", "no answer", body(alertMessage(NowTimestamp), Now - 2 * Hour));
    const auto answer = lookUp({city("1"), coast("A")});
    ASSERT_THAT(statuses(answer), ElementsAre("unknown", "clear"));
    const auto incident = incidents(answer.items[0]).front();
    const auto text = incident->title().value_or("") + "\n" + incident->summary().value_or("");
    EXPECT_THAT(text, HasSubstr("City Transit"));
    EXPECT_THAT(text, HasSubstr("2 hours"));
    EXPECT_EQ(incident->startDate(), nullptr);
    EXPECT_EQ(incident->endDate(), nullptr);
}

TEST_F(FeedLookupHonesty, EachUnknownLineHasANumberOfItsOwnThatStays) {
    addCoast();
    failWith("city/alerts", "no answer");
    const auto numbers = [&] {
        std::vector<std::uint64_t> unknown;
        for (const auto& item : lookUp({city("1"), city("2"), coast("A")}).items)
            if (status(item) == "unknown")
                unknown.push_back(incidents(item).front()->muid());
        return unknown;
    };
    const auto first = numbers();
    ASSERT_EQ(first.size(), 2U);
    EXPECT_NE(first[0], first[1]);
    EXPECT_EQ(numbers(), first);
}

TEST_F(FeedLookupHonesty, ALineThatLeftTheScheduleIsAnsweredFromWhatWasLastKnownOfIt) {
    importSchedule("city", {"2", "3"});
    answerWith("city/alerts", alertMessage(NowTimestamp, {{.routes = {"1"}}}));
    const auto answer = lookUp({city("1"), city("2")});
    EXPECT_THAT(statuses(answer), ElementsAre("unknown", "clear"));
    EXPECT_EQ(answer.items[0]->name(), "Line 1");
    EXPECT_EQ(answer.items[0]->system()->name(), "City Transit");
    EXPECT_EQ(answer.items[0]->origin(), (FeedLineOrigin{"city", "1"}));
    EXPECT_NE(answer.items[0]->alternateArtwork(), nullptr);
    EXPECT_THAT(incidents(answer.items[0]).front()->title().value_or("") +
                    incidents(answer.items[0]).front()->summary().value_or(""),
                HasSubstr("City Transit"));
}

TEST_F(FeedLookupHonesty, ALineThatLeftTheScheduleTellsTheAgeOfTheLastScheduleThatHadIt) {
    clock->advance(3 * Hour);
    importSchedule("city", {"2", "3"});
    clock->advance(2 * Hour);
    answers["city/alerts"] = body(alertMessage(NowTimestamp), Now + 5 * Hour);
    const auto departed = lookUp({city("1"), city("2")});
    EXPECT_THAT(statuses(departed), ElementsAre("unknown", "clear"));
    EXPECT_EQ(incidents(departed.items[0]).front()->summary(),
              "City Transit, last known 5 hours ago");
}

TEST_F(FeedLookupHonesty, ALineWhoseFeedWasRemovedTellsTheAgeOfItsLastSchedule) {
    EXPECT_EQ(store->removeSchedule("city"), nullptr);
    feeds.clear();
    clock->advance(72 * Hour);
    EXPECT_EQ(incidents(lookUp({city("1")}).items.at(0)).front()->summary(),
              "City Transit, last known 3 days ago");
}

TEST_F(FeedLookupHonesty, ALineWhoseFeedWasRemovedIsAnsweredAsUnknownAndNoSourceIsAsked) {
    EXPECT_EQ(store->removeSchedule("city"), nullptr);
    feeds.clear();
    const auto answer = lookUp({city("1")});
    EXPECT_THAT(statuses(answer), ElementsAre("unknown"));
    EXPECT_EQ(answer.items[0]->name(), "Line 1");
    EXPECT_THAT(asked, IsEmpty());
}

TEST_F(FeedLookupHonesty, ALineThatNoScheduleKnowsIsAnsweredFromTheKeptCopy) {
    TransitLineRecord::Fields fields;
    fields.muid = 77;
    fields.name = "Old Tram";
    keptLines[77] = FeedTransitLine::initWithFields_origin(std::move(fields), {"gone", "tram"});
    const auto answer = lookUp({77, city("1")});
    EXPECT_THAT(statuses(answer), ElementsAre("unknown", "clear"));
    EXPECT_EQ(answer.items[0]->name(), "Old Tram");
    EXPECT_EQ(answer.items[0]->origin().feed, "gone");
}

TEST_F(FeedLookupHonesty, ALineOfWhichNothingIsKnownIsNotLeftOut) {
    const auto answer = lookUp({77, city("1")});
    EXPECT_THAT(statuses(answer), ElementsAre("unknown", "clear"));
    EXPECT_EQ(answer.items[0]->muid(), 77U);
    EXPECT_EQ(answer.items[0]->name(), std::nullopt);
}

TEST_F(FeedLookupHonesty, ALineOfAFeedWithoutAScheduleIsUnknown) {
    EXPECT_EQ(store->removeSchedule("city"), nullptr);
    EXPECT_THAT(statuses(lookUp({city("1")})), ElementsAre("unknown"));
}

TEST_F(FeedLookupHonesty, ALineOfAFeedWithoutSourcesIsUnknown) {
    addFeed("mute", {"M"}, {});
    EXPECT_THAT(statuses(lookUp({lineMuid("mute", "M"), city("1")})),
                ElementsAre("unknown", "clear"));
}

TEST_F(FeedLookupHonesty, WithoutAnyReadableFeedTheLookupEndsWithAnErrorOfFeedAndCause) {
    failWith("city/alerts", "the server does not answer");
    const auto answer = lookUp({city("1"), city("2")});
    ASSERT_NE(answer.error, nullptr);
    EXPECT_THAT(answer.error->localizedDescription(), HasSubstr("city"));
    EXPECT_THAT(answer.error->localizedDescription(), HasSubstr("the server does not answer"));
    EXPECT_THAT(answer.items, IsEmpty());
}

TEST_F(FeedLookupHonesty, TheErrorOfSeveralUnreadableFeedsNamesEach) {
    addCoast();
    failWith("city/alerts", "the server does not answer");
    answerWith("coast/alerts", NSData::dataWithString("<html>"));
    const auto answer = lookUp({city("1"), coast("A")});
    ASSERT_NE(answer.error, nullptr);
    EXPECT_EQ(answer.error->domain(), FeedLookupErrorDomain);
    EXPECT_EQ(answer.error->code(), FeedLookupErrorNoFeedReadable);
    EXPECT_THAT(answer.error->localizedDescription(), HasSubstr("city"));
    EXPECT_THAT(answer.error->localizedDescription(), HasSubstr("the server does not answer"));
    EXPECT_THAT(answer.error->localizedDescription(), HasSubstr("coast"));
}

TEST_F(FeedLookupHonesty, AFeedThatHasNoneOfTheLinesAnyMoreIsAskedAllTheSame) {
    TransitLineRecord::Fields fields;
    fields.muid = 77;
    keptLines[77] = FeedTransitLine::initWithFields_origin(std::move(fields), {"city", "old"});
    EXPECT_THAT(statuses(lookUp({77})), ElementsAre("unknown"));
    EXPECT_THAT(asked, ElementsAre("city/alerts"));
    failWith("city/alerts", "no answer");
    EXPECT_NE(lookUp({77}).error, nullptr);
}

TEST_F(FeedLookupHonesty, FeedsThatWereNotAskedDoNotCountAsReadable) {
    addCoast();
    failWith("city/alerts", "no answer");
    EXPECT_NE(lookUp({city("1")}).error, nullptr);
    EXPECT_THAT(asked, ElementsAre("city/alerts"));
}

/// A store that can be read but for line 2 of the city.
class FeedLookupDamage : public FeedLookupHonesty {
protected:
    FeedLookupDamage() {
        addCoast();
        const auto other = SQLiteDatabase::open(
            ScheduleStore::defaultPath(), SQLiteDatabase::Mode::Write, nullptr);
        EXPECT_TRUE(other->execute(R"(
            ALTER TABLE line RENAME TO sound;
            CREATE VIEW line AS SELECT muid, feed, agency, route_id, agency_id, short_name,
                CASE route_id WHEN '2' THEN json('{') ELSE long_name END AS long_name,
                color, text_color, url, type, position, present, known_at FROM sound)"));
    }

    testing::LogCapture log;
};

TEST_F(FeedLookupDamage, ALineThatCannotBeReadIsUnknownAndSaysWhy) {
    const auto answer = lookUp({city("2"), coast("A")});
    EXPECT_THAT(statuses(answer), ElementsAre("unknown", "clear"));
    const auto why = incidents(answer.items[0]).front()->fullDescription().value_or("");
    EXPECT_THAT(why, HasSubstr("The schedule could not be read: "));
    EXPECT_THAT(why, HasSubstr(ScheduleStore::defaultPath().string()));
}

TEST_F(FeedLookupDamage, LinesOfAScheduleThatCannotBeReadAreUnknownAndTheOthersKnown) {
    const auto answer = lookUp({city("1"), coast("A"), city("3")});
    EXPECT_THAT(statuses(answer), ElementsAre("unknown", "clear", "unknown"));
    EXPECT_EQ(answer.items[0]->name(), "Line 1");
    EXPECT_THAT(incidents(answer.items[2]).front()->fullDescription().value_or(""),
                HasSubstr("The schedule could not be read: "));
    EXPECT_THAT(asked, ElementsAre("coast/alerts"));
}

TEST_F(FeedLookupDamage, WhereNoLineCanBeReadTheLookupEndsWithTheError) {
    const auto answer = lookUp({city("1"), city("2")});
    ASSERT_NE(answer.error, nullptr);
    EXPECT_THAT(answer.error->localizedDescription(),
                HasSubstr(ScheduleStore::defaultPath().string()));
    EXPECT_THAT(answer.items, IsEmpty());
    EXPECT_THAT(asked, IsEmpty());
}

TEST_F(FeedLookupDamage, AllLinesOfAFeedThatCannotBeReadAreAnError) {
    EXPECT_NE(lookUpFeeds().error, nullptr);
    EXPECT_EQ(lookUpFeeds(std::vector<std::string>{"coast"}).error, nullptr);
}

} // namespace
} // namespace orvo
