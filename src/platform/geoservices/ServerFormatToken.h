#pragma once

#include "platform/foundation/NSObject.h"

#include <optional>
#include <string>

namespace orvo {

/// One value that a server's formatted text refers to: a piece of text, a time or a number under a
/// name.
class ServerFormatToken final : public virtual NSObject {
public:
    struct Fields {
        std::int32_t type = 0;
        std::optional<std::string> token; ///< the name that the format refers to
        std::optional<std::string> text;
        double value = 0;
    };

    [[nodiscard]] static std::shared_ptr<ServerFormatToken> initWithFields(Fields fields);

    [[nodiscard]] const Fields& fields() const noexcept { return _fields; }
    [[nodiscard]] std::int32_t type() const { return _fields.type; }
    [[nodiscard]] std::optional<std::string> token() const { return _fields.token; }
    [[nodiscard]] std::optional<std::string> text() const { return _fields.text; }
    [[nodiscard]] double value() const { return _fields.value; }

    /// Every field, in order of declaration; two nils are equal.
    [[nodiscard]] bool isEqual(const NSObject* other) const override;
    [[nodiscard]] std::uint64_t hash() const override;

private:
    Fields _fields;
};

} // namespace orvo
