#include "platform/feeds/schedule/StopReader.h"

#include "platform/feeds/schedule/ScheduleText.h"

#include <utility>

namespace orvo {

void StopReader::begin(const CsvTable& table) {
    _id = table.column("stop_id");
    _name = table.column("stop_name");
    _parent = table.column("parent_station");
    _locationType = table.column("location_type");
}

void StopReader::readRow(const CsvTable& table) {
    ScheduleStop stop;
    stop.id = table.value(_id);
    if (stop.id.empty()) {
        _contents.notes.add(file(), "no stop_id, left out", table.rowNumber());
        return;
    }
    if (_ids.contains(stop.id)) {
        _contents.notes.add(
            file(), "a stop_id that stands above already, left out", table.rowNumber());
        return;
    }
    stop.name = ScheduleText::cleanName(table.value(_name));
    stop.parentId = table.value(_parent);
    stop.locationType = ScheduleText::smallNumber(table.value(_locationType)).value_or(0);
    _contents.stops.push_back(std::move(stop));
    _ids.insert(_contents.stops.back().id);
}

} // namespace orvo
