#include "platform/feeds/schedule/ScheduleText.h"

#include <unicode/uchar.h>
#include <unicode/unistr.h>

#include <algorithm>
#include <charconv>
#include <chrono>
#include <fmt/format.h>
#include <utility>

namespace orvo::ScheduleText {

namespace {

constexpr int MaximumNameLength = 500; // characters

bool changesDirection(UChar32 point) {
    return u_hasBinaryProperty(point, UCHAR_BIDI_CONTROL) != 0;
}

bool isDigits(std::string_view text) {
    return std::ranges::all_of(text, [](char digit) { return digit >= '0' && digit <= '9'; });
}

} // namespace

std::string_view trimmed(std::string_view text) noexcept {
    constexpr std::string_view blanks = " \t\r\n";
    const auto begin = text.find_first_not_of(blanks);
    if (begin == std::string_view::npos)
        return {};
    return text.substr(begin, text.find_last_not_of(blanks) - begin + 1);
}

std::string asciiLowercase(std::string_view text) {
    std::string lower(text);
    for (char& letter : lower)
        if (letter >= 'A' && letter <= 'Z')
            letter = static_cast<char>(letter - 'A' + 'a');
    return lower;
}

std::string cleanName(std::string_view text) {
    const auto source = icu::UnicodeString::fromUTF8(
        icu::StringPiece(text.data(), static_cast<int32_t>(text.size())));
    icu::UnicodeString name;
    bool blankIsDue = false;
    int count = 0;
    for (int32_t at = 0; at < source.length() && count < MaximumNameLength;
         at = source.moveIndex32(at, 1)) {
        const UChar32 point = source.char32At(at);
        if (u_isUWhiteSpace(point)) {
            blankIsDue = !name.isEmpty();
            continue;
        }
        if (u_iscntrl(point) || changesDirection(point))
            continue;
        if (std::exchange(blankIsDue, false)) {
            name.append(u' ');
            ++count;
        }
        name.append(point);
        ++count;
    }
    std::string utf8;
    name.toUTF8String(utf8);
    return utf8;
}

std::string webAddress(std::string_view text) {
    const std::string lower = asciiLowercase(text.substr(0, 8));
    if (!lower.starts_with("http://") && !lower.starts_with("https://"))
        return {};
    return cleanName(text);
}

std::string color(std::string_view text) {
    if (text.starts_with('#'))
        text.remove_prefix(1);
    if (text.size() != 6)
        return {};
    std::string capitals(text);
    for (char& digit : capitals) {
        if (digit >= 'a' && digit <= 'f')
            digit = static_cast<char>(digit - 'a' + 'A');
        else if (!(digit >= '0' && digit <= '9') && !(digit >= 'A' && digit <= 'F'))
            return {};
    }
    return capitals;
}

std::string date(std::string_view text) {
    if (text.size() != 8 || !isDigits(text))
        return {};
    int number = 0;
    std::from_chars(text.data(), text.data() + text.size(), number);
    const std::chrono::year_month_day day{
        std::chrono::year(number / 10000),
        std::chrono::month(static_cast<unsigned>(number / 100 % 100)),
        std::chrono::day(static_cast<unsigned>(number % 100))};
    if (!day.ok())
        return {};
    return fmt::format("{}-{}-{}", text.substr(0, 4), text.substr(4, 2), text.substr(6, 2));
}

std::optional<int> smallNumber(std::string_view text) noexcept {
    if (text.empty() || text.size() > 6 || !isDigits(text))
        return std::nullopt;
    int number = 0;
    std::from_chars(text.data(), text.data() + text.size(), number);
    return number;
}

} // namespace orvo::ScheduleText
