#include "platform/protobuf/ProtoWriter.h"

#include <bit>

namespace orvo {

void ProtoWriter::appendVarint(std::uint64_t value) {
    for (; value > 0x7fU; value >>= 7U)
        _bytes.push_back(static_cast<std::uint8_t>(value | 0x80U));
    _bytes.push_back(static_cast<std::uint8_t>(value));
}

void ProtoWriter::appendTag(std::uint32_t fieldNumber, ProtoWireType wireType) {
    appendVarint(static_cast<std::uint64_t>(fieldNumber) << 3U |
                 static_cast<std::uint32_t>(wireType));
}

void ProtoWriter::writeUInt64(std::uint32_t fieldNumber, std::uint64_t value) {
    appendTag(fieldNumber, ProtoWireType::Varint);
    appendVarint(value);
}

void ProtoWriter::writeInt32(std::uint32_t fieldNumber, std::int32_t value) {
    writeUInt64(fieldNumber, static_cast<std::uint64_t>(std::int64_t{value}));
}

void ProtoWriter::writeDouble(std::uint32_t fieldNumber, double value) {
    appendTag(fieldNumber, ProtoWireType::Fixed64);
    const auto bits = std::bit_cast<std::uint64_t>(value);
    for (unsigned shift = 0; shift < 64; shift += 8)
        _bytes.push_back(static_cast<std::uint8_t>(bits >> shift));
}

void ProtoWriter::writeString(std::uint32_t fieldNumber, std::string_view utf8) {
    appendTag(fieldNumber, ProtoWireType::LengthDelimited);
    appendVarint(utf8.size());
    _bytes.insert(_bytes.end(), utf8.begin(), utf8.end());
}

void ProtoWriter::writeBytes(std::uint32_t fieldNumber, std::span<const std::uint8_t> bytes) {
    appendTag(fieldNumber, ProtoWireType::LengthDelimited);
    appendVarint(bytes.size());
    writeRaw(bytes);
}

void ProtoWriter::writeRaw(std::span<const std::uint8_t> bytes) {
    _bytes.insert(_bytes.end(), bytes.begin(), bytes.end());
}

} // namespace orvo
