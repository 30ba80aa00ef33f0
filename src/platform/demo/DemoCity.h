#pragma once

#include <string>
#include <vector>

/// A city that does not exist, for people who have no feeds yet: what stays the same whenever it is
/// written.
namespace orvo::DemoCity {

/// The short name of its feed.
inline constexpr const char* FeedName = "city";

struct Agency {
    std::string id;
    std::string name;
    std::string url;
};

/// A stop with its place on the map, in degrees.
struct Stop {
    std::string id;
    std::string name;
    double latitude = 0;
    double longitude = 0;
};

struct Line {
    std::string routeId;
    std::string agencyId;
    std::string shortName; ///< may be empty
    std::string longName;
    std::string germanLongName;
    int routeType = 3;
    std::string color;     ///< `RRGGBB`, or empty
    std::string textColor; ///< `RRGGBB`, or empty
    std::vector<std::string> stopIds;
};

[[nodiscard]] const std::vector<Agency>& agencies();
[[nodiscard]] const std::vector<Stop>& stops();
[[nodiscard]] const std::vector<Line>& lines();
/// Routes of the lines that the visitor rides, in their order.
[[nodiscard]] const std::vector<std::string>& favoriteRouteIds();
/// The stop that the visitor lives at.
[[nodiscard]] const Stop& favoritePlace();

} // namespace orvo::DemoCity
