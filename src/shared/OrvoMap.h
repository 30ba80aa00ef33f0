#pragma once

#include "platform/foundation/NSArray.h"
#include "platform/foundation/NSObject.h"

#include <functional>

namespace orvo {

/// What `block` answers for each element of `collection`, in enumeration order; a nil answer is
/// left out. `index` is the element's place in the collection, so it goes on counting where answers
/// were left out. A nil collection gives nil, an empty one an empty array.
[[nodiscard]] std::shared_ptr<NSArray>
OrvoMap(const std::shared_ptr<const NSFastEnumeration>& collection,
        const std::function<std::shared_ptr<NSObject>(const std::shared_ptr<NSObject>& element,
                                                      std::size_t index)>& block);

} // namespace orvo
