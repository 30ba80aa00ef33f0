#pragma once

#include "handoff/DirectionsPlanTransitPreferences.h"
#include "platform/geoservices/OpaqueRecords.h"
#include "platform/protobuf/ProtoMessage.h"

#include <array>
#include <optional>
#include <string>
#include <vector>

namespace orvo {

enum class DisplayMethod : std::int32_t {
    DirectionsSearch = 0,
    RoutePicking = 1,
    DirectionsStarted = 2
};

enum class TransitPrioritization : std::int32_t {
    Default = 0,
    ByTravelTime = 1,
    ByTransferCount = 2,
    ByWalkingDistance = 3
};

/// The state of a directions search in the map application. This program never fills one; it
/// carries them.
///
/// `isPlayingTrace` has the number 404: the application reads it there.
class DirectionsPlan final : public ProtoMessage<DirectionsPlan> {
public:
    // Presence bits: by width, then by name; the application numbers them so.
    static constexpr std::uint32_t ArrivalTimeBit = 1;
    static constexpr std::uint32_t CurrentRouteIndexBit = 2;
    static constexpr std::uint32_t CurrentRouteStepBit = 4;
    static constexpr std::uint32_t DepartureTimeBit = 8;
    static constexpr std::uint32_t ExpiryTimeBit = 16;
    static constexpr std::uint32_t DisplayMethodBit = 32;
    static constexpr std::uint32_t EarlierPagesLoadedBit = 64;
    static constexpr std::uint32_t LaterPagesLoadedBit = 128;
    static constexpr std::uint32_t RoutesPerEarlierPageBit = 256;
    static constexpr std::uint32_t RoutesPerInitialPageBit = 512;
    static constexpr std::uint32_t RoutesPerLaterPageBit = 1024;
    static constexpr std::uint32_t TransitPrioritizationBit = 2048;
    static constexpr std::uint32_t TransitSurchargeOptionBit = 4096;
    static constexpr std::uint32_t IsPlayingTraceBit = 8192;

    static constexpr std::array DisplayMethodNames{
        "DirectionsSearch", "RoutePicking", "DirectionsStarted"};
    static constexpr std::array TransitPrioritizationNames{
        "TRANSIT_PRIORITIZE_DEFAULT",
        "TRANSIT_PRIORITIZE_BY_TRAVEL_TIME",
        "TRANSIT_PRIORITIZE_BY_TRANSFER_COUNT",
        "TRANSIT_PRIORITIZE_BY_WALKING_DISTANCE"};

