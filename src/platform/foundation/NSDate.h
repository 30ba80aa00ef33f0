#pragma once

#include "platform/foundation/NSObject.h"

namespace orvo {

/// Seconds.
using NSTimeInterval = double;

/// Seconds from 1970-01-01 to the reference date 2001-01-01, both 00:00 UTC.
inline constexpr NSTimeInterval NSTimeIntervalSince1970 = 978307200.0;

/// A moment, to which "now" is given by the environment's wall clock. Immutable.
class NSDate final : public virtual NSCopying {
public:
    [[nodiscard]] static std::shared_ptr<NSDate> date();
    [[nodiscard]] static std::shared_ptr<NSDate>
    dateWithTimeIntervalSinceNow(NSTimeInterval seconds);
    [[nodiscard]] static std::shared_ptr<NSDate>
    dateWithTimeIntervalSince1970(NSTimeInterval seconds);
    [[nodiscard]] static std::shared_ptr<NSDate>
    dateWithTimeIntervalSinceReferenceDate(NSTimeInterval seconds);

    [[nodiscard]] NSTimeInterval timeIntervalSinceReferenceDate() const noexcept {
        return _seconds;
    }
    [[nodiscard]] NSTimeInterval timeIntervalSince1970() const noexcept;
    /// Positive when the receiver is later.
    [[nodiscard]] NSTimeInterval timeIntervalSinceDate(const NSDate& other) const noexcept;
    /// Positive in the future.
    [[nodiscard]] NSTimeInterval timeIntervalSinceNow() const;

    [[nodiscard]] bool isEqual(const NSObject* other) const override;
    [[nodiscard]] std::uint64_t hash() const override;
    /// `2024-07-24 01:28:40 +0000`.
    [[nodiscard]] std::string description() const override;
    [[nodiscard]] std::shared_ptr<NSObject> copy() const override;

private:
    NSTimeInterval _seconds = 0;
};

} // namespace orvo
