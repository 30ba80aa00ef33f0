#pragma once

#include "orvo/CommandContext.h"
#include "orvo/IncidentReport.h"

#include <string>
#include <vector>

/// The lines of a report whose status is unknown, with why, and what a person can do.
namespace orvo::UnknownLines {

/// Lines of one feed that are unknown for one reason.
struct Group {
    std::string message; ///< which lines and why, without a full stop
    std::string cure;    ///< a sentence
};

/// In the order of the report.
/// @param feeds those that the person has
/// @param schedules tells whether a line is in its schedule; may be nil
[[nodiscard]] std::vector<Group> of(const IncidentReport& report,
                                    const std::vector<FeedConfiguration>& feeds,
                                    const ScheduleStore* schedules);

/// Warns of each on the terminal.
void warn(const IncidentReport& report, CommandContext& context);

} // namespace orvo::UnknownLines
