#include "platform/geoservices/TransitLineItemRecord.h"

namespace orvo {

std::shared_ptr<TransitLineItemRecord>
TransitLineItemRecord::initWithFields_service(Fields line, Service service) {
    auto record = std::make_shared<TransitLineItemRecord>();
    record->_initWithFields_service(std::move(line), std::move(service));
    return record;
}

void TransitLineItemRecord::_initWithFields_service(Fields line, Service service) {
    _initWithFields(std::move(line));
    _service = std::move(service);
}

} // namespace orvo
