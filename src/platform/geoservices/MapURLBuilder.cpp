#include "platform/geoservices/MapURLBuilder.h"

#include <fmt/format.h>

namespace orvo {

namespace {

std::string mapTypeParameter(std::int32_t mapType) {
    constexpr std::string_view letters = "mkhr";
    if (mapType >= 0 && std::cmp_less(mapType, letters.size()))
        return std::string(1, letters[static_cast<std::size_t>(mapType)]);
    return std::to_string(mapType);
}

} // namespace

std::shared_ptr<MapURLBuilder>
MapURLBuilder::URLForShowingFavoritesWithType(std::int32_t favoritesType) {
    auto builder = std::make_shared<MapURLBuilder>();
    builder->_favoritesType = favoritesType;
    return builder;
}

std::shared_ptr<NSURL> MapURLBuilder::build() const {
    auto text = fmt::format("orvo://?favorites={}", _favoritesType);
    if (_mapType)
        text += "&t=" + mapTypeParameter(*_mapType);
    return NSURL::URLWithString(std::move(text));
}

} // namespace orvo
