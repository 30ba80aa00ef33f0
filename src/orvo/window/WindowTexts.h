#pragma once

#include <cstddef>
#include <cstdint>
#include <optional>
#include <string>
#include <vector>

/// The words of the windows in the person's language, from the table `Windows` of the program's
/// resources. Any thread.
namespace orvo::WindowTexts {

/// The text of a key; the key itself where it is missing.
[[nodiscard]] std::string text(const std::string& key);
/// The text of a key with a name set in.
[[nodiscard]] std::string text(const std::string& key, const std::string& name);

/// `3 incidents`.
[[nodiscard]] std::string incidents(std::size_t count);
/// `and 2 more`, after lines that are named.
[[nodiscard]] std::string moreLines(std::size_t count);

/// Seconds since 1970; a missing end is open. As `PeriodText::period`, with the clock of the zone
/// (an IANA name; nothing, or an unknown one, is the machine's own): `Since 10:40 PM, until
/// 1:00 AM`.
[[nodiscard]] std::string period(std::optional<double> start,
                                 std::optional<double> end,
                                 double now,
                                 const std::optional<std::string>& timeZone);

} // namespace orvo::WindowTexts
