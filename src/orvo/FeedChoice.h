#pragma once

#include "orvo/CommandContext.h"
#include "platform/feeds/FeedConfiguration.h"

#include <string>
#include <vector>

namespace orvo {

/// The feeds that a command is about.
struct FeedChoice {
    std::vector<FeedConfiguration> feeds;
    std::shared_ptr<NSError> error; ///< why they cannot be known; nil when they are

    /// The feeds of these names in the order given, each once; without names all.
    [[nodiscard]] static FeedChoice of(const std::vector<std::string>& names,
                                       CommandContext& context);
};

} // namespace orvo
