#pragma once

#include <cstdint>
#include <string_view>

namespace orvo {

/// The multiplier that stands for a true boolean, and scatters whole numbers, in every hash of the
/// system.
inline constexpr std::uint64_t HashMultiplier = 2654435761U;

/// 64-bit FNV-1a: the same on every machine and in every run. `seed` continues an earlier hash.
[[nodiscard]] constexpr std::uint64_t
stableHash(std::string_view bytes, std::uint64_t seed = 0xcbf29ce484222325ULL) noexcept {
    std::uint64_t hash = seed;
    for (const char byte : bytes) {
        hash ^= static_cast<unsigned char>(byte);
        hash *= 0x100000001b3ULL;
    }
    return hash;
}

/// The hash of a number with a fraction. With a = |value| and r = a rounded half up: the fraction a
/// - r in units of 2^-64, plus r modulo 2^64 times the multiplier, wrapping. A fraction below 0
/// counts as 0, so 0.5, 0.7 and 1.0 hash alike; -0.0 as 0.0.
[[nodiscard]] std::uint64_t hashOfDouble(double value);

} // namespace orvo
