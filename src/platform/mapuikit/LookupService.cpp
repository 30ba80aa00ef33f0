#include "platform/mapuikit/LookupService.h"

#include "platform/mapuikit/FeedLookupService.h"

namespace orvo {

EnvironmentSlot<std::shared_ptr<LookupService>>& LookupService::shared() {
    static EnvironmentSlot<std::shared_ptr<LookupService>> slot(
        [] { return FeedLookupService::init(); });
    return slot;
}

std::shared_ptr<LookupService> LookupService::sharedService() {
    return shared().get();
}

std::shared_ptr<MapItemIdentifier>
MapItemIdentifierFromTransitLine(const std::shared_ptr<TransitLine>& line) {
    return line ? line->identifier() : nullptr;
}

} // namespace orvo
