#include "platform/geoservices/TransitIconDataSource.h"

#include "platform/foundation/Hashing.h"
#include "platform/foundation/NSString.h"

namespace orvo {

std::shared_ptr<TransitIconDataSource> TransitIconDataSource::initWithFields(Fields fields) {
    auto value = std::make_shared<TransitIconDataSource>();
    value->_fields = std::move(fields);
    return value;
}

bool TransitIconDataSource::isEqual(const NSObject* other) const {
    const auto* value = dynamic_cast<const TransitIconDataSource*>(other);
    if (!value)
        return false;
    const auto& a = _fields;
    const auto& b = value->_fields;
    return a.iconType == b.iconType && a.cartoID == b.cartoID &&
           a.defaultTransitType == b.defaultTransitType &&
           a.iconAttributeKey == b.iconAttributeKey && a.iconAttributeValue == b.iconAttributeValue;
}

std::uint64_t TransitIconDataSource::hash() const {
    return static_cast<std::uint64_t>(_fields.iconType) * HashMultiplier ^
           (static_cast<std::uint64_t>(_fields.cartoID) * HashMultiplier) * 3 ^
           (static_cast<std::uint64_t>(_fields.defaultTransitType) * HashMultiplier) * 5 ^
           (static_cast<std::uint64_t>(_fields.iconAttributeKey) * HashMultiplier) * 7 ^
           (static_cast<std::uint64_t>(_fields.iconAttributeValue) * HashMultiplier) * 9;
}

} // namespace orvo
