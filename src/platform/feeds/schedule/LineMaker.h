#pragma once

#include "platform/feeds/schedule/ScheduleLine.h"
#include "platform/geoservices/FeedTransitLine.h"

#include <memory>

namespace orvo {

/// The line as the rest of the program knows it: names, system, and artwork made from the
/// schedule's colours. Equal lines of one agency have equal system artworks.
[[nodiscard]] std::shared_ptr<FeedTransitLine> makeTransitLine(const ScheduleLine& line);

} // namespace orvo
