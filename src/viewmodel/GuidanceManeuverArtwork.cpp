#include "viewmodel/GuidanceManeuverArtwork.h"

#include "platform/foundation/Hashing.h"

#include <typeinfo>

namespace orvo {

std::shared_ptr<GuidanceManeuverArtwork>
GuidanceManeuverArtwork::artworkWithManeuver(std::int32_t maneuver) {
    return initWithManeuver_junction_drivingSide(maneuver, nullptr, 0);
}

std::shared_ptr<GuidanceManeuverArtwork>
GuidanceManeuverArtwork::initWithManeuver_junction_drivingSide(std::int32_t maneuver,
                                                               std::shared_ptr<NSObject> junction,
                                                               std::int32_t drivingSide) {
    auto artwork = std::make_shared<GuidanceManeuverArtwork>();
    artwork->_initWithManeuver_junction_drivingSide(maneuver, std::move(junction), drivingSide);
    return artwork;
}

void GuidanceManeuverArtwork::_initWithManeuver_junction_drivingSide(
    std::int32_t maneuver, std::shared_ptr<NSObject> junction, std::int32_t drivingSide) {
    _maneuver = maneuver;
    _junction = std::move(junction);
    _drivingSide = drivingSide;
}

bool GuidanceManeuverArtwork::isStartRouteManeuver() const noexcept {
    return _maneuver == 17 || _maneuver == 25;
}

bool GuidanceManeuverArtwork::isArriveManeuver() const noexcept {
    switch (_maneuver) {
    case 16:
    case 18:
    case 33:
    case 34:
    case 39:
        return true;
    default:
        return false;
    }
}

bool GuidanceManeuverArtwork::isEqual(const NSObject* other) const {
    if (this == other)
        return true;
    if (!other || typeid(*this) != typeid(*other))
        return false;
    const auto& artwork = dynamic_cast<const GuidanceManeuverArtwork&>(*other);
    return _maneuver == artwork._maneuver && _drivingSide == artwork._drivingSide &&
           equal(_junction, artwork._junction);
}

std::uint64_t GuidanceManeuverArtwork::hash() const {
    const auto scattered = [](std::int32_t number) {
        return static_cast<std::uint64_t>(std::int64_t{number}) * HashMultiplier;
    };
    return hashOf(_junction) ^ scattered(_maneuver) ^ scattered(_drivingSide);
}

} // namespace orvo
