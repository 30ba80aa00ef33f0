#pragma once

#include "platform/foundation/NSData.h"

namespace orvo::NSDataOrvoExtra {

/// A plain bzip2 stream of the bytes, with no header of our own; nil when compression fails. Empty
/// data gives a valid stream.
[[nodiscard]] std::shared_ptr<NSData> bzip2CompressedData(const NSData& data);

/// The reverse: nil for anything but one whole stream; empty, not nil, for the stream of empty
/// data.
[[nodiscard]] std::shared_ptr<NSData> bzip2UncompressedData(const NSData& data);

} // namespace orvo::NSDataOrvoExtra
