#include "platform/geoservices/TransitIncidentRecord.h"

#include <utility>

namespace orvo {

std::shared_ptr<TransitIncidentRecord> TransitIncidentRecord::initWithFields(Fields fields) {
    auto record = std::make_shared<TransitIncidentRecord>();
    record->_fields = std::move(fields);
    return record;
}

} // namespace orvo
