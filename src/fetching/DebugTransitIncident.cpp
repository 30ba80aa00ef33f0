#include "fetching/DebugTransitIncident.h"

#include "fetching/DebugAffectedEntities.h"

namespace orvo {

std::shared_ptr<DebugTransitIncident> DebugTransitIncident::init() {
    return std::make_shared<DebugTransitIncident>();
}

std::shared_ptr<DebugTransitIncident>
DebugTransitIncident::__debug_fakeIncidentAffectingLine(const std::shared_ptr<TransitLine>& line) {
    constexpr NSTimeInterval day = 86400;
    constexpr const char* message = "Something Bad™ happened";
    const auto now = NSDate::date();
    const NSTimeInterval seconds = now->timeIntervalSinceReferenceDate();

    auto incident = init();
    incident->setMuid(line->muid() + 1);
    incident->setTitle("Something Bad™");
    incident->setSummary(line->name().value_or("(null)") + " · Possible delays due to strike");
    incident->setFullDescription("Only one train out of three is working due to national strike of "
                                 "public transit workers.");
    incident->setMessageForRoutePlanning(message);
    incident->setMessageForRouteStepping(message);
    incident->setMessageForNonRoutable(message);
    incident->setStartDate(NSDate::dateWithTimeIntervalSinceReferenceDate(seconds - day));
    incident->setEndDate(NSDate::dateWithTimeIntervalSinceReferenceDate(seconds + day));
    incident->setIconType(1);
    incident->setCreationDate(incident->startDate());
    incident->setLastUpdated(now);
    incident->setBlockingIncident(true);
    incident->setAffectedEntities(
        NSArray::arrayOf({DebugAffectedEntities::initWithMuid(line->muid())}));
    return incident;
}

} // namespace orvo
