#include "platform/protobuf/ProtoReader.h"

#include <bit>

namespace orvo {

bool ProtoReader::take(std::size_t count, std::span<const std::uint8_t>& bytes) {
    if (_error || count > _limit - _position) {
        recordError();
        return false;
    }
    bytes = _bytes.subspan(_position, count);
    _position += count;
    return true;
}

std::uint64_t ProtoReader::readVarint() {
    constexpr int longest = 10;
    std::uint64_t value = 0;
    for (int i = 0; i < longest; ++i) {
        std::span<const std::uint8_t> byte;
        if (!take(1, byte))
            return 0;
        value |= static_cast<std::uint64_t>(byte[0] & 0x7fU)
                 << (7 * i); // the tenth byte's upper bits fall off
        if ((byte[0] & 0x80U) == 0)
            return value;
    }
    recordError();
    return 0;
}

ProtoTag ProtoReader::readTag() {
    const auto value = readVarint();
    const auto wireType = static_cast<std::uint32_t>(value & 7U);
    if (wireType > static_cast<std::uint32_t>(ProtoWireType::Fixed32))
        recordError();
    if (_error)
        return {};
    return {static_cast<std::uint32_t>(value >> 3U), static_cast<ProtoWireType>(wireType)};
}

std::uint32_t ProtoReader::readFixed32() {
    std::span<const std::uint8_t> bytes;
    std::uint32_t value = 0;
    if (take(sizeof value, bytes))
        for (std::size_t i = 0; i < sizeof value; ++i)
            value |= static_cast<std::uint32_t>(bytes[i]) << (8 * i);
    return value;
}

std::uint64_t ProtoReader::readFixed64() {
    std::span<const std::uint8_t> bytes;
    std::uint64_t value = 0;
    if (take(sizeof value, bytes))
        for (std::size_t i = 0; i < sizeof value; ++i)
            value |= static_cast<std::uint64_t>(bytes[i]) << (8 * i);
    return value;
}

double ProtoReader::readDouble() {
    return std::bit_cast<double>(readFixed64());
}

std::span<const std::uint8_t> ProtoReader::readBytes() {
    const auto length = readVarint();
    std::span<const std::uint8_t> bytes;
    if (_error || length > _limit - _position)
        recordError();
    else
        take(static_cast<std::size_t>(length), bytes);
    return bytes;
}

std::string ProtoReader::readString() {
    const auto bytes = readBytes();
    return {bytes.begin(), bytes.end()};
}

std::span<const std::uint8_t> ProtoReader::readRest() {
    std::span<const std::uint8_t> bytes;
    if (!_error)
        take(_limit - _position, bytes);
    return bytes;
}

void ProtoReader::skip(ProtoTag tag) {
    // Groups are walked with a list of their numbers, not by recursion: hostile bytes choose their
    // depth.
    std::vector<std::uint32_t> openGroups;
    while (!_error) {
        switch (tag.wireType) {
        case ProtoWireType::Varint:
            readVarint();
            break;
        case ProtoWireType::Fixed64:
            readFixed64();
            break;
        case ProtoWireType::LengthDelimited:
            readBytes();
            break;
        case ProtoWireType::Fixed32:
            readFixed32();
            break;
        case ProtoWireType::StartGroup:
            openGroups.push_back(tag.fieldNumber);
            if (openGroups.size() > MaximumGroupDepth)
                recordError();
            break;
        case ProtoWireType::EndGroup:
            if (openGroups.empty() || openGroups.back() != tag.fieldNumber)
                recordError();
            else
                openGroups.pop_back();
            break;
        }
        if (openGroups.empty())
            return;
        tag = readTag();
    }
}

bool ProtoReader::placeMark(Mark& mark) {
    const auto length = readVarint();
    if (_error || length > _limit - _position || _markDepth >= MaximumMarkDepth) {
        recordError();
        return false;
    }
    mark._outerLimit = _limit;
    _limit = _position + static_cast<std::size_t>(length);
    ++_markDepth;
    return true;
}

void ProtoReader::recallMark(const Mark& mark) {
    _position = _limit;
    _limit = mark._outerLimit;
    --_markDepth;
}

} // namespace orvo
