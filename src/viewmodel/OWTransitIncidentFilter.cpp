#include "viewmodel/OWTransitIncidentFilter.h"

#include "platform/geoservices/TransitIncident.h"

namespace orvo {

bool OWTransitIncidentFilter::shouldDisplayIncident(const TransitIncident& incident) const {
    const auto start = incident.startDate();
    if (start && start->timeIntervalSinceNow() > 0)
        return false;
    const auto end = incident.endDate();
    return !end || end->timeIntervalSinceNow() >= 0;
}

} // namespace orvo
