#include "platform/geoservices/TransitAffectedEntityRecord.h"

namespace orvo {

std::shared_ptr<TransitAffectedEntityRecord>
TransitAffectedEntityRecord::initWithFields(Fields fields) {
    auto record = std::make_shared<TransitAffectedEntityRecord>();
    record->_initWithFields(std::move(fields));
    return record;
}

} // namespace orvo
