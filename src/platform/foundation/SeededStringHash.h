#pragma once

#include <cstddef>
#include <cstdint>
#include <functional>
#include <memory>
#include <string>
#include <string_view>
#include <unordered_map>
#include <unordered_set>
#include <utility>

namespace orvo {

/// The same for equal numbers in this process, and another in every process: who makes a file
/// cannot choose keys that all fall into one bucket. A one-to-one mapping, so that it makes no two
/// hashes the same.
[[nodiscard]] std::uint64_t scattered(std::uint64_t hash);

/// Hashes text that others chose, for tables that live as long as the process: seeded anew in every
/// process, so that nobody can prepare texts with one hash. Never to be stored or shown.
struct SeededStringHash {
    using is_transparent = void;

    [[nodiscard]] std::size_t operator()(std::string_view text) const noexcept;
};

/// Hashes numbers that follow from what others chose, such as a line's.
struct SeededNumberHash {
    [[nodiscard]] std::size_t operator()(std::uint64_t number) const noexcept {
        return scattered(number);
    }
};

/// Tables of foreign text. Those with `std::string` keys are asked with views as well.
template <class Key, class Value, template <class> class Allocator = std::allocator>
using SeededTextMap = std::unordered_map<Key,
                                         Value,
                                         SeededStringHash,
                                         std::equal_to<>,
                                         Allocator<std::pair<const Key, Value>>>;
template <class Key>
using SeededTextSet = std::unordered_set<Key, SeededStringHash, std::equal_to<>>;

/// Tables of such numbers.
template <class Value, template <class> class Allocator = std::allocator>
using SeededNumberMap = std::unordered_map<std::uint64_t,
                                           Value,
                                           SeededNumberHash,
                                           std::equal_to<>,
                                           Allocator<std::pair<const std::uint64_t, Value>>>;
using SeededNumberSet = std::unordered_set<std::uint64_t, SeededNumberHash>;

} // namespace orvo
