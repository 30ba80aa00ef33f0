#pragma once

#include "platform/geoservices/FeedTransitLine.h"
#include "platform/geoservices/TransitArtworkTypes.h"
#include "platform/geoservices/TransitSystemRecord.h"

#include <string>

namespace orvo::testing {

inline std::shared_ptr<TransitArtworkDataSource> shield(const std::string& text) {
    TransitArtworkDataSource::Fields artwork;
    artwork.artworkSourceType = static_cast<std::int32_t>(TransitArtworkSourceType::Shield);
    artwork.shieldDataSource = TransitShieldDataSource::initWithFields({1, text, "009FE3,FFFFFF"});
    artwork.accessibilityText = "Line " + text;
    return TransitArtworkDataSource::initWithFields(std::move(artwork));
}

/// A line of the feed `city` with every artwork.
inline std::shared_ptr<FeedTransitLine> favoriteLine(std::uint64_t muid, const std::string& name) {
    TransitLineRecord::Fields fields;
    fields.muid = muid;
    fields.name = name;
    fields.identifier = MapItemIdentifier::identifierWithMuid(muid);
    fields.system = TransitSystemRecord::initWithFields({"City Transit", shield("CT")});
    fields.isBus = true;
    fields.modeArtwork = shield("Bus");
    fields.alternateArtwork = shield(name);
    fields.hasLineColorString = true;
    fields.lineColorString = "009FE3";
    return FeedTransitLine::initWithFields_origin(std::move(fields), {"city", "route-" + name});
}

} // namespace orvo::testing
