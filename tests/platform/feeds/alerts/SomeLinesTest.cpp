// What is told of some lines is what is told of them among all lines, however much of the message
// was not read for it.

#include "AlertMaker.h"
#include "TestLines.h"
#include "platform/foundation/NSString.h"
#include "platform/geoservices/TransitIncidentAffectedEntity.h"

#include <gtest/gtest.h>

#include <random>

namespace orvo::testing {

namespace {

const std::vector<std::string> Routes = {"R1", "R2", "R3", "M1", "T1"};

std::string textOf(const std::shared_ptr<NSDate>& date) {
    return date ? std::to_string(date->timeIntervalSince1970()) : "nil";
}

std::string entitiesOf(const FeedTransitIncident& incident) {
    std::string text;
    for (const auto& entity : typed<TransitIncidentAffectedEntity>(incident.affectedEntities())) {
        text += " " + std::to_string(entity->muid());
        if (!entity->hasNextStopIDs())
            continue;
        const auto stops = entity->nextStopIDs();
        for (const auto& stop : stops->elements())
            text += "/" + stringValue(stop.get()).value_or("nil");
    }
    return text;
}

std::string told(const FeedTransitIncident& incident) {
    const FeedTransitIncident::Details& details = incident.details();
    std::string text = std::to_string(incident.muid());
    for (const auto& each : {incident.title(),
                             incident.summary(),
                             incident.fullDescription(),
                             incident.messageForNonRoutable(),
                             details.spokenTitle,
                             details.link,
                             details.timeZone})
        text += '|' + each.value_or("nil");
    for (const auto& date : {incident.startDate(),
                             incident.endDate(),
                             incident.creationDate(),
                             incident.lastUpdated()})
        text += '|' + textOf(date);
    return text + '|' + nameOf(details.severity) + nameOf(details.effect) + nameOf(details.cause) +
           (incident.isBlockingIncident() ? "|blocking" : "") +
           (details.isPartOfLine ? "|part" : "") + entitiesOf(incident);
}

std::string told(const LineIncidents& line) {
    std::string text = line.isUnknown ? "unknown" : "known";
    for (const auto& incident : line.incidents)
        text += "\n" + told(*incident);
    return text;
}

/// Feeds by chance, the same in every run.
class Chance {
public:
    explicit Chance(std::uint32_t seed)
        : _random(seed) {}

    std::size_t below(std::size_t count) { return _random() % count; }
    template <class Value>
    Value of(const std::vector<Value>& values) {
        return values[below(values.size())];
    }

    /// Mostly the usual form that is recognised without being read.
    Wire selector() {
        const std::string line = of(_lines);
        switch (below(20)) {
        case 0:
            return Wire().bytes(1, of<std::string>({"A1", "A2", "A9"}));
        case 1:
            return Wire().bytes(5, of<std::string>({"S1", "S2", "S3"}));
        case 2:
            return Wire().number(3, below(4));
        case 3:
            return Wire().bytes(4, Wire().bytes(1, "trip").bytes(5, line));
        case 4:
            return Wire().bytes(2, " " + line);
        case 5:
            return below(8) == 0 ? Wire().number(2, 1) : Wire();
        case 6:
            return Wire().bytes(5, "S1").bytes(2, line);
        case 7:
            return route(line);
        default:
            Wire usual;
            usual.bytes(1, line == "T1" ? "A2" : "A1").bytes(2, line);
            return below(2) == 0 ? usual : usual.bytes(5, of<std::string>({"S1", "S22", "S3"}));
        }
    }

    AlertMaker alert() {
        AlertMaker maker;
        maker.id = std::to_string(below(6));
        maker.selectors.clear();
        for (std::size_t count = below(7); count > 0; --count)
            maker.selectors.push_back(selector());
        for (std::size_t count = below(3); count > 0; --count)
            maker.activePeriods.push_back(period(1749980000 + below(40000), 0));
        maker.effect = of<std::uint64_t>({1, 4, 4, 6, 10});
        maker.severity = below(5);
        maker.cause = below(13);
        const std::string language = of<std::string>({"en", "en", "fr"});
        maker.header = {{of<std::string>({"Delays",
                                          "Delays on many lines of the town",
                                          "Closed for works until the end of the week",
                                          "Closed for works until next spring",
                                          "1 Harbour",
                                          "<b>Tram</b>",
                                          ""}),
                         language}};
        maker.description = {{of<std::string>({"Fire.", "Works."}), language}};
        if (below(4) == 0)
            maker.spokenHeader = {{"Spoken", language}};
        if (below(10) == 0)
            maker.more.bytes(5, selector()).number(14, 3).bytes(5, selector());
        return maker;
    }

    Wire entity() {
        Wire entity = alert().entity();
        if (below(12) == 0)
            entity.bytes(5, Wire().bytes(5, selector()).bytes(5, selector()));
        return entity;
    }

