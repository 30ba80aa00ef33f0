#pragma once

#include <cstddef>
#include <string>
#include <string_view>

/// Makes published text fit to be shown.
namespace orvo::TextCleaner {

/// The most characters of a title, and of any other text.
inline constexpr std::size_t LongestTitle = 200;
inline constexpr std::size_t LongestText = 20'000;
/// The most bytes of a published text that are looked at: room for a lot of markup around what can
/// be shown. Megabytes of text are a mistake or malice, and would keep all others waiting.
inline constexpr std::size_t LongestPublished = std::size_t{1} << 20U;

/// Plain text: tags stripped, character references decoded (twice where they were escaped twice),
/// control characters and those that override the direction of writing dropped. Line breaks stay,
/// at most one empty line in a row; runs of blanks become one; nothing blank stands at either end
/// of a line. Empty for a text in which nothing can be seen. `text` is valid UTF-8.
[[nodiscard]] std::string clean(std::string_view text);

/// `clean` and then `onOneLine`.
[[nodiscard]] std::string cleanLine(std::string_view text);
/// The same without a copy where nothing is to be cleaned: views `text` then, and leaves `room` as
/// it was; else views `room`, which is written.
[[nodiscard]] std::string_view cleanLine(std::string_view text, std::string& room);

/// A clean text with each run of blanks and line breaks as one blank. Views `cleanText` or `room`,
/// as above; the text may lie in `room`.
[[nodiscard]] std::string_view onOneLine(std::string_view cleanText, std::string& room);

/// The first paragraph of a clean text: up to the first empty line.
[[nodiscard]] std::string_view firstParagraph(std::string_view cleanText) noexcept;

/// The text, or as much of its beginning as is whole characters (as a reader sees them) and at most
/// `most` Unicode characters; a first character that alone has more is cut. No blank stands at the
/// cut.
[[nodiscard]] std::string capped(std::string text, std::size_t most);

} // namespace orvo::TextCleaner
