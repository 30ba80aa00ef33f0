#include "platform/geoservices/TransitShieldDataSource.h"

#include "platform/foundation/Hashing.h"
#include "platform/foundation/NSString.h"

namespace orvo {

std::shared_ptr<TransitShieldDataSource> TransitShieldDataSource::initWithFields(Fields fields) {
    auto value = std::make_shared<TransitShieldDataSource>();
    value->_fields = std::move(fields);
    return value;
}

bool TransitShieldDataSource::isEqual(const NSObject* other) const {
    const auto* value = dynamic_cast<const TransitShieldDataSource*>(other);
    if (!value)
        return false;
    const auto& a = _fields;
    const auto& b = value->_fields;
    return a.shieldType == b.shieldType && a.shieldText == b.shieldText &&
           a.shieldColorString == b.shieldColorString;
}

std::uint64_t TransitShieldDataSource::hash() const {
    return static_cast<std::uint64_t>(_fields.shieldType) * HashMultiplier ^
           (hashOf(_fields.shieldText)) * 3 ^ (hashOf(_fields.shieldColorString)) * 5;
}

} // namespace orvo
