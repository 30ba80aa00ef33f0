#include "fetching/DebugTransitLineItem.h"

namespace orvo {

std::shared_ptr<DebugTransitLineItem>
DebugTransitLineItem::initWithLine_incidents(std::shared_ptr<TransitLineItem> line,
                                             std::shared_ptr<NSArray> incidents) {
    auto item = std::make_shared<DebugTransitLineItem>();
    item->_incidents = std::move(incidents);
    item->_wrappedLine = std::move(line);
    return item;
}

template <class T>
T DebugTransitLineItem::_forward(T (TransitLine::*property)() const) const {
    const TransitLine* line = _wrappedLine.get();
    return line ? (line->*property)() : T();
}

std::uint64_t DebugTransitLineItem::muid() const {
    return _forward(&TransitLine::muid);
}

std::shared_ptr<MapItemIdentifier> DebugTransitLineItem::identifier() const {
    return _forward(&TransitLine::identifier);
}

std::optional<std::string> DebugTransitLineItem::name() const {
    return _forward(&TransitLine::name);
}

std::shared_ptr<TransitSystem> DebugTransitLineItem::system() const {
    return _forward(&TransitLine::system);
}

std::uint64_t DebugTransitLineItem::departureTimeDisplayStyle() const {
    return _forward(&TransitLine::departureTimeDisplayStyle);
}

bool DebugTransitLineItem::departuresAreVehicleSpecific() const {
    return _forward(&TransitLine::departuresAreVehicleSpecific);
}

bool DebugTransitLineItem::isBus() const {
    return _forward(&TransitLine::isBus);
}

std::shared_ptr<TransitArtworkDataSource> DebugTransitLineItem::artwork() const {
    return _forward(&TransitLine::artwork);
}

std::shared_ptr<TransitArtworkDataSource> DebugTransitLineItem::modeArtwork() const {
    return _forward(&TransitLine::modeArtwork);
}

std::shared_ptr<TransitArtworkDataSource> DebugTransitLineItem::alternateArtwork() const {
    return _forward(&TransitLine::alternateArtwork);
}

bool DebugTransitLineItem::hasLineColorString() const {
    return _forward(&TransitLine::hasLineColorString);
}

std::optional<std::string> DebugTransitLineItem::lineColorString() const {
    return _forward(&TransitLine::lineColorString);
}

bool DebugTransitLineItem::showVehicleNumber() const {
    return _forward(&TransitLine::showVehicleNumber);
}

std::shared_ptr<NSArray> DebugTransitLineItem::operatingHours() const {
    return _forward(&TransitLine::operatingHours);
}

} // namespace orvo
