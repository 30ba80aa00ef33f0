#pragma once

#include "platform/foundation/NSDictionary.h"
#include "platform/foundation/NSObject.h"

#include <string>

namespace orvo {

inline constexpr const char* NSCocoaErrorDomain = "NSCocoaErrorDomain";
inline constexpr const char* NSPOSIXErrorDomain = "NSPOSIXErrorDomain";
/// Code of `NSCocoaErrorDomain`.
inline constexpr std::int64_t NSUserCancelledError = 3072;
/// User-info keys; the values are text, that of the last an `NSError`.
inline constexpr const char* NSLocalizedDescriptionKey = "NSLocalizedDescription";
inline constexpr const char* NSDebugDescriptionErrorKey = "NSDebugDescription";
inline constexpr const char* NSUnderlyingErrorKey = "NSUnderlyingError";

/// A failure as a value: who reports it (domain), what it is (code), and what a person should read.
/// Immutable.
class NSError : public virtual NSCopying {
public:
    /// `userInfo` may be nil.
    [[nodiscard]] static std::shared_ptr<NSError> errorWithDomain_code_userInfo(
        std::string domain, std::int64_t code, std::shared_ptr<NSDictionary> userInfo);
    /// With a message for the person under `NSLocalizedDescriptionKey`.
    [[nodiscard]] static std::shared_ptr<NSError>
    errorWithMessage(std::string domain, std::int64_t code, std::string message);

    [[nodiscard]] const std::string& domain() const noexcept { return _domain; }
    [[nodiscard]] std::int64_t code() const noexcept { return _code; }
    /// Nil when there is none.
    [[nodiscard]] const std::shared_ptr<NSDictionary>& userInfo() const noexcept {
        return _userInfo;
    }
    /// The message of the user info, else domain and code in words.
    [[nodiscard]] std::string localizedDescription() const;

    /// Domain, code and user info.
    [[nodiscard]] bool isEqual(const NSObject* other) const override;
    [[nodiscard]] std::uint64_t hash() const override;
    /// `Error Domain=D Code=3 "message"`.
    [[nodiscard]] std::string description() const override;
    [[nodiscard]] std::shared_ptr<NSObject> copy() const override;

private:
    std::string _domain;
    std::int64_t _code = 0;
    std::shared_ptr<NSDictionary> _userInfo;
};

} // namespace orvo
