#pragma once

#include <string>
#include <string_view>

/// The character references of HTML: the 252 names of HTML 4, `&apos;`, and numbers.
namespace orvo::HTMLEntities {

/// Each reference that ends with a semicolon is replaced by its character, once: a result that
/// looks like a reference stays. Unknown names, numbers of no character and control characters are
/// left as they are. Numbers 128 to 159 are read as Windows-1252, as browsers do.
[[nodiscard]] std::string decoded(std::string_view text);

} // namespace orvo::HTMLEntities
