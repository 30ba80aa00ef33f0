#include "platform/geoservices/FeedTransitLine.h"

namespace orvo {

std::shared_ptr<FeedTransitLine> FeedTransitLine::initWithFields_origin(Fields fields,
                                                                        FeedLineOrigin origin) {
    auto line = std::make_shared<FeedTransitLine>();
    line->_initWithFields(std::move(fields));
    line->_origin = std::move(origin);
    return line;
}

} // namespace orvo
