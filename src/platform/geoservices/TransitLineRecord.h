#pragma once

#include "platform/geoservices/TransitArtworkDataSource.h"
#include "platform/geoservices/TransitLine.h"

#include <utility>

namespace orvo {

/// A line as a plain immutable value.
class TransitLineRecord : public virtual TransitLine {
public:
    struct Fields {
        std::uint64_t muid = 0;
        std::optional<std::string> name;
        std::shared_ptr<MapItemIdentifier> identifier;
        std::shared_ptr<TransitSystem> system;
        std::uint64_t departureTimeDisplayStyle = 0;
        bool departuresAreVehicleSpecific = false;
        bool isBus = false;
        std::shared_ptr<TransitArtworkDataSource> artwork;
        std::shared_ptr<TransitArtworkDataSource> modeArtwork;
        std::shared_ptr<TransitArtworkDataSource> alternateArtwork;
        bool hasLineColorString = false;
        std::optional<std::string> lineColorString;
        bool showVehicleNumber = false;
        std::shared_ptr<NSArray> operatingHours;
        std::shared_ptr<NSArray> labelItems;
        std::shared_ptr<NSObject> attribution;
        std::shared_ptr<NSObject> mapRegion;
    };

    [[nodiscard]] static std::shared_ptr<TransitLineRecord> initWithFields(Fields fields);

    [[nodiscard]] const Fields& fields() const noexcept { return _fields; }

    [[nodiscard]] std::uint64_t muid() const override { return _fields.muid; }
    [[nodiscard]] std::optional<std::string> name() const override { return _fields.name; }
    [[nodiscard]] std::shared_ptr<MapItemIdentifier> identifier() const override {
        return _fields.identifier;
    }
    [[nodiscard]] std::shared_ptr<TransitSystem> system() const override { return _fields.system; }
    [[nodiscard]] std::uint64_t departureTimeDisplayStyle() const override {
        return _fields.departureTimeDisplayStyle;
    }
    [[nodiscard]] bool departuresAreVehicleSpecific() const override {
        return _fields.departuresAreVehicleSpecific;
    }
    [[nodiscard]] bool isBus() const override { return _fields.isBus; }
    [[nodiscard]] std::shared_ptr<TransitArtworkDataSource> artwork() const override {
        return _fields.artwork;
    }
    [[nodiscard]] std::shared_ptr<TransitArtworkDataSource> modeArtwork() const override {
        return _fields.modeArtwork;
    }
    [[nodiscard]] std::shared_ptr<TransitArtworkDataSource> alternateArtwork() const override {
        return _fields.alternateArtwork;
    }
    [[nodiscard]] bool hasLineColorString() const override { return _fields.hasLineColorString; }
    [[nodiscard]] std::optional<std::string> lineColorString() const override {
        return _fields.lineColorString;
    }
    [[nodiscard]] bool showVehicleNumber() const override { return _fields.showVehicleNumber; }
    [[nodiscard]] std::shared_ptr<NSArray> operatingHours() const override {
        return _fields.operatingHours;
    }
    [[nodiscard]] std::shared_ptr<NSArray> labelItems() const override {
        return _fields.labelItems;
    }
    [[nodiscard]] std::shared_ptr<NSObject> attribution() const override {
        return _fields.attribution;
    }
    [[nodiscard]] std::shared_ptr<NSObject> mapRegion() const override { return _fields.mapRegion; }

protected:
    void _initWithFields(Fields fields) { _fields = std::move(fields); }

private:
    Fields _fields;
};

} // namespace orvo
