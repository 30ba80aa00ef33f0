#include "orvo/console/PeriodText.h"

#include "platform/foundation/NSDate.h"
#include "platform/foundation/Text.h"

#include <unicode/calendar.h>
#include <unicode/dtptngen.h>
#include <unicode/smpdtfmt.h>

#include <algorithm>
#include <cmath>
#include <fmt/format.h>
#include <memory>

namespace orvo::PeriodText {

namespace {

constexpr double Millisecond = 1000;

icu::Locale personsLocale() {
    UErrorCode status = U_ZERO_ERROR;
    const icu::Locale locale = icu::Locale::forLanguageTag(Text::locale().get(), status);
    return U_FAILURE(status) || locale.isBogus() ? icu::Locale::getEnglish() : locale;
}

std::unique_ptr<icu::TimeZone> zoneNamed(const std::optional<std::string>& name) {
    std::unique_ptr<icu::TimeZone> zone;
    if (name) {
        zone.reset(icu::TimeZone::createTimeZone(icu::UnicodeString::fromUTF8(*name)));
        if (*zone != icu::TimeZone::getUnknown())
            return zone;
    }
    zone.reset(icu::TimeZone::createDefault());
    return zone;
}

/// Year and day of the year, in the zone.
std::pair<int, int> dayOf(double time, const icu::TimeZone& zone) {
    UErrorCode status = U_ZERO_ERROR;
    const std::unique_ptr<icu::Calendar> calendar(icu::Calendar::createInstance(zone, status));
    calendar->setTime(time * Millisecond, status);
    return {calendar->get(UCAL_EXTENDED_YEAR, status), calendar->get(UCAL_DAY_OF_YEAR, status)};
}

/// The first moment of the day after that of `time`, in the zone.
double dayAfter(double time, const icu::TimeZone& zone) {
    UErrorCode status = U_ZERO_ERROR;
    const std::unique_ptr<icu::Calendar> calendar(icu::Calendar::createInstance(zone, status));
    calendar->setTime(time * Millisecond, status);
    calendar->add(UCAL_DATE, 1, status);
    for (const auto field : {UCAL_HOUR_OF_DAY, UCAL_MINUTE, UCAL_SECOND, UCAL_MILLISECOND})
        calendar->set(field, 0);
    return calendar->getTime(status) / Millisecond;
}

} // namespace

std::optional<double> secondsOf(const std::shared_ptr<NSDate>& date) {
    return date ? std::optional(date->timeIntervalSince1970()) : std::nullopt;
}

std::string moment(double time, double now, const std::optional<std::string>& timeZone) {
    const auto zone = zoneNamed(timeZone);
    const auto [year, day] = dayOf(time, *zone);
    const auto [thisYear, today] = dayOf(now, *zone);
    const char* skeleton = year != thisYear ? "yMMMdjm" : day != today ? "MMMdjm" : "jm";

    UErrorCode status = U_ZERO_ERROR;
    const icu::Locale locale = personsLocale();
    const std::unique_ptr<icu::DateTimePatternGenerator> patterns(
        icu::DateTimePatternGenerator::createInstance(locale, status));
    if (U_FAILURE(status))
        return fmt::format("{}", time);
    icu::SimpleDateFormat format(patterns->getBestPattern(skeleton, status), locale, status);
    format.setTimeZone(*zone);
    icu::UnicodeString text;
    format.format(time * Millisecond, text);
    std::string utf8;
    return text.toUTF8String(utf8);
}

std::string period(std::optional<double> start,
                   std::optional<double> end,
                   double now,
                   const std::optional<std::string>& timeZone) {
    const auto at = [&](double time) {
        return moment(time, now, timeZone);
    };
    const bool isComing = start && *start > now;
    if (isComing && end)
        return fmt::format("{} – {}", at(*start), at(*end));
    if (isComing)
        return fmt::format("from {}", at(*start));
    if (start && end)
        return fmt::format("since {}, until {}", at(*start), at(*end));
    if (start)
        return fmt::format("since {}", at(*start));
    return end ? fmt::format("until {}", at(*end)) : "until further notice";
}

std::optional<double> nextChange(std::optional<double> start,
                                 std::optional<double> end,
                                 double now,
                                 const std::optional<std::string>& timeZone) {
    if (!start && !end)
        return std::nullopt;
    const double midnight = dayAfter(now, *zoneNamed(timeZone));
    return start && *start > now ? std::min(*start, midnight) : midnight;
}

std::string age(double seconds) {
    constexpr double Minute = 60;
    constexpr double Hour = 60 * Minute;
    constexpr double Day = 24 * Hour;
    const auto words = [](double count, const char* unit) {
        return fmt::format("{:.0f} {}{}", count, unit, count == 1 ? "" : "s");
    };
    if (seconds < Minute)
        return "less than a minute";
    if (seconds < Hour)
        return words(std::floor(seconds / Minute), "minute");
    if (seconds < Day)
        return words(std::floor(seconds / Hour), "hour");
    return words(std::floor(seconds / Day), "day");
}

} // namespace orvo::PeriodText
