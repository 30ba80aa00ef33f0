#pragma once

#include "platform/foundation/NSError.h"

#include <memory>
#include <string>

namespace orvo {

inline constexpr const char* HandOffErrorDomain = "OrvoHandOffErrorDomain";
enum class HandOffErrorCode : std::int64_t {
    NotOurs = 1,    ///< for another application, or for none
    Unknown = 2,    ///< well written, but there is no such thing
    Unreadable = 3, ///< bytes that are not what they should be
    TooLarge = 4,
};

[[nodiscard]] inline std::shared_ptr<NSError> handOffError(HandOffErrorCode code,
                                                           std::string message) {
    return NSError::errorWithMessage(
        HandOffErrorDomain, static_cast<std::int64_t>(code), std::move(message));
}

/// `error` may be null.
inline void
setHandOffError(std::shared_ptr<NSError>* error, HandOffErrorCode code, std::string message) {
    if (error)
        *error = handOffError(code, std::move(message));
}

} // namespace orvo
