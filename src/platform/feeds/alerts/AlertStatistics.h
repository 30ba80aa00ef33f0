#pragma once

#include <array>
#include <cstddef>
#include <cstdint>
#include <map>
#include <string>
#include <string_view>

namespace orvo {

/// What is counted while a feed's alerts are read and judged.
enum class AlertCount : std::size_t {
    // What the messages hold.
    Entities,
    Alerts,
    OtherEntities,   ///< trip updates, vehicles and the like
    DeletedEntities, ///< marked so by the feed
    // What could not be read. Each cost only itself.
    UnreadableEntities,
    UnreadableSelectors, ///< these, and the next, leave lines without an incident unknown
    UnreadableAlerts,    ///< that break off: what stood before the break is used
    UnreadablePeriods,
    UnreadableTexts,
    UnreadableNumbers, ///< cause, effect or severity, unlisted numbers among them
    UnreadableIds,
    // Selectors that name no line of the schedule.
    EmptySelectors,
    UnknownAgencies,
    UnknownRoutes,
    UnknownRouteTypes,
    UnservedStops, ///< stops that the schedule does not have, or ties to no line
    UnaskedStops,  ///< the schedule could not be asked: lines without an incident are unknown
    TripsWithoutRoute,
    ContradictorySelectors, ///< whose fields hold for no line together
    // What became of the alerts.
    AlertsWithoutEffect, ///< no effect, or more service than usual
    AlertsOnlyAboutAccess,
    AlertsOnlyInformation,
    AlertsOutOfTime, ///< over, empty, or beginning more than a day ahead
    AlertsOfNoLine,
    RepeatedAlerts, ///< united with an earlier alert of the same content or under the same id
    Incidents,
    Count_, ///< how many there are
};

/// Counters by reason. A query for some lines reads the other alerts, and in those that it reads
/// the selectors of other lines, only as far as needed: its counters are those of what was read. A
/// query for all lines counts everything.
class AlertStatistics {
public:
    void add(AlertCount reason, std::uint64_t count = 1) noexcept {
        _counts[static_cast<std::size_t>(reason)] += count;
    }
    /// Remembers what an unresolved selector named: `agency_id Blue Line`. Of many different ones
    /// the first few are kept.
    void addUnresolved(AlertCount reason, std::string_view what);
    void add(const AlertStatistics& other);

    [[nodiscard]] std::uint64_t count(AlertCount reason) const noexcept {
        return _counts[static_cast<std::size_t>(reason)];
    }
    /// What unresolved selectors named, and how often.
    [[nodiscard]] const std::map<std::string, std::uint64_t>& unresolved() const noexcept {
        return _unresolved;
    }
    [[nodiscard]] std::uint64_t unresolvedSelectors() const noexcept;
    /// All that could not be read.
    [[nodiscard]] std::uint64_t unreadable() const noexcept;

    /// `alerts: 99`, a line for each reason that was counted, in a fixed order; then the unresolved
    /// selectors.
    [[nodiscard]] std::string description() const;
    /// The reason in words: `alerts that concern no line`.
    [[nodiscard]] static std::string_view nameOf(AlertCount reason) noexcept;

private:
    std::array<std::uint64_t, static_cast<std::size_t>(AlertCount::Count_)> _counts{};
    std::map<std::string, std::uint64_t> _unresolved;
};

} // namespace orvo
