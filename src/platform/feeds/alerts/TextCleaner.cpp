#include "platform/feeds/alerts/TextCleaner.h"

#include "platform/feeds/alerts/ByteScan.h"
#include "platform/feeds/alerts/HTMLEntities.h"
#include "platform/feeds/alerts/TagStripper.h"

#include <unicode/ubrk.h>
#include <unicode/uchar.h>
#include <unicode/utext.h>
#include <unicode/utf8.h>

#include <algorithm>
#include <memory>
#include <type_traits>
#include <utility>

namespace orvo {

namespace {

enum class CharacterKind { Visible, Blank, NoBreakBlank, LineBreak, ParagraphBreak, Dropped };

CharacterKind kindOf(UChar32 c) {
    if (c == ' ' || c == '\t' || (c >= 0x2000 && c <= 0x200A) || c == 0x205F || c == 0x3000)
        return CharacterKind::Blank;
    if (c == 0x00A0 || c == 0x202F)
        return CharacterKind::NoBreakBlank;
    if (c == '\n' || c == '\v' || c == '\f' || c == 0x85 || c == 0x2028)
        return CharacterKind::LineBreak;
    if (c == 0x2029)
        return CharacterKind::ParagraphBreak;
    const bool isControl = c < 0x20 || (c >= 0x7F && c < 0xA0);
    const bool turnsDirection = (c >= 0x202A && c <= 0x202E) || (c >= 0x2066 && c <= 0x2069);
    const bool isMark = c == 0xFEFF || (c >= 0xFFF9 && c <= 0xFFFB);
    return isControl || turnsDirection || isMark ? CharacterKind::Dropped : CharacterKind::Visible;
}

/// Puts characters one behind the other with no more blanks and line breaks between them than
/// needed.
class Tidier {
public:
    explicit Tidier(std::size_t length) { _result.reserve(length); }

    void add(UChar32 c, std::string_view character) {
        switch (kindOf(c)) {
        case CharacterKind::Visible:
            _isSeen = _isSeen || !u_hasBinaryProperty(c, UCHAR_DEFAULT_IGNORABLE_CODE_POINT);
            return addVisible(character);
        case CharacterKind::Blank:
            _blank = " ";
            return;
        case CharacterKind::NoBreakBlank:
            _blank = _blank.empty() ? character : " ";
            return;
        case CharacterKind::LineBreak:
            _lineBreaks += 1;
            return;
        case CharacterKind::ParagraphBreak:
            _lineBreaks += 2;
            return;
        case CharacterKind::Dropped:
            return;
        }
    }

    /// Characters that only join or part others are nothing by themselves.
    std::string take() { return _isSeen ? std::move(_result) : std::string(); }

private:
    void addVisible(std::string_view character) {
        if (!_result.empty()) {
            if (_lineBreaks > 0)
                _result.append(std::min<std::size_t>(_lineBreaks, 2), '\n');
            else
                _result += _blank;
        }
        _blank = {};
        _lineBreaks = 0;
        _result += character;
    }

