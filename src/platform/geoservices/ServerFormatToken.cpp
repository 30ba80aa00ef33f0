#include "platform/geoservices/ServerFormatToken.h"

#include "platform/foundation/Hashing.h"
#include "platform/foundation/NSString.h"

#include <bit>

namespace orvo {

std::shared_ptr<ServerFormatToken> ServerFormatToken::initWithFields(Fields fields) {
    auto value = std::make_shared<ServerFormatToken>();
    value->_fields = std::move(fields);
    return value;
}

bool ServerFormatToken::isEqual(const NSObject* other) const {
    const auto* value = dynamic_cast<const ServerFormatToken*>(other);
    if (!value)
        return false;
    const auto& a = _fields;
    const auto& b = value->_fields;
    return a.type == b.type && a.token == b.token && a.text == b.text && a.value == b.value;
}

std::uint64_t ServerFormatToken::hash() const {
    return static_cast<std::uint64_t>(_fields.type) * HashMultiplier ^ (hashOf(_fields.token)) * 3 ^
           (hashOf(_fields.text)) * 5 ^
           (std::bit_cast<std::uint64_t>(_fields.value == 0 ? 0.0 : _fields.value)) * 7;
}

} // namespace orvo
