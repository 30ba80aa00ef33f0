#pragma once

#include "platform/protobuf/ProtoCodable.h"

#include <cstdint>
#include <vector>

namespace orvo::testing {

using Bytes = std::vector<std::uint8_t>;

/// A message as it is handed over.
inline Bytes encoded(const ProtoCodable& message) {
    ProtoWriter writer;
    message.writeTo(writer);
    return writer.bytes();
}

} // namespace orvo::testing
