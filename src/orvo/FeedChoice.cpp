#include "orvo/FeedChoice.h"

#include <algorithm>
#include <fmt/format.h>

namespace orvo {

FeedChoice FeedChoice::of(const std::vector<std::string>& names, CommandContext& context) {
    FeedChoice choice;
    const auto all = context.registry()->feeds(&choice.error);
    if (choice.error || names.empty()) {
        choice.feeds = all;
        return choice;
    }
    for (const auto& name : names) {
        const auto found = std::ranges::find(all, name, &FeedConfiguration::name);
        if (found == all.end()) {
            choice.feeds.clear();
            choice.error = NSError::errorWithMessage(
                FeedErrorDomain,
                static_cast<std::int64_t>(FeedErrorCode::UnknownFeed),
                fmt::format("there is no feed {}; see: orvo feeds list", name));
            return choice;
        }
        if (std::ranges::count(choice.feeds, name, &FeedConfiguration::name) == 0)
            choice.feeds.push_back(*found);
    }
    return choice;
}

} // namespace orvo
