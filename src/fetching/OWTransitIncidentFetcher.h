#pragma once

#include "fetching/OWTransitIncidentFetcherRequest.h"
#include "platform/foundation/NSArray.h"

namespace orvo {

class _OWTransitIncidentFetcherRequest;

/// Answers what is known now of the person's favourite lines: one reading of the favourites and one
/// lookup a fetch. It keeps nothing from one fetch to the next, and a fetch keeps it alive. Any
/// thread.
class OWTransitIncidentFetcher final : public virtual NSObject {
public:
    using CompletionHandler = OWTransitIncidentFetcherRequest::CompletionHandler;

    [[nodiscard]] static std::shared_ptr<OWTransitIncidentFetcher> init();

    /// Starts a fetch and answers its request, which has not ended yet. The handler, which may be
    /// nil, is called once with an array of `TransitLineItem`s, or with the lookup's error. It is
    /// called on the thread on which the lookup answers; without a favourite line, which is a
    /// success with an empty array, on the main queue. A lookup that never answers leaves the
    /// request pending.
    std::shared_ptr<OWTransitIncidentFetcherRequest>
    fetchFavoriteLinesTransitIncidentsWithCompletionHandler(CompletionHandler handler);

    /// Goes on with the favourites as they were read.
    void _fetchIncidentsForFavorites_withRequest(
        const std::shared_ptr<NSArray>& favorites,
        const std::shared_ptr<_OWTransitIncidentFetcherRequest>& request);
    /// Looks the `TransitLine`s up, of which there is at least one.
    void _fetchIncidentsForLines_withRequest(
        const std::shared_ptr<NSArray>& lines,
        const std::shared_ptr<_OWTransitIncidentFetcherRequest>& request);
    /// The `TransitLineItem`s in their order, most of those without incidents replaced by
    /// `DebugTransitLineItem`s with made-up ones.
    [[nodiscard]] std::shared_ptr<NSArray>
    _fakeLineItemsFromItems(const std::shared_ptr<NSArray>& items) const;
};

} // namespace orvo
