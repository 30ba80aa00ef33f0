#pragma once

#include <string>
#include <string_view>
#include <vector>

/// Text as a terminal shows it, measured in columns: East Asian wide characters and emoji take two,
/// combining marks and format characters none. All texts are UTF-8; a bad byte counts as one
/// column.
namespace orvo::DisplayText {

[[nodiscard]] std::size_t width(std::string_view text);

/// The text itself when it fits into `columns`, else its beginning and `…`.
[[nodiscard]] std::string cut(std::string_view text, std::size_t columns);

/// Lines of at most `columns`, broken at blanks; a word that is longer has a line of its own, since
/// a broken address cannot be copied. Line breaks in the text stay. Empty text gives no line.
[[nodiscard]] std::vector<std::string> wrap(std::string_view text, std::size_t columns);

/// The text in one line: control characters, which a terminal might obey, and runs of white space
/// become one blank; characters that override the direction of writing are left out.
[[nodiscard]] std::string oneLine(std::string_view text);

} // namespace orvo::DisplayText
