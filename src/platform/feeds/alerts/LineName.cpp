#include "platform/feeds/alerts/LineName.h"

#include <string>

namespace orvo {

namespace {

/// Letters and digits, those of ASCII in small letters.
std::string skeleton(std::string_view text) {
    std::string result;
    result.reserve(text.size());
    for (const char c : text) {
        if (c >= 'A' && c <= 'Z')
            result += static_cast<char>(c - 'A' + 'a');
        else if ((c >= 'a' && c <= 'z') || (c >= '0' && c <= '9') ||
                 static_cast<unsigned char>(c) >= 0x80)
            result += c;
    }
    return result;
}

} // namespace

bool isOnlyNameOfLine(std::string_view text, const ScheduleLine& line) {
    if (isLongerThanName(text.size(), line.shortName.size() + line.longName.size()))
        return false;
    const std::string said = skeleton(text);
    const std::string shortName = skeleton(line.shortName);
    const std::string longName = skeleton(line.longName);
    return !said.empty() && (said == shortName || said == longName ||
                             said == shortName + longName || said == longName + shortName);
}

} // namespace orvo
