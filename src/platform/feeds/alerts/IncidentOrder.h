#pragma once

#include "platform/geoservices/FeedTransitIncident.h"

namespace orvo {

/// Whether incident `a` of a line stands before incident `b` of it: by severity, worst first and
/// untold last; then effect, no service first; the whole line before part of it; the newest start,
/// an open one last; the number; the latest end, an open one first. A total order: two runs give
/// the same rows.
[[nodiscard]] bool standsBefore(const FeedTransitIncident& a, const FeedTransitIncident& b);

} // namespace orvo
