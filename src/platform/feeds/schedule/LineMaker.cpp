#include "platform/feeds/schedule/LineMaker.h"

#include "platform/feeds/schedule/LineColors.h"
#include "platform/feeds/schedule/SystemInitials.h"
#include "platform/geoservices/MapItemIdentifier.h"
#include "platform/geoservices/TransitArtworkTypes.h"
#include "platform/geoservices/TransitSystemRecord.h"

#include <optional>
#include <utility>

namespace orvo {

namespace {

constexpr const char* NeutralColors = "5B5B63,FFFFFF";

std::optional<std::string> nilIfEmpty(std::string text) {
    if (text.empty())
        return std::nullopt;
    return text;
}

TransitShieldType modeOf(int routeType) {
    switch (basicRouteType(routeType)) {
    case 0:
        return TransitShieldType::Tram;
    case 1:
    case 12:
        return TransitShieldType::Metro;
    case 2:
        return TransitShieldType::Rail;
    case 3:
    case 11:
        return TransitShieldType::Bus;
    case 4:
        return TransitShieldType::Ferry;
    case 5:
    case 6:
    case 7:
        return TransitShieldType::Cable;
    default:
        return TransitShieldType::Neutral;
    }
}

std::shared_ptr<TransitArtworkDataSource> shieldArtwork(TransitShieldType type,
                                                        const std::string& text,
                                                        std::string colors,
                                                        const std::string& spoken) {
    TransitShieldDataSource::Fields shield;
    shield.shieldType = static_cast<std::int32_t>(type);
    shield.shieldText = nilIfEmpty(text);
    shield.shieldColorString = std::move(colors);
    TransitArtworkDataSource::Fields fields;
    fields.artworkSourceType = static_cast<std::int32_t>(TransitArtworkSourceType::Shield);
    fields.shieldDataSource = TransitShieldDataSource::initWithFields(std::move(shield));
    fields.accessibilityText = nilIfEmpty(spoken);
    return TransitArtworkDataSource::initWithFields(std::move(fields));
}

std::shared_ptr<TransitArtworkDataSource> lineArtwork(const ScheduleLine& line) {
    if (line.shortName.empty() && line.color.empty())
        return nullptr;
    return shieldArtwork(modeOf(line.routeType),
                         line.shortName,
                         LineColors::mended(line.color, line.textColor).shieldColorString(),
                         line.name());
}

std::shared_ptr<TransitArtworkDataSource> modeArtwork(const ScheduleLine& line) {
    TransitIconDataSource::Fields icon;
    icon.defaultTransitType = static_cast<std::uint32_t>(modeOf(line.routeType));
    TransitArtworkDataSource::Fields fields;
    fields.artworkSourceType = static_cast<std::int32_t>(TransitArtworkSourceType::Icon);
    fields.iconDataSource = TransitIconDataSource::initWithFields(icon);
    return TransitArtworkDataSource::initWithFields(std::move(fields));
}

std::shared_ptr<TransitSystem> systemOf(const ScheduleLine& line) {
    // A line without an agency belongs to whatever its feed is called.
    const std::string& name = line.agency.name.empty() ? line.feed : line.agency.name;
    TransitSystemRecord::Fields fields;
    fields.name = nilIfEmpty(name);
    fields.artwork =
        shieldArtwork(TransitShieldType::Neutral, systemInitials(name), NeutralColors, name);
    return TransitSystemRecord::initWithFields(std::move(fields));
}

} // namespace

std::shared_ptr<FeedTransitLine> makeTransitLine(const ScheduleLine& line) {
    FeedTransitLine::Fields fields;
    fields.muid = line.muid;
    fields.name = line.name();
    fields.identifier = MapItemIdentifier::identifierWithMuid(line.muid);
    fields.system = systemOf(line);
    fields.isBus = isBusRouteType(line.routeType);
    fields.alternateArtwork = lineArtwork(line);
    fields.modeArtwork = modeArtwork(line);
    fields.artwork = fields.alternateArtwork ? fields.alternateArtwork : fields.modeArtwork;
    fields.hasLineColorString = !line.color.empty();
    fields.lineColorString = nilIfEmpty(line.color);
    return FeedTransitLine::initWithFields_origin(std::move(fields), {line.feed, line.routeId});
}

} // namespace orvo
