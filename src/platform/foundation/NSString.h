#pragma once

#include "platform/foundation/NSObject.h"

#include <optional>
#include <string>

namespace orvo {

/// Text where any object can stand. Elsewhere text is `std::string`, UTF-8.
class NSString final : public virtual NSCopying {
public:
    [[nodiscard]] static std::shared_ptr<NSString> string(std::string utf8);
    /// Nil for no text.
    [[nodiscard]] static std::shared_ptr<NSString>
    stringOrNil(const std::optional<std::string>& utf8);

    [[nodiscard]] const std::string& utf8() const noexcept { return _utf8; }

    [[nodiscard]] bool isEqual(const NSObject* other) const override;
    [[nodiscard]] std::uint64_t hash() const override;
    [[nodiscard]] std::string description() const override;
    [[nodiscard]] std::shared_ptr<NSObject> copy() const override;

private:
    std::string _utf8;
};

/// The text of `object` when it is an `NSString`.
[[nodiscard]] std::optional<std::string> stringValue(const NSObject* object);
/// The hash of a text that may be nil: 0 for nil, else that of its `NSString`.
[[nodiscard]] std::uint64_t hashOf(const std::optional<std::string>& text);

} // namespace orvo
