#pragma once

#include "platform/foundation/NSObject.h"

namespace orvo {

/// A stretch of text in UTF-16 units.
struct NSRange {
    std::size_t location = 0;
    std::size_t length = 0;

    friend bool operator==(const NSRange&, const NSRange&) = default;
};

/// A boxed range.
class NSValue final : public virtual NSCopying {
public:
    [[nodiscard]] static std::shared_ptr<NSValue> valueWithRange(NSRange range);

    [[nodiscard]] NSRange rangeValue() const noexcept { return _range; }

    [[nodiscard]] bool isEqual(const NSObject* other) const override;
    [[nodiscard]] std::uint64_t hash() const override;
    /// `{4, 2}`.
    [[nodiscard]] std::string description() const override;
    [[nodiscard]] std::shared_ptr<NSObject> copy() const override;

private:
    NSRange _range;
};

} // namespace orvo
