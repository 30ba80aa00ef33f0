#include "platform/geoservices/TransitIncidentRecord.h"

namespace orvo {

std::shared_ptr<TransitIncidentRecord> TransitIncidentRecord::initWithFields(Fields fields) {
    auto record = std::make_shared<TransitIncidentRecord>();
    record->_initWithFields(std::move(fields));
    return record;
}

} // namespace orvo
