#include "platform/feeds/schedule/ScheduleLine.h"

#include "platform/foundation/Hashing.h"

namespace orvo {

const std::string& ScheduleLine::name() const noexcept {
    if (!shortName.empty())
        return shortName;
    return longName.empty() ? routeId : longName;
}

std::uint64_t lineMuid(std::string_view feed, std::string_view routeId) noexcept {
    // The zero byte, which neither text holds, keeps "a" + "bc" apart from "ab" + "c".
    constexpr std::string_view separator("\0", 1);
    const std::uint64_t hash = stableHash(routeId, stableHash(separator, stableHash(feed)));
    return hash == 0 ? 1 : hash;
}

int basicRouteType(int routeType) noexcept {
    constexpr int tram = 0;
    constexpr int metro = 1;
    constexpr int rail = 2;
    constexpr int bus = 3;
    constexpr int ferry = 4;
    constexpr int gondola = 6;
    constexpr int funicular = 7;
    constexpr int trolleybus = 11;
    constexpr int monorail = 12;
    if (routeType == 405)
        return monorail;
    if (routeType == 800)
        return trolleybus;
    switch (routeType / 100) {
    case 1: // rail, with 100 to 117
    case 3: // suburban rail
        return rail;
    case 2: // coaches
    case 7: // buses
        return bus;
    case 4: // urban rail
    case 5: // metro
    case 6: // underground
        return metro;
    case 9:
        return tram;
    case 10: // ships
    case 12: // ferries
        return ferry;
    case 13: // aerial lifts
        return gondola;
    case 14:
        return funicular;
    default:
        return routeType;
    }
}

bool isBusRouteType(int routeType) noexcept {
    return routeType == 3 || routeType == 11 || (routeType >= 700 && routeType <= 799) ||
           routeType == 800;
}

} // namespace orvo