    std::string feed() {
        std::vector<Wire> entities;
        for (std::size_t count = 1 + below(8); count > 0; --count)
            entities.push_back(entity());
        return message(entities);
    }

private:
    std::mt19937 _random;
    std::vector<std::string> _lines = {"R1", "R2", "R3", "M1", "T1", "R9", "X17"};
};

} // namespace

TEST(SomeLines, AreToldWhatTheyAreToldAmongAll) {
    std::size_t incidents = 0;
    for (std::uint32_t seed = 0; seed < 4000; ++seed) {
        Chance chance(seed);
        std::vector<AlertSource> sources = {source(chance.feed())};
        if (chance.below(2) == 0)
            sources.push_back(source(chance.feed()));
        const Answer all(sources, {std::nullopt, Now, "en", false});
        const std::string route = chance.of(Routes);
        const std::string other = chance.of(Routes);
        const Answer some(
            sources,
            {std::vector{lineMuid("town", route), lineMuid("town", other)}, Now, "en", false});
        ASSERT_EQ(told(some.line(route)), told(all.line(route))) << seed << ' ' << route;
        ASSERT_EQ(told(some.line(other)), told(all.line(other))) << seed << ' ' << other;
        incidents += all.incidents(route).size();
    }
    EXPECT_GT(incidents, 4000U); // they are no empty feeds
}

TEST(SomeLines, AnAlertGivenInTwoPartsConcernsTheLinesOfBoth) {
    const auto ofAgency = [](std::string_view line) {
        return Wire().bytes(1, "A1").bytes(2, line);
    };
    AlertMaker one;
    one.header = {{"Trams turn early because of a demonstration", "en"}};
    one.selectors = {ofAgency("R9"), ofAgency("R1"), ofAgency("R2")};
    AlertMaker other = one;
    other.selectors = {ofAgency("R3")};
    const std::string bytes = message(
        std::vector<Wire>{one.entity(), other.entity().bytes(5, Wire().bytes(5, ofAgency("M1")))});
    const Answer some({source(bytes)}, {std::vector{lineMuid("town", "R1")}, Now, "en", false});
    EXPECT_EQ(entitiesOf(*some.incidents("R1").at(0)),
              entitiesOf(*Answer(bytes).incidents("R1").at(0)));
}

TEST(SomeLines, AffectedEntitiesAreTheSameHoweverOftenTheyAreAskedFor) {
    AlertMaker alert;
    alert.header = {{"Trams turn early because of a demonstration", "en"}};
    alert.selectors.assign(3, Wire().bytes(1, "A1").bytes(2, "R3").bytes(5, "S1"));
    alert.selectors.push_back(Wire().bytes(1, "A1").bytes(2, "R1"));
    const Answer some({source(message({alert}))},
                      {std::vector{lineMuid("town", "R1")}, Now, "en", false});
    const auto& incident = *some.incidents("R1").at(0);
    const std::string expected = " " + std::to_string(lineMuid("town", "R1")) + " " +
                                 std::to_string(lineMuid("town", "R3")) + "/S1";
    EXPECT_EQ(entitiesOf(incident), expected);
    EXPECT_EQ(entitiesOf(incident), expected);
}

TEST(SomeLines, ATitleThatOnlyNamesALineThatWasNotAskedAboutIsTheEffect) {
    AlertMaker named;
    named.selectors = {route("R1"), route("R3"), route("R2")};
    named.header = {{"3 Airport", "en"}};
    const Answer some({source(message({named, named}))},
                      {std::vector{lineMuid("town", "R1")}, Now, "en", false});
    EXPECT_EQ(some.titles("R1"), std::vector<std::string>{"Detour"});
}

TEST(SomeLines, AnAlertThatOnlyConcernsOthersIsNotCountedAsOfNoLine) {
    AlertMaker asked;
    asked.header = {{"Trams turn early because of a demonstration", "en"}};
    asked.selectors = {Wire().bytes(1, "A1").bytes(2, "R3"), Wire().bytes(1, "A1").bytes(2, "R1")};
    AlertMaker other = asked; // looked at, for it begins with the same words
    other.header[0].text += "!";
    other.selectors.assign(2, Wire().bytes(1, "A1").bytes(2, "R2"));
    other.activePeriods = {period(1, 0)};
    const Answer some({source(message({asked, other}))},
                      {std::vector{lineMuid("town", "R1")}, Now, "en", false});
    EXPECT_EQ(some.incidents("R1").size(), 1U);
    EXPECT_EQ(some.result().statistics.count(AlertCount::Incidents), 2U);
    EXPECT_EQ(some.result().statistics.count(AlertCount::AlertsOfNoLine), 0U);
}

TEST(SomeLines, AffectedEntitiesCanBeAskedForWhenTheMessageAndTheBuilderAreGone) {
    std::shared_ptr<FeedTransitIncident> incident;
    {
        AlertMaker alert;
        alert.header = {{"Trams turn early because of a demonstration", "en"}};
        alert.selectors = {route("R2"), route("R1"), route("T1"), route("R3")};
        const Answer some({source(message({alert}))},
                          {std::vector{lineMuid("town", "R1")}, Now, "en", false});
        incident = some.incidents("R1").at(0);
    }
    std::string expected;
    for (const char* const route : {"R1", "R2", "R3", "T1"})
        expected += " " + std::to_string(lineMuid("town", route));
    EXPECT_EQ(entitiesOf(*incident), expected);
}

} // namespace orvo::testing
