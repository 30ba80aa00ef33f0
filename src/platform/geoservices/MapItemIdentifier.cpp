#include "platform/geoservices/MapItemIdentifier.h"

#include "platform/foundation/Hashing.h"

namespace orvo {

std::shared_ptr<MapItemIdentifier> MapItemIdentifier::identifierWithMuid(std::uint64_t muid) {
    auto identifier = std::make_shared<MapItemIdentifier>();
    identifier->_muid = muid;
    return identifier;
}

bool MapItemIdentifier::isEqual(const NSObject* other) const {
    const auto* identifier = dynamic_cast<const MapItemIdentifier*>(other);
    return identifier && identifier->_muid == _muid;
}

std::uint64_t MapItemIdentifier::hash() const {
    return _muid * HashMultiplier;
}

std::string MapItemIdentifier::description() const {
    return std::to_string(_muid);
}

std::shared_ptr<NSObject> MapItemIdentifier::copy() const {
    return std::const_pointer_cast<NSObject>(shared_from_this());
}

} // namespace orvo
