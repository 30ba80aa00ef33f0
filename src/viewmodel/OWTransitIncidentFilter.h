#pragma once

#include "platform/foundation/NSObject.h"

namespace orvo {

class TransitIncident;

/// Says which incidents are shown now.
class OWTransitIncidentFilter : public virtual NSObject {
public:
    /// Not one that has not yet begun, nor one that is over. At the very moment of its beginning or
    /// end it is shown; a missing date never excludes.
    [[nodiscard]] virtual bool shouldDisplayIncident(const TransitIncident& incident) const;
};

} // namespace orvo
