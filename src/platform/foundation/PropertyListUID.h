#pragma once

#include "platform/foundation/NSObject.h"

namespace orvo {

/// A reference to an object of an archive, as the binary property list format holds it. Immutable.
class PropertyListUID final : public virtual NSObject {
public:
    [[nodiscard]] static std::shared_ptr<PropertyListUID> uidWithValue(std::uint64_t value);

    [[nodiscard]] std::uint64_t value() const noexcept { return _value; }

    [[nodiscard]] bool isEqual(const NSObject* other) const override;
    [[nodiscard]] std::uint64_t hash() const override;
    /// `UID(3)`.
    [[nodiscard]] std::string description() const override;

private:
    std::uint64_t _value = 0;
};

} // namespace orvo
