#include "platform/foundation/Hashing.h"

#include <cmath>

namespace orvo {

namespace {

constexpr double TwoTo64 = 18446744073709551616.0;

/// The whole part of a number: 0 for one below 0 or none at all, the limit for one past the range.
std::uint64_t wholePart(double number) {
    if (!(number > 0))
        return 0;
    return number >= TwoTo64 ? ~std::uint64_t{0} : static_cast<std::uint64_t>(number);
}

} // namespace

std::uint64_t hashOfDouble(double value) {
    const double magnitude = std::abs(value);
    const double rounded = std::floor(magnitude + 0.5);
    return wholePart((magnitude - rounded) * TwoTo64) +
           wholePart(std::fmod(rounded, TwoTo64)) * HashMultiplier;
}

} // namespace orvo
