#pragma once

#include <memory>
#include <optional>
#include <string>

namespace orvo {

class NSDate;

/// Periods of time in words, with the clock and calendar of a place and the number formats of the
/// person's language.
namespace PeriodText {

/// Seconds since 1970; nothing for nil.
[[nodiscard]] std::optional<double> secondsOf(const std::shared_ptr<NSDate>& date);

/// Seconds since 1970; a missing end is open. `now` decides between what has begun and what is
/// coming, and how much of a date need be said. `timeZone` is an IANA name; nothing, or one that
/// nobody knows, is the machine's own.
///
/// `until 16:45`, `from 18:00`, `18:00 – 20:30`, `since 9 Jun, 22:00`, `until further notice`.
[[nodiscard]] std::string period(std::optional<double> start,
                                 std::optional<double> end,
                                 double now,
                                 const std::optional<std::string>& timeZone);

/// When the words of a period next change while nothing but time goes by, in seconds since 1970 and
/// later than `now`: when it begins, and at midnight in the zone, which says anew how much of a
/// date need be said. Nothing for a period that is open on both sides.
[[nodiscard]] std::optional<double> nextChange(std::optional<double> start,
                                               std::optional<double> end,
                                               double now,
                                               const std::optional<std::string>& timeZone);

/// A moment as in the periods: `16:45` on the day of `now`, else `9 Jun, 16:45`, with the year
/// where it is another one.
[[nodiscard]] std::string
moment(double time, double now, const std::optional<std::string>& timeZone);

/// `5 minutes`, `3 hours`, `2 days`: the largest whole unit.
[[nodiscard]] std::string age(double seconds);

} // namespace PeriodText

} // namespace orvo
