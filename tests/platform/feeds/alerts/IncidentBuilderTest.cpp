#include "platform/feeds/alerts/IncidentBuilder.h"

#include "AlertMaker.h"
#include "TestLines.h"
#include "platform/feeds/alerts/EntityReader.h"
#include "platform/foundation/NSString.h"
#include "platform/geoservices/TransitIncidentAffectedEntity.h"

#include <gtest/gtest.h>

namespace orvo::testing {

namespace {

using Alerts = std::vector<AlertMaker>;

constexpr std::uint64_t At = 1750000000;

AlertMaker maker(const std::function<void(AlertMaker&)>& change = {}) {
    AlertMaker maker;
    if (change)
        change(maker);
    return maker;
}

IncidentQuery query(const std::string& language = "en", bool stepFree = false) {
    return {std::nullopt, Now, language, stepFree};
}

IncidentQuery queryFor(const std::vector<std::string>& routes) {
    IncidentQuery result = query();
    result.lines.emplace();
    for (const std::string& route : routes)
        result.lines->push_back(lineMuid("town", route));
    return result;
}

Answer answer(const Alerts& alerts) {
    return Answer(message(alerts));
}

double seconds(const std::shared_ptr<NSDate>& date) {
    return date ? date->timeIntervalSince1970() : -1;
}

/// The lines that an incident concerns: `R1(S1,S2)`.
std::string affected(const FeedTransitIncident& incident) {
    const auto index = smallIndex();
    std::string text;
    for (const auto& entity : typed<TransitIncidentAffectedEntity>(incident.affectedEntities())) {
        text += (text.empty() ? "" : " ") + index->line(entity->muid())->routeId;
        if (!entity->hasNextStopIDs())
            continue;
        text += "(";
        const auto stops = entity->nextStopIDs();
        for (const auto& stop : stops->elements())
            text += (text.back() == '(' ? "" : ",") + stringValue(stop.get()).value_or("nil");
        text += ")";
    }
    return text;
}

std::shared_ptr<NSError> failure() {
    return NSError::errorWithMessage("net", 5, "it timed out");
}

} // namespace

TEST(IncidentBuilder, MakesTheWholeRecord) {
    const Answer result = answer({maker([](AlertMaker& m) {
        m.activePeriods = {period(At - 100, At + 100)};
        m.effect = 1;
        m.cause = 4;
        m.severity = 4;
        m.link = {{"https://example.invalid/x", "en"}};
        m.spokenHeader = {{"Trams turn round early", "en"}};
    })});
    ASSERT_EQ(result.incidents("R1").size(), 1U);
    const FeedTransitIncident& incident = *result.incidents("R1")[0];
    EXPECT_NE(incident.muid(), 0U);
    EXPECT_EQ(seconds(incident.startDate()), At - 100);
    EXPECT_EQ(seconds(incident.endDate()), At + 100);
    EXPECT_EQ(incident.title(), "Trams turn early");
    EXPECT_EQ(incident.summary(), "No trams beyond the bridge.");
    EXPECT_EQ(incident.fullDescription(), "No trams beyond the bridge.");
    EXPECT_EQ(incident.messageForRoutePlanning(), incident.title());
    EXPECT_EQ(incident.messageForRouteStepping(), incident.title());
    EXPECT_EQ(incident.messageForNonRoutable(), incident.title());
    EXPECT_EQ(incident.iconType(), 1);
    EXPECT_TRUE(incident.isBlockingIncident());
    EXPECT_EQ(seconds(incident.creationDate()), At - 100);
    EXPECT_EQ(seconds(incident.lastUpdated()), At);
    EXPECT_EQ(affected(incident), "R1");
    EXPECT_EQ(incident.details().feed, "town");
    EXPECT_EQ(incident.details().severity, IncidentSeverity::Severe);
    EXPECT_EQ(incident.details().effect, IncidentEffect::NoService);
    EXPECT_EQ(incident.details().cause, IncidentCause::Strike);
    EXPECT_FALSE(incident.details().isPartOfLine);
    EXPECT_FALSE(incident.details().isUnknown);
    EXPECT_EQ(incident.details().spokenTitle, "Trams turn round early");
    EXPECT_EQ(incident.details().link, "https://example.invalid/x");
    EXPECT_EQ(incident.details().timeZone, "Europe/Paris");
    EXPECT_EQ(result.disturbed(), "R1");
}

TEST(IncidentBuilder, OnlyNoServiceOfAWholeLineBlocks) {
    const auto isBlocking = [](std::uint64_t effect, const Wire& selector) {
        const Answer result = answer({maker([&](AlertMaker& m) {
            m.effect = effect;
            m.selectors = {selector};
        })});
        return result.incidents("R1").at(0)->isBlockingIncident();
    };
    EXPECT_TRUE(isBlocking(1, route("R1")));
    EXPECT_FALSE(isBlocking(1, route("R1").bytes(5, "S1")));
    EXPECT_FALSE(isBlocking(1, route("R1").bytes(4, Wire().bytes(1, "T"))));
    EXPECT_FALSE(isBlocking(2, route("R1")));
}

TEST(IncidentBuilder, AnUntoldStartIsCreatedWhenTheMessageWasMade) {
    EXPECT_EQ(seconds(answer({maker()}).incidents("R1").at(0)->creationDate()), At);
    EXPECT_EQ(answer({maker()}).incidents("R1")[0]->startDate(), nullptr);
    EXPECT_EQ(answer({maker()}).incidents("R1")[0]->endDate(), nullptr);
}

TEST(IncidentBuilder, EachPeriodIsAnIncidentOfTheSameNumber) {
    const Answer result = answer({maker([](AlertMaker& m) {
        m.activePeriods = {period(At + 500, At + 600), period(At - 9, At + 9), period(1, 2)};
    })});
    const auto& incidents = result.incidents("R1");
    ASSERT_EQ(incidents.size(), 2U);
    EXPECT_EQ(incidents[0]->muid(), incidents[1]->muid());
    EXPECT_EQ(seconds(incidents[0]->startDate()), At + 500);
    EXPECT_EQ(seconds(incidents[1]->startDate()), At - 9);
    EXPECT_EQ(seconds(incidents[0]->creationDate()), 1);
}

TEST(IncidentBuilder, RecordsOfOneIncidentShareWhatTheyHaveInCommon) {
    const Answer result = answer({maker([](AlertMaker& m) {
        m.activePeriods = {period(At - 100, At + 100), period(At + 1000, At + 2000)};
        m.selectors = {route("R1"), route("R2").bytes(5, "S3")};
    })});
    const auto& whole = result.incidents("R1");
    const auto& part = result.incidents("R2");
    ASSERT_EQ(whole.size(), 2U);
    ASSERT_EQ(part.size(), 2U);
    EXPECT_NE(whole[0], whole[1]);
    EXPECT_NE(whole[0], part[0]);
    for (const auto& record : {whole[1], part[0], part[1]})
        EXPECT_EQ(record->common(), whole[0]->common());
}

TEST(IncidentBuilder, UnitedAlertsConcernAllTheirLinesEachWithItsOwnPeriods) {
    const Answer result = answer({maker([](AlertMaker& m) {
                                      m.id = "1";
                                      m.activePeriods = {period(At - 9, At + 100)};
                                  }),
                                  maker([](AlertMaker& m) {
                                      m.id = "2";
                                      m.selectors = {route("R2")};
                                      m.activePeriods = {period(At + 300, At + 400)};
                                  }),
                                  maker([](AlertMaker& m) {
                                      m.id = "3";
                                      m.selectors = {route("R1"), route("T1")};
                                      m.activePeriods = {period(At + 120, At + 200)};
                                  })});
    ASSERT_EQ(result.incidents("R1").size(), 1U);
    EXPECT_EQ(seconds(result.incidents("R1")[0]->startDate()), At - 9);
    EXPECT_EQ(seconds(result.incidents("R1")[0]->endDate()), At + 200);
    ASSERT_EQ(result.incidents("R2").size(), 1U);
    EXPECT_EQ(seconds(result.incidents("R2")[0]->startDate()), At + 300);
    EXPECT_EQ(seconds(result.incidents("T1").at(0)->startDate()), At + 120);
    for (const char* const line : {"R1", "R2", "T1"}) {
        EXPECT_EQ(affected(*result.incidents(line)[0]), "R1 R2 T1");
        EXPECT_EQ(result.incidents(line)[0]->muid(), result.incidents("R1")[0]->muid());
    }
}

TEST(IncidentBuilder, UnitedAlertsHaveTheWorstSeverityAndTheFirstToldCause) {
    const Answer result = answer({maker([](AlertMaker& m) { m.severity = 2; }),
                                  maker([](AlertMaker& m) {
                                      m.severity = 4;
                                      m.cause = 6;
                                  }),
                                  maker([](AlertMaker& m) { m.cause = 7; })});
    const auto& details = result.incidents("R1").at(0)->details();
    EXPECT_EQ(details.severity, IncidentSeverity::Severe);
    EXPECT_EQ(details.cause, IncidentCause::Accident);
}

TEST(IncidentBuilder, UnitedAlertsWereUpdatedWhenTheLatestOfTheirMessagesWasMade) {
    const auto made = [](double secondsAgo) {
        return source(message(Alerts{maker()}, static_cast<std::uint64_t>(At - secondsAgo)));
    };
    for (const auto& sources :
         {std::vector{made(20), made(300)}, std::vector{made(300), made(20)}}) {
        const Answer result(sources, query());
        ASSERT_EQ(result.incidents("R1").size(), 1U);
        EXPECT_EQ(seconds(result.incidents("R1")[0]->lastUpdated()), At - 20);
        EXPECT_EQ(seconds(result.incidents("R1")[0]->creationDate()), At - 20);
    }
}

TEST(IncidentBuilder, ConcernedStopsAreTold) {
    const Answer result = answer({maker([](AlertMaker& m) {
        m.selectors = {route("R2").bytes(5, "S7"),
                       route("R2").bytes(5, "S3"),
                       route("R1"),
                       Wire().bytes(5, "S2")};
    })});
    EXPECT_EQ(affected(*result.incidents("R2").at(0)), "R1 R2(S3,S7) T1(S2)");
    EXPECT_TRUE(result.incidents("R2")[0]->details().isPartOfLine);
    EXPECT_FALSE(result.incidents("R1").at(0)->details().isPartOfLine);
}

TEST(IncidentBuilder, IncidentsOfALineAreInOrder) {
    const auto alert = [](const char* header, std::uint64_t severity, std::uint64_t effect) {
        return maker([&](AlertMaker& m) {
            m.id = header;
            m.header = {{header, "en"}};
            m.severity = severity;
            m.effect = effect;
        });
    };
    EXPECT_EQ(answer({alert("c", 2, 1), alert("b", 3, 4), alert("d", 0, 1), alert("a", 3, 1)})
                  .titles("R1"),
              (std::vector<std::string>{"a", "b", "c", "d"}));
}

TEST(IncidentBuilder, StepFreeTravelShowsAccessibilityIssues) {
    const std::string bytes = message(Alerts{maker([](AlertMaker& m) { m.effect = 11; })});
    EXPECT_EQ(Answer({source(bytes)}, query("en", false)).disturbed(), "");
    EXPECT_EQ(Answer({source(bytes)}, query("en", true)).disturbed(), "R1");
}

TEST(IncidentBuilder, ThePersonsLanguageChangesTextsAndNeverTheNumber) {
    const std::string bytes = message(Alerts{maker([](AlertMaker& m) {
        m.header = {{"Demi-tour", "fr"}, {"Turn", "en"}};
        m.description = {{"Pont", "fr"}, {"Bridge", "en"}};
    })});
    const Answer french({source(bytes)}, query("fr"));
    const Answer english({source(bytes)}, query("en"));
    EXPECT_EQ(french.titles("R1"), std::vector<std::string>{"Demi-tour"});
    EXPECT_EQ(english.titles("R1"), std::vector<std::string>{"Turn"});
    EXPECT_EQ(french.incidents("R1")[0]->muid(), english.incidents("R1")[0]->muid());
}

TEST(IncidentBuilder, ALineWithoutAlertsInAProvenFeedIsClear) {
    const Answer result = answer({});
    EXPECT_EQ(result.disturbed(), "");
    EXPECT_FALSE(result.line("R1").isUnknown);
    EXPECT_EQ(result.result().error, nullptr);
    EXPECT_EQ(result.result().sources.at(0).headerTime, Now);
}

TEST(IncidentBuilder, AFailedSourceMakesEveryLineUnknownEachUnderItsOwnNumber) {
    const Answer result({source("<html>")}, query());
    EXPECT_EQ(result.disturbed(), "R1 R2 R3 M1 T1");
    for (const char* const line : {"R1", "T1"}) {
        ASSERT_EQ(result.incidents(line).size(), 1U);
        EXPECT_TRUE(result.line(line).isUnknown);
        EXPECT_TRUE(result.incidents(line)[0]->details().isUnknown);
    }
    EXPECT_NE(result.incidents("R1")[0]->muid(), result.incidents("R2")[0]->muid());
    EXPECT_EQ(result.incidents("T1")[0]->summary(), "Agency A2, nothing known yet");
    ASSERT_NE(result.result().error, nullptr);
    EXPECT_EQ(result.result().error->localizedDescription(),
              "The service alerts of town could not be read: it is a web page or XML, not "
              "GTFS-Realtime");
    EXPECT_NE(result.result().sources.at(0).error, nullptr);
}

TEST(IncidentBuilder, ALineWithACurrentIncidentFromAnotherSourceNeedsNoUnknownOne) {
    const Answer result({source(message(Alerts{maker()})), {nullptr, 0, failure()}}, query());
    EXPECT_FALSE(result.line("R1").isUnknown);
    EXPECT_EQ(result.titles("R1"), std::vector<std::string>{"Trams turn early"});
    EXPECT_TRUE(result.line("R2").isUnknown);
    EXPECT_EQ(result.result().error, nullptr);
}

TEST(IncidentBuilder, AComingIncidentAloneDoesNotTellHowTheLineRunsNow) {
    const std::string coming =
        message(Alerts{maker([](AlertMaker& m) { m.activePeriods = {period(At + 60, 0)}; })});
    const Answer result({source(coming), {nullptr, 0, failure()}}, query());
    EXPECT_TRUE(result.line("R1").isUnknown);
    EXPECT_EQ(result.titles("R1"),
              (std::vector<std::string>{"Status unknown", "Trams turn early"}));
    const Answer proven({source(coming)}, query());
    EXPECT_FALSE(proven.line("R1").isUnknown);
}

TEST(IncidentBuilder, ABodyOfMoreThanTenMinutesAgoProvesNothingAndTellsItsAge) {
    const std::string bytes = message(Alerts{maker()});
    EXPECT_FALSE(Answer({source(bytes, Now - 600)}, query()).line("R2").isUnknown);
    const Answer old({source(bytes, Now - 1260)}, query());
    EXPECT_EQ(old.titles("R1"), std::vector<std::string>{"Status unknown"});
    EXPECT_EQ(old.incidents("R1")[0]->summary(), "Agency A1, last known 21 minutes ago");
}

TEST(IncidentBuilder, AStaleHeaderCountsAsUnknown) {
    const Answer stale({source(message(Alerts{maker()}, At - 90000))}, query());
    EXPECT_EQ(stale.titles("R1"), std::vector<std::string>{"Status unknown"});
    EXPECT_EQ(stale.incidents("R1")[0]->summary(), "Agency A1, last known 1 day ago");
    EXPECT_FALSE(stale.result().error); // it was read
    EXPECT_TRUE(stale.result().sources.at(0).error);
}

TEST(IncidentBuilder, AHeaderWithoutATimeWasMadeWhenItWasFetched) {
    const Answer result({source(message(Alerts{maker()}, 0), Now - 60)}, query());
    EXPECT_EQ(seconds(result.incidents("R1").at(0)->lastUpdated()), Now - 60);
}

TEST(IncidentBuilder, UnreadableSelectorsMakeLinesWithoutAnIncidentUnknown) {
    const Answer result = answer({maker(), maker([](AlertMaker& m) {
                                      m.id = "2";
                                      m.header = {{"Closed", "en"}};
                                      m.selectors = {route("R2"), Wire().number(2, 1)};
                                  })});
    EXPECT_EQ(result.titles("R1"), std::vector<std::string>{"Trams turn early"});
    EXPECT_EQ(result.titles("R2"), std::vector<std::string>{"Closed"});
    EXPECT_EQ(result.titles("M1"), std::vector<std::string>{"Status unknown"});
    EXPECT_TRUE(result.line("T1").isUnknown);
    EXPECT_EQ(result.result().error, nullptr);
}

TEST(IncidentBuilder, AlertsThatNameMillionsOfLinesTogetherLeaveLinesWithoutAnIncidentUnknown) {
    auto contents = smallSchedule();
    for (std::size_t i = 0; i < 2000; ++i) {
        ScheduleLine line = contents.lines.front();
        line.routeId = "X" + std::to_string(i);
        line.muid = lineMuid("town", line.routeId);
        contents.lines.push_back(line);
    }
    Alerts alerts;
    for (int i = 0; i < 2000; ++i)
        alerts.push_back(maker([&](AlertMaker& m) {
            m.id = std::to_string(i);
            m.header = {{"Over " + m.id, "en"}};
            m.selectors = {Wire().bytes(1, "A1")};
            m.activePeriods = {period(1, 2)};
        }));
    const auto index = std::make_shared<const LineIndex>(std::move(contents));
    const Answer result(index, {source(message(alerts))}, query());
    EXPECT_TRUE(result.line("R1").isUnknown);
    EXPECT_TRUE(result.line("T1").isUnknown);
    EXPECT_EQ(result.result().statistics.count(AlertCount::UnreadableSelectors), 4U);
}

TEST(IncidentBuilder, AStopThatTheScheduleCannotBeAskedAboutMakesLinesWithoutAnIncidentUnknown) {
    auto contents = smallSchedule();
    contents.stops.linesServingStop = [](std::string_view) {
        return std::nullopt;
    };
    const auto index = std::make_shared<const LineIndex>(std::move(contents));
    const std::vector<AlertSource> sources = {
        source(message(Alerts{maker(), maker([](AlertMaker& m) {
                                  m.id = "2";
                                  m.header = {{"Closed", "en"}};
                                  m.selectors = {Wire().bytes(5, "S1")};
                              })}))};
    for (const IncidentQuery& asked : {query(), queryFor({"R1", "R2"})}) {
        const Answer result(index, sources, asked);
        EXPECT_EQ(result.titles("R1"), std::vector<std::string>{"Trams turn early"});
        EXPECT_EQ(result.titles("R2"), std::vector<std::string>{"Status unknown"});
        EXPECT_EQ(result.result().statistics.count(AlertCount::UnaskedStops), 1U);
    }
}

TEST(IncidentBuilder, AnUnreadablePeriodIsOpenAndNeverEndsAnAlert) {
    for (const Wire& unreadable :
         {Wire().number(1, 5), Wire().group(1), Wire().bytes(1, Wire().raw("\x08"))}) {
        const Answer result = answer({maker([&](AlertMaker& m) {
            m.activePeriods = {period(At - 7200, At - 3600)};
            m.more = unreadable;
        })});
        EXPECT_EQ(result.titles("R1"), std::vector<std::string>{"Trams turn early"});
        EXPECT_EQ(result.result().statistics.count(AlertCount::UnreadablePeriods), 1U);
    }
}

TEST(IncidentBuilder, ABadSideOfAPeriodIsOpenAndTheOtherHolds) {
    const auto withPeriod = [](const Wire& period) {
        return answer({maker([&](AlertMaker& m) { m.activePeriods = {period}; })});
    };
    EXPECT_EQ(withPeriod(period(At - 60, 0).bytes(2, "x")).disturbed(), "R1");
    EXPECT_EQ(withPeriod(period(0, At + 60).group(1)).disturbed(), "R1");
    EXPECT_EQ(withPeriod(period(0, At - 60).group(1)).disturbed(), "");
}

TEST(IncidentBuilder, AnUnreadableEntityThatWasDeletedConcernsNobody) {
    AlertMaker unreadable;
    unreadable.selectors = {Wire().number(2, 1)};
    const Answer result(message(std::vector<Wire>{unreadable.entity().number(2, 1)}));
    EXPECT_EQ(result.disturbed(), "");
}

TEST(IncidentBuilder, UnresolvedSelectorsNeverCostTheOthers) {
    const Answer result = answer({maker([](AlertMaker& m) {
        m.selectors = {route("X"), Wire().bytes(1, "Nobody"), route("R2"), Wire()};
    })});
    EXPECT_EQ(result.disturbed(), "R2");
    EXPECT_EQ(result.result().statistics.unresolvedSelectors(), 3U);
}

TEST(IncidentBuilder, AFeedWithoutSourcesProvesNothing) {
    const Answer result({}, query());
    EXPECT_TRUE(result.line("R1").isUnknown);
    ASSERT_NE(result.result().error, nullptr);
    EXPECT_EQ(result.result().error->code(), static_cast<std::int64_t>(AlertErrorCode::NoSource));
}

TEST(IncidentBuilder, ALineThatTheScheduleDoesNotHaveIsUnknown) {
    const Answer result({source(message(Alerts{maker()}))}, queryFor({"R1", "gone"}));
    EXPECT_FALSE(result.line("R1").isUnknown);
    EXPECT_TRUE(result.line("gone").isUnknown);
    EXPECT_EQ(result.incidents("gone").size(), 1U);
}

TEST(IncidentBuilder, AnswersInTheOrderAskedEvenTwice) {
    const Answer result({source(message(Alerts{maker()}))}, queryFor({"T1", "R1", "T1", "R1"}));
    ASSERT_EQ(result.result().lines.size(), 4U);
    EXPECT_EQ(result.result().lines[0].muid, lineMuid("town", "T1"));
    EXPECT_TRUE(result.result().lines[2].incidents.empty());
    EXPECT_EQ(result.result().lines[1].incidents, result.result().lines[3].incidents);
    EXPECT_EQ(result.result().lines[3].incidents.size(), 1U);
}

TEST(IncidentBuilder, WhatConcernsOtherLinesIsToldToThoseAskedAbout) {
    const std::string bytes =
        message(Alerts{maker([](AlertMaker& m) { m.id = "1"; }), maker([](AlertMaker& m) {
                           m.id = "2";
                           m.selectors = {route("R2")};
                           m.activePeriods = {period(1, 0)};
                       })});
    const Answer result({source(bytes)}, queryFor({"R1"}));
    ASSERT_EQ(result.incidents("R1").size(), 1U);
    EXPECT_EQ(affected(*result.incidents("R1")[0]), "R1 R2");
    EXPECT_EQ(seconds(result.incidents("R1")[0]->creationDate()), 1);
    EXPECT_EQ(result.incidents("R1")[0]->startDate(), nullptr);
}

TEST(IncidentBuilder, TranslationsWithoutSelectorsReachTheLinesAskedAbout) {
    const std::string bytes = message(Alerts{maker(), maker([](AlertMaker& m) {
                                                 m.selectors.clear();
                                                 m.header = {{"Demi-tour", "fr"}};
                                                 m.description = {{"Pont", "fr"}};
                                             })});
    IncidentQuery french = queryFor({"R1"});
    french.language = "fr";
    EXPECT_EQ(Answer({source(bytes)}, french).titles("R1"), std::vector<std::string>{"Demi-tour"});
}

TEST(IncidentBuilder, AFailedSourceLeavesNoTraceInASelection) {
    const std::string good = message(Alerts{maker()});
    const std::string cut = good.substr(0, good.size() - 1);
    const Answer result({source(cut), source(good)}, queryFor({"R1", "R2"}));
    EXPECT_EQ(result.titles("R1"), std::vector<std::string>{"Trams turn early"});
    EXPECT_TRUE(result.line("R2").isUnknown);
}

TEST(IncidentBuilder, EqualArgumentsGiveEqualAnswers) {
    const std::string bytes = message(Alerts{maker(), maker([](AlertMaker& m) {
                                                 m.header = {{"Closed", "en"}};
                                             })});
    const Answer one(bytes);
    const Answer other(bytes);
    EXPECT_EQ(one.titles("R1"), other.titles("R1"));
    EXPECT_EQ(one.incidents("R1")[0]->muid(), other.incidents("R1")[0]->muid());
}

TEST(IncidentBuilder, CutAtEveryByteItNeverShowsGoodServiceUnlessTheMessageLooksWhole) {
    const std::string whole =
        message(Alerts{maker([](AlertMaker& m) { m.selectors = {Wire().bytes(1, "A1")}; })});
    const std::size_t headerOnly = message(std::vector<Wire>()).size();
    for (std::size_t length = 0; length < whole.size(); ++length) {
        const Answer result(whole.substr(0, length));
        EXPECT_EQ(result.line("R1").isUnknown, length != headerOnly) << length;
    }
}

TEST(IncidentBuilder, CutInsideItsEntityItNeverShowsGoodServiceEither) {
    const std::string alert = AlertMaker().alert().str();
    for (std::size_t length = 1; length < alert.size(); ++length) {
        const Wire entity = Wire().bytes(1, "1").bytes(5, alert.substr(0, length));
        const Answer result(message(std::vector<Wire>{entity}));
        const bool isAtBoundary = [&] {
            AlertStatistics ignored;
            return !EntityReader(ignored).read(entity.str()).mayConcernAnyLine;
        }();
        EXPECT_EQ(result.line("T1").isUnknown, !isAtBoundary) << length;
    }
}

} // namespace orvo::testing
