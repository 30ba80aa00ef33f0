#include "viewmodel/OWTransitItemDataSourceBuilder.h"

#include "viewmodel/OWTransitIncidentDataSourceErrorBuilder.h"
#include "viewmodel/OWTransitIncidentsDataSourceBuilder.h"

namespace orvo {

std::shared_ptr<OWTransitItemDataSourceBuilder> OWTransitDataSourceBuilderForResult(
    const std::shared_ptr<Result>& result,
    std::uint64_t maxNumberOfItems,
    const std::shared_ptr<ArtworkDataSourceCache>& artworkCache,
    const std::shared_ptr<OWTransitIncidentsAnalyticsDelegate>& analytics) {
    std::shared_ptr<OWTransitItemDataSourceBuilder> builder;
    result->withValue_orError(
        [&](const std::shared_ptr<NSObject>& lineItems) {
            builder = OWTransitIncidentsDataSourceBuilder::
                initWithLineItems_maxNumberOfItems_artworkCache_analytics(
                    std::dynamic_pointer_cast<NSArray>(lineItems),
                    maxNumberOfItems,
                    artworkCache,
                    analytics);
        },
        [&](const std::shared_ptr<NSError>& error) {
            builder = OWTransitIncidentDataSourceErrorBuilder::initWithError(error);
        });
    return builder;
}

} // namespace orvo
