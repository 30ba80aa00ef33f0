#include "platform/foundation/NSString.h"

#include "platform/foundation/Hashing.h"

namespace orvo {

std::shared_ptr<NSString> NSString::string(std::string utf8) {
    auto result = std::make_shared<NSString>();
    result->_utf8 = std::move(utf8);
    return result;
}

std::shared_ptr<NSString> NSString::stringOrNil(const std::optional<std::string>& utf8) {
    return utf8 ? string(*utf8) : nullptr;
}

bool NSString::isEqual(const NSObject* other) const {
    const auto* string = dynamic_cast<const NSString*>(other);
    return string && string->_utf8 == _utf8;
}

std::uint64_t NSString::hash() const {
    return stableHash(_utf8);
}

std::string NSString::description() const {
    return _utf8;
}

std::shared_ptr<NSObject> NSString::copy() const {
    return std::const_pointer_cast<NSObject>(shared_from_this());
}

std::optional<std::string> stringValue(const NSObject* object) {
    const auto* string = dynamic_cast<const NSString*>(object);
    return string ? std::optional(string->utf8()) : std::nullopt;
}

std::uint64_t hashOf(const std::optional<std::string>& text) {
    return text ? stableHash(*text) : 0;
}

} // namespace orvo
