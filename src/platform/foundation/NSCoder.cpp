#include "platform/foundation/NSCoder.h"

#include "platform/foundation/Exceptions.h"
#include "platform/foundation/NSString.h"

namespace orvo {

namespace {

[[noreturn]] void throwOnlyReads(const NSCoder& coder, const std::string& key) {
    throw NSInvalidArgumentException("the " + coder.className() + " reads, it cannot encode " +
                                     key);
}
[[noreturn]] void throwOnlyWrites(const NSCoder& coder, const std::string& key) {
    throw NSInvalidArgumentException("the " + coder.className() + " writes, it cannot decode " +
                                     key);
}

} // namespace

void NSCoder::encodeObject_forKey(const std::shared_ptr<NSObject>&, const std::string& key) {
    throwOnlyReads(*this, key);
}
void NSCoder::encodeBool_forKey(bool, const std::string& key) {
    throwOnlyReads(*this, key);
}
void NSCoder::encodeInteger_forKey(std::int64_t, const std::string& key) {
    throwOnlyReads(*this, key);
}
void NSCoder::encodeDouble_forKey(double, const std::string& key) {
    throwOnlyReads(*this, key);
}

void NSCoder::encodeString_forKey(const std::optional<std::string>& text, const std::string& key) {
    encodeObject_forKey(NSString::stringOrNil(text), key);
}

bool NSCoder::containsValueForKey(const std::string& key) const {
    throwOnlyWrites(*this, key);
}
std::shared_ptr<NSObject> NSCoder::decodeObjectOfClasses_forKey(const std::vector<std::string>&,
                                                                const std::string& key) {
    throwOnlyWrites(*this, key);
}
std::shared_ptr<NSObject> NSCoder::decodeObjectForKey(const std::string& key) {
    throwOnlyWrites(*this, key);
}
bool NSCoder::decodeBoolForKey(const std::string& key) {
    throwOnlyWrites(*this, key);
}
std::int64_t NSCoder::decodeIntegerForKey(const std::string& key) {
    throwOnlyWrites(*this, key);
}
double NSCoder::decodeDoubleForKey(const std::string& key) {
    throwOnlyWrites(*this, key);
}

std::shared_ptr<NSObject> NSCoder::decodeObjectOfClass_forKey(const std::string& className,
                                                              const std::string& key) {
    return decodeObjectOfClasses_forKey({className}, key);
}

std::optional<std::string> NSCoder::decodeStringForKey(const std::string& key) {
    return stringValue(decodeObjectOfClass_forKey("NSString", key).get());
}

} // namespace orvo
