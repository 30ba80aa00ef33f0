#pragma once

#include "platform/foundation/NSObject.h"

#include <optional>
#include <string>

namespace orvo {

/// What a mode's or system's icon shows.
class TransitIconDataSource final : public virtual NSObject {
public:
    struct Fields {
        std::int32_t iconType = 0;
        std::uint32_t cartoID = 0;
        std::uint32_t defaultTransitType = 0; ///< the mode, `TransitShieldType`
        std::uint32_t iconAttributeKey = 0;
        std::uint32_t iconAttributeValue = 0;
    };

    [[nodiscard]] static std::shared_ptr<TransitIconDataSource> initWithFields(Fields fields);

    [[nodiscard]] const Fields& fields() const noexcept { return _fields; }
    [[nodiscard]] std::int32_t iconType() const { return _fields.iconType; }
    [[nodiscard]] std::uint32_t cartoID() const { return _fields.cartoID; }
    [[nodiscard]] std::uint32_t defaultTransitType() const { return _fields.defaultTransitType; }
    [[nodiscard]] std::uint32_t iconAttributeKey() const { return _fields.iconAttributeKey; }
    [[nodiscard]] std::uint32_t iconAttributeValue() const { return _fields.iconAttributeValue; }

    /// Every field, in order of declaration; two nils are equal.
    [[nodiscard]] bool isEqual(const NSObject* other) const override;
    [[nodiscard]] std::uint64_t hash() const override;

private:
    Fields _fields;
};

} // namespace orvo
