#pragma once

#include "platform/feeds/alerts/AlertStatistics.h"
#include "platform/feeds/alerts/SourceProof.h"
#include "platform/feeds/alerts/UnknownIncident.h"
#include "platform/feeds/schedule/LineIndex.h"
#include "platform/foundation/NSError.h"
#include "platform/geoservices/FeedTransitIncident.h"

#include <cstdint>
#include <memory>
#include <optional>
#include <string>
#include <vector>

namespace orvo {

class LineTable;

/// What is asked of a feed.
struct IncidentQuery {
    /// The lines, by muid; nothing for all lines of the schedule in its order.
    std::optional<std::vector<std::uint64_t>> lines;
    double now = 0;        ///< seconds since 1970
    std::string language;  ///< the person's, a BCP-47 tag
    bool stepFree = false; ///< whether the person asked for step-free travel
};

/// What is known of one line.
struct LineIncidents {
    std::uint64_t muid = 0; ///< the line's
    /// The most important first; current ones and those that begin within a day. One incident with
    /// several periods stands here once for each, under one muid.
    std::vector<std::shared_ptr<FeedTransitIncident>> incidents;
    /// Whether the line's status could not be proven. Then an incident that says so is the first,
    /// and beside it stand at most coming ones from the sources that could be read.
    bool isUnknown = false;
};

/// What became of one source.
struct AlertSourceReport {
    std::shared_ptr<NSError> error; ///< why the source proves nothing; nil when it was read
    double fetchedAt = 0;           ///< as given, in seconds since 1970
    /// The message's own time, in seconds since 1970; nothing when it could not be read.
    std::optional<double> headerTime;
    AlertStatistics statistics; ///< of what this source's message holds
};

/// The answer of one feed.
struct FeedIncidents {
    std::vector<LineIncidents> lines;       ///< in the order asked
    std::vector<AlertSourceReport> sources; ///< in the order given
    AlertStatistics statistics;             ///< of all sources and of the rules
    /// Not nil when no source could be read: names the feed and the cause. A message that is old by
    /// its own time was read: it makes lines unknown.
    std::shared_ptr<NSError> error;
};

/// Makes the incidents of a feed's lines from the messages of its sources. Nothing is kept between
/// calls; equal arguments give equal answers. Any thread.
///
/// What a source proves is `SourceProof`'s. A line is unknown unless all sources prove something
/// and all selectors could be read and resolved, or unless it has a current incident; so is a line
/// that the schedule does not have.
class IncidentBuilder {
public:
    /// Takes time in proportion to the lines of the schedule: a builder that is kept with its index
    /// answers sooner.
    explicit IncidentBuilder(std::shared_ptr<const LineIndex> index);

    [[nodiscard]] FeedIncidents build(const std::vector<AlertSource>& sources,
                                      const IncidentQuery& query) const;

private:
    std::shared_ptr<const LineTable> _table; // of the index
};

} // namespace orvo
