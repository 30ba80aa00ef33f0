#include "platform/feeds/schedule/TextDecoder.h"

#include "platform/feeds/schedule/ScheduleError.h"

#include <utility>

namespace orvo {

namespace {

void appendUtf8(std::string& text, char32_t point) {
    const auto put = [&text](char32_t byte) {
        text.push_back(static_cast<char>(byte));
    };
    if (point < 0x80) {
        put(point);
    } else if (point < 0x800) {
        put(0xC0 | (point >> 6));
        put(0x80 | (point & 0x3F));
    } else if (point < 0x10000) {
        put(0xE0 | (point >> 12));
        put(0x80 | ((point >> 6) & 0x3F));
        put(0x80 | (point & 0x3F));
    } else {
        put(0xF0 | (point >> 18));
        put(0x80 | ((point >> 12) & 0x3F));
        put(0x80 | ((point >> 6) & 0x3F));
        put(0x80 | (point & 0x3F));
    }
}

} // namespace

TextDecoder::TextDecoder(ScheduleStream& stream, std::string file)
    : _stream(stream)
    , _file(std::move(file))
    , _buffer(BufferSize, '\0') {}

std::string_view TextDecoder::next(std::shared_ptr<NSError>& error) {
    while (!_ended && !_isBad) {
        _length = 0;
        // The mark must be seen whole, and a stream may give it byte by byte.
        const std::size_t wanted = _encoding == Encoding::Unknown ? 3 : 1;
        while (_length < wanted) {
            const std::size_t read = _stream.read(std::span(_buffer).subspan(_length), error);
            if (read == 0) {
                _ended = true;
                break;
            }
            _length += read;
        }
        if (error)
            return {};
        const std::size_t start = _encoding == Encoding::Unknown ? detect() : 0;
        const std::string_view piece(_buffer.data() + start, _length - start);
        if (_encoding == Encoding::Utf8) {
            if (!piece.empty())
                return piece;
            continue;
        }
        _converted.clear();
        _isBad = !convert(piece) || (_ended && (_oddByte >= 0 || _highSurrogate));
        if (!_converted.empty())
            return _converted;
    }
    if (_isBad)
        error = badUtf16();
    return {};
}

/// Answers the length of the mark.
std::size_t TextDecoder::detect() {
    const std::string_view head(_buffer.data(), _length);
    if (head.substr(0, 2) == "\xFF\xFE") {
        _encoding = Encoding::Utf16LittleEndian;
        return 2;
    }
    if (head.substr(0, 2) == "\xFE\xFF") {
        _encoding = Encoding::Utf16BigEndian;
        return 2;
    }
    _encoding = Encoding::Utf8;
    return head.substr(0, 3) == "\xEF\xBB\xBF" ? 3 : 0;
}

bool TextDecoder::convert(std::string_view bytes) {
    for (const char character : bytes) {
        const int byte = static_cast<unsigned char>(character);
        if (_oddByte < 0) {
            _oddByte = byte;
            continue;
        }
        const int first = std::exchange(_oddByte, -1);
        const int unit =
            _encoding == Encoding::Utf16LittleEndian ? first | byte << 8 : first << 8 | byte;
        if (!appendUnit(static_cast<char16_t>(unit)))
            return false;
    }
    return true;
}

bool TextDecoder::appendUnit(char16_t unit) {
    const bool isHigh = unit >= 0xD800 && unit < 0xDC00;
    const bool isLow = unit >= 0xDC00 && unit < 0xE000;
    if (isLow != (_highSurrogate != 0))
        return false;
    if (isHigh) {
        _highSurrogate = unit;
        return true;
    }
    char32_t point = unit;
    if (isLow)
        point = 0x10000 +
                ((static_cast<char32_t>(std::exchange(_highSurrogate, u'\0')) - 0xD800) << 10) +
                (point - 0xDC00);
    appendUtf8(_converted, point);
    return true;
}

std::shared_ptr<NSError> TextDecoder::badUtf16() const {
    return scheduleError(ScheduleErrorCode::NotText,
                         _file + ": is marked as UTF-16 but is not valid UTF-16");
}

} // namespace orvo
