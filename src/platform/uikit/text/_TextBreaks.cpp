#include "platform/uikit/text/_TextBreaks.h"

#include <unicode/brkiter.h>
#include <unicode/ubidi.h>
#include <unicode/uchar.h>
#include <unicode/unistr.h>
#include <unicode/utext.h>
#include <unicode/utf8.h>

#include <memory>

namespace orvo {

namespace {

constexpr UChar32 NoBreakSpace = 0x00A0;
constexpr UChar32 FigureSpace = 0x2007;
constexpr UChar32 NarrowNoBreakSpace = 0x202F;
constexpr UChar32 NextLine = 0x0085;
constexpr UChar32 LineSeparator = 0x2028;
constexpr UChar32 ParagraphSeparator = 0x2029;

UChar32 characterAt(const std::string& text, std::size_t offset) {
    UChar32 character = 0;
    U8_GET_OR_FFFD(reinterpret_cast<const std::uint8_t*>(text.data()),
                   0,
                   static_cast<std::int32_t>(offset),
                   static_cast<std::int32_t>(text.size()),
                   character);
    return character;
}

/// Made once a thread: making one reads its rules.
icu::BreakIterator* characterIterator() {
    thread_local const std::unique_ptr<icu::BreakIterator> iterator = [] {
        UErrorCode status = U_ZERO_ERROR;
        return std::unique_ptr<icu::BreakIterator>(
            icu::BreakIterator::createCharacterInstance(icu::Locale::getRoot(), status));
    }();
    return iterator.get();
}

icu::BreakIterator* lineIterator() {
    thread_local const std::unique_ptr<icu::BreakIterator> iterator = [] {
        UErrorCode status = U_ZERO_ERROR;
        return std::unique_ptr<icu::BreakIterator>(
            icu::BreakIterator::createLineInstance(icu::Locale::getRoot(), status));
    }();
    return iterator.get();
}

std::vector<std::size_t> boundaries(icu::BreakIterator* iterator, const std::string& text) {
    std::vector<std::size_t> found;
    UErrorCode status = U_ZERO_ERROR;
    UText source = UTEXT_INITIALIZER;
    utext_openUTF8(&source, text.data(), static_cast<std::int64_t>(text.size()), &status);
    if (iterator && U_SUCCESS(status)) {
        iterator->setText(&source, status);
        iterator->first();
        for (auto at = iterator->next(); at != icu::BreakIterator::DONE; at = iterator->next())
            found.push_back(static_cast<std::size_t>(at));
    }
    utext_close(&source);
    return found;
}

} // namespace

_TextBreaks _TextBreaks::of(const std::string& text) {
    _TextBreaks breaks;
    if (text.empty())
        return breaks;
    breaks.clusters = boundaries(characterIterator(), text);
    if (!breaks.clusters.empty())
        breaks.clusters.pop_back();
    breaks.clusters.insert(breaks.clusters.begin(), 0);
    breaks.opportunities = boundaries(lineIterator(), text);
    return breaks;
}

bool _isSpaceAt(const std::string& text, std::size_t offset) {
    const auto character = characterAt(text, offset);
    return u_isUWhiteSpace(character) && character != NoBreakSpace && character != FigureSpace &&
           character != NarrowNoBreakSpace;
}

bool _isParagraphEndAt(const std::string& text, std::size_t offset) {
    const auto character = characterAt(text, offset);
    return (character >= '\n' && character <= '\r') || character == NextLine ||
           character == LineSeparator || character == ParagraphSeparator;
}

bool _isRightToLeft(const std::string& text, std::size_t begin, std::size_t end, bool otherwise) {
    const auto paragraph = icu::UnicodeString::fromUTF8(
        icu::StringPiece(text.data() + begin, static_cast<std::int32_t>(end - begin)));
    switch (ubidi_getBaseDirection(paragraph.getBuffer(), paragraph.length())) {
    case UBIDI_LTR:
        return false;
    case UBIDI_RTL:
        return true;
    default:
        return otherwise;
    }
}

} // namespace orvo