    [[nodiscard]] const std::shared_ptr<RouteRequestStorage>& routeRequestStorage() const noexcept {
        return _routeRequestStorage;
    }
    void setRouteRequestStorage(std::shared_ptr<RouteRequestStorage> value) {
        _routeRequestStorage = std::move(value);
    }
    [[nodiscard]] bool hasRouteRequestStorage() const noexcept {
        return _routeRequestStorage != nullptr;
    }
    [[nodiscard]] const std::optional<std::string>& originString() const noexcept {
        return _originString;
    }
    void setOriginString(std::optional<std::string> value) { _originString = std::move(value); }
    [[nodiscard]] bool hasOriginString() const noexcept { return _originString.has_value(); }
    [[nodiscard]] const std::optional<std::string>& destinationString() const noexcept {
        return _destinationString;
    }
    void setDestinationString(std::optional<std::string> value) {
        _destinationString = std::move(value);
    }
    [[nodiscard]] bool hasDestinationString() const noexcept {
        return _destinationString.has_value();
    }
    [[nodiscard]] double departureTime() const noexcept { return _departureTime; }
    void setDepartureTime(double value) noexcept {
        assign(_departureTime, value, DepartureTimeBit);
    }
    [[nodiscard]] bool hasDepartureTime() const noexcept { return hasBit(DepartureTimeBit); }
    void setHasDepartureTime(bool present) noexcept { setHasBit(DepartureTimeBit, present); }
    [[nodiscard]] double arrivalTime() const noexcept { return _arrivalTime; }
    void setArrivalTime(double value) noexcept { assign(_arrivalTime, value, ArrivalTimeBit); }
    [[nodiscard]] bool hasArrivalTime() const noexcept { return hasBit(ArrivalTimeBit); }
    void setHasArrivalTime(bool present) noexcept { setHasBit(ArrivalTimeBit, present); }
    [[nodiscard]] std::uint64_t currentRouteIndex() const noexcept { return _currentRouteIndex; }
    void setCurrentRouteIndex(std::uint64_t value) noexcept {
        assign(_currentRouteIndex, value, CurrentRouteIndexBit);
    }
    [[nodiscard]] bool hasCurrentRouteIndex() const noexcept {
        return hasBit(CurrentRouteIndexBit);
    }
    void setHasCurrentRouteIndex(bool present) noexcept {
        setHasBit(CurrentRouteIndexBit, present);
    }
    [[nodiscard]] std::uint64_t currentRouteStep() const noexcept { return _currentRouteStep; }
    void setCurrentRouteStep(std::uint64_t value) noexcept {
        assign(_currentRouteStep, value, CurrentRouteStepBit);
    }
    [[nodiscard]] bool hasCurrentRouteStep() const noexcept { return hasBit(CurrentRouteStepBit); }
    void setHasCurrentRouteStep(bool present) noexcept { setHasBit(CurrentRouteStepBit, present); }
    [[nodiscard]] std::int32_t displayMethod() const noexcept { return _displayMethod; }
    void setDisplayMethod(std::int32_t value) noexcept {
        assign(_displayMethod, value, DisplayMethodBit);
    }
    [[nodiscard]] bool hasDisplayMethod() const noexcept { return hasBit(DisplayMethodBit); }
    void setHasDisplayMethod(bool present) noexcept { setHasBit(DisplayMethodBit, present); }
    [[nodiscard]] static std::string displayMethodAsString(std::int32_t value);
    [[nodiscard]] static std::int32_t StringAsDisplayMethod(const std::string& name);
    [[nodiscard]] const std::shared_ptr<DirectionsPlanTransitPreferences>&
    transitPreferences() const noexcept {
        return _transitPreferences;
    }
    void setTransitPreferences(std::shared_ptr<DirectionsPlanTransitPreferences> value) {
        _transitPreferences = std::move(value);
    }
    [[nodiscard]] bool hasTransitPreferences() const noexcept {
        return _transitPreferences != nullptr;
    }
    [[nodiscard]] std::uint32_t routesPerInitialPage() const noexcept {
        return _routesPerInitialPage;
    }
    void setRoutesPerInitialPage(std::uint32_t value) noexcept {
        assign(_routesPerInitialPage, value, RoutesPerInitialPageBit);
    }
    [[nodiscard]] bool hasRoutesPerInitialPage() const noexcept {
        return hasBit(RoutesPerInitialPageBit);
    }
    void setHasRoutesPerInitialPage(bool present) noexcept {
        setHasBit(RoutesPerInitialPageBit, present);
    }
    [[nodiscard]] std::uint32_t earlierPagesLoaded() const noexcept { return _earlierPagesLoaded; }
    void setEarlierPagesLoaded(std::uint32_t value) noexcept {
        assign(_earlierPagesLoaded, value, EarlierPagesLoadedBit);
    }
    [[nodiscard]] bool hasEarlierPagesLoaded() const noexcept {
        return hasBit(EarlierPagesLoadedBit);
    }
    void setHasEarlierPagesLoaded(bool present) noexcept {
        setHasBit(EarlierPagesLoadedBit, present);
    }
    [[nodiscard]] std::uint32_t laterPagesLoaded() const noexcept { return _laterPagesLoaded; }
    void setLaterPagesLoaded(std::uint32_t value) noexcept {
        assign(_laterPagesLoaded, value, LaterPagesLoadedBit);
    }
    [[nodiscard]] bool hasLaterPagesLoaded() const noexcept { return hasBit(LaterPagesLoadedBit); }
    void setHasLaterPagesLoaded(bool present) noexcept { setHasBit(LaterPagesLoadedBit, present); }
    [[nodiscard]] std::uint32_t routesPerEarlierPage() const noexcept {
        return _routesPerEarlierPage;
    }
    void setRoutesPerEarlierPage(std::uint32_t value) noexcept {
        assign(_routesPerEarlierPage, value, RoutesPerEarlierPageBit);
    }
    [[nodiscard]] bool hasRoutesPerEarlierPage() const noexcept {
        return hasBit(RoutesPerEarlierPageBit);
    }
    void setHasRoutesPerEarlierPage(bool present) noexcept {
        setHasBit(RoutesPerEarlierPageBit, present);
    }
    [[nodiscard]] std::uint32_t routesPerLaterPage() const noexcept { return _routesPerLaterPage; }
    void setRoutesPerLaterPage(std::uint32_t value) noexcept {
        assign(_routesPerLaterPage, value, RoutesPerLaterPageBit);
    }
    [[nodiscard]] bool hasRoutesPerLaterPage() const noexcept {
        return hasBit(RoutesPerLaterPageBit);
    }
    void setHasRoutesPerLaterPage(bool present) noexcept {
        setHasBit(RoutesPerLaterPageBit, present);
    }
    [[nodiscard]] std::int32_t transitPrioritization() const noexcept {
        return _transitPrioritization;
    }
    void setTransitPrioritization(std::int32_t value) noexcept {
        assign(_transitPrioritization, value, TransitPrioritizationBit);
    }
    [[nodiscard]] bool hasTransitPrioritization() const noexcept {
        return hasBit(TransitPrioritizationBit);
    }
    void setHasTransitPrioritization(bool present) noexcept {
        setHasBit(TransitPrioritizationBit, present);
    }
    [[nodiscard]] static std::string transitPrioritizationAsString(std::int32_t value);
    [[nodiscard]] static std::int32_t StringAsTransitPrioritization(const std::string& name);
    [[nodiscard]] std::int32_t transitSurchargeOption() const noexcept {
        return _transitSurchargeOption;
    }
    void setTransitSurchargeOption(std::int32_t value) noexcept {
        assign(_transitSurchargeOption, value, TransitSurchargeOptionBit);
    }
    [[nodiscard]] bool hasTransitSurchargeOption() const noexcept {
        return hasBit(TransitSurchargeOptionBit);
    }
    void setHasTransitSurchargeOption(bool present) noexcept {
        setHasBit(TransitSurchargeOptionBit, present);
    }
    [[nodiscard]] double expiryTime() const noexcept { return _expiryTime; }
    void setExpiryTime(double value) noexcept { assign(_expiryTime, value, ExpiryTimeBit); }
    [[nodiscard]] bool hasExpiryTime() const noexcept { return hasBit(ExpiryTimeBit); }
    void setHasExpiryTime(bool present) noexcept { setHasBit(ExpiryTimeBit, present); }
    [[nodiscard]] bool isPlayingTrace() const noexcept { return _isPlayingTrace; }
    void setIsPlayingTrace(bool value) noexcept {
        assign(_isPlayingTrace, value, IsPlayingTraceBit);
    }
    [[nodiscard]] bool hasIsPlayingTrace() const noexcept { return hasBit(IsPlayingTraceBit); }
    void setHasIsPlayingTrace(bool present) noexcept { setHasBit(IsPlayingTraceBit, present); }

