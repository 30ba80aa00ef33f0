#include "platform/feeds/schedule/LineIndex.h"

#include "platform/feeds/schedule/ScheduleText.h"

#include <set>
#include <utility>

namespace orvo {

namespace {

const std::vector<std::uint64_t> NoLines;

} // namespace

LineIndex::LineIndex(Contents contents)
    : _contents(std::move(contents)) {
    _positions.reserve(_contents.lines.size());
    _byRoute.reserve(_contents.lines.size());
    for (std::size_t position = 0; position < _contents.lines.size(); ++position) {
        const ScheduleLine& line = _contents.lines[position];
        if (!_positions.emplace(line.muid, position).second)
            continue;
        _byRoute.emplace(line.routeId, line.muid);
        _byAgency[line.agencyId].push_back(line.muid);
        _byType[basicRouteType(line.routeType)].push_back(line.muid);
    }
}

const ScheduleLine* LineIndex::line(std::uint64_t muid) const {
    const auto found = _positions.find(muid);
    return found == _positions.end() ? nullptr : &_contents.lines[found->second];
}

std::optional<std::uint64_t> LineIndex::lineForRoute(std::string_view routeId) const {
    const auto found = _byRoute.find(ScheduleText::trimmed(routeId));
    if (found == _byRoute.end() || found->first.empty())
        return std::nullopt;
    return found->second;
}

const std::vector<std::uint64_t>& LineIndex::linesOfAgency(std::string_view agencyId) const {
    const std::string_view id = ScheduleText::trimmed(agencyId);
    const auto found = _byAgency.find(id);
    return id.empty() || found == _byAgency.end() ? NoLines : found->second;
}

const std::vector<std::uint64_t>& LineIndex::linesOfType(int routeType) const {
    const auto found = _byType.find(basicRouteType(routeType));
    return found == _byType.end() ? NoLines : found->second;
}

std::optional<std::vector<std::uint64_t>>
LineIndex::linesServingStop(std::string_view stopId) const {
    std::vector<std::uint64_t> lines;
    const std::string_view id = ScheduleText::trimmed(stopId);
    if (id.empty() || !_contents.stops.linesServingStop)
        return lines;
    const auto serving = _contents.stops.linesServingStop(id);
    if (!serving)
        return std::nullopt;
    std::set<std::size_t> positions;
    for (const std::uint64_t muid : *serving)
        if (const auto found = _positions.find(muid); found != _positions.end())
            positions.insert(found->second);
    lines.reserve(positions.size());
    for (const std::size_t position : positions)
        lines.push_back(_contents.lines[position].muid);
    return lines;
}

std::optional<std::string> LineIndex::stopName(std::string_view stopId) const {
    const std::string_view id = ScheduleText::trimmed(stopId);
    if (id.empty() || !_contents.stops.stopName)
        return std::nullopt;
    return _contents.stops.stopName(id);
}

} // namespace orvo
