#pragma once

#include <optional>
#include <string>
#include <string_view>

/// What values of schedule files are made into.
namespace orvo::ScheduleText {

/// Without blanks and line breaks at its ends.
[[nodiscard]] std::string_view trimmed(std::string_view text) noexcept;

/// A to Z in small letters, all else as it is.
[[nodiscard]] std::string asciiLowercase(std::string_view text);

/// A name as a person may be shown it: line breaks, tabs and rows of blanks are one blank, control
/// characters and those that change the direction of writing are left out, and it ends after 500
/// characters. Bytes that are not UTF-8 become U+FFFD.
[[nodiscard]] std::string cleanName(std::string_view text);

/// A web address, or empty for anything but `http:` and `https:`.
[[nodiscard]] std::string webAddress(std::string_view text);

/// `RRGGBB` in capitals from six hexadecimal digits, a `#` before them passed over; empty for
/// anything else.
[[nodiscard]] std::string color(std::string_view text);

/// `2024-07-09` from `20240709`; empty for anything that is no day of the calendar.
[[nodiscard]] std::string date(std::string_view text);

/// A whole number from 0 to 999,999; nothing for anything else.
[[nodiscard]] std::optional<int> smallNumber(std::string_view text) noexcept;

} // namespace orvo::ScheduleText
