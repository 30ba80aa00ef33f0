#pragma once

#include "platform/protobuf/ProtoMessage.h"

#include <array>
#include <optional>
#include <string>
#include <vector>

namespace orvo {

/// Which kinds of transit a directions search leaves out.
class DirectionsPlanTransitPreferences final
    : public ProtoMessage<DirectionsPlanTransitPreferences> {
public:
    // Presence bits: by width, then by name; the application numbers them so.
    static constexpr std::uint32_t AvoidBusRoutesBit = 1;
    static constexpr std::uint32_t AvoidFerryRoutesBit = 2;
    static constexpr std::uint32_t AvoidMetroLightRailRoutesBit = 4;
    static constexpr std::uint32_t AvoidRailRoutesBit = 8;

    [[nodiscard]] bool avoidBusRoutes() const noexcept { return _avoidBusRoutes; }
    void setAvoidBusRoutes(bool value) noexcept {
        assign(_avoidBusRoutes, value, AvoidBusRoutesBit);
    }
    [[nodiscard]] bool hasAvoidBusRoutes() const noexcept { return hasBit(AvoidBusRoutesBit); }
    void setHasAvoidBusRoutes(bool present) noexcept { setHasBit(AvoidBusRoutesBit, present); }
    [[nodiscard]] bool avoidMetroLightRailRoutes() const noexcept {
        return _avoidMetroLightRailRoutes;
    }
    void setAvoidMetroLightRailRoutes(bool value) noexcept {
        assign(_avoidMetroLightRailRoutes, value, AvoidMetroLightRailRoutesBit);
    }
    [[nodiscard]] bool hasAvoidMetroLightRailRoutes() const noexcept {
        return hasBit(AvoidMetroLightRailRoutesBit);
    }
    void setHasAvoidMetroLightRailRoutes(bool present) noexcept {
        setHasBit(AvoidMetroLightRailRoutesBit, present);
    }
    [[nodiscard]] bool avoidRailRoutes() const noexcept { return _avoidRailRoutes; }
    void setAvoidRailRoutes(bool value) noexcept {
        assign(_avoidRailRoutes, value, AvoidRailRoutesBit);
    }
    [[nodiscard]] bool hasAvoidRailRoutes() const noexcept { return hasBit(AvoidRailRoutesBit); }
    void setHasAvoidRailRoutes(bool present) noexcept { setHasBit(AvoidRailRoutesBit, present); }
    [[nodiscard]] bool avoidFerryRoutes() const noexcept { return _avoidFerryRoutes; }
    void setAvoidFerryRoutes(bool value) noexcept {
        assign(_avoidFerryRoutes, value, AvoidFerryRoutesBit);
    }
    [[nodiscard]] bool hasAvoidFerryRoutes() const noexcept { return hasBit(AvoidFerryRoutesBit); }
    void setHasAvoidFerryRoutes(bool present) noexcept { setHasBit(AvoidFerryRoutesBit, present); }

    [[nodiscard]] static auto schema() {
        return std::tuple{ProtoScalarField<DirectionsPlanTransitPreferences, bool>{
                              1,
                              "avoidBusRoutes",
                              &DirectionsPlanTransitPreferences::_avoidBusRoutes,
                              AvoidBusRoutesBit},
                          ProtoScalarField<DirectionsPlanTransitPreferences, bool>{
                              2,
                              "avoidMetroLightRailRoutes",
                              &DirectionsPlanTransitPreferences::_avoidMetroLightRailRoutes,
                              AvoidMetroLightRailRoutesBit},
                          ProtoScalarField<DirectionsPlanTransitPreferences, bool>{
                              3,
                              "avoidRailRoutes",
                              &DirectionsPlanTransitPreferences::_avoidRailRoutes,
                              AvoidRailRoutesBit},
                          ProtoScalarField<DirectionsPlanTransitPreferences, bool>{
                              4,
                              "avoidFerryRoutes",
                              &DirectionsPlanTransitPreferences::_avoidFerryRoutes,
                              AvoidFerryRoutesBit}};
    }

private:
    friend class ProtoMessage<DirectionsPlanTransitPreferences>;

    bool _avoidBusRoutes = false;
    bool _avoidMetroLightRailRoutes = false;
    bool _avoidRailRoutes = false;
    bool _avoidFerryRoutes = false;
};

} // namespace orvo