    std::string _result;
    std::string_view _blank;
    std::size_t _lineBreaks = 0;
    bool _isSeen = false;
};

std::string tidied(std::string_view text) {
    Tidier tidier(text.size());
    const auto* const bytes = reinterpret_cast<const std::uint8_t*>(text.data());
    const auto length = static_cast<std::int32_t>(text.size());
    for (std::int32_t i = 0; i < length;) {
        const std::int32_t begin = i;
        UChar32 c = 0;
        U8_NEXT_OR_FFFD(bytes, i, length, c);
        if (c == '\r' && (i == length || text[static_cast<std::size_t>(i)] != '\n'))
            c = '\n';
        tidier.add(
            c, text.substr(static_cast<std::size_t>(begin), static_cast<std::size_t>(i - begin)));
    }
    return tidier.take();
}

bool isPlainCharacter(char c) {
    return c >= ' ' && c <= '~' && c != '<' && c != '&';
}

/// Whether cleaning would change nothing, and that is quickly seen: visible ASCII without markup
/// and single blanks between.
bool isPlain(std::string_view text) {
    if (text.empty())
        return true;
    if (text.front() == ' ' || text.back() == ' ')
        return false;
    if (text.size() <= ByteScan::Block)
        return std::ranges::all_of(text, isPlainCharacter) &&
               text.find("  ") == std::string_view::npos;
    const char* const last = text.data() + text.size() - ByteScan::Block - 1;
    for (const char* block = text.data(); block < last; block += ByteScan::Block)
        if (!ByteScan::isPlainText(block))
            return false;
    return ByteScan::isPlainText(last) && isPlainCharacter(text.back());
}

/// The text up to the most that is looked at, which ends with a whole character.
std::string_view begun(std::string_view text) {
    if (text.size() <= TextCleaner::LongestPublished)
        return text;
    const auto* const bytes = reinterpret_cast<const std::uint8_t*>(text.data());
    auto end = static_cast<std::int32_t>(TextCleaner::LongestPublished);
    U8_SET_CP_START(bytes, 0, end);
    return text.substr(0, static_cast<std::size_t>(end));
}

std::string_view trimmed(std::string_view text) {
    text = begun(text);
    constexpr std::string_view Blanks = " \t\r\n";
    text.remove_prefix(std::min(text.find_first_not_of(Blanks), text.size()));
    return text.substr(0, text.find_last_not_of(Blanks) + 1);
}

/// One step of taking HTML apart. Text that was escaped twice needs two.
std::string withoutMarkup(std::string text) {
    if (text.find('<') != std::string::npos)
        text = TagStripper::stripped(text);
    if (text.find('&') != std::string::npos)
        text = HTMLEntities::decoded(text);
    return text;
}

using Characters = std::unique_ptr<UBreakIterator, decltype(&ubrk_close)>;

} // namespace

namespace TextCleaner {

std::string clean(std::string_view text) {
    text = trimmed(text);
    if (isPlain(text))
        return std::string(text);
    if (text.find_first_of("<&") == std::string_view::npos)
        return tidied(text);
    std::string plain = withoutMarkup(withoutMarkup(std::string(text)));
    if (plain.find('<') != std::string::npos)
        plain = TagStripper::stripped(plain);
    return tidied(plain);
}

std::string cleanLine(std::string_view text) {
    std::string room;
    const std::string_view line = cleanLine(text, room);
    return room.empty() ? std::string(line) : std::move(room);
}

std::string_view cleanLine(std::string_view text, std::string& room) {
    text = trimmed(text);
    if (isPlain(text))
        return text;
    room = clean(text);
    return onOneLine(room, room);
}

std::string_view onOneLine(std::string_view cleanText, std::string& room) {
    if (isPlain(cleanText))
        return cleanText;
    std::string line(cleanText);
    std::replace(line.begin(), line.end(), '\n', ' ');
    return room = tidied(line);
}

std::string_view firstParagraph(std::string_view cleanText) noexcept {
    return cleanText.substr(0, cleanText.find("\n\n"));
}

std::string capped(std::string text, std::size_t most) {
    if (text.size() <= most)
        return text;
    const auto* const bytes = reinterpret_cast<const std::uint8_t*>(text.data());
    const auto length = static_cast<std::int32_t>(text.size());
    std::int32_t cut = 0;
    for (std::size_t count = 0; count < most && cut < length; ++count)
        U8_FWD_1(bytes, cut, length);
    if (cut == length)
        return text;
    UErrorCode status = U_ZERO_ERROR;
    const Characters characters(ubrk_open(UBRK_CHARACTER, "", nullptr, 0, &status), &ubrk_close);
    UText view = UTEXT_INITIALIZER;
    utext_openUTF8(&view, text.data(), length, &status);
    ubrk_setUText(characters.get(), &view, &status);
    if (U_SUCCESS(status) && !ubrk_isBoundary(characters.get(), cut))
        // What is left of a first character that is longer than all may be is better than nothing.
        if (const auto before = ubrk_preceding(characters.get(), cut); before > 0)
            cut = before;
    utext_close(&view);
    text.resize(static_cast<std::size_t>(cut));
    text.erase(std::min(text.size(), text.find_last_not_of(" \n") + 1));
    return text;
}

} // namespace TextCleaner

} // namespace orvo
