#pragma once

#include "platform/geoservices/TransitLineItem.h"

#include <utility>

namespace orvo {

/// A line item with other incidents than its own. What makes the line recognisable is that of the
/// wrapped line; what goes beyond that, and what the incidents' origin would prove, is missing. A
/// missing wrapped line answers nil, 0 and false. Not synchronised.
class DebugTransitLineItem final : public virtual TransitLineItem {
public:
    [[nodiscard]] static std::shared_ptr<DebugTransitLineItem>
    initWithLine_incidents(std::shared_ptr<TransitLineItem> line,
                           std::shared_ptr<NSArray> incidents);

    void setIncidents(std::shared_ptr<NSArray> incidents) { _incidents = std::move(incidents); }
    [[nodiscard]] std::shared_ptr<TransitLineItem> wrappedLine() const { return _wrappedLine; }
    void setWrappedLine(std::shared_ptr<TransitLineItem> line) { _wrappedLine = std::move(line); }

    [[nodiscard]] std::uint64_t muid() const override;
    [[nodiscard]] std::shared_ptr<MapItemIdentifier> identifier() const override;
    [[nodiscard]] std::optional<std::string> name() const override;
    [[nodiscard]] std::shared_ptr<TransitSystem> system() const override;
    [[nodiscard]] std::uint64_t departureTimeDisplayStyle() const override;
    [[nodiscard]] bool departuresAreVehicleSpecific() const override;
    [[nodiscard]] bool isBus() const override;
    [[nodiscard]] std::shared_ptr<TransitArtworkDataSource> artwork() const override;
    [[nodiscard]] std::shared_ptr<TransitArtworkDataSource> modeArtwork() const override;
    [[nodiscard]] std::shared_ptr<TransitArtworkDataSource> alternateArtwork() const override;
    [[nodiscard]] bool hasLineColorString() const override;
    [[nodiscard]] std::optional<std::string> lineColorString() const override;
    [[nodiscard]] bool showVehicleNumber() const override;
    [[nodiscard]] std::shared_ptr<NSArray> operatingHours() const override;

    [[nodiscard]] std::shared_ptr<NSArray> labelItems() const override { return nullptr; }
    [[nodiscard]] std::shared_ptr<NSObject> attribution() const override { return nullptr; }
    [[nodiscard]] std::shared_ptr<NSObject> mapRegion() const override { return nullptr; }

    [[nodiscard]] std::shared_ptr<NSArray> incidents() const override { return _incidents; }
    [[nodiscard]] bool isIncidentsTTLExpired() const override { return false; }
    [[nodiscard]] bool hasIncidentComponent() const override { return false; }
    [[nodiscard]] bool hasEncyclopedicInfo() const override { return false; }
    [[nodiscard]] std::shared_ptr<NSObject> encyclopedicInfo() const override { return nullptr; }

private:
    template <class T>
    [[nodiscard]] T _forward(T (TransitLine::*property)() const) const;

    std::shared_ptr<NSArray> _incidents; // immutable: to keep it is to copy it
    std::shared_ptr<TransitLineItem> _wrappedLine;
};

} // namespace orvo
