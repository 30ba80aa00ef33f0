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

std::string affected(const FeedTransitIncident& incident) {
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

std::string told(const LineIncidents& line) {
    std::string text = line.isUnknown ? "unknown" : "known";
    for (const auto& incident : line.incidents)
        text += "\n" + std::to_string(incident->muid()) + '|' + incident->title().value_or("nil") +
                '|' + incident->summary().value_or("nil") + '|' + textOf(incident->startDate()) +
                '|' + textOf(incident->endDate()) + '|' + textOf(incident->creationDate()) +
                (incident->isBlockingIncident() ? "|blocking" : "") +
                (incident->details().isPartOfLine ? "|part" : "") + affected(*incident);
    return text;
}

/// Feeds by chance, the same in every run.
class Chance {
public:
    explicit Chance(std::uint32_t seed)
        : _random(seed) {}

    std::size_t below(std::size_t count) { return _random() % count; }
    template <class Value>
    const Value& of(const std::vector<Value>& values) {
        return values[below(values.size())];
    }

    /// Mostly the usual form that is recognised without being read.
    Wire selector() {
        const std::string& line = of(_lines);
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
        if (below(2) == 0)
            maker.activePeriods = {period(1749990000 + below(20000), 0)};
        maker.effect = of<std::uint64_t>({1, 4, 4, 6, 10});
        maker.header = {{of<std::string>({"Delays", "Closed", "1 Harbour", "<b>Tram</b>", ""}),
                         of<std::string>({"en", "en", "fr"})}};
        maker.description = {{of<std::string>({"Fire.", "Works."}), maker.header[0].language}};
        if (below(10) == 0)
            maker.more.bytes(5, selector()).number(14, 3).bytes(5, selector());
        return maker;
    }

    std::string feed() {
        std::vector<AlertMaker> alerts;
        for (std::size_t count = 1 + below(6); count > 0; --count)
            alerts.push_back(alert());
        return message(alerts);
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
        const std::vector<AlertSource> sources(1 + chance.below(2), source(chance.feed()));
        const Answer all(sources, {std::nullopt, Now, "en", false});
        const std::string& route = chance.of(Routes);
        const std::string& other = chance.of(Routes);
        const Answer some(
            sources,
            {std::vector{lineMuid("town", route), lineMuid("town", other)}, Now, "en", false});
        ASSERT_EQ(told(some.line(route)), told(all.line(route))) << seed << ' ' << route;
        ASSERT_EQ(told(some.line(other)), told(all.line(other))) << seed << ' ' << other;
        incidents += all.incidents(route).size();
    }
    EXPECT_GT(incidents, 4000U); // they are no empty feeds
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
    EXPECT_EQ(affected(*incident), expected);
}

} // namespace orvo::testing
