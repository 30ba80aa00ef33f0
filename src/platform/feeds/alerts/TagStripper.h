#pragma once

#include <string>
#include <string_view>

/// Takes the tags out of text that may be HTML.
namespace orvo::TagStripper {

/// Tags and comments are dropped, scripts and style sheets with what is in them. Those that end a
/// line or a paragraph leave a line break or an empty line, cells of a table a blank. A `<` that
/// begins no tag stays.
[[nodiscard]] std::string stripped(std::string_view text);

} // namespace orvo::TagStripper
