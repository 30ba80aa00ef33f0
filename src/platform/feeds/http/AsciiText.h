#pragma once

#include <algorithm>
#include <string>
#include <string_view>

namespace orvo {

/// What protocols compare without regard to case: letters A to Z only, whatever the locale.
[[nodiscard]] constexpr char asciiLowercased(char c) noexcept {
    return c >= 'A' && c <= 'Z' ? static_cast<char>(c - 'A' + 'a') : c;
}

[[nodiscard]] inline std::string asciiLowercased(std::string_view text) {
    std::string result(text);
    std::ranges::transform(result, result.begin(), [](char c) { return asciiLowercased(c); });
    return result;
}

[[nodiscard]] inline bool beginsIgnoringCase(std::string_view text, std::string_view beginning) {
    return asciiLowercased(text.substr(0, beginning.size())) == asciiLowercased(beginning);
}

} // namespace orvo
