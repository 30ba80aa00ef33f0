#include "handoff/OrvoActivity.h"

#include "platform/foundation/Exceptions.h"

namespace orvo {

std::string OrvoActivity::collectionsModeAsString(std::int32_t value) {
    return protoEnumAsString(CollectionsModeNames, value);
}

std::int32_t OrvoActivity::StringAsCollectionsMode(const std::string& name) {
    return protoStringAsEnum(CollectionsModeNames, name);
}

void OrvoActivity::addSearchPlaces(std::shared_ptr<MapItemStorage> element) {
    if (!element)
        throw NSInvalidArgumentException("attempt to insert nil object into searchPlaces");
    _searchPlaces.push_back(std::move(element));
}

std::shared_ptr<MapItemStorage> OrvoActivity::searchPlacesAtIndex(std::size_t index) const {
    if (index >= _searchPlaces.size())
        throw NSInvalidArgumentException("index beyond bounds of searchPlaces");
    return _searchPlaces[index];
}

} // namespace orvo
