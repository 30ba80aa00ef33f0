#include "platform/foundation/NSValue.h"

#include "platform/foundation/Hashing.h"

#include <fmt/format.h>

namespace orvo {

std::shared_ptr<NSValue> NSValue::valueWithRange(NSRange range) {
    auto value = std::make_shared<NSValue>();
    value->_range = range;
    return value;
}

bool NSValue::isEqual(const NSObject* other) const {
    const auto* value = dynamic_cast<const NSValue*>(other);
    return value && value->_range == _range;
}

std::uint64_t NSValue::hash() const {
    return (_range.location * 31 + _range.length) * HashMultiplier;
}

std::string NSValue::description() const {
    return fmt::format("{{{}, {}}}", _range.location, _range.length);
}

std::shared_ptr<NSObject> NSValue::copy() const {
    return std::const_pointer_cast<NSObject>(shared_from_this());
}

} // namespace orvo
