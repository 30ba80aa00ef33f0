#pragma once

#include "platform/feeds/http/SourceRequest.h"
#include "platform/foundation/NSError.h"

#include <memory>
#include <optional>
#include <string>
#include <string_view>
#include <vector>

namespace orvo {

inline constexpr const char* FeedErrorDomain = "OrvoFeedErrorDomain";
enum class FeedErrorCode : std::int64_t {
    InvalidName = 1,
    InvalidSource = 2, ///< a location, header or user that cannot be asked for
    NameTaken = 3,
    UnknownFeed = 4,
    Damaged = 5 ///< a file of the registry holds something else
};

/// One static schedule with its alert sources, under a short name that the person chose. A value.
struct FeedConfiguration {
    static constexpr std::size_t LongestName = 64;

    std::string name;
    SourceRequest schedule;            ///< a zip file, or a folder
    std::vector<SourceRequest> alerts; ///< in the order given; may be empty
    /// When a newer schedule was last asked for, in seconds since 1970 by the environment's wall
    /// clock; nothing before the first time.
    std::optional<double> lastScheduleCheck;

    /// Nil when it can be registered; else what is wrong with the name or a source.
    [[nodiscard]] std::shared_ptr<NSError> problem() const;

    friend bool operator==(const FeedConfiguration&, const FeedConfiguration&) = default;
};

/// Whether a text can name a feed: 1 to `LongestName` letters A to Z of either case, digits, `-`,
/// `_` and `.`, the first of them a letter or digit.
[[nodiscard]] bool isFeedName(std::string_view text);

} // namespace orvo
