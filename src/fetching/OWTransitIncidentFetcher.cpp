#include "fetching/OWTransitIncidentFetcher.h"

#include "fetching/DebugTransitIncident.h"
#include "fetching/DebugTransitLineItem.h"
#include "fetching/FakeIncidentKeys.h"
#include "fetching/FavoritesContainer_OWFavorites.h"
#include "fetching/_OWTransitIncidentFetcherRequest.h"
#include "platform/favorites/FavoriteTransitLine.h"
#include "platform/foundation/DispatchQueue.h"
#include "platform/foundation/Environment.h"
#include "platform/mapuikit/LookupService.h"
#include "shared/NSUserDefaults_OrvoGroup.h"
#include "shared/OrvoMap.h"
#include "shared/WidgetLog.h"

#include <utility>

namespace orvo {

namespace {

std::size_t countOf(const std::shared_ptr<NSArray>& array) {
    return array ? array->count() : 0;
}

/// Nil for a favourite that is no line.
std::shared_ptr<TransitLine> lineOfFavorite(const std::shared_ptr<NSObject>& favorite) {
    const auto favoriteLine = std::dynamic_pointer_cast<FavoriteTransitLine>(favorite);
    return favoriteLine ? favoriteLine->transitLine() : nullptr;
}

/// The item itself, or what replaces it.
std::shared_ptr<TransitLineItem> possiblyFakeItem(const std::shared_ptr<NSObject>& element,
                                                  bool randomNumberOfIncidents) {
    auto item = std::dynamic_pointer_cast<TransitLineItem>(element);
    if (!item)
        throwWrongElementClass(*element, "TransitLineItem");
    if (countOf(item->incidents()) > 0)
        return item;
    const auto random = Environment::random().get();
    if (random() % 3 == 0)
        return item;
    const std::uint32_t count = randomNumberOfIncidents ? random() % 3 : 1;
    NSArray::Elements fakes;
    for (std::uint32_t i = 0; i < count; ++i)
        fakes.push_back(DebugTransitIncident::__debug_fakeIncidentAffectingLine(item));
    return DebugTransitLineItem::initWithLine_incidents(
        item, NSArray::arrayWithObjects(std::move(fakes)));
}

} // namespace

std::shared_ptr<OWTransitIncidentFetcher> OWTransitIncidentFetcher::init() {
    return std::make_shared<OWTransitIncidentFetcher>();
}

std::shared_ptr<OWTransitIncidentFetcherRequest>
OWTransitIncidentFetcher::fetchFavoriteLinesTransitIncidentsWithCompletionHandler(
    CompletionHandler handler) {
    auto request = _OWTransitIncidentFetcherRequest::initWithCompletionHandler(std::move(handler));
    OWFavorites::defaultContainer()->accessContentsUsingConcurrentBlock(
        [self = strong(this), request](const std::shared_ptr<NSArray>& favorites) {
            self->_fetchIncidentsForFavorites_withRequest(favorites, request);
        });
    return request;
}

void OWTransitIncidentFetcher::_fetchIncidentsForFavorites_withRequest(
    const std::shared_ptr<NSArray>& favorites,
    const std::shared_ptr<_OWTransitIncidentFetcherRequest>& request) {
    widgetLog()->debug("Received %lu favorites from container.", countOf(favorites));
    const auto lines = OrvoMap(
        favorites, [](const auto& favorite, std::size_t) { return lineOfFavorite(favorite); });
    if (countOf(lines) > 0) {
        _fetchIncidentsForLines_withRequest(lines, request);
        return;
    }
    widgetLog()->debug("0 Favorite lines, returning early.");
    DispatchQueue::mainQueue()->async([request] {
        request->setResultAndInvokeCompletionHandlers(Result::resultWithValue(NSArray::array()));
    });
}

void OWTransitIncidentFetcher::_fetchIncidentsForLines_withRequest(
    const std::shared_ptr<NSArray>& lines,
    const std::shared_ptr<_OWTransitIncidentFetcherRequest>& request) {
    const auto identifiers = OrvoMap(lines, [](const auto& line, std::size_t) {
        return MapItemIdentifierFromTransitLine(std::dynamic_pointer_cast<TransitLine>(line));
    });
    widgetLog()->debug("Issuing favorite lines lookup request for Muids: %{private}@.",
                       identifiers);
    const auto answer = [self = strong(this), request](const std::shared_ptr<NSArray>& items,
                                                       const std::shared_ptr<NSError>& error) {
        if (error) {
            widgetLog()->debug("Received error: %{private}@.", error);
            request->setResultAndInvokeCompletionHandlers(Result::resultWithError(error));
            return;
        }
        const bool fakes =
            OrvoGroup::__orvo_groupUserDefaults()->boolForKey(injectFakeIncidentsKey);
        const auto lineItems = fakes ? self->_fakeLineItemsFromItems(items) : items;
        widgetLog()->debug("Received %lu line items.", countOf(lineItems));
        request->setResultAndInvokeCompletionHandlers(Result::resultWithValue(lineItems));
    };
    LookupService::sharedService()
        ->ticketForTransitLines_traits(identifiers, nullptr)
        ->submitWithHandler_networkActivity(answer, nullptr);
}

std::shared_ptr<NSArray>
// NOLINTNEXTLINE(readability-convert-member-functions-to-static): a fetcher is asked for it
OWTransitIncidentFetcher::_fakeLineItemsFromItems(const std::shared_ptr<NSArray>& items) const {
    const bool randomNumber =
        OrvoGroup::__orvo_groupUserDefaults()->boolForKey(randomNumberIncidentsKey);
    return OrvoMap(
        items, [&](const auto& item, std::size_t) { return possiblyFakeItem(item, randomNumber); });
}

} // namespace orvo
