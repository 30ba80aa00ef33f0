#pragma once

#include "platform/foundation/EnvironmentSlot.h"
#include "platform/foundation/NSValue.h"

#include <optional>
#include <string>
#include <string_view>
#include <vector>

/// What depends on a language and writing system: words, searching, case. Positions are in UTF-16
/// units. Text that is not valid UTF-8 is read with U+FFFD for each bad sequence. Any thread.
namespace orvo::Text {

/// The language that the person reads, as a BCP-47 tag: `de-CH`. Default: `defaultLocale()`.
EnvironmentSlot<std::string>& locale();
/// The first of the variables `LC_ALL`, `LC_MESSAGES` and `LANG` that is set; `en` where that is
/// none, `C` or `POSIX`.
[[nodiscard]] std::string defaultLocale();

/// Whether one reads that language, a BCP-47 tag, from right to left.
[[nodiscard]] bool isRightToLeft(const std::string& tag);

struct Word {
    std::string text;
    NSRange range;
};

/// The words of `text` in order, found by the current locale's rules, with a dictionary where the
/// writing does not part them: what holds a letter, a digit or an ideograph. Blanks, punctuation
/// and symbols are no words.
[[nodiscard]] std::vector<Word> words(std::string_view text);

/// The first place at which `needle` stands in `text` by the locale's primary strength: case,
/// accents and width do not count. Nothing when it stands nowhere, is empty, or holds nothing that
/// counts at that strength.
[[nodiscard]] std::optional<NSRange> localizedStandardRange(std::string_view text,
                                                            std::string_view needle);

/// The length in UTF-16 units.
[[nodiscard]] std::size_t utf16Length(std::string_view text);

/// The text in UTF-16: what ranges count in.
[[nodiscard]] std::u16string utf16(std::string_view text);
/// Unpaired surrogates become U+FFFD.
[[nodiscard]] std::string utf8(std::u16string_view text);

/// Whether the bytes are UTF-8 throughout.
[[nodiscard]] bool isValidUTF8(std::string_view text);

} // namespace orvo::Text
