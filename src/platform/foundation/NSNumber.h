#pragma once

#include "platform/foundation/NSObject.h"

#include <variant>

namespace orvo {

/// A boxed truth value or number. Numbers that are the same number are equal whatever their type,
/// and hash alike; true equals 1 and false equals 0, and not-a-number equals itself.
class NSNumber final : public virtual NSCopying {
public:
    using Value = std::variant<bool, std::int64_t, std::uint64_t, double>;

    [[nodiscard]] static std::shared_ptr<NSNumber> numberWithBool(bool value);
    [[nodiscard]] static std::shared_ptr<NSNumber> numberWithInteger(std::int64_t value);
    [[nodiscard]] static std::shared_ptr<NSNumber> numberWithUnsignedInteger(std::uint64_t value);
    [[nodiscard]] static std::shared_ptr<NSNumber> numberWithDouble(double value);

    [[nodiscard]] const Value& value() const noexcept { return _value; }
    [[nodiscard]] bool boolValue() const;
    /// Saturates at the limits of the type; a fraction is cut off; not-a-number is 0.
    [[nodiscard]] std::int64_t integerValue() const;
    /// Saturates at the limits of the type: a negative number is 0.
    [[nodiscard]] std::uint64_t unsignedIntegerValue() const;
    [[nodiscard]] double doubleValue() const;

    [[nodiscard]] bool isEqual(const NSObject* other) const override;
    [[nodiscard]] std::uint64_t hash() const override;
    [[nodiscard]] std::string description() const override;
    [[nodiscard]] std::shared_ptr<NSObject> copy() const override;

private:
    static std::shared_ptr<NSNumber> make(Value value);

    Value _value;
};

} // namespace orvo
