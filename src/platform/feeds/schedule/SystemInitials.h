#pragma once

#include <string>
#include <string_view>

namespace orvo {

/// What a system's own mark says: the initials of its name, at most three characters. Of several
/// words the first of each, those in small letters passed over where others are not; of one word
/// its capitals, or its first letter. Empty for a name without letters and digits.
[[nodiscard]] std::string systemInitials(std::string_view name);

} // namespace orvo
