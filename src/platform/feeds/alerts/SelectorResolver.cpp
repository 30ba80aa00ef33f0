#include "platform/feeds/alerts/SelectorResolver.h"

#include "platform/feeds/alerts/ByteScan.h"

#include <string>

namespace orvo {

namespace {

std::string named(const char* field, std::string_view value) {
    constexpr std::size_t Longest = 80;
    return std::string(field) + ' ' + std::string(value.substr(0, Longest));
}

std::string_view trimmed(std::string_view id) {
    while (!id.empty() && id.front() == ' ')
        id.remove_prefix(1);
    while (!id.empty() && id.back() == ' ')
        id.remove_suffix(1);
    return id;
}

} // namespace

void SelectorResolver::resolve(const AlertSelector& selector, Places& lines) {
    if (!routeOf(selector).empty())
        return resolveRoute(selector, lines);
    if (!selector.tripId.empty() || selector.namesDeparture)
        return _statistics.addUnresolved(AlertCount::TripsWithoutRoute,
                                         named("trip_id", selector.tripId));
    resolveWithoutRoute(selector, lines);
}

void SelectorResolver::resolveRoute(const AlertSelector& selector, Places& lines) {
    if (!selector.routeId.empty() && !selector.tripRouteId.empty() &&
        selector.routeId != selector.tripRouteId)
        return countContradiction(selector);
    const LineTable::Place line = _table.placeOfRoute(routeOf(selector));
    if (line == LineTable::None)
        return _statistics.addUnresolved(AlertCount::UnknownRoutes,
                                         named("route_id", routeOf(selector)));
    if (holds(selector, line))
        lines.push_back(line);
    else
        countContradiction(selector);
}

void SelectorResolver::resolveWithoutRoute(const AlertSelector& selector, Places& lines) {
    const LineIndex& index = _table.index();
    if (!selector.stopId.empty()) {
        const Places* const serving = linesServing(selector.stopId);
        if (!serving)
            return _statistics.addUnresolved(AlertCount::UnaskedStops,
                                             named("stop_id", selector.stopId));
        if (serving->empty())
            return _statistics.addUnresolved(AlertCount::UnservedStops,
                                             named("stop_id", selector.stopId));
        return resolveList(selector, *serving, lines);
    }
    if (!selector.agencyId.empty()) {
        const Places ofAgency = placesOf(index.linesOfAgency(selector.agencyId));
        if (ofAgency.empty())
            return _statistics.addUnresolved(AlertCount::UnknownAgencies,
                                             named("agency_id", selector.agencyId));
        return resolveList(selector, ofAgency, lines);
    }
    if (!selector.routeType)
        return _statistics.add(AlertCount::EmptySelectors);
    const Places ofType = placesOf(index.linesOfType(*selector.routeType));
    if (ofType.empty())
        return _statistics.addUnresolved(AlertCount::UnknownRouteTypes,
                                         named("route_type", std::to_string(*selector.routeType)));
    lines.insert(lines.end(), ofType.begin(), ofType.end());
}

void SelectorResolver::resolveList(const AlertSelector& selector,
                                   const Places& candidates,
                                   Places& lines) {
    const std::size_t before = lines.size();
    for (const LineTable::Place line : candidates)
        if (holds(selector, line))
            lines.push_back(line);
    if (lines.size() == before)
        countContradiction(selector);
}

bool SelectorResolver::holds(const AlertSelector& selector, LineTable::Place line) const {
    const LineTable::Entry& entry = _table.at(line);
    // A schedule of one agency may leave its id out: what it does not say contradicts nothing.
    if (!selector.agencyId.empty() && !entry.agencyId.empty() &&
        !ByteScan::isEqual(entry.agencyId, selector.agencyId) &&
        entry.agencyId != trimmed(selector.agencyId))
        return false;
    return !selector.routeType || *selector.routeType == entry.basicType ||
           basicRouteType(*selector.routeType) == entry.basicType;
}

SelectorResolver::Places SelectorResolver::placesOf(const std::vector<std::uint64_t>& muids) const {
    Places lines;
    lines.reserve(muids.size());
    for (const std::uint64_t muid : muids)
        if (const LineTable::Place line = _table.placeOf(muid); line != LineTable::None)
            lines.push_back(line);
    return lines;
}

const SelectorResolver::Places* SelectorResolver::linesServing(std::string_view stopId) {
    const auto found = _linesServing.find(stopId);
    if (found != _linesServing.end())
        return &found->second;
    const auto serving = _hasLostStops ? std::nullopt : _table.index().linesServingStop(stopId);
    _hasLostStops = !serving;
    return serving ? &_linesServing.emplace(stopId, placesOf(*serving)).first->second : nullptr;
}

void SelectorResolver::countContradiction(const AlertSelector& selector) {
    std::string what = "contradictory:";
    const auto add = [&](const char* field, std::string_view value) {
        if (!value.empty())
            what += ' ' + named(field, value);
    };
    add("agency_id", selector.agencyId);
    add("route_id", selector.routeId);
    if (selector.routeType)
        add("route_type", std::to_string(*selector.routeType));
    add("trip route_id", selector.tripRouteId);
    add("stop_id", selector.stopId);
    _statistics.addUnresolved(AlertCount::ContradictorySelectors, what);
}

} // namespace orvo
