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
    const FeedTransitIncident::Occurrence& occurrence = incident.occurrence();
    return std::tuple(-static_cast<std::int32_t>(incident.severity()),
                      static_cast<std::int32_t>(incident.effect()),
                      occurrence.isPartOfLine,
                      -secondsOf(occurrence.startDate.get(), -Infinity),
                      incident.muid(),
                      -secondsOf(occurrence.endDate.get(), Infinity));
}

} // namespace

bool standsBefore(const FeedTransitIncident& a, const FeedTransitIncident& b) {
    return sortKey(a) < sortKey(b);
}

} // namespace orvo
