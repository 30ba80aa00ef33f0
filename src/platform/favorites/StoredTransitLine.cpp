#include "platform/favorites/StoredTransitLine.h"

#include "platform/favorites/TransitStorageLineItem.h"
#include "platform/geoservices/FeedTransitLineItem.h"
#include "platform/geoservices/TransitSystemRecord.h"

namespace orvo::StoredTransitLine {

namespace {

std::shared_ptr<TransitSystem> copyOf(const std::shared_ptr<TransitSystem>& system) {
    if (!system)
        return nullptr;
    return TransitSystemRecord::initWithFields({system->name(), system->artwork()});
}

std::shared_ptr<TransitLine> lineWithoutService(const TransitLine& line) {
    auto fields = fieldsOf(line);
    if (auto origin = originOf(line))
        return FeedTransitLine::initWithFields_origin(std::move(fields), std::move(*origin));
    return TransitLineRecord::initWithFields(std::move(fields));
}

} // namespace

TransitLineRecord::Fields fieldsOf(const TransitLine& line) {
    TransitLineRecord::Fields fields;
    fields.muid = line.muid();
    fields.name = line.name();
    fields.identifier = line.identifier();
    fields.system = copyOf(line.system());
    fields.departureTimeDisplayStyle = line.departureTimeDisplayStyle();
    fields.departuresAreVehicleSpecific = line.departuresAreVehicleSpecific();
    fields.isBus = line.isBus();
    fields.artwork = line.artwork();
    fields.modeArtwork = line.modeArtwork();
    fields.alternateArtwork = line.alternateArtwork();
    fields.hasLineColorString = line.hasLineColorString();
    fields.lineColorString = line.lineColorString();
    fields.showVehicleNumber = line.showVehicleNumber();
    return fields;
}

std::optional<FeedLineOrigin> originOf(const TransitLine& line) {
    if (const auto* feedLine = dynamic_cast<const FeedTransitLine*>(&line))
        return feedLine->origin();
    if (const auto* item = dynamic_cast<const FeedTransitLineItem*>(&line))
        return item->origin();
    if (const auto* storage = dynamic_cast<const TransitStorageLineItem*>(&line))
        return storage->origin();
    return std::nullopt;
}

std::shared_ptr<NSData> encode(const TransitLine& line) {
    return TransitStorageLineItem::initWithLineItem(lineWithoutService(line))->data();
}

std::shared_ptr<TransitLine> decode(std::span<const std::uint8_t> bytes) {
    const auto storage = protoMessageWithBytes<TransitStorageLineItem>(bytes);
    return storage ? lineWithoutService(*storage) : nullptr;
}

} // namespace orvo::StoredTransitLine
