#pragma once

#include "platform/geoservices/FeedTransitIncident.h"

#include <cstdint>
#include <memory>
#include <optional>
#include <string>

namespace orvo {

/// The line whose status could not be proven.
struct UnknownLine {
    std::string feed;       ///< its feed's short name
    std::uint64_t muid = 0; ///< the line's
    std::string systemName; ///< its agency's; may be empty
    std::string timeZone;   ///< an IANA name; may be empty
};

/// What is not known of a line, and why.
struct UnknownStatus {
    enum class Reason {
        SourceFailed,   ///< a source of alerts could not be read, or not recently enough
        SelectorLost,   ///< some alert may concern the line, but its selectors were unreadable
        LineDeparted,   ///< the line is no longer in the schedule, or its feed was removed
        ScheduleUnread, ///< the schedule could not be read
        NothingToAsk,   ///< the feed has no source of alerts
    };
    Reason reason = Reason::SourceFailed;
    /// When what is known was last got, in seconds since 1970; nothing when never.
    std::optional<double> lastKnown;
    std::string cause; ///< in words for a person, in any language: why it failed; may be empty
};

/// The incident that says that a line's status is unknown: with the system's name and the age of
/// what was last known, and without dates. Its number is the same at every lookup, and of this line
/// alone.
/// @param now seconds since 1970
/// @param language the person's, a BCP-47 tag
[[nodiscard]] std::shared_ptr<FeedTransitIncident> makeUnknownIncident(const UnknownLine& line,
                                                                       const UnknownStatus& status,
                                                                       double now,
                                                                       const std::string& language);

} // namespace orvo
