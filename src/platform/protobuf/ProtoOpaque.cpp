#include "platform/protobuf/ProtoOpaque.h"

#include "platform/foundation/Hashing.h"

#include <typeinfo>

namespace orvo {

bool ProtoOpaque::readFrom(ProtoReader& reader) {
    const auto rest = reader.readRest();
    _bytes.assign(rest.begin(), rest.end());
    return !reader.hasError();
}

void ProtoOpaque::writeTo(ProtoWriter& writer) const {
    writer.writeRaw(_bytes);
}

void ProtoOpaque::mergeFrom(const ProtoCodable& other) {
    if (typeid(*this) != typeid(other))
        return;
    const auto appended =
        dynamic_cast<const ProtoOpaque&>(other)._bytes; // a copy: it may be the receiver
    _bytes.insert(_bytes.end(), appended.begin(), appended.end());
}

std::shared_ptr<NSDictionary> ProtoOpaque::dictionaryRepresentation() const {
    if (_bytes.empty())
        return NSDictionary::dictionary();
    return NSDictionary::dictionaryWithTextKeys({{"bytes", NSData::dataWithBytes(_bytes)}});
}

bool ProtoOpaque::isEqual(const NSObject* other) const {
    return other && typeid(*this) == typeid(*other) &&
           _bytes == dynamic_cast<const ProtoOpaque&>(*other)._bytes;
}

std::uint64_t ProtoOpaque::hash() const {
    return stableHash({reinterpret_cast<const char*>(_bytes.data()), _bytes.size()});
}

std::shared_ptr<NSObject> ProtoOpaque::copy() const {
    auto copy = _alloc();
    copy->_bytes = _bytes;
    return copy;
}

} // namespace orvo
