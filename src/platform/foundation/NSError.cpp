#include "platform/foundation/NSError.h"

#include "platform/foundation/Hashing.h"
#include "platform/foundation/NSString.h"

#include <fmt/format.h>

namespace orvo {

std::shared_ptr<NSError> NSError::errorWithDomain_code_userInfo(
    std::string domain, std::int64_t code, std::shared_ptr<NSDictionary> userInfo) {
    auto error = std::make_shared<NSError>();
    error->_domain = std::move(domain);
    error->_code = code;
    error->_userInfo = std::move(userInfo);
    return error;
}

std::shared_ptr<NSError>
NSError::errorWithMessage(std::string domain, std::int64_t code, std::string message) {
    return errorWithDomain_code_userInfo(
        std::move(domain),
        code,
        NSDictionary::dictionaryWithTextKeys(
            {{NSLocalizedDescriptionKey, NSString::string(std::move(message))}}));
}

std::string NSError::localizedDescription() const {
    if (_userInfo)
        if (auto message = stringValue(_userInfo->objectForKey(NSLocalizedDescriptionKey).get()))
            return *message;
    return fmt::format("The operation could not be completed. ({} error {}.)", _domain, _code);
}

bool NSError::isEqual(const NSObject* other) const {
    const auto* error = dynamic_cast<const NSError*>(other);
    return error && error->_domain == _domain && error->_code == _code &&
           equal(_userInfo, error->_userInfo);
}

std::uint64_t NSError::hash() const {
    return stableHash(_domain) ^ static_cast<std::uint64_t>(_code) * HashMultiplier;
}

std::string NSError::description() const {
    return fmt::format("Error Domain={} Code={} \"{}\"", _domain, _code, localizedDescription());
}

std::shared_ptr<NSObject> NSError::copy() const {
    return std::const_pointer_cast<NSObject>(shared_from_this());
}

} // namespace orvo
