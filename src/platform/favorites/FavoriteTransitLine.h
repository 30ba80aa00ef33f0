#pragma once

#include "platform/foundation/NSObject.h"
#include "platform/geoservices/TransitLine.h"

namespace orvo {

/// A favourite that is a line. Favourites of other kinds do not adopt this protocol.
class FavoriteTransitLine : public virtual NSObject {
public:
    /// May be nil.
    [[nodiscard]] virtual std::shared_ptr<TransitLine> transitLine() const = 0;
};

} // namespace orvo
