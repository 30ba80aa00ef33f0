#include "orvo/console/LanguageTag.h"

#include <algorithm>

namespace orvo {

namespace {

constexpr std::size_t ShortestLanguage = 2;
constexpr std::size_t LongestPart = 8;

bool isLetter(char c) {
    return (c >= 'a' && c <= 'z') || (c >= 'A' && c <= 'Z');
}

bool isLetterOrDigit(char c) {
    return isLetter(c) || (c >= '0' && c <= '9');
}

} // namespace

bool isLanguageTag(std::string_view text) {
    std::size_t end = std::min(text.find_first_of("-_"), text.size());
    const auto language = text.substr(0, end);
    if (language.size() < ShortestLanguage || language.size() > LongestPart ||
        !std::ranges::all_of(language, isLetter))
        return false;
    while (end < text.size()) {
        const std::size_t begin = end + 1;
        end = std::min(text.find_first_of("-_", begin), text.size());
        const auto part = text.substr(begin, end - begin);
        if (part.empty() || part.size() > LongestPart ||
            !std::ranges::all_of(part, isLetterOrDigit))
            return false;
    }
    return true;
}

} // namespace orvo
