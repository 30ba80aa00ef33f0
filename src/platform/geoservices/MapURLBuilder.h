#pragma once

#include "platform/foundation/NSURL.h"

#include <cstdint>
#include <optional>

namespace orvo {

/// Builds the URLs that the map application opens: `orvo://?…`, the parameters in a fixed order.
class MapURLBuilder : public virtual NSObject {
public:
    /// A URL that shows the favourites of a type; type 2 is transit lines.
    [[nodiscard]] static std::shared_ptr<MapURLBuilder>
    URLForShowingFavoritesWithType(std::int32_t favoritesType);

    /// The map behind it. Type 3 is the transit map, `t=r`; 0 standard `t=m`, 1 satellite `t=k`, 2
    /// hybrid `t=h`; other numbers are written as they are.
    void setMapType(std::int32_t mapType) { _mapType = mapType; }

    [[nodiscard]] std::shared_ptr<NSURL> build() const;

private:
    std::int32_t _favoritesType = 0;
    std::optional<std::int32_t> _mapType;
};

} // namespace orvo
