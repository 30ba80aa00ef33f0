#pragma once

#include "platform/feeds/alerts/IncidentBuilder.h"

#include <string>
#include <vector>

namespace orvo {

/// What a lookup found out about one feed, beside the incidents.
struct FeedStatistics {
    std::string feed; ///< the feed's short name
    bool hasSchedule = false;
    std::size_t lines = 0;                  ///< that were asked for and are in the schedule
    std::size_t linesWithIncidents = 0;     ///< of those, with an incident, current or coming
    std::size_t unknownLines = 0;           ///< of those, whose status could not be proven
    std::vector<AlertSourceReport> sources; ///< in the order of the feed's configuration
    AlertStatistics alerts;                 ///< of all sources and of the rules
    /// Not nil when no source could be read: names the feed and the cause.
    std::shared_ptr<NSError> error;

    /// A line for each fact, in a fixed order, for people.
    [[nodiscard]] std::string description() const;
};

} // namespace orvo
