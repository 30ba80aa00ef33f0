#pragma once

#include <stdexcept>
#include <string>
#include <zlib.h>

namespace orvo::testing {

/// One gzip member.
inline std::string gzip(std::string text) {
    z_stream stream{};
    constexpr int GzipWindow = 16 + MAX_WBITS;
    if (deflateInit2(&stream, 9, Z_DEFLATED, GzipWindow, 8, Z_DEFAULT_STRATEGY) != Z_OK)
        throw std::runtime_error("no memory");
    std::string packed(text.size() + 100, '\0');
    stream.next_in = reinterpret_cast<Bytef*>(text.data());
    stream.avail_in = static_cast<uInt>(text.size());
    stream.next_out = reinterpret_cast<Bytef*>(packed.data());
    stream.avail_out = static_cast<uInt>(packed.size());
    deflate(&stream, Z_FINISH);
    packed.resize(stream.total_out);
    deflateEnd(&stream);
    return packed;
}

} // namespace orvo::testing
