#include "platform/geoservices/TransitTextDataSource.h"

#include "platform/foundation/Hashing.h"
#include "platform/foundation/NSString.h"

namespace orvo {

std::shared_ptr<TransitTextDataSource> TransitTextDataSource::initWithFields(Fields fields) {
    auto value = std::make_shared<TransitTextDataSource>();
    value->_fields = std::move(fields);
    return value;
}

bool TransitTextDataSource::isEqual(const NSObject* other) const {
    const auto* value = dynamic_cast<const TransitTextDataSource*>(other);
    if (!value)
        return false;
    const auto& a = _fields;
    const auto& b = value->_fields;
    return equal(a.text, b.text);
}

std::uint64_t TransitTextDataSource::hash() const {
    return hashOf(_fields.text);
}

} // namespace orvo
