#include "platform/favorites/FavoriteTransitLineRecord.h"

#include "platform/foundation/Hashing.h"

namespace orvo {

std::shared_ptr<FavoriteTransitLineRecord>
FavoriteTransitLineRecord::initWithTransitLine(std::shared_ptr<TransitLine> line) {
    auto favorite = std::make_shared<FavoriteTransitLineRecord>();
    favorite->_line = std::move(line);
    return favorite;
}

bool FavoriteTransitLineRecord::isEqual(const NSObject* other) const {
    const auto* favorite = dynamic_cast<const FavoriteTransitLineRecord*>(other);
    if (!favorite || !_line || !favorite->_line)
        return favorite && _line == favorite->_line;
    return _line->muid() == favorite->_line->muid();
}

std::uint64_t FavoriteTransitLineRecord::hash() const {
    return _line ? _line->muid() * HashMultiplier : 0;
}

std::string FavoriteTransitLineRecord::description() const {
    return _line ? _line->name().value_or(std::string()) : std::string();
}

} // namespace orvo
