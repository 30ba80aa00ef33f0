#include "platform/feeds/schedule/SystemInitials.h"

#include <unicode/uchar.h>
#include <unicode/unistr.h>

#include <algorithm>
#include <vector>

namespace orvo {

namespace {

constexpr std::size_t MostCharacters = 3;
using Word = std::vector<UChar32>;

std::vector<Word> wordsOf(std::string_view name) {
    const auto text = icu::UnicodeString::fromUTF8(
        icu::StringPiece(name.data(), static_cast<int32_t>(name.size())));
    std::vector<Word> words;
    bool isInWord = false;
    for (int32_t at = 0; at < text.length(); at = text.moveIndex32(at, 1)) {
        const UChar32 point = text.char32At(at);
        const bool isPart = u_isalnum(point);
        if (isPart && !isInWord)
            words.emplace_back();
        if (isPart)
            words.back().push_back(point);
        isInWord = isPart;
    }
    return words;
}

bool isCapitalOrDigit(UChar32 point) {
    return u_isUUppercase(point) || u_isdigit(point);
}

Word initialsOf(const std::vector<Word>& words) {
    Word initials;
    if (words.size() == 1) {
        std::ranges::copy_if(words.front(), std::back_inserter(initials), isCapitalOrDigit);
        if (initials.empty())
            initials.push_back(words.front().front());
        return initials;
    }
    for (const Word& word : words)
        if (!u_isULowercase(word.front()))
            initials.push_back(word.front());
    if (initials.empty())
        for (const Word& word : words)
            initials.push_back(word.front());
    return initials;
}

} // namespace

std::string systemInitials(std::string_view name) {
    const std::vector<Word> words = wordsOf(name);
    if (words.empty())
        return {};
    Word initials = initialsOf(words);
    initials.resize(std::min(initials.size(), MostCharacters));
    icu::UnicodeString text;
    for (const UChar32 point : initials)
        text.append(u_toupper(point));
    std::string utf8;
    text.toUTF8String(utf8);
    return utf8;
}

} // namespace orvo
