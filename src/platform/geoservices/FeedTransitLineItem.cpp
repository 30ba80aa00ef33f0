#include "platform/geoservices/FeedTransitLineItem.h"

namespace orvo {

std::shared_ptr<FeedTransitLineItem> FeedTransitLineItem::initWithFields_service_origin(
    Fields line, Service service, FeedLineOrigin origin) {
    auto item = std::make_shared<FeedTransitLineItem>();
    item->_initWithFields_service(std::move(line), std::move(service));
    item->_origin = std::move(origin);
    return item;
}

} // namespace orvo
