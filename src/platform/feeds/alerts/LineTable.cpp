#include "platform/feeds/alerts/LineTable.h"

#include "platform/feeds/alerts/ByteScan.h"
#include "platform/foundation/SeededStringHash.h"

#include <algorithm>
#include <bit>
#include <utility>

namespace orvo {

LineTable::LineTable(std::shared_ptr<const LineIndex> index)
    : _index(std::move(index))
    , _slots(std::bit_ceil(2 * _index->lines().size() + 2), None) {
    _entries.reserve(_index->lines().size());
    std::size_t length = 0;
    for (const ScheduleLine& line : _index->lines())
        length += line.routeId.size();
    _routeIds.reserve(length); // views into it stay good
    std::string_view agency;   // that of neighbours is mostly the same text: kept where it is warm
    for (const ScheduleLine& line : _index->lines()) {
        if (agency != line.agencyId)
            agency = line.agencyId;
        const auto place = static_cast<Place>(_entries.size());
        const std::size_t begin = _routeIds.size();
        _routeIds += line.routeId;
        _entries.push_back({&line,
                            std::string_view(_routeIds).substr(begin),
                            agency,
                            basicRouteType(line.routeType),
                            line.shortName.size() + line.longName.size(),
                            line.muid});
        std::size_t slot = slotOf(line.routeId);
        std::size_t probe = 0;
        for (; _slots[slot] != None; ++probe)
            slot = (slot + 1) % _slots.size();
        _slots[slot] = place;
        _longestProbe = std::max(_longestProbe, probe);
        _longestName = std::max(_longestName, _entries.back().nameLength);
    }
}

LineTable::Place LineTable::placeOf(std::uint64_t muid) const {
    const ScheduleLine* const line = _index->line(muid);
    return line ? static_cast<Place>(line - _index->lines().data()) : None;
}

LineTable::Place LineTable::placeOfRoute(std::string_view routeId) const {
    if (routeId.empty())
        return None;
    for (std::size_t slot = slotOf(routeId); _slots[slot] != None;
         slot = (slot + 1) % _slots.size())
        if (ByteScan::isEqual(_entries[_slots[slot]].routeId, routeId))
            return _slots[slot];
    // The index knows what does not count, such as blanks around an identifier.
    const bool isPlain = routeId.front() > ' ' && routeId.back() > ' ';
    const auto muid = isPlain ? std::nullopt : _index->lineForRoute(routeId);
    return muid ? placeOf(*muid) : None;
}

std::size_t LineTable::slotOf(std::string_view routeId) const noexcept {
    return SeededStringHash()(routeId) & (_slots.size() - 1);
}

} // namespace orvo
