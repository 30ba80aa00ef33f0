#include "platform/geoservices/TransitSystemRecord.h"

namespace orvo {

std::shared_ptr<TransitSystemRecord> TransitSystemRecord::initWithFields(Fields fields) {
    auto record = std::make_shared<TransitSystemRecord>();
    record->_initWithFields(std::move(fields));
    return record;
}

} // namespace orvo
