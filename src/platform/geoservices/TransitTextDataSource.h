#pragma once

#include "platform/foundation/NSObject.h"
#include "platform/geoservices/ServerFormattedString.h"

#include <optional>
#include <string>

namespace orvo {

/// An artwork that is text.
class TransitTextDataSource final : public virtual NSObject {
public:
    struct Fields {
        std::shared_ptr<ServerFormattedString> text;
    };

    [[nodiscard]] static std::shared_ptr<TransitTextDataSource> initWithFields(Fields fields);

    [[nodiscard]] const Fields& fields() const noexcept { return _fields; }
    [[nodiscard]] std::shared_ptr<ServerFormattedString> text() const { return _fields.text; }

    /// Every field, in order of declaration; two nils are equal.
    [[nodiscard]] bool isEqual(const NSObject* other) const override;
    [[nodiscard]] std::uint64_t hash() const override;

private:
    Fields _fields;
};

} // namespace orvo
