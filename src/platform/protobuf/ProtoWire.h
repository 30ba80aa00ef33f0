#pragma once

#include <cstdint>

namespace orvo {

/// The wire types of the Protocol Buffers encoding; 6 and 7 do not exist.
enum class ProtoWireType : std::uint32_t {
    Varint = 0,
    Fixed64 = 1,
    LengthDelimited = 2,
    StartGroup = 3,
    EndGroup = 4,
    Fixed32 = 5,
};

/// What stands before each field.
struct ProtoTag {
    std::uint32_t fieldNumber = 0;
    ProtoWireType wireType = ProtoWireType::Varint;

    friend bool operator==(const ProtoTag&, const ProtoTag&) = default;
};

} // namespace orvo
