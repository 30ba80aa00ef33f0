#pragma once

#include "platform/feeds/schedule/ScheduleStream.h"

#include <memory>
#include <string>
#include <string_view>

namespace orvo {

/// Gives a stream's text as UTF-8, piece by piece: a byte-order mark is dropped, and UTF-16 that is
/// announced by its mark is converted. Bytes without a mark are passed on as they are, unchecked.
class TextDecoder {
public:
    /// `file` stands in messages. The stream must outlive the decoder.
    TextDecoder(ScheduleStream& stream, std::string file);

    /// The next piece, valid until the next call; empty at the end, and on failure, which sets
    /// `error`: the stream's own, or UTF-16 that is cut or has half a pair. What stands before such
    /// a place is given first.
    [[nodiscard]] std::string_view next(std::shared_ptr<NSError>& error);

private:
    enum class Encoding { Unknown, Utf8, Utf16LittleEndian, Utf16BigEndian };

    std::size_t detect();
    bool convert(std::string_view bytes);
    bool appendUnit(char16_t unit);
    [[nodiscard]] std::shared_ptr<NSError> badUtf16() const;

    static constexpr std::size_t BufferSize = std::size_t{1} << 16;

    ScheduleStream& _stream;
    std::string _file;
    Encoding _encoding = Encoding::Unknown;
    std::string _buffer;
    std::size_t _length = 0; // bytes of _buffer in use
    std::string _converted;
    char16_t _highSurrogate = 0; // waits for its other half
    int _oddByte = -1;           // the first half of a unit that the last piece was cut in
    bool _ended = false;
    bool _isBad = false; // told once what stands before it was given
};

} // namespace orvo
