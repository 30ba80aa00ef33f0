#include "platform/favorites/TransitStorageLineItem.h"

#include "platform/favorites/_MessageCoding.h"
#include "platform/geoservices/FeedTransitLineItem.h"

namespace orvo {

std::shared_ptr<TransitStorageLineItem>
TransitStorageLineItem::initWithLineItem(const std::shared_ptr<TransitLine>& line) {
    if (!line)
        return nullptr;
    auto storage = std::make_shared<TransitStorageLineItem>();
    storage->takeLine(*line);
    storage->takeOrigin(*line);
    if (const auto* item = dynamic_cast<const TransitLineItem*>(line.get()))
        storage->takeService(*item);
    return storage;
}

void TransitStorageLineItem::takeLine(const TransitLine& line) {
    assign(_muid, line.muid(), MuidBit);
    _name = line.name();
    if (const auto identifier = line.identifier())
        assign(_identifier, identifier->muid(), IdentifierBit);
    _system = TransitStorageSystem::initWithSystem(line.system());
    _artwork = TransitStorageArtwork::initWithArtwork(line.artwork());
    _modeArtwork = TransitStorageArtwork::initWithArtwork(line.modeArtwork());
    _alternateArtwork = TransitStorageArtwork::initWithArtwork(line.alternateArtwork());
    assign(_isBus, line.isBus(), IsBusBit);
    assign(_departureTimeDisplayStyle, line.departureTimeDisplayStyle(), StyleBit);
    assign(_departuresAreVehicleSpecific, line.departuresAreVehicleSpecific(), SpecificBit);
    _lineColorString = line.lineColorString();
    assign(_hasLineColorString, line.hasLineColorString(), HasColorBit);
    assign(_showVehicleNumber, line.showVehicleNumber(), VehicleNumberBit);
}

void TransitStorageLineItem::takeOrigin(const TransitLine& line) {
    std::optional<FeedLineOrigin> origin;
    if (const auto* feedItem = dynamic_cast<const FeedTransitLineItem*>(&line))
        origin = feedItem->origin();
    else if (const auto* feedLine = dynamic_cast<const FeedTransitLine*>(&line))
        origin = feedLine->origin();
    else if (const auto* stored = dynamic_cast<const TransitStorageLineItem*>(&line))
        origin = stored->origin();
    if (!origin)
        return;
    _feed = origin->feed;
    _routeId = origin->routeId;
}

void TransitStorageLineItem::takeService(const TransitLineItem& item) {
    if (const auto incidents = item.incidents()) {
        assign(_hasIncidents, true, HasIncidentsBit);
        for (const auto& incident : typed<TransitIncident>(incidents))
            _incidents.push_back(TransitStorageIncident::initWithIncident(incident));
    }
    assign(_isIncidentsTTLExpired, item.isIncidentsTTLExpired(), ExpiredBit);
    assign(_hasIncidentComponent, item.hasIncidentComponent(), ComponentBit);
}

std::shared_ptr<MapItemIdentifier> TransitStorageLineItem::identifier() const {
    return hasBit(IdentifierBit) ? MapItemIdentifier::identifierWithMuid(_identifier) : nullptr;
}

std::shared_ptr<NSArray> TransitStorageLineItem::incidents() const {
    return _hasIncidents || !_incidents.empty() ? NSArray::arrayOf(_incidents) : nullptr;
}

std::optional<FeedLineOrigin> TransitStorageLineItem::origin() const {
    if (!_feed || !_routeId)
        return std::nullopt;
    return FeedLineOrigin{*_feed, *_routeId};
}

std::shared_ptr<TransitStorageLineItem> TransitStorageLineItem::initWithCoder(NSCoder& coder) {
    return decodedMessage<TransitStorageLineItem>(coder);
}

void TransitStorageLineItem::encodeWithCoder(NSCoder& coder) const {
    encodeMessage(*this, coder);
}

} // namespace orvo
