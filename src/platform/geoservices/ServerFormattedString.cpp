#include "platform/geoservices/ServerFormattedString.h"

#include "platform/foundation/Hashing.h"
#include "platform/foundation/NSString.h"

namespace orvo {

namespace {

bool sameList(const std::shared_ptr<NSArray>& a, const std::shared_ptr<NSArray>& b) {
    const auto isEmpty = [](const auto& list) {
        return !list || list->count() == 0;
    };
    return isEmpty(a) || isEmpty(b) ? isEmpty(a) && isEmpty(b) : a->isEqual(b.get());
}

std::uint64_t hashOfList(const std::shared_ptr<NSArray>& list) {
    return list && list->count() > 0 ? list->hash() : 0;
}

} // namespace

std::shared_ptr<ServerFormattedString> ServerFormattedString::initWithFields(Fields fields) {
    auto value = std::make_shared<ServerFormattedString>();
    value->_fields = std::move(fields);
    return value;
}

bool ServerFormattedString::isEqual(const NSObject* other) const {
    const auto* value = dynamic_cast<const ServerFormattedString*>(other);
    if (!value)
        return false;
    const auto& a = _fields;
    const auto& b = value->_fields;
    return sameList(a.formatStrings, b.formatStrings) && sameList(a.separators, b.separators) &&
           sameList(a.formatTokens, b.formatTokens) && a.alternativeString == b.alternativeString;
}

std::uint64_t ServerFormattedString::hash() const {
    return hashOfList(_fields.formatStrings) ^ (hashOfList(_fields.separators)) * 3 ^
           (hashOfList(_fields.formatTokens)) * 5 ^ (hashOf(_fields.alternativeString)) * 7;
}

} // namespace orvo
