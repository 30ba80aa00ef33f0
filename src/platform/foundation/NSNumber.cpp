#include "platform/foundation/NSNumber.h"

#include "platform/foundation/Hashing.h"

#include <bit>
#include <cmath>
#include <fmt/format.h>
#include <limits>

namespace orvo {

namespace {

constexpr double TwoTo63 = 9223372036854775808.0;
constexpr double TwoTo64 = 18446744073709551616.0;

std::int64_t saturatedSigned(double value) {
    if (std::isnan(value))
        return 0;
    if (value >= TwoTo63)
        return std::numeric_limits<std::int64_t>::max();
    if (value < -TwoTo63)
        return std::numeric_limits<std::int64_t>::min();
    return static_cast<std::int64_t>(value);
}

std::uint64_t saturatedUnsigned(double value) {
    if (std::isnan(value) || value <= 0)
        return 0;
    if (value >= TwoTo64)
        return std::numeric_limits<std::uint64_t>::max();
    return static_cast<std::uint64_t>(value);
}

/// A number as sign and magnitude where it is whole and fits, so that equality is exact across
/// types.
struct Whole {
    bool isWhole = false;
    bool negative = false;
    std::uint64_t magnitude = 0;

    friend bool operator==(const Whole&, const Whole&) = default;
};

Whole wholeOf(const NSNumber::Value& value) {
    if (const auto* flag = std::get_if<bool>(&value))
        return {true, false, *flag ? 1U : 0U};
    if (const auto* number = std::get_if<std::int64_t>(&value))
        return {true,
                *number < 0,
                *number < 0 ? ~static_cast<std::uint64_t>(*number) + 1
                            : static_cast<std::uint64_t>(*number)};
    if (const auto* number = std::get_if<std::uint64_t>(&value))
        return {true, false, *number};
    const double number = std::get<double>(value);
    if (std::trunc(number) != number || std::abs(number) >= TwoTo64)
        return {};
    return {true, number < 0, static_cast<std::uint64_t>(std::abs(number))};
}

} // namespace

std::shared_ptr<NSNumber> NSNumber::make(Value value) {
    auto number = std::make_shared<NSNumber>();
    number->_value = value;
    return number;
}

std::shared_ptr<NSNumber> NSNumber::numberWithBool(bool value) {
    return make(value);
}
std::shared_ptr<NSNumber> NSNumber::numberWithInteger(std::int64_t value) {
    return make(value);
}
std::shared_ptr<NSNumber> NSNumber::numberWithUnsignedInteger(std::uint64_t value) {
    return make(value);
}
std::shared_ptr<NSNumber> NSNumber::numberWithDouble(double value) {
    return make(value);
}

bool NSNumber::boolValue() const {
    return std::visit([](auto value) { return value != decltype(value){}; }, _value);
}

std::int64_t NSNumber::integerValue() const {
    if (const auto* number = std::get_if<double>(&_value))
        return saturatedSigned(*number);
    if (const auto* number = std::get_if<std::uint64_t>(&_value))
        return std::cmp_greater(*number, std::numeric_limits<std::int64_t>::max())
                   ? std::numeric_limits<std::int64_t>::max()
                   : static_cast<std::int64_t>(*number);
    if (const auto* flag = std::get_if<bool>(&_value))
        return *flag ? 1 : 0;
    return std::get<std::int64_t>(_value);
}

std::uint64_t NSNumber::unsignedIntegerValue() const {
    if (const auto* number = std::get_if<double>(&_value))
        return saturatedUnsigned(*number);
    if (const auto* number = std::get_if<std::int64_t>(&_value))
        return *number < 0 ? 0 : static_cast<std::uint64_t>(*number);
    if (const auto* flag = std::get_if<bool>(&_value))
        return *flag ? 1 : 0;
    return std::get<std::uint64_t>(_value);
}

double NSNumber::doubleValue() const {
    return std::visit([](auto value) { return static_cast<double>(value); }, _value);
}

bool NSNumber::isEqual(const NSObject* other) const {
    const auto* number = dynamic_cast<const NSNumber*>(other);
    if (!number)
        return false;
    const auto mine = wholeOf(_value);
    const auto theirs = wholeOf(number->_value);
    if (mine.isWhole || theirs.isWhole)
        return mine == theirs;
    const double a = std::get<double>(_value);
    const double b = std::get<double>(number->_value);
    return a == b || (std::isnan(a) && std::isnan(b)); // an object is always equal to itself
}

std::uint64_t NSNumber::hash() const {
    const auto whole = wholeOf(_value);
    if (!whole.isWhole) {
        const double fraction = std::get<double>(_value);
        return std::isnan(fraction) ? HashMultiplier : std::bit_cast<std::uint64_t>(fraction);
    }
    return (whole.negative ? ~whole.magnitude + 1 : whole.magnitude) * HashMultiplier;
}

std::string NSNumber::description() const {
    if (const auto* flag = std::get_if<bool>(&_value))
        return *flag ? "1" : "0";
    return std::visit([](auto value) { return fmt::format("{}", value); }, _value);
}

std::shared_ptr<NSObject> NSNumber::copy() const {
    return std::const_pointer_cast<NSObject>(shared_from_this());
}

} // namespace orvo
