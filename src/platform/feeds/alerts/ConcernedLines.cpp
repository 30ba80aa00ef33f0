#include "platform/feeds/alerts/ConcernedLines.h"

#include "platform/feeds/alerts/EntityReader.h"

#include <algorithm>

namespace orvo {

namespace {

/// Whether the selector leaves the route to the schedule.
bool isBroad(const AlertSelector& selector) {
    return SelectorResolver::routeOf(selector).empty();
}

} // namespace

void ConcernedLines::find(const Incident& incident) {
    const auto isWhole = [](const IncidentMember& member) {
        return !member.alert->hasUnreadSelectors;
    };
    _areAll = std::ranges::all_of(incident.members, isWhole);
    const auto hasOthers = [](const IncidentMember& member) {
        const Alert& alert = *member.alert;
        const bool isScattered = alert.selectorFields.empty() && !alert.selectors.empty();
        return isScattered || std::ranges::any_of(alert.selectors, isBroad);
    };
    if (!_areAll && std::ranges::any_of(incident.members, hasOthers))
        return findAll(incident);
    collect(incident);
}

void ConcernedLines::findAll(const Incident& incident) {
    _areAll = true;
    collect(incident);
}

void ConcernedLines::collect(const Incident& incident) {
    _lines.clear();
    _stops.clear();
    _members.clear();
    _mentions.clear();
    for (std::size_t member = 0; member < incident.members.size(); ++member)
        addMentions(selectorsOf(*incident.members[member].alert), member);
    const auto isBefore = [](const Mention& a, const Mention& b) {
        return a.place != b.place ? a.place < b.place : a < b;
    };
    if (!std::is_sorted(_mentions.begin(), _mentions.end(), isBefore))
        std::sort(_mentions.begin(), _mentions.end(), isBefore);
    for (const Mention& mention : _mentions)
        takeMention(mention);
    finishLine();
}

/// Those that were read, or all.
std::span<const AlertSelector> ConcernedLines::selectorsOf(const Alert& alert) {
    if (!_areAll || !alert.hasUnreadSelectors)
        return alert.selectors;
    _reread.clear();
    EntityReader::readSelectors(alert.selectorFields, _reread);
    return _reread;
}

/// A selector without a route may name every line of an agency: said twice by one alert it is taken
/// once. One with a trip names none, and is no reason to pass over another with the same stop.
void ConcernedLines::addMentions(std::span<const AlertSelector> selectors, std::size_t member) {
    _broad.clear();
    for (const AlertSelector& selector : selectors) {
        const bool isPart = SelectorResolver::namesPart(selector);
        const bool namesTrip = !selector.tripId.empty() || selector.namesDeparture;
        if (isBroad(selector) && !namesTrip &&
            !_broad.emplace(selector.agencyId, selector.stopId, selector.routeType).second)
            continue;
        _named.clear();
        if (!isBroad(selector) || _broadLeft > 0)
            _resolver.resolve(selector, _named);
        if (isBroad(selector) && !takeBroad())
            continue;
        for (const LineTable::Place place : _named)
            _mentions.push_back({place, isPart, member, selector.stopId});
    }
}

/// Whether there is room for the lines that a selector without a route named. Once there is none,
/// the schedule is not asked for more.
bool ConcernedLines::takeBroad() {
    if (_broadLeft > 0 && _named.size() <= _broadLeft) {
        _broadLeft -= _named.size();
        return true;
    }
    _broadLeft = 0;
    ++_lostSelectors;
    return false;
}

void ConcernedLines::takeMention(const Mention& mention) {
    if (_lines.empty() || _lines.back().place != mention.place) {
        finishLine();
        Line& line = _lines.emplace_back();
        line.place = mention.place;
        line.entry = &_resolver.table().at(mention.place);
        line.line = line.entry->line;
        line.firstStop = _stops.size();
        line.firstMember = _members.size();
    }
    Line& line = _lines.back();
    line.isPart = line.isPart && mention.isPart;
    if (_members.size() == line.firstMember || _members.back() != mention.member)
        _members.push_back(mention.member);
    if (!mention.stop.empty() && (_stops.size() == line.firstStop || _stops.back() != mention.stop))
        _stops.push_back(mention.stop);
}

void ConcernedLines::finishLine() {
    if (_lines.empty())
        return;
    Line& line = _lines.back();
    if (_members.size() - line.firstMember > 1) { // mostly it is one
        const auto members = _members.begin() + static_cast<std::ptrdiff_t>(line.firstMember);
        std::sort(members, _members.end());
        _members.erase(std::unique(members, _members.end()), _members.end());
    }
    if (!line.isPart)
        _stops.resize(line.firstStop);
    line.endStop = _stops.size();
    line.endMember = _members.size();
}

} // namespace orvo
