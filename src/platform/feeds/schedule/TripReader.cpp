#include "platform/feeds/schedule/TripReader.h"

namespace orvo {

void TripReader::begin(const CsvTable& table) {
    _tripId = table.column("trip_id");
    _routeId = table.column("route_id");
    for (std::size_t index = 0; index < _contents.lines.size(); ++index)
        _lines.emplace(_contents.lines[index].routeId, static_cast<std::uint32_t>(index));
}

void TripReader::readRow(const CsvTable& table) {
    const auto found = _lines.find(table.value(_routeId));
    if (found == _lines.end())
        _contents.notes.add(
            file(), "a route_id that routes.txt does not have, left out", table.rowNumber());
    else
        _trips.add(table.value(_tripId), found->second);
}

} // namespace orvo
