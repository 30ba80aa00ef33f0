#include "platform/feeds/http/Inflation.h"

#include <algorithm>
#include <limits>
#include <zlib.h>

namespace orvo {

namespace {

constexpr int GzipWindow = 16 + MAX_WBITS; // zlib's way to say "gzip and nothing else"
constexpr std::size_t Step = 256 * 1024;

class Inflater {
public:
    Inflater() { _isReady = inflateInit2(&_stream, GzipWindow) == Z_OK; }
    Inflater(const Inflater&) = delete;
    Inflater& operator=(const Inflater&) = delete;
    ~Inflater() { inflateEnd(&_stream); }

    Inflation inflateAll(std::span<const std::uint8_t> bytes, std::uint64_t maximumBytes) {
        std::vector<std::uint8_t> whole;
        std::size_t given = 0;
        int result = Z_OK;
        while (_isReady && (result != Z_STREAM_END || given < bytes.size())) {
            if (result == Z_STREAM_END && inflateReset(&_stream) != Z_OK)
                return {};
            const auto input = bytes.subspan(given).first(
                std::min<std::size_t>(bytes.size() - given, std::numeric_limits<uInt>::max()));
            // zlib's interface is older than `const`; it only reads.
            _stream.next_in = const_cast<Bytef*>(input.data());
            _stream.avail_in = static_cast<uInt>(input.size());
            const auto size = whole.size();
            whole.resize(size + Step);
            _stream.next_out = whole.data() + size;
            _stream.avail_out = Step;
            result = ::inflate(&_stream, Z_NO_FLUSH);
            whole.resize(size + Step - _stream.avail_out);
            const auto taken = input.size() - _stream.avail_in;
            given += taken;
            if (whole.size() > maximumBytes)
                return {Inflation::Outcome::TooLarge, nullptr};
            if ((result != Z_OK && result != Z_STREAM_END) ||
                (result == Z_OK && taken == 0 && whole.size() == size))
                return {};
        }
        if (!_isReady)
            return {};
        whole.shrink_to_fit();
        return {Inflation::Outcome::Whole, NSData::dataWithVector(std::move(whole))};
    }

private:
    z_stream _stream{};
    bool _isReady = false;
};

} // namespace

Inflation inflateGzip(std::span<const std::uint8_t> bytes, std::uint64_t maximumBytes) {
    return Inflater().inflateAll(bytes, maximumBytes);
}

} // namespace orvo