    [[nodiscard]] static auto schema() {
        return std::tuple{
            ProtoMessageField<DirectionsPlan, RouteRequestStorage>{
                1, "routeRequestStorage", &DirectionsPlan::_routeRequestStorage},
            ProtoStringField<DirectionsPlan>{2, "originString", &DirectionsPlan::_originString},
            ProtoStringField<DirectionsPlan>{
                3, "destinationString", &DirectionsPlan::_destinationString},
            ProtoScalarField<DirectionsPlan, double>{
                4, "departureTime", &DirectionsPlan::_departureTime, DepartureTimeBit},
            ProtoScalarField<DirectionsPlan, double>{
                5, "arrivalTime", &DirectionsPlan::_arrivalTime, ArrivalTimeBit},
            ProtoScalarField<DirectionsPlan, std::uint64_t>{
                6, "currentRouteIndex", &DirectionsPlan::_currentRouteIndex, CurrentRouteIndexBit},
            ProtoScalarField<DirectionsPlan, std::uint64_t>{
                7, "currentRouteStep", &DirectionsPlan::_currentRouteStep, CurrentRouteStepBit},
            ProtoScalarField<DirectionsPlan, std::int32_t>{8,
                                                           "displayMethod",
                                                           &DirectionsPlan::_displayMethod,
                                                           DisplayMethodBit,
                                                           DisplayMethodNames},
            ProtoMessageField<DirectionsPlan, DirectionsPlanTransitPreferences>{
                9, "transitPreferences", &DirectionsPlan::_transitPreferences},
            ProtoScalarField<DirectionsPlan, std::uint32_t>{10,
                                                            "routesPerInitialPage",
                                                            &DirectionsPlan::_routesPerInitialPage,
                                                            RoutesPerInitialPageBit},
            ProtoScalarField<DirectionsPlan, std::uint32_t>{11,
                                                            "earlierPagesLoaded",
                                                            &DirectionsPlan::_earlierPagesLoaded,
                                                            EarlierPagesLoadedBit},
            ProtoScalarField<DirectionsPlan, std::uint32_t>{
                12, "laterPagesLoaded", &DirectionsPlan::_laterPagesLoaded, LaterPagesLoadedBit},
            ProtoScalarField<DirectionsPlan, std::uint32_t>{13,
                                                            "routesPerEarlierPage",
                                                            &DirectionsPlan::_routesPerEarlierPage,
                                                            RoutesPerEarlierPageBit},
            ProtoScalarField<DirectionsPlan, std::uint32_t>{14,
                                                            "routesPerLaterPage",
                                                            &DirectionsPlan::_routesPerLaterPage,
                                                            RoutesPerLaterPageBit},
            ProtoScalarField<DirectionsPlan, std::int32_t>{15,
                                                           "transitPrioritization",
                                                           &DirectionsPlan::_transitPrioritization,
                                                           TransitPrioritizationBit,
                                                           TransitPrioritizationNames},
            ProtoScalarField<DirectionsPlan, std::int32_t>{16,
                                                           "transitSurchargeOption",
                                                           &DirectionsPlan::_transitSurchargeOption,
                                                           TransitSurchargeOptionBit},
            ProtoScalarField<DirectionsPlan, double>{
                17, "expiryTime", &DirectionsPlan::_expiryTime, ExpiryTimeBit},
            ProtoScalarField<DirectionsPlan, bool>{
                404, "isPlayingTrace", &DirectionsPlan::_isPlayingTrace, IsPlayingTraceBit}};
    }

private:
    friend class ProtoMessage<DirectionsPlan>;

    std::shared_ptr<RouteRequestStorage> _routeRequestStorage;
    std::optional<std::string> _originString;
    std::optional<std::string> _destinationString;
    double _departureTime = 0;
    double _arrivalTime = 0;
    std::uint64_t _currentRouteIndex = 0;
    std::uint64_t _currentRouteStep = 0;
    std::int32_t _displayMethod = 0;
    std::shared_ptr<DirectionsPlanTransitPreferences> _transitPreferences;
    std::uint32_t _routesPerInitialPage = 0;
    std::uint32_t _earlierPagesLoaded = 0;
    std::uint32_t _laterPagesLoaded = 0;
    std::uint32_t _routesPerEarlierPage = 0;
    std::uint32_t _routesPerLaterPage = 0;
    std::int32_t _transitPrioritization = 0;
    std::int32_t _transitSurchargeOption = 0;
    double _expiryTime = 0;
    bool _isPlayingTrace = false;
};

} // namespace orvo
