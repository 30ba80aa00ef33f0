#include "platform/feeds/http/BodyRecord.h"

#include "platform/foundation/NSDictionary.h"
#include "platform/foundation/NSNumber.h"
#include "platform/foundation/NSString.h"

#include <cmath>

namespace orvo {

namespace {

constexpr std::int64_t Version = 1;

std::shared_ptr<NSNumber> number(const NSDictionary& entries, const char* key) {
    return std::dynamic_pointer_cast<NSNumber>(entries.objectForKey(key));
}

} // namespace

std::shared_ptr<NSObject> BodyRecord::propertyList() const {
    // The format's whole numbers are signed.
    const auto bits = [](std::uint64_t value) {
        return NSNumber::numberWithInteger(static_cast<std::int64_t>(value));
    };
    return NSDictionary::dictionaryWithTextKeys({
        {"version", NSNumber::numberWithInteger(Version)},
        {"entityTag", NSString::string(entityTag)},
        {"lastModified", NSString::string(lastModified)},
        {"receivedAt", NSNumber::numberWithDouble(receivedAt)},
        {"validatedAt", NSNumber::numberWithDouble(validatedAt)},
        {"validations", NSNumber::numberWithInteger(validations)},
        {"length", bits(length)},
        {"checksum", bits(checksum)},
    });
}

std::optional<BodyRecord> BodyRecord::fromPropertyList(const NSObject* list) {
    const auto* entries = dynamic_cast<const NSDictionary*>(list);
    if (!entries)
        return std::nullopt;
    const auto version = number(*entries, "version");
    const auto received = number(*entries, "receivedAt");
    const auto validated = number(*entries, "validatedAt");
    const auto validations = number(*entries, "validations");
    const auto length = number(*entries, "length");
    const auto checksum = number(*entries, "checksum");
    if (!version || version->integerValue() != Version || !received || !validated || !validations ||
        !length || !checksum || !std::isfinite(received->doubleValue()) ||
        !(validated->doubleValue() >= received->doubleValue()))
        return std::nullopt;
    BodyRecord record;
    record.entityTag = stringValue(entries->objectForKey("entityTag").get()).value_or("");
    record.lastModified = stringValue(entries->objectForKey("lastModified").get()).value_or("");
    record.receivedAt = received->doubleValue();
    record.validatedAt = validated->doubleValue();
    record.validations =
        static_cast<int>(std::min<std::int64_t>(validations->integerValue(), INT32_MAX));
    record.length = static_cast<std::uint64_t>(length->integerValue());
    record.checksum = static_cast<std::uint64_t>(checksum->integerValue());
    return record;
}

} // namespace orvo
