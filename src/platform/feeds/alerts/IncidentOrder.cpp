#include "platform/feeds/alerts/IncidentOrder.h"

#include <limits>
#include <tuple>

namespace orvo {

namespace {

/// Seconds since the reference date, or the given number where the date is missing.
double secondsOf(const NSDate* date, double ifMissing) {
    return date ? date->timeIntervalSinceReferenceDate() : ifMissing;
}

auto sortKey(const FeedTransitIncident& incident) {
    constexpr double Infinity = std::numeric_limits<double>::infinity();
    const FeedTransitIncident::Details& details = incident.details();
    return std::tuple(-static_cast<std::int32_t>(details.severity),
                      static_cast<std::int32_t>(details.effect),
                      details.isPartOfLine,
                      -secondsOf(incident.fields().startDate.get(), -Infinity),
                      incident.fields().muid,
                      -secondsOf(incident.fields().endDate.get(), Infinity));
}

} // namespace

bool standsBefore(const FeedTransitIncident& a, const FeedTransitIncident& b) {
    return sortKey(a) < sortKey(b);
}

} // namespace orvo
