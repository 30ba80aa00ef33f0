#pragma once

#include "platform/favorites/TransitStorageIncident.h"
#include "platform/favorites/TransitStorageSystem.h"
#include "platform/foundation/NSCoding.h"
#include "platform/geoservices/FeedTransitLine.h"
#include "platform/geoservices/TransitLineItem.h"
#include "platform/protobuf/ProtoMessage.h"

#include <optional>
#include <string>

namespace orvo {

/// A storable copy of a line item, or of a line without incidents: what the rows are built from,
/// and where a feed's line came from. Opening hours, labels, attribution, region and background are
/// not kept and answer nil.
class TransitStorageLineItem final : public ProtoMessage<TransitStorageLineItem>,
                                     public virtual TransitLineItem,
                                     public virtual NSSecureCoding {
public:
    /// Of any line; the incidents of a `TransitLineItem` are copied too. Nil for nil.
    [[nodiscard]] static std::shared_ptr<TransitStorageLineItem>
    initWithLineItem(const std::shared_ptr<TransitLine>& line);

    [[nodiscard]] std::uint64_t muid() const override { return _muid; }
    [[nodiscard]] std::optional<std::string> name() const override { return _name; }
    [[nodiscard]] std::shared_ptr<MapItemIdentifier> identifier() const override;
    [[nodiscard]] std::shared_ptr<TransitSystem> system() const override { return _system; }
    [[nodiscard]] std::uint64_t departureTimeDisplayStyle() const override {
        return _departureTimeDisplayStyle;
    }
    [[nodiscard]] bool departuresAreVehicleSpecific() const override {
        return _departuresAreVehicleSpecific;
    }
    [[nodiscard]] bool isBus() const override { return _isBus; }
    [[nodiscard]] std::shared_ptr<TransitArtworkDataSource> artwork() const override {
        return artworkOf(_artwork);
    }
    [[nodiscard]] std::shared_ptr<TransitArtworkDataSource> modeArtwork() const override {
        return artworkOf(_modeArtwork);
    }
    [[nodiscard]] std::shared_ptr<TransitArtworkDataSource> alternateArtwork() const override {
        return artworkOf(_alternateArtwork);
    }
    [[nodiscard]] bool hasLineColorString() const override { return _hasLineColorString; }
    [[nodiscard]] std::optional<std::string> lineColorString() const override {
        return _lineColorString;
    }
    [[nodiscard]] bool showVehicleNumber() const override { return _showVehicleNumber; }
    [[nodiscard]] std::shared_ptr<NSArray> operatingHours() const override { return nullptr; }
    [[nodiscard]] std::shared_ptr<NSArray> labelItems() const override { return nullptr; }
    [[nodiscard]] std::shared_ptr<NSObject> attribution() const override { return nullptr; }
    [[nodiscard]] std::shared_ptr<NSObject> mapRegion() const override { return nullptr; }

    [[nodiscard]] std::shared_ptr<NSArray> incidents() const override;
    [[nodiscard]] bool isIncidentsTTLExpired() const override { return _isIncidentsTTLExpired; }
    [[nodiscard]] bool hasIncidentComponent() const override { return _hasIncidentComponent; }
    [[nodiscard]] bool hasEncyclopedicInfo() const override { return false; }
    [[nodiscard]] std::shared_ptr<NSObject> encyclopedicInfo() const override { return nullptr; }

    /// Nothing for a line that came from no feed.
    [[nodiscard]] std::optional<FeedLineOrigin> origin() const;

    /// Archived as the message's bytes under one key; nil where the coder does not hold them.
    [[nodiscard]] static std::shared_ptr<TransitStorageLineItem> initWithCoder(NSCoder& coder);
    void encodeWithCoder(NSCoder& coder) const override;

    [[nodiscard]] static auto schema() {
        using Self = TransitStorageLineItem;
        return std::tuple{
            ProtoScalarField<Self, std::uint64_t>{1, "muid", &Self::_muid, MuidBit},
            ProtoStringField<Self>{2, "name", &Self::_name},
            ProtoMessageField<Self, TransitStorageSystem>{3, "system", &Self::_system},
            ProtoMessageField<Self, TransitStorageArtwork>{4, "artwork", &Self::_artwork},
            ProtoMessageField<Self, TransitStorageArtwork>{5, "modeArtwork", &Self::_modeArtwork},
            ProtoMessageField<Self, TransitStorageArtwork>{
                6, "alternateArtwork", &Self::_alternateArtwork},
            ProtoScalarField<Self, bool>{7, "isBus", &Self::_isBus, IsBusBit},
            ProtoScalarField<Self, std::uint64_t>{
                8, "departureTimeDisplayStyle", &Self::_departureTimeDisplayStyle, StyleBit},
            ProtoScalarField<Self, bool>{9,
                                         "departuresAreVehicleSpecific",
                                         &Self::_departuresAreVehicleSpecific,
                                         SpecificBit},
            ProtoStringField<Self>{10, "lineColorString", &Self::_lineColorString},
            ProtoScalarField<Self, bool>{
                11, "hasLineColorString", &Self::_hasLineColorString, HasColorBit},
            ProtoScalarField<Self, bool>{
                12, "showVehicleNumber", &Self::_showVehicleNumber, VehicleNumberBit},
            ProtoRepeatedField<Self, TransitStorageIncident>{13, "incidents", &Self::_incidents},
            ProtoScalarField<Self, bool>{14, "hasIncidents", &Self::_hasIncidents, HasIncidentsBit},
            ProtoScalarField<Self, bool>{
                15, "isIncidentsTTLExpired", &Self::_isIncidentsTTLExpired, ExpiredBit},
            ProtoScalarField<Self, bool>{
                16, "hasIncidentComponent", &Self::_hasIncidentComponent, ComponentBit},
            ProtoScalarField<Self, std::uint64_t>{
                17, "identifier", &Self::_identifier, IdentifierBit},
            ProtoStringField<Self>{18, "feed", &Self::_feed},
            ProtoStringField<Self>{19, "routeId", &Self::_routeId}};
    }

private:
    friend class ProtoMessage<TransitStorageLineItem>;

    enum Bits : std::uint32_t {
        MuidBit = 1U << 0U,
        IsBusBit = 1U << 1U,
        StyleBit = 1U << 2U,
        SpecificBit = 1U << 3U,
        HasColorBit = 1U << 4U,
        VehicleNumberBit = 1U << 5U,
        HasIncidentsBit = 1U << 6U,
        ExpiredBit = 1U << 7U,
        ComponentBit = 1U << 8U,
        IdentifierBit = 1U << 9U,
    };

    void takeLine(const TransitLine& line);
    void takeService(const TransitLineItem& item);
    void takeOrigin(const TransitLine& line);

    std::uint64_t _muid = 0;
    std::optional<std::string> _name;
    std::shared_ptr<TransitStorageSystem> _system;
    std::shared_ptr<TransitStorageArtwork> _artwork;
    std::shared_ptr<TransitStorageArtwork> _modeArtwork;
    std::shared_ptr<TransitStorageArtwork> _alternateArtwork;
    bool _isBus = false;
    std::uint64_t _departureTimeDisplayStyle = 0;
    bool _departuresAreVehicleSpecific = false;
    std::optional<std::string> _lineColorString;
    bool _hasLineColorString = false;
    bool _showVehicleNumber = false;
    std::vector<std::shared_ptr<TransitStorageIncident>> _incidents;
    bool _hasIncidents = false; // a list that is empty, not nil
    bool _isIncidentsTTLExpired = false;
    bool _hasIncidentComponent = false;
    std::uint64_t _identifier = 0;
    std::optional<std::string> _feed;
    std::optional<std::string> _routeId;
};

} // namespace orvo
