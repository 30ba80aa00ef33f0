#include "platform/geoservices/TransitLineRecord.h"

namespace orvo {

std::shared_ptr<TransitLineRecord> TransitLineRecord::initWithFields(Fields fields) {
    auto record = std::make_shared<TransitLineRecord>();
    record->_initWithFields(std::move(fields));
    return record;
}

} // namespace orvo
