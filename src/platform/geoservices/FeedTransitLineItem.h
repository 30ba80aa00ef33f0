#pragma once

#include "platform/geoservices/FeedTransitLine.h"
#include "platform/geoservices/TransitLineItemRecord.h"

namespace orvo {

/// A line of a public feed with its incidents, all `FeedTransitIncident`s.
class FeedTransitLineItem final : public TransitLineItemRecord {
public:
    [[nodiscard]] static std::shared_ptr<FeedTransitLineItem>
    initWithFields_service_origin(Fields line, Service service, FeedLineOrigin origin);

    [[nodiscard]] const FeedLineOrigin& origin() const noexcept { return _origin; }

private:
    FeedLineOrigin _origin;
};

} // namespace orvo
