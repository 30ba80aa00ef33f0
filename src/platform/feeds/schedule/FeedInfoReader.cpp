#include "platform/feeds/schedule/FeedInfoReader.h"

#include "platform/feeds/schedule/ScheduleDay.h"
#include "platform/feeds/schedule/ScheduleText.h"

namespace orvo {

void FeedInfoReader::begin(const CsvTable& /*table*/) {
    _hasRow = false;
}

void FeedInfoReader::readRow(const CsvTable& table) {
    if (_hasRow)
        return;
    _hasRow = true;
    const auto text = [&table](const char* column) {
        return ScheduleText::cleanName(table.value(table.column(column)));
    };
    ScheduleInfo& info = _contents.info;
    info.publisher = text("feed_publisher_name");
    info.version = text("feed_version");
    // A schedule in several languages calls itself "mul" and names the one of its texts apart.
    const std::string language = text("feed_lang");
    info.language =
        ScheduleText::asciiLowercase(language) == "mul" ? text("default_lang") : language;
    info.startDate = readDate(table, "feed_start_date");
    info.endDate = readDate(table, "feed_end_date");
}

void FeedInfoReader::end() {
    ScheduleInfo& info = _contents.info;
    if (!_contents.agencies.empty()) {
        const ScheduleAgency& first = _contents.agencies.front();
        info.timezone = first.timezone;
        if (info.language.empty())
            info.language = first.language;
    }
    info.validUntil = endOfDay(info.endDate, info.timezone);
}

std::string FeedInfoReader::readDate(const CsvTable& table, const char* column) {
    const std::string_view text = table.value(table.column(column));
    std::string date = ScheduleText::date(text);
    if (date.empty() && !text.empty())
        _contents.notes.add(
            file(), std::string("no day of the calendar in ") + column, table.rowNumber());
    return date;
}

} // namespace orvo
