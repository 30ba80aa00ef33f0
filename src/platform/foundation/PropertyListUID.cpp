#include "platform/foundation/PropertyListUID.h"

#include "platform/foundation/Hashing.h"

#include <fmt/format.h>

namespace orvo {

std::shared_ptr<PropertyListUID> PropertyListUID::uidWithValue(std::uint64_t value) {
    auto uid = std::make_shared<PropertyListUID>();
    uid->_value = value;
    return uid;
}

bool PropertyListUID::isEqual(const NSObject* other) const {
    const auto* uid = dynamic_cast<const PropertyListUID*>(other);
    return uid && uid->_value == _value;
}

std::uint64_t PropertyListUID::hash() const {
    return _value * HashMultiplier;
}

std::string PropertyListUID::description() const {
    return fmt::format("UID({})", _value);
}

} // namespace orvo
