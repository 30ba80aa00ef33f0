#pragma once

#include "platform/foundation/NSArray.h"
#include "platform/foundation/NSObject.h"

#include <optional>
#include <string>

namespace orvo {

/// A text composed by a server: formats joined by separators, with tokens filled in.
///
/// A nil list and an empty one are the same.
class ServerFormattedString final : public virtual NSObject {
public:
    struct Fields {
        std::shared_ptr<NSArray> formatStrings; ///< `NSString`s
        std::shared_ptr<NSArray> separators;    ///< `NSString`s
        std::shared_ptr<NSArray> formatTokens;  ///< `ServerFormatToken`s
        std::optional<std::string> alternativeString;
    };

    [[nodiscard]] static std::shared_ptr<ServerFormattedString> initWithFields(Fields fields);

    [[nodiscard]] const Fields& fields() const noexcept { return _fields; }
    [[nodiscard]] std::shared_ptr<NSArray> formatStrings() const { return _fields.formatStrings; }
    [[nodiscard]] std::shared_ptr<NSArray> separators() const { return _fields.separators; }
    [[nodiscard]] std::shared_ptr<NSArray> formatTokens() const { return _fields.formatTokens; }
    [[nodiscard]] std::optional<std::string> alternativeString() const {
        return _fields.alternativeString;
    }

    /// Every field, in order of declaration; two nils are equal.
    [[nodiscard]] bool isEqual(const NSObject* other) const override;
    [[nodiscard]] std::uint64_t hash() const override;

private:
    Fields _fields;
};

} // namespace orvo
