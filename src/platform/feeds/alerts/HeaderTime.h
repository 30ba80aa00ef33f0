#pragma once

#include <cstdint>
#include <optional>

namespace orvo {

/// A moment as feeds publish it, in whole seconds since 1970: values above 10^11 are milliseconds.
[[nodiscard]] constexpr std::uint64_t wholeSeconds(std::uint64_t published) noexcept {
    constexpr std::uint64_t LargestInSeconds = 100'000'000'000;
    return published > LargestInSeconds ? published / 1000 : published;
}

/// When a message was made, in seconds since 1970, by its header's timestamp. One of 0, or in the
/// future, tells nothing: then it is when the message was fetched.
/// @param now seconds since 1970
/// @return nothing when the message is more than a day old: it proves nothing any more
[[nodiscard]] std::optional<double>
headerTime(std::uint64_t timestamp, double fetchedAt, double now) noexcept;

} // namespace orvo
