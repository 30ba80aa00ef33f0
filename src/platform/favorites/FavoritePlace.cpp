#include "platform/favorites/FavoritePlace.h"

#include "platform/foundation/Hashing.h"

namespace orvo {

std::shared_ptr<FavoritePlace> FavoritePlace::initWithName_latitude_longitude(std::string name,
                                                                              double latitude,
                                                                              double longitude) {
    auto place = std::make_shared<FavoritePlace>();
    place->_name = std::move(name);
    place->_latitude = latitude;
    place->_longitude = longitude;
    return place;
}

bool FavoritePlace::isEqual(const NSObject* other) const {
    const auto* place = dynamic_cast<const FavoritePlace*>(other);
    return place && place->_name == _name && place->_latitude == _latitude &&
           place->_longitude == _longitude;
}

std::uint64_t FavoritePlace::hash() const {
    return stableHash(_name); // 0.0 and -0.0 are equal but no same bits: the name is enough
}

std::string FavoritePlace::description() const {
    return _name;
}

} // namespace orvo
