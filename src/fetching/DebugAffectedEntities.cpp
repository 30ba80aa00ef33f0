#include "fetching/DebugAffectedEntities.h"

namespace orvo {

std::shared_ptr<DebugAffectedEntities> DebugAffectedEntities::initWithMuid(std::uint64_t muid) {
    auto entities = std::make_shared<DebugAffectedEntities>();
    entities->_muid = muid;
    return entities;
}

} // namespace orvo
