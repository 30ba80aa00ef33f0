#pragma once

#include <optional>
#include <string>
#include <string_view>

namespace orvo::ISO8601 {

/// `2024-07-24T01:28:40Z` for seconds since 1970, UTC, fractions cut towards the past. Moments
/// outside the years 0 to 9999 are given as the bare number of seconds.
[[nodiscard]] std::string string(double secondsSince1970);

/// Seconds since 1970 of `2024-07-24T01:28:40Z`; also with a fraction, a blank for the T, an offset
/// such as `+02:00` or
/// `+0200`, without seconds, without a zone (read as UTC), or the date alone (midnight UTC).
/// Nothing for anything else, impossible calendar dates included.
[[nodiscard]] std::optional<double> parse(std::string_view text);

} // namespace orvo::ISO8601
