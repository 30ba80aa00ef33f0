#pragma once

#include <cstdint>
#include <span>
#include <string>
#include <string_view>
#include <vector>

namespace orvo {

/// What tells one incident from another, whatever its identifier: its effect and, in one language,
/// its texts, normalised. An empty text is a missing one. Views texts that outlive it.
struct IncidentContent {
    std::string_view header;
    std::string_view description;
    std::int32_t effect = 0;

    friend bool operator==(const IncidentContent&, const IncidentContent&) = default;

    /// A number for each content, the same at every fetch: a `stableHash` of the feed's short name
    /// and the content.
    [[nodiscard]] static std::vector<std::uint64_t>
    numbersOf(std::span<const IncidentContent> contents, std::string_view feed);

    /// A text as it is compared: clean, on one line, with plain blanks only. Views `text` where it
    /// is so, and leaves `room` as it was; else views `room`, which is written.
    [[nodiscard]] static std::string_view normalised(std::string_view text, std::string& room);
};

} // namespace orvo
