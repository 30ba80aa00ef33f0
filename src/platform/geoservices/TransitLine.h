#pragma once

#include "platform/foundation/NSArray.h"
#include "platform/foundation/NSObject.h"
#include "platform/geoservices/MapItemIdentifier.h"
#include "platform/geoservices/TransitSystem.h"

#include <cstdint>
#include <optional>
#include <string>

namespace orvo {

/// A line: one route of a schedule, as the rider knows it. Objects and texts may be nil.
class TransitLine : public virtual NSObject {
public:
    /// The same on every machine and after every import; never 0 for a line of a feed.
    [[nodiscard]] virtual std::uint64_t muid() const = 0;
    [[nodiscard]] virtual std::optional<std::string> name() const = 0;
    [[nodiscard]] virtual std::shared_ptr<MapItemIdentifier> identifier() const = 0;
    [[nodiscard]] virtual std::shared_ptr<TransitSystem> system() const = 0;
    [[nodiscard]] virtual std::uint64_t departureTimeDisplayStyle() const = 0;
    [[nodiscard]] virtual bool departuresAreVehicleSpecific() const = 0;
    [[nodiscard]] virtual bool isBus() const = 0;
    /// What stands for the line on the map.
    [[nodiscard]] virtual std::shared_ptr<TransitArtworkDataSource> artwork() const = 0;
    /// The icon of its mode of transport.
    [[nodiscard]] virtual std::shared_ptr<TransitArtworkDataSource> modeArtwork() const = 0;
    /// The line's own shield; nil for a line with neither a short name nor a colour.
    [[nodiscard]] virtual std::shared_ptr<TransitArtworkDataSource> alternateArtwork() const = 0;
    [[nodiscard]] virtual bool hasLineColorString() const = 0;
    /// `RRGGBB`.
    [[nodiscard]] virtual std::optional<std::string> lineColorString() const = 0;
    [[nodiscard]] virtual bool showVehicleNumber() const = 0;
    [[nodiscard]] virtual std::shared_ptr<NSArray> operatingHours() const = 0;
    [[nodiscard]] virtual std::shared_ptr<NSArray> labelItems() const = 0;
    [[nodiscard]] virtual std::shared_ptr<NSObject> attribution() const = 0;
    [[nodiscard]] virtual std::shared_ptr<NSObject> mapRegion() const = 0;
};

} // namespace orvo
