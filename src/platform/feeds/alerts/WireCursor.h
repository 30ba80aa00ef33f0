#pragma once

#include <cstddef>
#include <cstdint>
#include <string_view>

namespace orvo {

/// Walks the fields of one protobuf message, whatever its bytes. Each field is read whole, value
/// and all, before it is shown, so no getter can be called on the wrong wire type. A group is one
/// field, which has no value to get; it is stepped over without recursion. Views into the bytes;
/// nothing is copied or allocated.
class WireCursor {
public:
    /// Which field of which wire type, in one number for `switch`.
    using Key = std::uint32_t;
    [[nodiscard]] static constexpr Key number(std::uint32_t field) noexcept { return field << 3U; }
    [[nodiscard]] static constexpr Key bytes(std::uint32_t field) noexcept {
        return (field << 3U) | 2U;
    }

    explicit WireCursor(std::string_view message) noexcept
        : _position(message.data())
        , _end(message.data() + message.size()) {}

    /// Moves to the next field, known or not: which of the known ones came in the wrong wire type
    /// is for the caller to see. False at the end, and from the first thing on that is no field:
    /// then `failed()`.
    [[nodiscard]] bool next() noexcept {
        // Nearly every field has a key and a value, or a length, of one byte.
        if (remaining() >= 2) {
            const Key key = static_cast<unsigned char>(_position[0]);
            const std::size_t value = static_cast<unsigned char>(_position[1]);
            const bool areShort = key - 8U < 0x78U && value < 0x80U;
            if (areShort && (key & 7U) == 2U && remaining() - 2 >= value) {
                _key = key;
                _bytes = {_position + 2, value};
                _position += 2 + value;
                return true;
            }
            if (areShort && (key & 7U) == 0U) {
                _key = key;
                _number = value;
                _position += 2;
                return true;
            }
            // Longer texts and messages have a length of two bytes.
            if (value >= 0x80 && (key & 7U) == 2U && key - 8U < 0x78U && remaining() >= 3) {
                const std::size_t high = static_cast<unsigned char>(_position[2]);
                const std::size_t length = (value & 0x7FU) | (high << 7U);
                if (high < 0x80U && remaining() - 3 >= length) {
                    _key = key;
                    _bytes = {_position + 3, length};
                    _position += 3 + length;
                    return true;
                }
            }
        }
        return nextOfAnyForm();
    }

    /// Gives what follows the current field, from its first byte to behind the last, to `skim`,
    /// which steps over as many whole fields as it likes and answers where it stopped.
    template <class Skim>
    void skipWith(const Skim& skim) noexcept {
        _position = skim(_position, _end);
    }

    /// Where the next field begins, or the message ends.
    [[nodiscard]] const char* position() const noexcept { return _position; }
    /// Of the current field.
    [[nodiscard]] Key key() const noexcept { return _key; }
    [[nodiscard]] std::uint32_t field() const noexcept { return _key >> 3U; }
    /// The value of a `number` field.
    [[nodiscard]] std::uint64_t number() const noexcept { return _number; }
    /// The value of a `bytes` field.
    [[nodiscard]] std::string_view bytes() const noexcept { return _bytes; }

    /// Whether the message cannot be walked to its end.
    [[nodiscard]] bool failed() const noexcept { return _failed; }
    /// Whether it failed because something reaches past its end.
    [[nodiscard]] bool wasCutShort() const noexcept { return _cutShort; }

private:
    [[nodiscard]] std::size_t remaining() const noexcept {
        return static_cast<std::size_t>(_end - _position);
    }
    bool nextOfAnyForm() noexcept;
    bool readKey() noexcept;
    bool readVarint(std::uint64_t& value) noexcept;
    bool readValue() noexcept;
    bool skip(std::uint64_t length) noexcept;
    bool skipGroup() noexcept;
    bool fail(bool cutShort) noexcept;

    const char* _position;
    const char* _end;
    Key _key = 0;
    std::uint64_t _number = 0;
    std::string_view _bytes;
    bool _failed = false;
    bool _cutShort = false;
};

} // namespace orvo
