#pragma once

#include "platform/feeds/alerts/Alert.h"

#include <cstdint>
#include <optional>
#include <vector>

namespace orvo {

/// From start to end, both included, in whole seconds since 1970; a missing side is open.
struct IncidentPeriod {
    std::optional<std::int64_t> start;
    std::optional<std::int64_t> end;

    friend bool operator==(const IncidentPeriod&, const IncidentPeriod&) = default;
};

/// When an incident holds, from what feeds publish.
namespace IncidentPeriods {

/// In whole seconds; a start or end of 0, and an end after the year 9999, are open. Nothing for a
/// period that is empty or never begins.
[[nodiscard]] std::optional<IncidentPeriod> fromPublished(const AlertPeriod& period) noexcept;

/// Appends the periods that count of one alert: of its impact, else of its communication, else the
/// active ones. The last are ignored where one of the others is there. An alert without any holds
/// as long as it is in the feed: one period, open on both sides. Nothing when all are empty.
void addOfAlert(const Alert& alert, std::vector<IncidentPeriod>& periods);

/// The earliest start that the alert tells, of its communication too; nothing when it tells none.
[[nodiscard]] std::optional<std::int64_t> earliestStart(const Alert& alert) noexcept;

/// Makes of the periods of united alerts what they come to: those that are over at `now` dropped,
/// the rest sorted and joined where they overlap, touch or lie less than a minute apart, so that no
/// two are current together; of these, those that are current or begin within a day. A period that
/// ends exactly now is still current.
/// @param now seconds since 1970
void keepCurrentAndComing(std::vector<IncidentPeriod>& periods, double now);

[[nodiscard]] bool isCurrent(const IncidentPeriod& period, double now) noexcept;

} // namespace IncidentPeriods

} // namespace orvo
