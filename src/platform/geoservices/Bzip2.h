#pragma once

#include "platform/foundation/EnvironmentSlot.h"

#include <cstddef>
#include <cstdint>
#include <functional>

namespace orvo {

/// The largest output of a decompression, 256 MiB: past it the input counts as hostile and is
/// refused.
inline constexpr std::size_t Bzip2MaximumOutput = std::size_t{256} << 20U;

/// Compresses `length` bytes into a plain bzip2 stream. On success `*output` is a buffer from
/// `malloc` that the caller frees, and `*outputLength` its length; on failure both are nil and 0.
/// Empty input gives a valid stream. Any thread.
[[nodiscard]] bool Bzip2Compress(const std::uint8_t* bytes,
                                 std::size_t length,
                                 std::uint8_t** output,
                                 std::size_t* outputLength);

/// The reverse, for one whole stream and nothing behind it. A cut-off, damaged or foreign stream
/// fails: never a prefix.
[[nodiscard]] bool Bzip2Uncompress(const std::uint8_t* bytes,
                                   std::size_t length,
                                   std::uint8_t** output,
                                   std::size_t* outputLength);

/// The same, where no more than `maximumOutput` bytes are expected: a stream that holds more fails.
[[nodiscard]] bool Bzip2UncompressAtMost(std::size_t maximumOutput,
                                         const std::uint8_t* bytes,
                                         std::size_t length,
                                         std::uint8_t** output,
                                         std::size_t* outputLength);

/// Either of the first two, as whoever compresses calls it.
using Bzip2Routine =
    std::function<bool(const std::uint8_t*, std::size_t, std::uint8_t**, std::size_t*)>;

/// What compresses. Default: `Bzip2Compress`.
EnvironmentSlot<Bzip2Routine>& Bzip2Compressor();

} // namespace orvo
