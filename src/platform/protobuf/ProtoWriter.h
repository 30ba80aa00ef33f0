#pragma once

#include "platform/protobuf/ProtoWire.h"

#include <span>
#include <string_view>
#include <vector>

namespace orvo {

/// Writes the Protocol Buffers encoding, each value with its tag.
class ProtoWriter {
public:
    void writeUInt64(std::uint32_t fieldNumber, std::uint64_t value);
    void writeUInt32(std::uint32_t fieldNumber, std::uint32_t value) {
        writeUInt64(fieldNumber, value);
    }
    /// A negative number as the ten bytes of its 64-bit form.
    void writeInt32(std::uint32_t fieldNumber, std::int32_t value);
    void writeBool(std::uint32_t fieldNumber, bool value) {
        writeUInt64(fieldNumber, value ? 1 : 0);
    }
    void writeDouble(std::uint32_t fieldNumber, double value);
    void writeString(std::uint32_t fieldNumber, std::string_view utf8);
    void writeBytes(std::uint32_t fieldNumber, std::span<const std::uint8_t> bytes);
    /// Bytes that are encoded fields already.
    void writeRaw(std::span<const std::uint8_t> bytes);

    [[nodiscard]] const std::vector<std::uint8_t>& bytes() const noexcept { return _bytes; }

private:
    void appendTag(std::uint32_t fieldNumber, ProtoWireType wireType);
    void appendVarint(std::uint64_t value);

    std::vector<std::uint8_t> _bytes;
};

} // namespace orvo
