#include "platform/mapuikit/FeedLookupService.h"

#include "platform/favorites/FavoritesStore.h"
#include "platform/feeds/FeedLookup.h"
#include "platform/feeds/ScheduleUpdater.h"
#include "platform/foundation/Exceptions.h"
#include "platform/mapuikit/FeedLineItemTicket.h"

namespace orvo {

namespace {

std::shared_ptr<FeedTransitLine> favoriteLine(std::uint64_t muid) {
    const auto store =
        FavoritesStore::open(FavoritesStore::standardPath(), FavoritesStore::Access::Read, nullptr);
    return store ? std::dynamic_pointer_cast<FeedTransitLine>(store->line(muid)) : nullptr;
}

} // namespace

std::shared_ptr<FeedLookupService> FeedLookupService::init() {
    auto ground = FeedLookup::profileGround();
    ground.lastKnownLine = favoriteLine;
    return initWithLookup_updater(FeedLookup::make(std::move(ground)),
                                  ScheduleUpdater::make(ScheduleUpdater::profileGround()));
}

std::shared_ptr<FeedLookupService>
FeedLookupService::initWithLookup_updater(std::shared_ptr<const FeedLookup> lookup,
                                          std::shared_ptr<ScheduleUpdater> updater) {
    if (!lookup)
        throw NSInvalidArgumentException("A lookup service needs a lookup.");
    auto service = std::make_shared<FeedLookupService>();
    service->_lookup = std::move(lookup);
    service->_updater = std::move(updater);
    return service;
}

std::shared_ptr<LineItemTicket>
FeedLookupService::ticketForTransitLines_traits(const std::shared_ptr<NSArray>& identifiers,
                                                const std::shared_ptr<NSObject>& /*traits*/) {
    std::vector<std::uint64_t> muids;
    for (const auto& identifier : typed<MapItemIdentifier>(identifiers))
        muids.push_back(identifier->muid());
    return FeedLineItemTicket::initWithLookup_updater_muids(_lookup, _updater, std::move(muids));
}

} // namespace orvo
