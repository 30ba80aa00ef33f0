#include "AlertMaker.h"
#include "CapturedFeed.h"
#include "platform/feeds/alerts/AlertReader.h"
#include "platform/geoservices/TransitIncidentAffectedEntity.h"

#include <gtest/gtest.h>

#include <map>
#include <sstream>

// What a person reads from the captured messages at the time of their headers.

namespace orvo::testing {

namespace {

struct Shown {
    std::string title;
    double start; ///< seconds since 1970; -1 open
    double end;
    bool isPart;
    bool isBlocking;

    friend bool operator==(const Shown&, const Shown&) = default;
    friend void PrintTo(const Shown& shown, std::ostream* out) {
        *out << '"' << shown.title << "\" " << static_cast<std::int64_t>(shown.start) << " to "
             << static_cast<std::int64_t>(shown.end) << (shown.isPart ? " part" : "")
             << (shown.isBlocking ? " blocking" : "");
    }
};

Shown shown(const FeedTransitIncident& incident) {
    const auto seconds = [](const std::shared_ptr<NSDate>& date) {
        return date ? date->timeIntervalSince1970() : -1;
    };
    return {incident.title().value_or("nil"),
            seconds(incident.startDate()),
            seconds(incident.endDate()),
            incident.details().isPartOfLine,
            incident.isBlockingIncident()};
}

std::vector<Shown> shown(const Answer& answer, const std::string& route) {
    std::vector<Shown> result;
    for (const auto& incident : answer.incidents(route))
        result.push_back(shown(*incident));
    return result;
}

/// The period of the incident whose title begins so; nothing where there is none.
std::optional<Shown>
find(const Answer& answer, const std::string& route, const std::string& beginning) {
    for (const Shown& each : shown(answer, route))
        if (each.title.starts_with(beginning))
            return each;
    return std::nullopt;
}

/// Everything that an answer tells of a line, as text.
std::string dump(const LineIncidents& line) {
    std::string text = line.isUnknown ? "unknown\n" : "";
    for (const auto& incident : line.incidents) {
        std::ostringstream out;
        PrintTo(shown(*incident), &out);
        text += std::to_string(incident->muid()) + " " + out.str() + " " +
                incident->summary().value_or("nil") + " " +
                incident->fullDescription().value_or("nil") + " " +
                descriptionOf(incident->creationDate()) + " " +
                descriptionOf(incident->lastUpdated()) + " " + nameOf(incident->details().cause) +
                " " + nameOf(incident->details().severity);
        for (const auto& entity :
             typed<TransitIncidentAffectedEntity>(incident->affectedEntities()))
            text += " " + std::to_string(entity->muid()) + descriptionOf(entity->nextStopIDs());
        text += "\n";
    }
    return text;
}

/// The captured message as it would be if each of its alerts named the route besides.
std::string alsoNaming(const char* routeId, const std::string& bytes, std::uint64_t timestamp) {
    const auto data = NSData::dataWithString(bytes);
    const auto message = AlertReader::read(data->bytes(), nullptr);
    Wire wire;
    wire.bytes(1, header(timestamp));
    for (const std::string_view entity : message.value().entities)
        wire.bytes(2, Wire().raw(entity).bytes(5, Wire().bytes(5, route(routeId))));
    return wire.str();
}

class CapturedFeeds : public ::testing::Test {
protected:
    void SetUp() override {
        if (capturedFeeds().empty())
            GTEST_SKIP() << "ORVO_TEST_FEEDS is not set";
    }
};

} // namespace

TEST_F(CapturedFeeds, MontpellierRepeatsOneIncidentForEachRoute) {
    const CapturedFeed feed("tam-montpellier-2025");
    const Answer answer = feed.answer("alerts.pb", 1741793374, "fr");
    const std::vector<Shown> delay = {
        {"TR/BUS MULTILIGNES/Retard/ RETARDS SANS CAUSE", 1741784400, 1741811400, false, false}};
    EXPECT_EQ(answer.disturbed(feed.routes()), "7-13 7-7");
    EXPECT_EQ(shown(answer, "7-7"), delay);
    EXPECT_EQ(shown(answer, "7-13"), delay);
    EXPECT_EQ(answer.incidents("7-7")[0]->muid(), answer.incidents("7-13")[0]->muid());
    EXPECT_EQ(answer.incidents("7-7")[0]->affectedEntities()->count(), 2U);
    EXPECT_EQ(answer.incidents("7-7")[0]->summary(), "Des retards sont annoncés.");
    EXPECT_EQ(feed.answer("empty.pb", 1741816420).disturbed(feed.routes()), "");
}

TEST_F(CapturedFeeds, DetroitClosesStationsOfItsOneLine) {
    const CapturedFeed feed("detroit-people-mover-2023");
    const auto titles = [&](const char* file, double now) {
        std::vector<std::string> result;
        for (const Shown& each : shown(feed.answer(file, now), "22210")) {
            EXPECT_TRUE(each.isPart && !each.isBlocking);
            EXPECT_EQ(each.start, 1653004800);
            result.push_back(each.title);
        }
        std::sort(result.begin(), result.end());
        return result;
    };
    using Titles = std::vector<std::string>;
    EXPECT_EQ(titles("alerts-20221118.pb", 1668827900),
              (Titles{"Station at Bricktown closed",
                      "Station at Cadillac Center closed",
                      "Station at Times Square closed"}));
    EXPECT_EQ(titles("alerts-20221219.pb", 1671490127),
              (Titles{"Station at Cadillac Center closed", "Station at Times Square closed"}));
    EXPECT_EQ(titles("alerts-20230526.pb", 1685120400), Titles{"Station at Times Square closed"});
    // Stops that the schedule of another year does not have.
    EXPECT_EQ(titles("alerts-20221001.pb", 1664668800), Titles{});
    EXPECT_EQ(feed.answer("alerts-20221001.pb", 1664668800)
                  .result()
                  .statistics.count(AlertCount::UnservedStops),
              3U);
}

TEST_F(CapturedFeeds, DetroitsGoodNewsAndItsFutureAreNoIncidents) {
    const CapturedFeed feed("detroit-people-mover-2023");
    for (const auto& [file, now] :
         std::map<const char*, double>{{"alerts-20230724.pb", 1690209234},
                                       {"alerts-20230911.pb", 1690209234},
                                       {"alerts-20231009.pb", 1696714317}}) {
        const Answer answer = feed.answer(file, now);
        EXPECT_EQ(answer.disturbed({"22210"}), "") << file;
        EXPECT_FALSE(answer.line("22210").isUnknown) << file;
    }
}

TEST_F(CapturedFeeds, DetroitsStationsCloseOneAfterTheOther) {
    const CapturedFeed feed("detroit-people-mover-2023");
    // A day later the first of them begins within a day, the others do not.
    EXPECT_EQ(
        shown(feed.answer("alerts-20231009.pb", 1696714317 + 86400), "22210"),
        (std::vector<Shown>{
            {"Michigan station closed for construction", 1696824001, 1697126399, true, false}}));
}

TEST_F(CapturedFeeds, TheBelgianRailwaysTellEachIncidentOnceInEachLanguageAndOfNoLine) {
    const auto folder = capturedFeeds() / "irail-nmbs-2015";
    for (const auto& [file, now] : std::map<const char*, double>{{"alerts-a.pb", 1438247636},
                                                                 {"alerts-b.pb", 1438260927},
                                                                 {"alerts-c.pb", 1438268951}}) {
        const Answer answer({source(bytesOf(folder / file), now)},
                            {std::nullopt, now, "en", false});
        EXPECT_EQ(answer.disturbed(), "") << file;
        EXPECT_FALSE(answer.line("R1").isUnknown) << file;
        const AlertStatistics& statistics = answer.result().statistics;
        EXPECT_EQ(statistics.count(AlertCount::Alerts), 6U) << file;
        EXPECT_EQ(statistics.count(AlertCount::Incidents), 2U) << file;
        EXPECT_EQ(statistics.count(AlertCount::AlertsOfNoLine), 6U) << file;
    }
    EXPECT_FALSE(Answer({source(bytesOf(folder / "empty.pb"), 1438266085)},
                        {std::nullopt, 1438266085, "en", false})
                     .line("R1")
                     .isUnknown);
}

TEST_F(CapturedFeeds, TheBelgianRailwaysEscapeTheirMarkupTwice) {
    constexpr std::uint64_t now = 1438247636;
    const auto bytes =
        alsoNaming("R1", bytesOf(capturedFeeds() / "irail-nmbs-2015" / "alerts-a.pb"), now);
    const auto find = [&](const char* language, const std::string& title) {
        const Answer answer({source(bytes, now)}, {std::nullopt, now, language, false});
        EXPECT_EQ(answer.incidents("R1").size(), 2U);
        for (const auto& incident : answer.incidents("R1"))
            if (incident->title() == title)
                return incident;
        throw std::out_of_range(title + " is not among them");
    };
    const auto english = find("en", "La Louviere-Sud - Pieton: Overhead power line damage.");
    EXPECT_EQ(english->summary(), "Overhead power line damage.");
    EXPECT_EQ(english->fullDescription(),
              "Overhead power line damage.\n\nDelayed train traffic.\n\n"
              "Trains on one track between La Louviere-Sud and Morlanwelz.\n\n"
              "Delays and cancellations are possible.\n"
              "Disruption for an undetermined amount of time.\n\n"
              "Listen to the announcements in the train.\n"
              "Listen to the announcements in the train station.\n"
              "Listen to the announcements in the train.");
    const auto french = find("fr-BE", "La Louviere-Sud - Pieton: Dégâts à la caténaire.");
    EXPECT_EQ(french->summary(), "Dégâts à la caténaire.");
    EXPECT_EQ(french->muid(), english->muid());
    const auto dutch = find("nl", "La Louviere-Zuid - Pieton: Beschadiging aan de bovenleiding.");
    EXPECT_EQ(dutch->muid(), english->muid());
    EXPECT_EQ(dutch->startDate(), nullptr);
    EXPECT_EQ(dutch->endDate(), nullptr);
    EXPECT_EQ(dutch->creationDate()->timeIntervalSince1970(), now);
}

TEST_F(CapturedFeeds, MiWayTellsTheSubstanceInTheDescription) {
    const CapturedFeed feed("miway-2025");
    for (const auto& [file, now] : std::map<const char*, double>{
             {"alerts.pb", 1761519032}, {"alerts-earlier.pb", 1761515652}}) {
        const Answer answer = feed.answer(file, now);
        EXPECT_EQ(shown(answer, "3"),
                  (std::vector<Shown>{{"Stop moved", 1760537606, 1761969598, true, false}}));
        EXPECT_EQ(answer.incidents("3")[0]->summary(),
                  "3 West - Stop 1348 on Bloor St at Grand Forks Rd is relocated 45 metres east.");
        EXPECT_EQ(answer.incidents("3")[0]->details().cause, IncidentCause::Construction);
        EXPECT_EQ(answer.incidents("2").size(), 9U);
        EXPECT_EQ(answer.incidents("2")[0]->title(), "Service notice");
        EXPECT_EQ(answer.incidents("7").size(), 0U);
        const AlertStatistics& statistics = answer.result().statistics;
        EXPECT_EQ(statistics.count(AlertCount::Alerts), 69U);
        EXPECT_EQ(statistics.unresolved(),
                  (std::map<std::string, std::uint64_t>{{"agency_id Mississauga Transit", 3}}));
        EXPECT_EQ(statistics.unreadable(), 0U);
    }
}

TEST_F(CapturedFeeds, BostonsRoutesHaveTheirIncidents) {
    const CapturedFeed feed("mbta-2024");
    const Answer answer = feed.answer("alerts.pb", 1721784520);
    EXPECT_EQ(answer.result().statistics.count(AlertCount::Alerts), 99U);
    EXPECT_EQ(answer.result().statistics.unreadable(), 0U);
    EXPECT_EQ(answer.result().statistics.count(AlertCount::AlertsOnlyAboutAccess), 15U);
    EXPECT_EQ(find(answer, "1", "Route 1 is experiencing delays of up to 20 minutes"),
              (Shown{"Route 1 is experiencing delays of up to 20 minutes due to traffic",
                     1721764380,
                     1721791720,
                     false,
                     false}));
    const auto haverhill = find(answer, "CR-Haverhill", "Commuter Rail train service is suspended");
    ASSERT_TRUE(haverhill);
    EXPECT_EQ(haverhill->start, 1721743680);
    EXPECT_EQ(haverhill->end, -1);
    EXPECT_TRUE(haverhill->isPart);
    EXPECT_FALSE(haverhill->isBlocking);
    EXPECT_EQ(answer.incidents("CR-Haverhill")[0]->title(), haverhill->title);
}

TEST_F(CapturedFeeds, OfBostons260PeriodsTheNextDayIsShown) {
    const CapturedFeed feed("mbta-2024");
    const std::string entrance = "The Alewife front entrance";
    const auto coming = find(feed.answer("alerts.pb", 1721784520), "67", entrance);
    ASSERT_TRUE(coming);
    EXPECT_EQ(coming->start, 1721822400);
    EXPECT_EQ(coming->end, 1721851200);
    // A day after the first morning begins the second.
    std::vector<double> starts;
    for (const Shown& each : shown(feed.answer("alerts.pb", 1721822400), "67"))
        if (each.title.starts_with(entrance))
            starts.push_back(each.start);
    EXPECT_EQ(starts, (std::vector<double>{1721908800, 1721822400}));
}

TEST_F(CapturedFeeds, BostonsAdditionalTrainsAndLaterTimetablesAreNotShown) {
    const CapturedFeed feed("mbta-2024");
    const Answer answer = feed.answer("alerts.pb", 1721784520);
    EXPECT_EQ(find(answer, "111", "Route 111 has additional weekday"), std::nullopt);
    EXPECT_EQ(find(answer, "CR-Fitchburg", "On weekdays, from Monday, July 15th"), std::nullopt);
    EXPECT_EQ(find(answer, "CR-Newburyport", "A new Newburyport/Rockport Line schedule"),
              std::nullopt);
}

TEST_F(CapturedFeeds, BostonsLiftsAreShownToWhoNeedsThem) {
    const CapturedFeed feed("mbta-2024");
    const std::string bytes = feed.bytes("alerts.pb");
    IncidentQuery query = feed.all(1721784520);
    const auto lifts = [&] {
        std::size_t count = 0;
        const Answer answer(feed.index(), {source(bytes, query.now)}, query);
        for (const LineIncidents& line : answer.result().lines)
            for (const auto& incident : line.incidents)
                count += incident->details().effect == IncidentEffect::AccessibilityIssue ? 1U : 0U;
        return count;
    };
    EXPECT_EQ(lifts(), 0U);
    query.stepFree = true;
    EXPECT_GT(lifts(), 0U);
}

TEST_F(CapturedFeeds, HostilePeriodsAreReadAsMeant) {
    const CapturedFeed feed("hostile-rt");
    const Answer answer = feed.answer("periods.pb", 1750000000);
    std::map<std::string, std::string> periods;
    for (const Shown& each : shown(answer, "R1")) {
        const auto side = [](double seconds) {
            return seconds < 0 ? "open" : std::to_string(static_cast<std::int64_t>(seconds));
        };
        std::string& text = periods[each.title];
        text = side(each.start) + " " + side(each.end) + (text.empty() ? "" : ", ") + text;
    }
    EXPECT_EQ(periods,
              (std::map<std::string, std::string>{
                  {"260", "1750000000 1750003600, 1750086400 1750090000"},
                  {"both-zero", "open open"},
                  {"empty-range", "open open"},
                  {"end-equals-now", "1749999990 1750000000"},
                  {"end-zero", "1749999990 open"},
                  {"future-only", "1750003600 1750007200"},
                  {"gap-now", "1750000050 1750000100"},
                  {"milliseconds", "1749999990 1750000010"},
                  {"minus-one", "1749999990 open"},
                  {"none", "open open"},
                  {"open-end", "1749999990 open"},
                  {"open-start", "open 1750000010"},
                  {"past-then-now", "1749999999 1750000001"},
                  {"start-equals-now", "1750000000 1750000001"},
                  {"uint64-max", "open open"},
                  {"unsorted", "1749999995 1750000060"},
                  {"year-3000", "1749999990 32503694400"},
              }));
}

TEST_F(CapturedFeeds, ImpactPeriodsComeFirst) {
    const CapturedFeed feed("hostile-rt");
    const Answer answer = feed.answer("new-periods-2026.pb", 1750000000);
    const auto start = [&](const char* title) {
        const auto found = find(answer, "R1", title);
        return found ? found->start : -2;
    };
    EXPECT_EQ(answer.incidents("R1").size(), 5U);
    EXPECT_EQ(start("active-only-now"), 1749999999);
    EXPECT_EQ(start("comm-now-impact-later"), 1750005000);
    EXPECT_EQ(start("comm-and-impact-now"), 1749999999);
    EXPECT_EQ(start("active-now-impact-later"), 1750005000);
    EXPECT_EQ(start("active-now-comm-past"), -2);
    EXPECT_EQ(start("impact-now-only"), 1749999999);
}

TEST_F(CapturedFeeds, HostileSelectorsOfOneContentAreOneIncident) {
    const CapturedFeed feed("hostile-rt");
    const Answer answer = feed.answer("selectors.pb", 1750000000);
    const std::vector<Shown> head = {{"Head", -1, -1, false, false}};
    EXPECT_EQ(shown(answer, "R1"), head);
    EXPECT_EQ(shown(answer, "R2"), head);
    const AlertStatistics& statistics = answer.result().statistics;
    EXPECT_EQ(statistics.count(AlertCount::UnknownAgencies), 1U);
    EXPECT_EQ(statistics.count(AlertCount::UnknownRoutes), 1U);
    EXPECT_EQ(statistics.count(AlertCount::UnservedStops), 1U);
    EXPECT_EQ(statistics.count(AlertCount::TripsWithoutRoute), 1U);
    EXPECT_EQ(statistics.count(AlertCount::ContradictorySelectors), 2U);
    EXPECT_EQ(statistics.count(AlertCount::EmptySelectors), 2U);
}

TEST_F(CapturedFeeds, HostileLanguageTagsAreChosenAmong) {
    const CapturedFeed feed("hostile-rt");
    const auto titles = [&](const std::string& language) {
        auto result = feed.answer("languages.pb", 1750000000, language).titles("R1");
        std::sort(result.begin(), result.end());
        return result;
    };
    using Titles = std::vector<std::string>;
    EXPECT_EQ(titles("en"),
              (Titles{"EN",
                      "Service notice",
                      "default",
                      "en-US",
                      "en_GB",
                      "english",
                      "first",
                      "hant",
                      "no",
                      "norsk",
                      "plain",
                      "xx"}));
    EXPECT_EQ(titles("fr-CA"),
              (Titles{"FR",
                      "Service notice",
                      "default",
                      "en_GB",
                      "english",
                      "first",
                      "fr-CA",
                      "hant",
                      "no",
                      "norsk",
                      "plain",
                      "xx"}));
    EXPECT_EQ(titles("nn"),
              (Titles{"EN",
                      "Service notice",
                      "default",
                      "en-US",
                      "en_GB",
                      "english",
                      "first",
                      "hant",
                      "nn",
                      "norsk",
                      "plain",
                      "xx"}));
    EXPECT_EQ(titles("zh-CN"),
              (Titles{"EN",
                      "Service notice",
                      "default",
                      "en-US",
                      "en_GB",
                      "english",
                      "first",
                      "hans",
                      "no",
                      "norsk",
                      "plain",
                      "xx"}));
}

TEST_F(CapturedFeeds, WhatIsNoMessageMakesEveryLineUnknown) {
    const CapturedFeed feed("hostile-rt");
    for (const char* const file : {"truncated-middle.pb", "html-error-page.pb"}) {
        const Answer answer = feed.answer(file, 1750000000);
        EXPECT_TRUE(answer.line("R1").isUnknown) << file;
        EXPECT_TRUE(answer.line("R2").isUnknown) << file;
        EXPECT_NE(answer.result().error, nullptr) << file;
    }
    const std::string nothing = bytesOf(capturedFeeds() / "empty-feeds" / "zero-bytes.pb");
    EXPECT_TRUE(Answer(nothing).line("R1").isUnknown);
}

TEST_F(CapturedFeeds, AFileCutBetweenEntitiesIsTakenAsItStands) {
    const CapturedFeed feed("hostile-rt");
    const Answer atItsTime = feed.answer("truncated-at-boundary.pb", 1721784520);
    EXPECT_FALSE(atItsTime.line("R1").isUnknown);
    const Answer later = feed.answer("truncated-at-boundary.pb", 1750000000);
    EXPECT_TRUE(later.line("R1").isUnknown) << "its header is of the year before";
}

TEST_F(CapturedFeeds, SomeLinesAreToldTheSameAsAllLines) {
    const std::vector<std::pair<std::string, std::pair<std::string, double>>> cases = {
        {"tam-montpellier-2025", {"alerts.pb", 1741793374}},
        {"detroit-people-mover-2023", {"alerts-20221118.pb", 1668827900}},
        {"miway-2025", {"alerts.pb", 1761519032}},
        {"mbta-2024", {"alerts.pb", 1721784520}},
        {"hostile-rt", {"periods.pb", 1750000000}},
        {"hostile-rt", {"selectors.pb", 1750000000}},
        {"hostile-rt", {"languages.pb", 1750000000}},
        {"perf", {"alerts-5000.pb", 1750000000}},
    };
    for (const auto& [folder, capture] : cases) {
        const CapturedFeed feed(folder);
        const auto& [file, now] = capture;
        const std::vector<AlertSource> sources = {source(feed.bytes(file), now)};
        const IncidentBuilder builder(feed.index());
        const FeedIncidents all = builder.build(sources, feed.all(now));
        for (std::size_t i = 0; i < all.lines.size(); i += 1 + all.lines.size() / 40) {
            IncidentQuery one = feed.all(now);
            one.lines = {all.lines[i].muid};
            EXPECT_EQ(dump(builder.build(sources, one).lines.at(0)), dump(all.lines[i]))
                << folder << " " << file << " " << i;
        }
    }
}

} // namespace orvo::testing
