#pragma once

#include <cstddef>
#include <string_view>

namespace orvo {

/// How many units were left out, added, changed, or swapped with their neighbour between the two.
/// It takes time in the product of the lengths. Any thread.
[[nodiscard]] std::size_t editDistance(std::u16string_view a, std::u16string_view b);

} // namespace orvo
