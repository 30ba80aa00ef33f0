#pragma once

#include <cstdint>
#include <string>
#include <string_view>

namespace orvo {

/// One row of agency.txt. Texts that the schedule does not give are empty.
struct ScheduleAgency {
    std::string id;
    std::string name;
    std::string url;
    std::string timezone; ///< an IANA name
    std::string language; ///< a BCP-47 tag

    friend bool operator==(const ScheduleAgency&, const ScheduleAgency&) = default;
};

/// One row of routes.txt with its agency, as the store keeps it. Texts that the schedule does not
/// give are empty; all are valid UTF-8 without control characters.
struct ScheduleLine {
    std::uint64_t muid = 0; ///< `lineMuid(feed, routeId)`
    std::string feed;       ///< the feed's short name
    std::string routeId;
    /// As routes.txt has it; where that is blank and the schedule has one agency, that agency's.
    std::string agencyId;
    std::string shortName;
    std::string longName;
    std::string color;     ///< `RRGGBB` in capitals, or empty
    std::string textColor; ///< likewise
    std::string url;
    int routeType = 3;      ///< as routes.txt has it, extended types included
    std::int64_t order = 0; ///< place in the schedule's order, from 0
    bool present = true;    ///< false: it left the schedule, or its feed was removed
    /// When a schedule that has it was last imported, in seconds since 1970; 0 where that is not
    /// known, as before an import.
    double knownAt = 0;
    ScheduleAgency agency;

    /// What a rider calls the line: the short name, else the long one, else the route's id.
    [[nodiscard]] const std::string& name() const noexcept;

    friend bool operator==(const ScheduleLine&, const ScheduleLine&) = default;
};

/// The number of a line: a hash of both texts, the same on every machine and after every import;
/// never 0.
[[nodiscard]] std::uint64_t lineMuid(std::string_view feed, std::string_view routeId) noexcept;

/// The basic type (0 tram, 1 metro, 2 rail, 3 bus, 4 ferry, 5 cable tram, 6 gondola, 7 funicular,
/// 11 trolleybus, 12 monorail) that a basic or extended type stands for. A number that means
/// nothing is answered as it is.
[[nodiscard]] int basicRouteType(int routeType) noexcept;

/// Whether a bus or trolleybus runs: 3, 11, 700 to 799, 800.
[[nodiscard]] bool isBusRouteType(int routeType) noexcept;

} // namespace orvo
