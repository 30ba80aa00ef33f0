#pragma once

#include <optional>
#include <string_view>

namespace orvo {

/// Seconds since 1970 of `Sun, 06 Nov 1994 08:49:37 GMT`, `Sunday, 06-Nov-94 08:49:37 GMT` or
/// `Sun Nov  6 08:49:37 1994`: what servers write in Date and Retry-After. Two digits of a year are
/// 1970 to 2069. The day of the week is not checked. Nothing for anything else.
[[nodiscard]] std::optional<double> parseHttpDate(std::string_view text);

} // namespace orvo
