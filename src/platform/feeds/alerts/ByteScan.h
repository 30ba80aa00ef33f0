#pragma once

#include <cstddef>
#include <cstdint>
#include <cstring>
#include <string_view>

/// Looks at many bytes quickly: eight at a time.
namespace orvo::ByteScan {

inline constexpr std::size_t Word = sizeof(std::uint64_t);

/// Eight bytes from any place, in the machine's order.
[[nodiscard]] inline std::uint64_t wordAt(const char* bytes) noexcept {
    std::uint64_t word = 0;
    std::memcpy(&word, bytes, Word);
    return word;
}

/// All bytes of a text shorter than a word in one number, without a copy of unknown length.
[[nodiscard]] inline std::uint64_t shortWord(std::string_view bytes) noexcept {
    const std::size_t size = bytes.size();
    if (size >= sizeof(std::uint32_t)) {
        std::uint32_t first = 0;
        std::uint32_t last = 0;
        std::memcpy(&first, bytes.data(), sizeof first);
        std::memcpy(&last, bytes.data() + size - sizeof last, sizeof last);
        return std::uint64_t{first} << 32U | last;
    }
    if (size == 0)
        return 0;
    const auto byteAt = [&](std::size_t i) -> std::uint64_t {
        return static_cast<unsigned char>(bytes[i]);
    };
    return byteAt(0) << 16U | byteAt(size / 2) << 8U | byteAt(size - 1);
}

/// Whether two texts are the same; for short ones without a call.
[[nodiscard]] inline bool isEqual(std::string_view a, std::string_view b) noexcept {
    if (a.size() != b.size())
        return false;
    return a.size() < Word ? shortWord(a) == shortWord(b) : a == b;
}

[[nodiscard]] inline bool isASCII(std::string_view bytes) noexcept {
    std::uint64_t all = 0;
    if (bytes.size() < Word) {
        all = shortWord(bytes);
    } else {
        for (std::size_t i = 0; i + Word <= bytes.size(); i += Word)
            all |= wordAt(bytes.data() + i);
        all |= wordAt(bytes.data() + bytes.size() - Word);
    }
    return (all & 0x8080808080808080ULL) == 0;
}

/// Whether eight bytes are visible ASCII and single blanks, without `<` and `&`. May say no to some
/// that are, never yes to others.
[[nodiscard]] constexpr bool isPlainText(std::uint64_t word) noexcept {
    constexpr std::uint64_t Ones = 0x0101010101010101ULL;
    constexpr std::uint64_t HighBits = Ones << 7U;
    // A byte of `x` is 0 where that of `zeros(x)` has its high bit; above the first such byte some
    // others may have it too.
    const auto zeros = [](std::uint64_t x) {
        return (x - Ones) & ~x & HighBits;
    };
    const std::uint64_t controls = (word - Ones * ' ') & ~word;
    const std::uint64_t beyond = word | (word + Ones); // 0x7F and above
    const std::uint64_t markup = zeros(word ^ (Ones * '<')) | zeros(word ^ (Ones * '&'));
    const std::uint64_t blanks = zeros(word ^ (Ones * ' '));
    return (((controls | beyond) & HighBits) | markup | (blanks & (blanks << 8U))) == 0;
}

/// A hash for tables of this run: quick, and not the same on every machine.
[[nodiscard]] inline std::uint64_t quickHash(std::string_view bytes) noexcept {
    constexpr std::uint64_t Multiplier = 0x9E3779B97F4A7C15ULL;
    std::uint64_t hash = bytes.size() * Multiplier;
    if (bytes.size() < Word) {
        hash ^= shortWord(bytes);
    } else {
        for (std::size_t i = 0; i + Word < bytes.size(); i += Word)
            hash = (hash ^ wordAt(bytes.data() + i)) * Multiplier;
        hash ^= wordAt(bytes.data() + bytes.size() - Word);
    }
    hash *= Multiplier;
    return hash ^ (hash >> 32U);
}

} // namespace orvo::ByteScan
