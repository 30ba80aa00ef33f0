#pragma once

#include "platform/feeds/alerts/ConcernedLines.h"
#include "platform/feeds/alerts/Incident.h"
#include "platform/feeds/alerts/IncidentDates.h"
#include "platform/feeds/alerts/IncidentPeriods.h"
#include "platform/feeds/alerts/IncidentWording.h"
#include "platform/foundation/NSDate.h"
#include "platform/geoservices/FeedTransitIncident.h"

#include <memory>
#include <string>
#include <vector>

namespace orvo {

/// What all records of one feed have in common.
struct RecordContext {
    std::string feed;     ///< the feed's short name
    std::string timeZone; ///< where an agency has none of its own; may be empty
    std::vector<std::shared_ptr<NSDate>> headerDates; ///< of each source: when it was made
    IncidentWording wording;
    std::shared_ptr<const LineTable> table;
    IncidentDates dates;
};

/// Makes the records of incidents, one incident after the other. What the records of one share is
/// made once, with the first of them.
class IncidentRecords {
public:
    /// The context outlives the object.
    explicit IncidentRecords(RecordContext& context)
        : _context(context) {}

    /// Incident and lines outlive the making of its records.
    void begin(const Incident& incident, const ConcernedLines& lines);
    /// How many different records of the incident were made.
    [[nodiscard]] std::size_t count() const noexcept { return _made.size(); }

    /// The incident as it concerns one of its lines, in one period. Lines that it concerns alike
    /// have the same record.
    [[nodiscard]] std::shared_ptr<FeedTransitIncident> record(const ConcernedLines::Line& line,
                                                              const IncidentPeriod& period);

private:
    [[nodiscard]] const std::string& timeZoneOf(const ConcernedLines::Line& line) const;
    [[nodiscard]] std::shared_ptr<FeedTransitIncident> made(const ConcernedLines::Line& line,
                                                            const IncidentPeriod& period) const;
    [[nodiscard]] std::shared_ptr<NSDate> latestHeaderDate() const;
    [[nodiscard]] FeedTransitIncident::Common makeCommon() const;
    [[nodiscard]] std::shared_ptr<NSDate> dateOf(const std::optional<std::int64_t>& seconds) const;
    [[nodiscard]] FeedTransitIncident::Occurrence occurrence(const ConcernedLines::Line& line,
                                                             const IncidentPeriod& period) const;

    RecordContext& _context;
    const Incident* _incident = nullptr;
    const ConcernedLines* _lines = nullptr;
    std::shared_ptr<const FeedTransitIncident::Common> _common;

    /// A record and what it was made for.
    struct Made {
        IncidentPeriod period;
        std::shared_ptr<FeedTransitIncident> record;
    };
    std::vector<Made> _made;
};

} // namespace orvo
