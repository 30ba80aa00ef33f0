#include "orvo/FeedChoice.h"

#include "orvo/console/Arguments.h"

#include <algorithm>
#include <fmt/format.h>
#include <iterator>

namespace orvo {

namespace {

std::string noSuchFeed(const std::string& name, const std::vector<FeedConfiguration>& all) {
    std::vector<std::string> names;
    std::ranges::transform(all, std::back_inserter(names), &FeedConfiguration::name);
    if (const auto meant = nearest(name, names))
        return fmt::format("there is no feed {}; did you mean {}?", name, *meant);
    return fmt::format("there is no feed {}; see: orvo feeds list", name);
}

} // namespace

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
            choice.error =
                NSError::errorWithMessage(FeedErrorDomain,
                                          static_cast<std::int64_t>(FeedErrorCode::UnknownFeed),
                                          noSuchFeed(name, all));
            return choice;
        }
        if (std::ranges::count(choice.feeds, name, &FeedConfiguration::name) == 0)
            choice.feeds.push_back(*found);
    }
    return choice;
}

} // namespace orvo
