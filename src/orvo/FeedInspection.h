#pragma once

#include "orvo/CommandContext.h"
#include "platform/feeds/FeedLookup.h"

#include <vector>

/// A lookup of everything that feeds hold, for what it tells about the feeds.
namespace orvo::FeedInspection {

/// Asks the feeds' sources now and waits. The schedules are the context's.
[[nodiscard]] FeedLookup::Answer of(const std::vector<FeedConfiguration>& feeds,
                                    CommandContext& context);

} // namespace orvo::FeedInspection
