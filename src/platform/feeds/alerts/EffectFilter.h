#pragma once

#include "platform/feeds/alerts/AlertStatistics.h"

#include <cstdint>
#include <optional>

namespace orvo {

/// Which alerts are incidents. Not: those without an effect, or with more service than usual; those
/// about lifts, ramps and the like, unless the person asked for step-free travel; and
/// unspecified ones that the feed itself calls information. Without this, notices about bicycle
/// parking and lifts would keep nearly every line of a big city disturbed.
/// @param effect a number of `IncidentEffect`
/// @param severity a number of `IncidentSeverity`
/// @return nothing for an incident, else why it is none
[[nodiscard]] std::optional<AlertCount>
reasonAgainstIncident(std::int32_t effect, std::int32_t severity, bool stepFree) noexcept;

} // namespace orvo
