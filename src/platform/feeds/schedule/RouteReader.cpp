#include "platform/feeds/schedule/RouteReader.h"

#include "platform/feeds/schedule/ScheduleText.h"

#include <algorithm>
#include <limits>
#include <utility>

namespace orvo {

namespace {

constexpr int BusType = 3;

} // namespace

RouteReader::RouteReader(ScheduleContents& contents, std::string feed)
    : _contents(contents)
    , _feed(std::move(feed)) {}

void RouteReader::begin(const CsvTable& table) {
    _columns = {.id = table.column("route_id"),
                .agency = table.column("agency_id"),
                .shortName = table.column("route_short_name"),
                .longName = table.column("route_long_name"),
                .type = table.column("route_type"),
                .url = table.column("route_url"),
                .color = table.column("route_color"),
                .textColor = table.column("route_text_color"),
                .sortOrder = table.column("route_sort_order")};
}

void RouteReader::readRow(const CsvTable& table) {
    ScheduleLine line;
    line.feed = _feed;
    line.routeId = table.value(_columns.id);
    if (line.routeId.empty()) {
        _contents.notes.add(file(), "no route_id, left out", table.rowNumber());
        return;
    }
    if (!_ids.insert(line.routeId).second) {
        _contents.notes.add(
            file(), "a route_id that stands above already, left out", table.rowNumber());
        return;
    }
    line.muid = lineMuid(line.feed, line.routeId);
    line.shortName = ScheduleText::cleanName(table.value(_columns.shortName));
    line.longName = ScheduleText::cleanName(table.value(_columns.longName));
    line.url = ScheduleText::webAddress(table.value(_columns.url));
    line.color = ScheduleText::color(table.value(_columns.color));
    line.textColor = ScheduleText::color(table.value(_columns.textColor));
    line.routeType = routeType(table.value(_columns.type), table.rowNumber());
    line.order = ScheduleText::smallNumber(table.value(_columns.sortOrder))
                     .value_or(std::numeric_limits<int>::max());
    setAgency(line, table.value(_columns.agency), table.rowNumber());
    _contents.lines.push_back(std::move(line));
}

void RouteReader::end() {
    std::ranges::stable_sort(_contents.lines, {}, &ScheduleLine::order);
    std::int64_t order = 0;
    for (ScheduleLine& line : _contents.lines)
        line.order = order++;
}

void RouteReader::setAgency(ScheduleLine& line, std::string_view agencyId, std::uint64_t row) {
    const auto& agencies = _contents.agencies;
    line.agencyId = agencyId;
    const auto found = std::ranges::find(agencies, agencyId, &ScheduleAgency::id);
    if (found != agencies.end()) {
        line.agency = *found;
    } else if (agencies.size() == 1 && (agencyId.empty() || agencies.front().id.empty())) {
        // One of both files left the id out, as it may where there is but one agency.
        line.agency = agencies.front();
        if (agencyId.empty())
            line.agencyId = line.agency.id;
    } else {
        line.agency.id = agencyId;
        _contents.notes.add(file(), "an agency_id that agency.txt does not have", row);
    }
}

int RouteReader::routeType(std::string_view text, std::uint64_t row) {
    if (const auto type = ScheduleText::smallNumber(text))
        return *type;
    _contents.notes.add(file(), "no number in route_type, taken for a bus", row);
    return BusType;
}

} // namespace orvo
