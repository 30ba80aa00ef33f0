#pragma once

#include "platform/foundation/NSObject.h"

#include <string>

namespace orvo {

/// A URL as text. Immutable.
class NSURL final : public virtual NSCopying {
public:
    /// Nil when `text` is no URL: no scheme, blanks or control characters.
    [[nodiscard]] static std::shared_ptr<NSURL> URLWithString(std::string text);

    [[nodiscard]] const std::string& absoluteString() const noexcept { return _text; }
    /// In small letters.
    [[nodiscard]] std::string scheme() const;

    [[nodiscard]] bool isEqual(const NSObject* other) const override;
    [[nodiscard]] std::uint64_t hash() const override;
    [[nodiscard]] std::string description() const override;
    [[nodiscard]] std::shared_ptr<NSObject> copy() const override;

private:
    std::string _text;
};

} // namespace orvo
