#pragma once

#include "platform/protobuf/ProtoCodable.h"

#include <cstdint>
#include <vector>

namespace orvo {

/// How the map application should show what it is handed. Only the map type is this program's
/// business; every other field that was read is carried through and written after it.
class URLOptions final : public ProtoCodable {
public:
    [[nodiscard]] std::int32_t mapType() const noexcept { return _mapType; }
    [[nodiscard]] bool hasMapType() const noexcept { return _hasMapType; }
    void setMapType(std::int32_t mapType) noexcept;

    bool readFrom(ProtoReader& reader) override;
    void writeTo(ProtoWriter& writer) const override;
    void mergeFrom(const ProtoCodable& other) override;
    [[nodiscard]] std::shared_ptr<NSDictionary> dictionaryRepresentation() const override;
    [[nodiscard]] bool isEqual(const NSObject* other) const override;
    [[nodiscard]] std::uint64_t hash() const override;
    [[nodiscard]] std::shared_ptr<NSObject> copy() const override;

private:
    static constexpr std::uint32_t MapTypeField = 1;

    std::int32_t _mapType = 0;
    bool _hasMapType = false;
    std::vector<std::uint8_t> _otherFields; // as encoded
};

} // namespace orvo
