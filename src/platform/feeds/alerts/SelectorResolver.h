#pragma once

#include "platform/feeds/alerts/Alert.h"
#include "platform/feeds/alerts/AlertStatistics.h"
#include "platform/feeds/alerts/LineTable.h"
#include "platform/foundation/SeededStringHash.h"

#include <string_view>
#include <vector>

namespace orvo {

/// Finds the lines that selectors name. Inside one selector all fields must hold. It remembers the
/// stops that it asked the schedule about.
class SelectorResolver {
public:
    using Places = std::vector<LineTable::Place>;

    /// Both outlive the resolver.
    SelectorResolver(const LineTable& table, AlertStatistics& statistics)
        : _table(table)
        , _statistics(statistics) {}

    [[nodiscard]] const LineTable& table() const noexcept { return _table; }

    /// Appends the places of the lines that the selector names. When it names none, that is counted
    /// by reason.
    void resolve(const AlertSelector& selector, Places& lines);
    /// Whether some selector may name any line, for the schedule could not be asked about its stop.
    /// It is not asked again then.
    [[nodiscard]] bool hasLostStops() const noexcept { return _hasLostStops; }

    /// Whether the selector names stops or trips of a line, and not the whole of it. A direction
    /// narrows nothing.
    [[nodiscard]] static bool namesPart(const AlertSelector& selector) noexcept {
        return !selector.stopId.empty() || !selector.tripId.empty() || selector.namesDeparture;
    }
    /// The route that the selector names, or its trip; empty for none.
    [[nodiscard]] static std::string_view routeOf(const AlertSelector& selector) noexcept {
        return selector.routeId.empty() ? selector.tripRouteId : selector.routeId;
    }

private:
    [[nodiscard]] bool holds(const AlertSelector& selector, LineTable::Place line) const;
    void resolveRoute(const AlertSelector& selector, Places& lines);
    void resolveWithoutRoute(const AlertSelector& selector, Places& lines);
    void resolveList(const AlertSelector& selector, const Places& candidates, Places& lines);
    [[nodiscard]] Places placesOf(const std::vector<std::uint64_t>& muids) const;
    /// Nil when the schedule could not be asked.
    const Places* linesServing(std::string_view stopId);
    void countContradiction(const AlertSelector& selector);

    const LineTable& _table;
    AlertStatistics& _statistics;
    SeededTextMap<std::string_view, Places> _linesServing; // views into the messages
    bool _hasLostStops = false;
};

} // namespace orvo
