#pragma once

#include "platform/foundation/NSError.h"

#include <cstdint>
#include <memory>
#include <string>

namespace orvo {

inline constexpr const char* SourceErrorDomain = "OrvoSourceErrorDomain";
/// Codes of `SourceErrorDomain`. A cancelled load ends with `NSUserCancelledError` of
/// `NSCocoaErrorDomain`. Every message names the source without its secrets.
enum class SourceErrorCode : std::int64_t {
    InvalidRequest = 1, ///< location, header or user that cannot be asked for
    Unreadable = 2,     ///< a local file that is missing, no file, or may not be read
    Unreachable = 3,    ///< no host, no connection, a broken one
    Untrusted = 4,      ///< TLS: certificate or handshake
    TimedOut = 5,
    Status = 6,     ///< an HTTP status other than 200 and 304; the number is in the message
    RetryLater = 7, ///< the server asked for a pause that is not over; it was not asked
    Redirect = 8,   ///< too many, from https to http, or to nowhere
    TooLarge = 9,   ///< beyond `LoadOptions::maximumBytes`
    Incomplete = 10 ///< shorter than announced, of an untold length, or not to be inflated
};

[[nodiscard]] inline std::shared_ptr<NSError> sourceError(SourceErrorCode code,
                                                          std::string message) {
    return NSError::errorWithMessage(
        SourceErrorDomain, static_cast<std::int64_t>(code), std::move(message));
}

} // namespace orvo
