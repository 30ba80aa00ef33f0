#include "platform/feeds/http/HttpDate.h"

#include <algorithm>
#include <array>
#include <charconv>
#include <chrono>
#include <vector>

namespace orvo {

namespace {

constexpr std::array<std::string_view, 12> Months = {
    "Jan", "Feb", "Mar", "Apr", "May", "Jun", "Jul", "Aug", "Sep", "Oct", "Nov", "Dec"};

std::vector<std::string_view> words(std::string_view text) {
    constexpr std::string_view Separators = " ,-:\t";
    std::vector<std::string_view> found;
    for (auto start = text.find_first_not_of(Separators); start != std::string_view::npos;
         start = text.find_first_not_of(Separators)) {
        text.remove_prefix(start);
        const auto end = std::min(text.find_first_of(Separators), text.size());
        found.push_back(text.substr(0, end));
        text.remove_prefix(end);
    }
    return found;
}

/// -1 for what is no number.
int number(std::string_view text) {
    int value = -1;
    const auto [end, error] = std::from_chars(text.data(), text.data() + text.size(), value);
    return error == std::errc() && end == text.data() + text.size() ? value : -1;
}

int fullYear(std::string_view text) {
    const int year = number(text);
    if (text.size() != 2 || year < 0)
        return text.size() == 4 ? year : -1;
    return year < 70 ? 2000 + year : 1900 + year;
}

} // namespace

std::optional<double> parseHttpDate(std::string_view text) {
    auto parts = words(text);
    // Weekday, day, month, year, three of the time, zone; or weekday, month, day, time, year.
    if (parts.size() == 8 && (parts[7] == "GMT" || parts[7] == "UTC"))
        parts.pop_back();
    else if (parts.size() == 7)
        parts = {parts[0], parts[2], parts[1], parts[6], parts[3], parts[4], parts[5]};
    else
        return std::nullopt;
    const auto month = std::ranges::find(Months, parts[2]);
    const auto day = number(parts[1]);
    const auto year = fullYear(parts[3]);
    if (month == Months.end() || day < 1 || year < 0)
        return std::nullopt;
    const std::chrono::year_month_day date(
        std::chrono::year(year),
        std::chrono::month(static_cast<unsigned>(month - Months.begin()) + 1),
        std::chrono::day(static_cast<unsigned>(day)));
    const int hour = number(parts[4]);
    const int minute = number(parts[5]);
    const int second = number(parts[6]); // 60 is a leap second
    if (!date.ok() || hour < 0 || hour > 23 || minute < 0 || minute > 59 || second < 0 ||
        second > 60)
        return std::nullopt;
    const auto days = std::chrono::sys_days(date).time_since_epoch().count();
    return static_cast<double>(days) * 86400 + hour * 3600 + minute * 60 + second;
}

} // namespace orvo
