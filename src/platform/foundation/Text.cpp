#include "platform/foundation/Text.h"

#include "platform/foundation/LocaleVariables.h"

#include <unicode/ubrk.h>
#include <unicode/ucol.h>
#include <unicode/uloc.h>
#include <unicode/usearch.h>
#include <unicode/utf16.h>
#include <unicode/utf8.h>

#include <algorithm>
#include <cstdlib>
#include <limits>
#include <memory>

namespace orvo::Text {

namespace {

template <auto Close>
struct Closer {
    template <class T>
    void operator()(T* handle) const {
        Close(handle);
    }
};
using BreakIterator = std::unique_ptr<UBreakIterator, Closer<ubrk_close>>;
using Collator = std::unique_ptr<UCollator, Closer<ucol_close>>;
using StringSearch = std::unique_ptr<UStringSearch, Closer<usearch_close>>;

/// The library counts in 32 bits. Longer text has no words and is not searched.
bool isCountable(std::u16string_view text) {
    return text.size() <= static_cast<std::size_t>(std::numeric_limits<std::int32_t>::max());
}
std::int32_t length32(std::u16string_view text) {
    return static_cast<std::int32_t>(text.size());
}

/// The library's own identifier of the current locale. A tag that it cannot read is the root.
std::string localeIdentifier() {
    UErrorCode status = U_ZERO_ERROR;
    std::string identifier(ULOC_FULLNAME_CAPACITY, '\0');
    const auto length = uloc_forLanguageTag(
        locale().get().c_str(), identifier.data(), ULOC_FULLNAME_CAPACITY, nullptr, &status);
    if (U_FAILURE(status))
        return "";
    identifier.resize(static_cast<std::size_t>(length));
    return identifier;
}

constexpr char16_t ReplacementCharacter = 0xFFFD;

#pragma GCC diagnostic push
#pragma GCC diagnostic ignored "-Wconversion" // the macro's
#pragma GCC diagnostic ignored "-Wsign-conversion"
/// The code point at `i`, which moves behind it; negative for bytes that are none.
UChar32 nextOfUTF8(std::string_view text, std::size_t& i) {
    const char* bytes = text.data();
    UChar32 c = 0;
    U8_NEXT(bytes, i, text.size(), c);
    return c;
}
#pragma GCC diagnostic pop

void appendUTF8(std::string& bytes, char32_t c) {
    const auto continuation = [&](unsigned shift) {
        bytes.push_back(static_cast<char>(0x80U | (c >> shift & 0x3FU)));
    };
    if (c < 0x80) {
        bytes.push_back(static_cast<char>(c));
        return;
    }
    if (c < 0x800) {
        bytes.push_back(static_cast<char>(0xC0U | c >> 6U));
    } else {
        if (c < 0x10000) {
            bytes.push_back(static_cast<char>(0xE0U | c >> 12U));
        } else {
            bytes.push_back(static_cast<char>(0xF0U | c >> 18U));
            continuation(12);
        }
        continuation(6);
    }
    continuation(0);
}

} // namespace

EnvironmentSlot<std::string>& locale() {
    static EnvironmentSlot<std::string> slot(defaultLocale);
    return slot;
}

std::string defaultLocale() {
    return localeOfVariables([](const std::string& variable) -> std::optional<std::string> {
        const char* const value = std::getenv(variable.c_str());
        return value ? std::optional<std::string>(value) : std::nullopt;
    });
}

bool isRightToLeft(const std::string& tag) {
    return uloc_isRightToLeft(tag.c_str()) != 0;
}

std::vector<Word> words(std::string_view text) {
    const auto units = utf16(text);
    if (!isCountable(units))
        return {};
    UErrorCode status = U_ZERO_ERROR;
    const BreakIterator iterator(
        ubrk_open(UBRK_WORD, localeIdentifier().c_str(), units.data(), length32(units), &status));
    if (U_FAILURE(status))
        return {};
    std::vector<Word> words;
    auto begin = ubrk_first(iterator.get());
    for (auto end = ubrk_next(iterator.get()); end != UBRK_DONE; end = ubrk_next(iterator.get())) {
        const NSRange range{static_cast<std::size_t>(begin), static_cast<std::size_t>(end - begin)};
        if (ubrk_getRuleStatus(iterator.get()) >= UBRK_WORD_NONE_LIMIT)
            words.push_back(
                {utf8(std::u16string_view(units).substr(range.location, range.length)), range});
        begin = end;
    }
    return words;
}

std::optional<NSRange> localizedStandardRange(std::string_view text, std::string_view needle) {
    const auto where = utf16(text);
    const auto what = utf16(needle);
    if (where.empty() || what.empty() || !isCountable(where) || !isCountable(what))
        return std::nullopt; // the search library does not take empty texts
    UErrorCode status = U_ZERO_ERROR;
    const Collator collator(ucol_open(localeIdentifier().c_str(), &status));
    if (U_FAILURE(status))
        return std::nullopt;
    ucol_setStrength(collator.get(), UCOL_PRIMARY);
    const StringSearch search(usearch_openFromCollator(what.data(),
                                                       length32(what),
                                                       where.data(),
                                                       length32(where),
                                                       collator.get(),
                                                       nullptr,
                                                       &status));
    if (U_FAILURE(status))
        return std::nullopt;
    const auto location = usearch_first(search.get(), &status);
    const auto length = usearch_getMatchedLength(search.get());
    if (U_FAILURE(status) || location == USEARCH_DONE || length <= 0)
        return std::nullopt;
    return NSRange{static_cast<std::size_t>(location), static_cast<std::size_t>(length)};
}

std::size_t utf16Length(std::string_view text) {
    std::size_t units = 0;
    for (std::size_t i = 0; i < text.size();)
        units += nextOfUTF8(text, i) > 0xFFFF ? 2U : 1U;
    return units;
}

std::u16string utf16(std::string_view text) {
    std::u16string units;
    units.reserve(text.size());
    for (std::size_t i = 0; i < text.size();) {
        const auto c = nextOfUTF8(text, i);
        if (c < 0) {
            units.push_back(ReplacementCharacter);
        } else if (c <= 0xFFFF) {
            units.push_back(static_cast<char16_t>(c));
        } else {
            units.push_back(U16_LEAD(c));
            units.push_back(U16_TRAIL(c));
        }
    }
    return units;
}

std::string utf8(std::u16string_view text) {
    std::string bytes;
    bytes.reserve(text.size());
    for (std::size_t i = 0; i < text.size(); ++i) {
        char32_t c = text[i];
        const char32_t following = i + 1 < text.size() ? text[i + 1] : U'\0';
        if (U16_IS_LEAD(c) && U16_IS_TRAIL(following)) {
            c = 0x10000 + ((c - 0xD800) << 10U) + (following - 0xDC00);
            ++i;
        } else if (U16_IS_SURROGATE(c)) {
            c = ReplacementCharacter;
        }
        appendUTF8(bytes, c);
    }
    return bytes;
}

bool isValidUTF8(std::string_view text) {
    for (std::size_t i = 0; i < text.size();)
        if (nextOfUTF8(text, i) < 0)
            return false;
    return true;
}

} // namespace orvo::Text
