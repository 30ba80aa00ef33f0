#include "platform/feeds/schedule/ScheduleDay.h"

#include "platform/feeds/schedule/ScheduleText.h"

#include <unicode/gregocal.h>
#include <unicode/timezone.h>

#include <memory>

namespace orvo {

std::optional<double> endOfDay(std::string_view date, std::string_view timezone) {
    if (date.size() != 10)
        return std::nullopt;
    const auto year = ScheduleText::smallNumber(date.substr(0, 4));
    const auto month = ScheduleText::smallNumber(date.substr(5, 2));
    const auto day = ScheduleText::smallNumber(date.substr(8, 2));
    if (!year || !month || !day)
        return std::nullopt;
    const auto name = icu::UnicodeString::fromUTF8(
        icu::StringPiece(timezone.data(), static_cast<int32_t>(timezone.size())));
    std::unique_ptr<icu::TimeZone> zone(icu::TimeZone::createTimeZone(name));
    UErrorCode status = U_ZERO_ERROR;
    icu::GregorianCalendar calendar(*zone, status);
    calendar.clear();
    calendar.set(*year, *month - 1, *day + 1, 0, 0, 0);
    const double milliseconds = calendar.getTime(status);
    if (U_FAILURE(status))
        return std::nullopt;
    return milliseconds / 1000;
}

} // namespace orvo
