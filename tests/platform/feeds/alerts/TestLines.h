#pragma once

#include "platform/feeds/alerts/IncidentBuilder.h"
#include "platform/feeds/schedule/LineIndex.h"

#include <map>
#include <memory>
#include <string>
#include <string_view>
#include <vector>

namespace orvo::testing {

inline constexpr double Now = 1750000000;

/// A small schedule: buses R1 to R3 and the metro M1 of agency A1, the tram T1 of agency A2. Stop
/// S1 is served by R1 and M1, stop S2 by T1.
inline LineIndex::Contents smallSchedule() {
    LineIndex::Contents contents;
    contents.feed = "town";
    contents.language = "en";
    contents.timezone = "Europe/Paris";
    const auto add = [&](const char* route, const char* agency, int type, const char* longName) {
        ScheduleLine line;
        line.muid = lineMuid("town", route);
        line.feed = "town";
        line.routeId = route;
        line.agencyId = agency;
        line.shortName = std::string_view(route).substr(1);
        line.longName = longName;
        line.routeType = type;
        line.order = static_cast<std::int64_t>(contents.lines.size());
        line.agency = {agency, std::string("Agency ") + agency, "", "Europe/Paris", ""};
        contents.lines.push_back(line);
    };
    add("R1", "A1", 3, "Harbour");
    add("R2", "A1", 3, "Castle");
    add("R3", "A1", 702, "Airport");
    add("M1", "A1", 1, "Metro");
    add("T1", "A2", 0, "Tram");
    contents.stops.linesServingStop = [](std::string_view stop) -> std::vector<std::uint64_t> {
        if (stop == "S1")
            return {lineMuid("town", "R1"), lineMuid("town", "M1")};
        if (stop == "S2")
            return {lineMuid("town", "T1")};
        return {};
    };
    return contents;
}

inline std::shared_ptr<const LineIndex> smallIndex() {
    return std::make_shared<LineIndex>(smallSchedule());
}

inline AlertSource source(const std::string& bytes, double fetchedAt = Now) {
    return {NSData::dataWithString(bytes), fetchedAt, nullptr};
}

/// The answer for all lines of the small schedule, to be asked about by route.
class Answer {
public:
    Answer(const std::vector<AlertSource>& sources, IncidentQuery query)
        : Answer(smallIndex(), sources, std::move(query)) {}
    Answer(std::shared_ptr<const LineIndex> index,
           const std::vector<AlertSource>& sources,
           IncidentQuery query)
        : _feed(index->feed())
        , _result(IncidentBuilder(std::move(index)).build(sources, query)) {}
    explicit Answer(const std::string& bytes)
        : Answer({source(bytes)}, {std::nullopt, Now, "en", false}) {}

    [[nodiscard]] const FeedIncidents& result() const { return _result; }
    [[nodiscard]] const LineIncidents& line(std::string_view route) const {
        for (const LineIncidents& line : _result.lines)
            if (line.muid == lineMuid(_feed, route))
                return line;
        throw std::out_of_range("no such line was asked for");
    }
    [[nodiscard]] const std::vector<std::shared_ptr<FeedTransitIncident>>&
    incidents(std::string_view route) const {
        return line(route).incidents;
    }
    [[nodiscard]] std::vector<std::string> titles(std::string_view route) const {
        std::vector<std::string> titles;
        for (const auto& incident : incidents(route))
            titles.push_back(incident->title().value_or("nil"));
        return titles;
    }
    /// The routes among the given ones that have an incident.
    [[nodiscard]] std::string disturbed(const std::vector<std::string>& routes = {
                                            "R1", "R2", "R3", "M1", "T1"}) const {
        std::string text;
        for (const std::string& route : routes)
            if (!incidents(route).empty())
                text += (text.empty() ? "" : " ") + route;
        return text;
    }

private:
    std::string _feed;
    FeedIncidents _result;
};

} // namespace orvo::testing
