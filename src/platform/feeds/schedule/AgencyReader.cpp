#include "platform/feeds/schedule/AgencyReader.h"

#include "platform/feeds/schedule/ScheduleText.h"

#include <algorithm>
#include <utility>

namespace orvo {

void AgencyReader::begin(const CsvTable& table) {
    _id = table.column("agency_id");
    _name = table.column("agency_name");
    _url = table.column("agency_url");
    _timezone = table.column("agency_timezone");
    _language = table.column("agency_lang");
}

void AgencyReader::readRow(const CsvTable& table) {
    ScheduleAgency agency;
    agency.id = table.value(_id);
    agency.name = ScheduleText::cleanName(table.value(_name));
    agency.url = ScheduleText::webAddress(table.value(_url));
    agency.timezone = ScheduleText::cleanName(table.value(_timezone));
    agency.language = ScheduleText::cleanName(table.value(_language));
    if (std::ranges::any_of(_contents.agencies,
                            [&](const auto& other) { return other.id == agency.id; })) {
        _contents.notes.add(
            file(), "an agency_id that stands above already, left out", table.rowNumber());
        return;
    }
    if (agency.name.empty())
        _contents.notes.add(file(), "no agency_name", table.rowNumber());
    _contents.agencies.push_back(std::move(agency));
}

} // namespace orvo
