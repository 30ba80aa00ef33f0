#include "platform/geoservices/Bzip2.h"

#include <algorithm>
#include <cstdlib>
#include <memory>

namespace {

constexpr std::size_t MaximumOutput = std::size_t{1} << 20U; // keeps a round short

struct Free {
    void operator()(std::uint8_t* bytes) const noexcept { std::free(bytes); }
};
struct Output {
    std::unique_ptr<std::uint8_t, Free> bytes;
    std::size_t length = 0;
    bool isWhole = false;
};

Output uncompressed(const std::uint8_t* bytes, std::size_t length) {
    Output output;
    std::uint8_t* made = nullptr;
    output.isWhole =
        orvo::Bzip2UncompressAtMost(MaximumOutput, bytes, length, &made, &output.length);
    output.bytes.reset(made);
    if (output.isWhole && output.length > MaximumOutput)
        std::abort();
    return output;
}

/// Whatever is compressed comes back, and no part of its stream is taken for the whole.
void compressAndBack(const std::uint8_t* bytes, std::size_t length) {
    std::uint8_t* made = nullptr;
    std::size_t streamLength = 0;
    if (!orvo::Bzip2Compress(bytes, length, &made, &streamLength))
        std::abort();
    const std::unique_ptr<std::uint8_t, Free> stream(made);
    const auto back = uncompressed(stream.get(), streamLength);
    if (!back.isWhole ||
        !std::equal(bytes, bytes + length, back.bytes.get(), back.bytes.get() + back.length))
        std::abort();
    if (uncompressed(stream.get(), streamLength - 1).isWhole)
        std::abort();
}

} // namespace

extern "C" int LLVMFuzzerTestOneInput(const std::uint8_t* data, std::size_t size) {
    (void)uncompressed(data, size);
    if (size <= MaximumOutput)
        compressAndBack(data, size);
    return 0;
}
