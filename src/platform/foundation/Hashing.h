#pragma once

#include <algorithm>
#include <array>
#include <cstddef>
#include <cstdint>
#include <string_view>

namespace orvo {

/// The multiplier that stands for a true boolean, and scatters whole numbers, in every hash of the
/// system.
inline constexpr std::uint64_t HashMultiplier = 2654435761U;

/// One step of `stableHash`.
[[nodiscard]] constexpr std::uint64_t hashWithByte(std::uint64_t hash, char byte) noexcept {
    return (hash ^ static_cast<unsigned char>(byte)) * 0x100000001b3ULL;
}

/// 64-bit FNV-1a: the same on every machine and in every run. `seed` continues an earlier hash.
[[nodiscard]] constexpr std::uint64_t
stableHash(std::string_view bytes, std::uint64_t seed = 0xcbf29ce484222325ULL) noexcept {
    std::uint64_t hash = seed;
    for (const char byte : bytes)
        hash = hashWithByte(hash, byte);
    return hash;
}

/// So many hashes are worked out in about the time of one.
inline constexpr std::size_t HashLanes = 4;

/// `stableHash` of four texts, of which each continues its own earlier hash. One step of a hash has
/// to wait for the step before; those of the others are done meanwhile.
[[nodiscard]] constexpr std::array<std::uint64_t, HashLanes>
stableHashes(const std::array<std::string_view, HashLanes>& texts,
             const std::array<std::uint64_t, HashLanes>& seeds) noexcept {
    const std::size_t common =
        std::min({texts[0].size(), texts[1].size(), texts[2].size(), texts[3].size()});
    auto [a, b, c, d] = seeds;
    for (std::size_t i = 0; i < common; ++i) {
        a = hashWithByte(a, texts[0][i]);
        b = hashWithByte(b, texts[1][i]);
        c = hashWithByte(c, texts[2][i]);
        d = hashWithByte(d, texts[3][i]);
    }
    return {stableHash(texts[0].substr(common), a),
            stableHash(texts[1].substr(common), b),
            stableHash(texts[2].substr(common), c),
            stableHash(texts[3].substr(common), d)};
}

/// The hash of a number with a fraction. With a = |value| and r = a rounded half up: the fraction a
/// - r in units of 2^-64, plus r modulo 2^64 times the multiplier, wrapping. A fraction below 0
/// counts as 0, so 0.5, 0.7 and 1.0 hash alike; -0.0 as 0.0.
[[nodiscard]] std::uint64_t hashOfDouble(double value);

} // namespace orvo
