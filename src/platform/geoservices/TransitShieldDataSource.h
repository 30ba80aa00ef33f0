#pragma once

#include "platform/foundation/NSObject.h"

#include <optional>
#include <string>

namespace orvo {

/// What a line's shield shows.
///
/// `shieldType` is the shape, by mode (`TransitShieldType`). `shieldColorString` is the background
/// as `RRGGBB`, or background and text as `RRGGBB,RRGGBB`.
class TransitShieldDataSource final : public virtual NSObject {
public:
    struct Fields {
        std::int32_t shieldType = 0;
        std::optional<std::string> shieldText;
        std::optional<std::string> shieldColorString;
    };

    [[nodiscard]] static std::shared_ptr<TransitShieldDataSource> initWithFields(Fields fields);

    [[nodiscard]] const Fields& fields() const noexcept { return _fields; }
    [[nodiscard]] std::int32_t shieldType() const { return _fields.shieldType; }
    [[nodiscard]] std::optional<std::string> shieldText() const { return _fields.shieldText; }
    [[nodiscard]] std::optional<std::string> shieldColorString() const {
        return _fields.shieldColorString;
    }

    /// Every field, in order of declaration; two nils are equal.
    [[nodiscard]] bool isEqual(const NSObject* other) const override;
    [[nodiscard]] std::uint64_t hash() const override;

private:
    Fields _fields;
};

} // namespace orvo
