#include "Classes.h"

#include "platform/favorites/TransitStorageIncident.h"
#include "platform/favorites/TransitStorageLineItem.h"
#include "widget/OWTransitIncidentViewControllerState.h"
#include "widget/OWTransitIncidentsViewController.h"

namespace orvo {

std::shared_ptr<const CodingClassTable> codingClasses() {
    return std::make_shared<const CodingClassTable>(
        CodingClassTable{CodingClass::of<TransitStorageIncident>("TransitStorageIncident"),
                         CodingClass::of<TransitStorageLineItem>("TransitStorageLineItem"),
                         CodingClass::of<OWTransitIncidentViewControllerState>(
                             "OWTransitIncidentViewControllerState")});
}

PrincipalClassTable widgetPrincipalClasses() {
    return {{"OWTransitIncidentsViewController", [] {
                 return OWTransitIncidentsViewController::initWithNibName_bundle(std::nullopt,
                                                                                 nullptr);
             }}};
}

} // namespace orvo
