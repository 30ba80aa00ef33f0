#include "viewmodel/_OWDisplayedIncidents.h"

namespace orvo {

_OWDisplayedRow* _OWDisplayedIncidents::rowOfIncident(std::uint64_t muid) {
    const auto position = _positionOfMuid.find(muid);
    return position == _positionOfMuid.end() ? nullptr : &_rows[position->second];
}

void _OWDisplayedIncidents::add(const std::shared_ptr<TransitIncident>& incident,
                                std::shared_ptr<OWTransitItem> row,
                                const std::shared_ptr<TransitLineItem>& line) {
    _positionOfMuid.emplace(incident->muid(), _rows.size());
    _incidents.push_back(incident);
    _rows.push_back({std::move(row), {line}});
    _incidentsToLineMapping->setObject_forKey(line, incident);
}

} // namespace orvo
