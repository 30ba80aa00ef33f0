#pragma once

#include "analytics/OWTransitIncidentsAnalyticsDelegate.h"
#include "platform/foundation/NSArray.h"
#include "platform/mapuikit/ArtworkDataSourceCache.h"
#include "viewmodel/OWTransitListItem.h"
#include "widget/result/Result.h"

#include <cstdint>
#include <optional>

namespace orvo {

/// Makes what the widget shows from the outcome of a fetch. Main thread.
class OWTransitItemDataSourceBuilder : public virtual NSObject {
public:
    /// Built on the first call and kept.
    [[nodiscard]] virtual std::shared_ptr<OWTransitListItem> listItem() = 0;
    /// Optional: nothing where a builder does not answer it.
    [[nodiscard]] virtual std::optional<std::int64_t> analyticsResultType() const {
        return std::nullopt;
    }
    /// Optional: nothing where a builder does not answer it; within, the array may be nil.
    [[nodiscard]] virtual std::optional<std::shared_ptr<NSArray>>
    analyticsTransitIncidentItems() const {
        return std::nullopt;
    }
};

/// The builder for a fetch's result: one for line items, one for an error. `maxNumberOfItems` 0 is
/// no limit; `analytics` may be nil.
[[nodiscard]] std::shared_ptr<OWTransitItemDataSourceBuilder> OWTransitDataSourceBuilderForResult(
    const std::shared_ptr<Result>& result,
    std::uint64_t maxNumberOfItems,
    const std::shared_ptr<ArtworkDataSourceCache>& artworkCache,
    const std::shared_ptr<OWTransitIncidentsAnalyticsDelegate>& analytics);

} // namespace orvo
