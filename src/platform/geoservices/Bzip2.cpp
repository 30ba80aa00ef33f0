#include "platform/geoservices/Bzip2.h"

#include <bzlib.h>

#include <algorithm>
#include <cstdlib>
#include <limits>
#include <memory>

namespace orvo {

namespace {

/// A growing buffer of malloc's memory, since whoever takes the result frees it so.
class Output {
public:
    Output() = default;
    Output(const Output&) = delete;
    Output& operator=(const Output&) = delete;
    ~Output() { std::free(_bytes); } // NOLINT(cppcoreguidelines-no-malloc)

    /// Offers the unused end to the stream, after growing where there is none left.
    bool offer(bz_stream& stream, std::size_t maximum) {
        if (_used == _capacity) {
            const auto grown = std::min(maximum, std::max<std::size_t>(4096, _capacity * 2));
            if (grown == _capacity)
                return false;
            auto* bytes = static_cast<std::uint8_t*>(
                std::realloc(_bytes, grown)); // NOLINT(cppcoreguidelines-no-malloc)
            if (!bytes)
                return false;
            _bytes = bytes;
            _capacity = grown;
        }
        stream.next_out = reinterpret_cast<char*>(_bytes + _used);
        stream.avail_out = static_cast<unsigned>(
            std::min<std::size_t>(_capacity - _used, std::numeric_limits<unsigned>::max()));
        return true;
    }
    void tookUpTo(const bz_stream& stream) {
        _used = static_cast<std::size_t>(reinterpret_cast<std::uint8_t*>(stream.next_out) - _bytes);
    }
    void handOver(std::uint8_t** output, std::size_t* length) {
        *output = std::exchange(_bytes, nullptr);
        *length = _used;
    }

private:
    std::uint8_t* _bytes = nullptr;
    std::size_t _capacity = 0;
    std::size_t _used = 0;
};

/// Gives the stream the next piece of input: its lengths are of 32 bits.
void offerInput(bz_stream& stream, const std::uint8_t*& bytes, std::size_t& left) {
    if (stream.avail_in > 0 || left == 0)
        return;
    const auto piece = std::min<std::size_t>(left, std::numeric_limits<unsigned>::max());
    stream.next_in =
        const_cast<char*>(reinterpret_cast<const char*>(bytes)); // the library reads it only
    stream.avail_in = static_cast<unsigned>(piece);
    bytes += piece;
    left -= piece;
}

template <int (*End)(bz_stream*)>
struct StreamEnd {
    void operator()(bz_stream* stream) const { End(stream); }
};

} // namespace

bool Bzip2Compress(const std::uint8_t* bytes,
                   std::size_t length,
                   std::uint8_t** output,
                   std::size_t* outputLength) {
    *output = nullptr;
    *outputLength = 0;
    constexpr int blockSize = 9;
    bz_stream stream{};
    if (BZ2_bzCompressInit(&stream, blockSize, 0, 0) != BZ_OK)
        return false;
    const std::unique_ptr<bz_stream, StreamEnd<BZ2_bzCompressEnd>> end(&stream);
    Output result;
    for (int status = BZ_RUN_OK; status != BZ_STREAM_END;) {
        offerInput(stream, bytes, length);
        if (!result.offer(stream, std::numeric_limits<std::size_t>::max()))
            return false;
        status = BZ2_bzCompress(&stream, length == 0 ? BZ_FINISH : BZ_RUN);
        if (status < 0)
            return false;
        result.tookUpTo(stream);
    }
    result.handOver(output, outputLength);
    return true;
}

bool Bzip2Uncompress(const std::uint8_t* bytes,
                     std::size_t length,
                     std::uint8_t** output,
                     std::size_t* outputLength) {
    return Bzip2UncompressAtMost(Bzip2MaximumOutput, bytes, length, output, outputLength);
}

bool Bzip2UncompressAtMost(std::size_t maximumOutput,
                           const std::uint8_t* bytes,
                           std::size_t length,
                           std::uint8_t** output,
                           std::size_t* outputLength) {
    *output = nullptr;
    *outputLength = 0;
    bz_stream stream{};
    if (BZ2_bzDecompressInit(&stream, 0, 0) != BZ_OK)
        return false;
    const std::unique_ptr<bz_stream, StreamEnd<BZ2_bzDecompressEnd>> end(&stream);
    Output result;
    for (int status = BZ_OK; status != BZ_STREAM_END;) {
        offerInput(stream, bytes, length);
        if (!result.offer(stream, maximumOutput))
            return false;
        const auto room = stream.avail_out;
        status = BZ2_bzDecompress(&stream);
        result.tookUpTo(stream);
        const bool isStuck =
            status == BZ_OK && stream.avail_in == 0 && length == 0 && stream.avail_out == room;
        if ((status != BZ_OK && status != BZ_STREAM_END) || isStuck)
            return false;
    }
    if (stream.avail_in > 0 || length > 0)
        return false;
    result.handOver(output, outputLength);
    return true;
}

EnvironmentSlot<Bzip2Routine>& Bzip2Compressor() {
    static EnvironmentSlot<Bzip2Routine> slot([] { return Bzip2Routine(Bzip2Compress); });
    return slot;
}

} // namespace orvo
