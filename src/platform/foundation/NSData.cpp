#include "platform/foundation/NSData.h"

#include "platform/foundation/Hashing.h"

#include <algorithm>
#include <cstdlib>
#include <fmt/format.h>

namespace orvo {

std::shared_ptr<NSData> NSData::dataWithBytes(std::span<const std::uint8_t> bytes) {
    return dataWithVector({bytes.begin(), bytes.end()});
}

std::shared_ptr<NSData> NSData::dataWithString(std::string_view bytes) {
    return dataWithVector({bytes.begin(), bytes.end()});
}

std::shared_ptr<NSData> NSData::dataWithVector(std::vector<std::uint8_t> bytes) {
    auto data = std::make_shared<NSData>();
    data->_storage = std::move(bytes);
    data->_bytes = data->_storage;
    return data;
}

std::shared_ptr<NSData> NSData::dataWithBytesNoCopy(std::uint8_t* bytes, std::size_t length) {
    auto data = std::make_shared<NSData>();
    data->_owned = bytes;
    data->_bytes = {bytes, length};
    return data;
}

NSData::~NSData() {
    std::free(_owned);
} // NOLINT(cppcoreguidelines-no-malloc): owned as malloc's memory

std::string_view NSData::stringView() const noexcept {
    return {reinterpret_cast<const char*>(_bytes.data()), _bytes.size()};
}

bool NSData::isEqual(const NSObject* other) const {
    const auto* data = dynamic_cast<const NSData*>(other);
    return data && std::ranges::equal(_bytes, data->_bytes);
}

std::uint64_t NSData::hash() const {
    return stableHash(stringView());
}

std::string NSData::description() const {
    constexpr std::size_t shownWhole = 24;
    constexpr std::size_t shownEnd = 8;
    std::string hex;
    const auto append = [&](std::span<const std::uint8_t> part) {
        for (const auto byte : part)
            hex += fmt::format("{:02x}", byte);
    };
    if (_bytes.size() <= shownWhole) {
        append(_bytes);
    } else {
        append(_bytes.first(shownWhole - shownEnd));
        hex += " ... ";
        append(_bytes.last(shownEnd));
    }
    return fmt::format("{{length = {}, bytes = 0x{}}}", _bytes.size(), hex);
}

std::shared_ptr<NSObject> NSData::copy() const {
    return std::const_pointer_cast<NSObject>(shared_from_this());
}

} // namespace orvo
