#include "platform/geoservices/TransitArtworkDataSource.h"

#include "platform/foundation/Hashing.h"
#include "platform/foundation/NSString.h"

namespace orvo {

std::shared_ptr<TransitArtworkDataSource> TransitArtworkDataSource::initWithFields(Fields fields) {
    auto value = std::make_shared<TransitArtworkDataSource>();
    value->_fields = std::move(fields);
    return value;
}

bool TransitArtworkDataSource::isEqual(const NSObject* other) const {
    const auto* value = dynamic_cast<const TransitArtworkDataSource*>(other);
    if (!value)
        return false;
    const auto& a = _fields;
    const auto& b = value->_fields;
    return a.artworkSourceType == b.artworkSourceType && a.artworkUseType == b.artworkUseType &&
           equal(a.shieldDataSource, b.shieldDataSource) &&
           equal(a.iconDataSource, b.iconDataSource) &&
           equal(a.iconFallbackShieldDataSource, b.iconFallbackShieldDataSource) &&
           equal(a.textDataSource, b.textDataSource) &&
           a.hasRoutingIncidentBadge == b.hasRoutingIncidentBadge &&
           a.accessibilityText == b.accessibilityText;
}

std::uint64_t TransitArtworkDataSource::hash() const {
    return static_cast<std::uint64_t>(_fields.artworkSourceType) * HashMultiplier ^
           (static_cast<std::uint64_t>(_fields.artworkUseType) * HashMultiplier) * 3 ^
           (hashOf(_fields.shieldDataSource)) * 5 ^ (hashOf(_fields.iconDataSource)) * 7 ^
           (hashOf(_fields.iconFallbackShieldDataSource)) * 9 ^
           (hashOf(_fields.textDataSource)) * 11 ^
           ((_fields.hasRoutingIncidentBadge ? HashMultiplier : 0)) * 13 ^
           (hashOf(_fields.accessibilityText)) * 15;
}

} // namespace orvo
