#pragma once

#include "platform/foundation/NSData.h"

#include <cstdint>
#include <memory>
#include <span>

namespace orvo {

/// How inflating went.
struct Inflation {
    enum class Outcome {
        Whole,
        Damaged, ///< no gzip, cut short, or with more behind it that is no gzip
        TooLarge ///< more than the limit; no more than that was ever held
    };
    Outcome outcome = Outcome::Damaged;
    std::shared_ptr<NSData> bytes; ///< nil unless whole
};

/// The content of one or more gzip members. Their checksums are checked, and the last one's end:
/// the toolkit's own decoder takes a stream that was cut for a whole one.
[[nodiscard]] Inflation inflateGzip(std::span<const std::uint8_t> bytes,
                                    std::uint64_t maximumBytes);

} // namespace orvo
