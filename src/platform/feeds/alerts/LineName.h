#pragma once

#include "platform/feeds/schedule/ScheduleLine.h"

#include <cstddef>
#include <string_view>

namespace orvo {

/// Whether a text of so many bytes is too long to say nothing but the name of a line whose two
/// names have `nameLength` bytes together.
[[nodiscard]] constexpr bool isLongerThanName(std::size_t length, std::size_t nameLength) noexcept {
    constexpr std::size_t Punctuation = 16;
    return length > nameLength + Punctuation;
}

/// Whether the text says nothing but the name of the line: its short or its long name, or both,
/// whatever the case of ASCII letters, blanks and punctuation. False for a blank text.
[[nodiscard]] bool isOnlyNameOfLine(std::string_view text, const ScheduleLine& line);

} // namespace orvo
