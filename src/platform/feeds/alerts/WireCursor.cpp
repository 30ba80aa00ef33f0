#include "platform/feeds/alerts/WireCursor.h"

#include <protozero/exception.hpp>
#include <protozero/types.hpp>
#include <protozero/varint.hpp>

#include <array>
#include <limits>

namespace orvo {

namespace {

constexpr std::size_t DeepestGroup = 64;
constexpr std::uint32_t StartOfGroup = 3;
constexpr std::uint32_t EndOfGroup = 4;

constexpr std::uint32_t typeOf(protozero::pbf_wire_type type) {
    return static_cast<std::uint32_t>(type);
}

} // namespace

bool WireCursor::nextOfAnyForm() noexcept {
    if (_failed || _position == _end || !readKey())
        return false;
    return (_key & 7U) == StartOfGroup ? skipGroup() : readValue();
}

bool WireCursor::readKey() noexcept {
    std::uint64_t key = 0;
    if (!readVarint(key))
        return false;
    if (key > std::numeric_limits<Key>::max() || key >> 3U == 0)
        return fail(false);
    _key = static_cast<Key>(key);
    return true;
}

bool WireCursor::readVarint(std::uint64_t& value) noexcept {
    try {
        value = protozero::decode_varint(&_position, _end);
        return true;
    } catch (const protozero::end_of_buffer_exception&) {
        return fail(true);
    } catch (const protozero::exception&) {
        return fail(false);
    }
}

bool WireCursor::readValue() noexcept {
    switch (_key & 7U) {
    case typeOf(protozero::pbf_wire_type::varint):
        return readVarint(_number);
    case typeOf(protozero::pbf_wire_type::fixed64):
        return skip(8);
    case typeOf(protozero::pbf_wire_type::fixed32):
        return skip(4);
    case typeOf(protozero::pbf_wire_type::length_delimited): {
        std::uint64_t length = 0;
        if (!readVarint(length))
            return false;
        const char* const begin = _position;
        if (!skip(length))
            return false;
        _bytes = {begin, static_cast<std::size_t>(length)};
        return true;
    }
    default:
        return fail(false);
    }
}

bool WireCursor::skip(std::uint64_t length) noexcept {
    if (length > remaining())
        return fail(true);
    _position += length;
    return true;
}

/// The groups that are open are kept in a list of fixed size, so that no nesting can use up the
/// stack.
bool WireCursor::skipGroup() noexcept {
    std::array<std::uint32_t, DeepestGroup> open{};
    std::size_t depth = 0;
    const Key group = _key;
    open[depth++] = field();
    while (depth > 0) {
        if (_position == _end)
            return fail(true);
        if (!readKey())
            return false;
        if ((_key & 7U) == StartOfGroup) {
            if (depth == open.size())
                return fail(false);
            open[depth++] = field();
        } else if ((_key & 7U) == EndOfGroup) {
            if (open[--depth] != field())
                return fail(false);
        } else if (!readValue()) {
            return false;
        }
    }
    _key = group;
    return true;
}

bool WireCursor::fail(bool cutShort) noexcept {
    _failed = true;
    _cutShort = cutShort;
    _position = _end;
    return false;
}

} // namespace orvo
