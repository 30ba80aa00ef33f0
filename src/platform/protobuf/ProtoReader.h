#pragma once

#include "platform/protobuf/ProtoWire.h"

#include <span>
#include <string>
#include <vector>

namespace orvo {

/// Reads the Protocol Buffers encoding from bytes that it does not own. The first thing that is
/// wrong (cut-off input, a length past the limit, a varint of more than ten bytes, an unterminated
/// group) sets the error, for good: from then on there is nothing left to read, and every value
/// reads as 0 or empty. Never throws on bad bytes, allocates no more than they hold.
class ProtoReader {
public:
    /// Remembers where the outer message goes on.
    class Mark {
        friend class ProtoReader;
        std::size_t _outerLimit = 0;
    };

    /// Unknown groups inside one another, at most.
    static constexpr int MaximumGroupDepth = 64;
    /// Messages inside one another, at most, counted by marks.
    static constexpr int MaximumMarkDepth = 100;

    explicit ProtoReader(std::span<const std::uint8_t> bytes) noexcept
        : _bytes(bytes)
        , _limit(bytes.size()) {}

    [[nodiscard]] bool hasError() const noexcept { return _error; }
    /// For a message that finds its content wrong.
    void recordError() noexcept { _error = true; }
    /// At the end of the message that is being read, or after an error.
    [[nodiscard]] bool isAtEnd() const noexcept { return _error || _position >= _limit; }
    [[nodiscard]] std::size_t position() const noexcept { return _position; }

    /// A tag of 64 bits is cut to a field number of 32, as the varint that it is.
    ProtoTag readTag();
    std::uint64_t readVarint();
    std::uint32_t readFixed32();
    std::uint64_t readFixed64();
    double readDouble();
    bool readBool() { return readVarint() != 0; }
    /// A length, then that many bytes.
    std::span<const std::uint8_t> readBytes();
    /// The same as text. The bytes are taken as they are.
    std::string readString();
    /// Everything up to the limit.
    std::span<const std::uint8_t> readRest();
    /// Passes over the value after `tag`: a start-group tag up to its own end-group tag.
    void skip(ProtoTag tag);

    /// Reads a length and makes the message end there. False, with the error set, when it lies past
    /// the limit or messages lie too deep.
    bool placeMark(Mark& mark);
    /// Goes on behind the message that the mark began, wherever its reading stopped.
    void recallMark(const Mark& mark);

private:
    bool take(std::size_t count, std::span<const std::uint8_t>& bytes);

    std::span<const std::uint8_t> _bytes;
    std::size_t _position = 0;
    std::size_t _limit;
    int _markDepth = 0;
    bool _error = false;
};

} // namespace orvo
