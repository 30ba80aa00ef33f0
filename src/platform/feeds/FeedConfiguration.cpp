#include "platform/feeds/FeedConfiguration.h"

#include <algorithm>
#include <fmt/format.h>

namespace orvo {

namespace {

bool isLetterOrDigit(char c) {
    return (c >= 'a' && c <= 'z') || (c >= 'A' && c <= 'Z') || (c >= '0' && c <= '9');
}

std::shared_ptr<NSError> invalidSource(const char* what, const NSError& problem) {
    return NSError::errorWithMessage(FeedErrorDomain,
                                     static_cast<std::int64_t>(FeedErrorCode::InvalidSource),
                                     fmt::format("{}: {}", what, problem.localizedDescription()));
}

} // namespace

bool isFeedName(std::string_view text) {
    return !text.empty() && text.size() <= FeedConfiguration::LongestName &&
           isLetterOrDigit(text.front()) && std::ranges::all_of(text, [](char c) {
               return isLetterOrDigit(c) || c == '-' || c == '_' || c == '.';
           });
}

std::shared_ptr<NSError> FeedConfiguration::problem() const {
    if (!isFeedName(name))
        return NSError::errorWithMessage(
            FeedErrorDomain,
            static_cast<std::int64_t>(FeedErrorCode::InvalidName),
            fmt::format("\"{}\" cannot name a feed: use 1 to {} letters A to Z, digits, \"-\", "
                        "\"_\" and \".\", and begin with a letter or digit",
                        name,
                        LongestName));
    if (const auto found = schedule.problem())
        return invalidSource("schedule", *found);
    for (const auto& source : alerts)
        if (const auto found = source.problem())
            return invalidSource("alerts", *found);
    return nullptr;
}

} // namespace orvo
