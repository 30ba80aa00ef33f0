#include "platform/feeds/schedule/StopTimeReader.h"

#include <algorithm>

namespace orvo {

namespace {

constexpr std::size_t CompactionStep = std::size_t{1} << 16; // new entries between two compactions
constexpr int LevelsAboveStop = 2;                           // boarding area, platform, station

} // namespace

void StopTimeReader::begin(const CsvTable& table) {
    _tripId = table.column("trip_id");
    _stopId = table.column("stop_id");
    _pickup = table.column("pickup_type");
    _dropOff = table.column("drop_off_type");
    _stops.reserve(_contents.stops.size());
    for (std::size_t index = 0; index < _contents.stops.size(); ++index)
        _stops.emplace(_contents.stops[index].id, static_cast<std::uint32_t>(index));
}

void StopTimeReader::readRow(const CsvTable& table) {
    // Nobody gets on or off: the vehicle only passes.
    if (table.value(_pickup) == "1" && table.value(_dropOff) == "1")
        return;
    const auto line = lineOfTrip(table.value(_tripId));
    if (!line) {
        _contents.notes.add(
            file(), "a trip_id that trips.txt does not have, left out", table.rowNumber());
        return;
    }
    const std::string_view stopId = table.value(_stopId);
    if (stopId.empty()) {
        _contents.notes.add(file(), "no stop_id, left out", table.rowNumber());
        return;
    }
    _contents.stopsOfLines.push_back({numberOfStop(stopId, table.rowNumber()), *line});
    if (_contents.stopsOfLines.size() > 2 * _compactedSize + CompactionStep)
        removeRepetitions();
}

void StopTimeReader::end() {
    removeRepetitions();
    addStations();
    removeRepetitions();
    _contents.info.knowsStopsOfLines = !_contents.stopsOfLines.empty();
}

std::optional<std::uint32_t> StopTimeReader::lineOfTrip(std::string_view tripId) {
    if (_lastTripId != tripId || tripId.empty()) {
        _lastTripId = tripId;
        _lastLine = _trips.lineOfTrip(tripId);
    }
    return _lastLine;
}

/// A stop that stops.txt does not have is served all the same.
std::uint32_t StopTimeReader::numberOfStop(std::string_view stopId, std::uint64_t row) {
    if (const auto known = _stops.find(stopId); known != _stops.end())
        return known->second;
    _contents.notes.add(file(), "a stop_id that stops.txt does not have", row);
    const auto number = static_cast<std::uint32_t>(_contents.stops.size());
    _contents.stops.emplace_back().id = stopId;
    _stops.emplace(_contents.stops.back().id, number);
    return number;
}

void StopTimeReader::addStations() {
    const std::size_t count = _contents.stopsOfLines.size();
    for (std::size_t index = 0; index < count; ++index) {
        StopOfLine entry = _contents.stopsOfLines[index];
        for (int level = 0; level < LevelsAboveStop; ++level) {
            const auto parent = _stops.find(_contents.stops[entry.stop].parentId);
            if (parent == _stops.end())
                break;
            entry.stop = parent->second;
            _contents.stopsOfLines.push_back(entry);
        }
    }
}

void StopTimeReader::removeRepetitions() {
    auto& entries = _contents.stopsOfLines;
    std::ranges::sort(entries);
    entries.erase(std::unique(entries.begin(), entries.end()), entries.end());
    _compactedSize = entries.size();
}

} // namespace orvo
