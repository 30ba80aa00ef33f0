#include "orvo/console/DisplayText.h"

#include <unicode/uchar.h>
#include <unicode/utf8.h>

#include <cstdint>
#include <utility>

namespace orvo::DisplayText {

namespace {

/// The code point at `at`, negative for a bad byte; moves `at` behind it.
UChar32 nextCodePoint(std::string_view text, std::size_t& at) {
    const auto* bytes = reinterpret_cast<const std::uint8_t*>(text.data());
    auto index = static_cast<std::int32_t>(at);
    const auto length = static_cast<std::int32_t>(text.size());
    UChar32 c = 0;
    U8_NEXT(bytes, index, length, c);
    at = static_cast<std::size_t>(index);
    return c;
}

std::size_t columnsOf(UChar32 c) {
    if (c < 0)
        return 1;
    switch (u_charType(c)) {
    case U_NON_SPACING_MARK:
    case U_ENCLOSING_MARK:
    case U_FORMAT_CHAR:
    case U_CONTROL_CHAR:
        return 0;
    default:
        break;
    }
    const int width = u_getIntPropertyValue(c, UCHAR_EAST_ASIAN_WIDTH);
    return width == U_EA_FULLWIDTH || width == U_EA_WIDE ? 2 : 1;
}

/// Identifiers come as feeds have them: one of these would turn the rest of its row around.
bool turnsDirection(UChar32 c) {
    return (c >= 0x202A && c <= 0x202E) || (c >= 0x2066 && c <= 0x2069);
}

} // namespace

std::size_t width(std::string_view text) {
    std::size_t columns = 0;
    for (std::size_t at = 0; at < text.size();)
        columns += columnsOf(nextCodePoint(text, at));
    return columns;
}

std::string cut(std::string_view text, std::size_t columns) {
    if (width(text) <= columns)
        return std::string(text);
    if (columns == 0)
        return {};
    std::size_t used = 0;
    std::size_t at = 0;
    while (at < text.size()) {
        std::size_t next = at;
        used += columnsOf(nextCodePoint(text, next));
        if (used > columns - 1)
            break;
        at = next;
    }
    return std::string(text.substr(0, at)) + "…";
}

std::vector<std::string> wrap(std::string_view text, std::size_t columns) {
    std::vector<std::string> lines;
    while (!text.empty()) {
        const std::size_t end = text.find('\n');
        std::string_view rest = text.substr(0, end);
        text = end == std::string_view::npos ? std::string_view() : text.substr(end + 1);
        std::string line;
        std::size_t used = 0; // columns of the line
        while (!rest.empty()) {
            const std::size_t blank = rest.find(' ');
            const std::string_view word = rest.substr(0, blank);
            rest = blank == std::string_view::npos ? std::string_view() : rest.substr(blank + 1);
            if (word.empty())
                continue;
            const std::size_t wanted = width(word);
            if (!line.empty() && used + 1 + wanted > columns) {
                lines.push_back(std::exchange(line, {}));
                used = 0;
            }
            used += wanted + (line.empty() ? 0 : 1);
            line.append(line.empty() ? "" : " ").append(word);
        }
        lines.push_back(line);
    }
    return lines;
}

std::string oneLine(std::string_view text) {
    std::string line;
    bool blank = false;
    for (std::size_t at = 0; at < text.size();) {
        const std::size_t start = at;
        const UChar32 c = nextCodePoint(text, at);
        if (c >= 0 && (u_isUWhiteSpace(c) || u_charType(c) == U_CONTROL_CHAR)) {
            blank = true;
            continue;
        }
        if (turnsDirection(c))
            continue;
        if (blank && !line.empty())
            line += ' ';
        blank = false;
        line += text.substr(start, at - start);
    }
    return line;
}

} // namespace orvo::DisplayText
