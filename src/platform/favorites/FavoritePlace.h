#pragma once

#include "platform/foundation/NSObject.h"

#include <string>

namespace orvo {

/// A favourite that is a place on the map. Immutable.
class FavoritePlace final : public virtual NSObject {
public:
    /// Degrees: latitude -90 to 90, longitude -180 to 180.
    [[nodiscard]] static std::shared_ptr<FavoritePlace>
    initWithName_latitude_longitude(std::string name, double latitude, double longitude);

    [[nodiscard]] const std::string& name() const noexcept { return _name; }
    [[nodiscard]] double latitude() const noexcept { return _latitude; }
    [[nodiscard]] double longitude() const noexcept { return _longitude; }

    /// All three.
    [[nodiscard]] bool isEqual(const NSObject* other) const override;
    [[nodiscard]] std::uint64_t hash() const override;
    /// The name.
    [[nodiscard]] std::string description() const override;

private:
    std::string _name;
    double _latitude = 0;
    double _longitude = 0;
};

} // namespace orvo
