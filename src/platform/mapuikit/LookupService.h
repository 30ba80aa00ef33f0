#pragma once

#include "platform/foundation/EnvironmentSlot.h"
#include "platform/geoservices/MapItemIdentifier.h"
#include "platform/geoservices/TransitLine.h"
#include "platform/mapuikit/LineItemTicket.h"

namespace orvo {

/// Looks up what is known of items of the map. Any thread.
class LookupService : public virtual NSObject {
public:
    /// The process's service.
    [[nodiscard]] static std::shared_ptr<LookupService> sharedService();
    /// What `sharedService` answers. Default: a `FeedLookupService` over the profile in use.
    static EnvironmentSlot<std::shared_ptr<LookupService>>& shared();

    /// A ticket for the line items of the lines that the `MapItemIdentifier`s of `identifiers`
    /// name; a nil array reads as empty. Nothing is asked before the ticket is submitted. There are
    /// no traits: nil.
    [[nodiscard]] virtual std::shared_ptr<LineItemTicket>
    ticketForTransitLines_traits(const std::shared_ptr<NSArray>& identifiers,
                                 const std::shared_ptr<NSObject>& traits) = 0;
};

/// Nil for a line that has none, and for nil.
[[nodiscard]] std::shared_ptr<MapItemIdentifier>
MapItemIdentifierFromTransitLine(const std::shared_ptr<TransitLine>& line);

} // namespace orvo
