#pragma once

#include <cstdint>
#include <span>
#include <string>
#include <string_view>
#include <vector>

namespace orvo {

/// What tells one incident from another, whatever its identifier: its effect and, in one language,
/// its texts. Views into the messages; an empty text is a missing one.
struct IncidentContent {
    std::string_view header;
    std::string_view description;
    std::int32_t effect = 0;

    /// Whether both are the same but for markup and blanks.
    [[nodiscard]] bool isSameAs(const IncidentContent& other) const;
    /// A number for each content, the same at every fetch: a `stableHash` of the feed's short name
    /// and the content. Contents that are the same have the same one, whatever their markup.
    [[nodiscard]] static std::vector<std::uint64_t>
    numbersOf(std::span<const IncidentContent> contents, std::string_view feed);

    /// A text as it is compared: clean, on one line, with plain blanks only. Views `text`, or
    /// `room`, which may be written.
    [[nodiscard]] static std::string_view normalised(std::string_view text, std::string& room);
};

} // namespace orvo
