#include "Classes.h"

#include "platform/favorites/TransitStorageIncident.h"
#include "platform/favorites/TransitStorageLineItem.h"

namespace orvo {

std::shared_ptr<const CodingClassTable> codingClasses() {
    return std::make_shared<const CodingClassTable>(
        CodingClassTable{CodingClass::of<TransitStorageIncident>("TransitStorageIncident"),
                         CodingClass::of<TransitStorageLineItem>("TransitStorageLineItem")});
}

} // namespace orvo
