#pragma once

#include "platform/geoservices/TransitLineRecord.h"

#include <string>

namespace orvo {

/// Where a line of a public feed comes from: what the platform's record has no place for.
struct FeedLineOrigin {
    std::string feed;    ///< the feed's short name
    std::string routeId; ///< routes.txt `route_id`

    friend bool operator==(const FeedLineOrigin&, const FeedLineOrigin&) = default;
};

/// A line of a public feed. Line items of feeds are `FeedTransitLineItem`s, which carry the same
/// origin.
class FeedTransitLine final : public TransitLineRecord {
public:
    [[nodiscard]] static std::shared_ptr<FeedTransitLine>
    initWithFields_origin(Fields fields, FeedLineOrigin origin);

    [[nodiscard]] const FeedLineOrigin& origin() const noexcept { return _origin; }

private:
    FeedLineOrigin _origin;
};

} // namespace orvo
