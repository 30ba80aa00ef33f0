#include "platform/foundation/SeededStringHash.h"

#include "platform/foundation/Hashing.h"

#include <random>

namespace orvo {

namespace {

std::uint64_t processSeed() {
    static const std::uint64_t seed = [] {
        std::random_device random;
        return (std::uint64_t{random()} << 32U) | random();
    }();
    return seed;
}

} // namespace

std::uint64_t scattered(std::uint64_t hash) {
    const std::uint64_t seed = processSeed();
    hash = (hash ^ seed) * 0x9E3779B97F4A7C15ULL;
    hash = (hash ^ (hash >> 32U)) * (seed | 1U);
    return hash ^ (hash >> 32U);
}

std::size_t SeededStringHash::operator()(std::string_view text) const noexcept {
    // The seed goes in first: texts with one unseeded hash would keep one after any later mixing.
    return scattered(stableHash(text, processSeed()));
}

} // namespace orvo
