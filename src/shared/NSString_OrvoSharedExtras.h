#pragma once

#include "platform/foundation/NSArray.h"

#include <string_view>

namespace orvo::OrvoSharedExtras {

/// Where the words that a person typed begin words of `self`: for each word of `searchString`, in
/// order, an `NSValue` with a range of `self` that starts at the first word beginning with it and
/// is as long as the word that was typed. Case and accents do not count. Words are those of the
/// current locale, lengths are in UTF-16 units. Nil when one of the words begins none; empty when
/// nothing was typed.
[[nodiscard]] std::shared_ptr<NSArray>
_orvo_prefixMatchesForSearchString(std::string_view self, std::string_view searchString);

} // namespace orvo::OrvoSharedExtras
