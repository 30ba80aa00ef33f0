#include "handoff/NSDataOrvoExtra.h"

#include "platform/geoservices/Bzip2.h"

#include <cstdlib>

namespace orvo::NSDataOrvoExtra {

namespace {

std::shared_ptr<NSData> converted(const NSData& data, const Bzip2Routine& routine) {
    std::uint8_t* output = nullptr;
    std::size_t length = 0;
    if (routine(data.bytes().data(), data.length(), &output, &length))
        return NSData::dataWithBytesNoCopy(output, length);
    std::free(output); // NOLINT(cppcoreguidelines-no-malloc): a routine may fail with a half-filled
                       // buffer
    return nullptr;
}

} // namespace

std::shared_ptr<NSData> bzip2CompressedData(const NSData& data) {
    return converted(data, Bzip2Compressor().get());
}

std::shared_ptr<NSData> bzip2UncompressedData(const NSData& data) {
    return converted(data, Bzip2Uncompress);
}

} // namespace orvo::NSDataOrvoExtra
