#pragma once

#include <array>
#include <bit>
#include <cstddef>
#include <cstdint>
#include <cstring>
#include <string_view>

/// Looks at many bytes quickly: eight or sixteen at a time.
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

/// So many bytes are compared at once.
inline constexpr std::size_t Block = 16;

/// Whether a block is visible ASCII and single blanks, without `<` and `&`; the byte behind it,
/// which can be read, makes no second blank with its last.
[[nodiscard]] inline bool isPlainText(const char* block) noexcept {
    using Characters [[gnu::vector_size(Block)]] = signed char;
    Characters characters{};
    Characters next{};
    std::memcpy(&characters, block, Block);
    std::memcpy(&next, block + 1, Block);
    // What is beyond ASCII is below 0.
    const auto others = (characters < ' ') | (characters == '\x7F') | (characters == '<') |
                        (characters == '&') | ((characters == ' ') & (next == ' '));
    const auto words = std::bit_cast<std::array<std::uint64_t, Block / Word>>(others);
    return (words[0] | words[1]) == 0;
}

/// A hash for tables of this run: quick, and not the same on every machine. Every bit of it depends
/// on every byte, wherever in the text the few lie that differ from one to the next.
[[nodiscard]] inline std::uint64_t quickHash(std::string_view bytes) noexcept {
    constexpr std::uint64_t Multiplier = 0x9E3779B97F4A7C15ULL;
    // A product's low bits know nothing of the factors' high ones: they are brought down.
    const auto mixed = [](std::uint64_t hash) {
        hash *= Multiplier;
        return hash ^ (hash >> 32U);
    };
    std::uint64_t hash = bytes.size() * Multiplier;
    if (bytes.size() < Word) {
        hash ^= shortWord(bytes);
    } else {
        for (std::size_t i = 0; i + Word < bytes.size(); i += Word)
            hash = mixed(hash ^ wordAt(bytes.data() + i));
        hash ^= wordAt(bytes.data() + bytes.size() - Word);
    }
    return mixed(mixed(hash));
}

} // namespace orvo::ByteScan
