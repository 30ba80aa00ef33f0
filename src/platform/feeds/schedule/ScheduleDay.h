#pragma once

#include <optional>
#include <string_view>

namespace orvo {

/// When the day `2024-08-24` ends in the zone (an IANA name), in seconds since 1970. An unknown
/// zone counts as UTC; nothing for an empty date.
[[nodiscard]] std::optional<double> endOfDay(std::string_view date, std::string_view timezone);

} // namespace orvo
