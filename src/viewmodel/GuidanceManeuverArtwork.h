#pragma once

#include "platform/foundation/NSObject.h"

#include <cstdint>

namespace orvo {

/// Which manoeuvre a guidance sign shows. Shared with the map application; the widget makes none.
/// Immutable.
class GuidanceManeuverArtwork : public virtual NSObject {
public:
    /// Without a junction, driving side 0.
    [[nodiscard]] static std::shared_ptr<GuidanceManeuverArtwork>
    artworkWithManeuver(std::int32_t maneuver);
    /// `junction`, a description of the junction, may be nil.
    [[nodiscard]] static std::shared_ptr<GuidanceManeuverArtwork>
    initWithManeuver_junction_drivingSide(std::int32_t maneuver,
                                          std::shared_ptr<NSObject> junction,
                                          std::int32_t drivingSide);

    [[nodiscard]] std::int32_t maneuver() const noexcept { return _maneuver; }
    [[nodiscard]] const std::shared_ptr<NSObject>& junction() const noexcept { return _junction; }
    [[nodiscard]] std::int32_t drivingSide() const noexcept { return _drivingSide; }

    /// Manoeuvres 17 and 25.
    [[nodiscard]] bool isStartRouteManeuver() const noexcept;
    /// Manoeuvres 16, 18, 33, 34 and 39.
    [[nodiscard]] bool isArriveManeuver() const noexcept;

    /// Itself, or an object of exactly the same class with equal fields; the junctions both nil, or
    /// of one kind and equal.
    [[nodiscard]] bool isEqual(const NSObject* other) const override;
    [[nodiscard]] std::uint64_t hash() const override;

protected:
    void _initWithManeuver_junction_drivingSide(std::int32_t maneuver,
                                                std::shared_ptr<NSObject> junction,
                                                std::int32_t drivingSide);

private:
    std::int32_t _maneuver = 0;
    std::shared_ptr<NSObject> _junction;
    std::int32_t _drivingSide = 0;
};

} // namespace orvo
