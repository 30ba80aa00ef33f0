#pragma once

#include "platform/foundation/NSObject.h"

#include <cstdint>

namespace orvo {

/// Names one item of the map, here a line. Immutable.
class MapItemIdentifier final : public virtual NSCopying {
public:
    [[nodiscard]] static std::shared_ptr<MapItemIdentifier> identifierWithMuid(std::uint64_t muid);

    [[nodiscard]] std::uint64_t muid() const noexcept { return _muid; }

    [[nodiscard]] bool isEqual(const NSObject* other) const override;
    [[nodiscard]] std::uint64_t hash() const override;
    /// The number.
    [[nodiscard]] std::string description() const override;
    [[nodiscard]] std::shared_ptr<NSObject> copy() const override;

private:
    std::uint64_t _muid = 0;
};

} // namespace orvo
