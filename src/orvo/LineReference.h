#pragma once

#include "platform/feeds/schedule/ScheduleStore.h"

#include <cstddef>
#include <optional>
#include <string>
#include <string_view>
#include <vector>

/// How a person names a line: `FEED:ROUTE_ID`, or a short or long name that only one line has.
namespace orvo::LineReference {

struct Answer {
    std::optional<ScheduleLine> line;
    std::string message; ///< why there is no line, without a full stop
    std::string cure;    ///< what to do, a sentence
};

[[nodiscard]] Answer resolve(const ScheduleStore& schedules, const std::string& text);

/// `Did you mean city:H1 (Old Harbour)?`; empty for no lines. What is of no feed has its name only.
[[nodiscard]] std::string didYouMean(const std::vector<ScheduleLine>& lines);
/// So many lines are named at most where one may have been meant.
inline constexpr std::size_t MostMeant = 3;

/// What to do where no feed has a schedule, a sentence.
inline constexpr const char* NoScheduleCure =
    "Add a feed with: orvo feeds add. For those that you have: orvo feeds update";

/// `FEED:ROUTE_ID` of a line.
[[nodiscard]] std::string nameOf(std::string_view feed, std::string_view routeId);

} // namespace orvo::LineReference
