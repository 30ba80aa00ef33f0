#include "platform/geoservices/URLOptions.h"

#include "platform/foundation/Hashing.h"
#include "platform/foundation/NSNumber.h"

namespace orvo {

void URLOptions::setMapType(std::int32_t mapType) noexcept {
    _mapType = mapType;
    _hasMapType = true;
}

bool URLOptions::readFrom(ProtoReader& reader) {
    const auto bytes = reader.readRest();
    ProtoReader fields(bytes);
    while (!fields.isAtEnd()) {
        const auto start = fields.position();
        const auto tag = fields.readTag();
        if (tag.wireType == ProtoWireType::EndGroup)
            break;
        if (tag.fieldNumber == MapTypeField && tag.wireType == ProtoWireType::Varint) {
            setMapType(static_cast<std::int32_t>(fields.readVarint()));
            continue;
        }
        fields.skip(tag);
        const auto field = bytes.subspan(start, fields.position() - start);
        _otherFields.insert(_otherFields.end(), field.begin(), field.end());
    }
    return !fields.hasError() && !reader.hasError();
}

void URLOptions::writeTo(ProtoWriter& writer) const {
    if (_hasMapType)
        writer.writeInt32(MapTypeField, _mapType);
    writer.writeRaw(_otherFields);
}

void URLOptions::mergeFrom(const ProtoCodable& other) {
    const auto* options = dynamic_cast<const URLOptions*>(&other);
    if (!options)
        return;
    if (options->_hasMapType)
        setMapType(options->_mapType);
    const auto appended = options->_otherFields; // a copy: the other may be the receiver
    _otherFields.insert(_otherFields.end(), appended.begin(), appended.end());
}

std::shared_ptr<NSDictionary> URLOptions::dictionaryRepresentation() const {
    std::vector<std::pair<std::string, std::shared_ptr<NSObject>>> entries;
    if (_hasMapType)
        entries.emplace_back("mapType", NSNumber::numberWithInteger(_mapType));
    return NSDictionary::dictionaryWithTextKeys(std::move(entries));
}

bool URLOptions::isEqual(const NSObject* other) const {
    const auto* options = dynamic_cast<const URLOptions*>(other);
    return options && options->_hasMapType == _hasMapType &&
           (!_hasMapType || options->_mapType == _mapType) && options->_otherFields == _otherFields;
}

std::uint64_t URLOptions::hash() const {
    return (_hasMapType ? static_cast<std::uint64_t>(std::int64_t{_mapType}) * HashMultiplier : 0) ^
           (_otherFields.empty() ? 0
                                 : stableHash({reinterpret_cast<const char*>(_otherFields.data()),
                                               _otherFields.size()}));
}

std::shared_ptr<NSObject> URLOptions::copy() const {
    auto copy = std::make_shared<URLOptions>();
    copy->mergeFrom(*this);
    return copy;
}

} // namespace orvo
