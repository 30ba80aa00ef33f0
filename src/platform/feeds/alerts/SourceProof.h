#pragma once

#include "platform/feeds/alerts/AlertReader.h"
#include "platform/foundation/NSData.h"
#include "platform/foundation/NSError.h"

#include <functional>
#include <memory>
#include <optional>
#include <string_view>

namespace orvo {

/// What one source of alerts last gave.
struct AlertSource {
    std::shared_ptr<NSData> bytes;  ///< the last good body; nil when nothing was ever got
    double fetchedAt = 0;           ///< when it was last got whole or validated, s since 1970
    std::shared_ptr<NSError> error; ///< why the latest attempt failed; nil when it succeeded
};

/// What a source proves. It proves something when it was got at most ten minutes ago, is a whole
/// message, and is not stale by its own time; whether the latest attempt failed does not matter
/// then.
struct SourceProof {
    /// The message, which views the source's bytes; nothing when the source proves nothing.
    std::optional<AlertMessage> message;
    double headerTime = 0;          ///< of the message, in seconds since 1970
    std::shared_ptr<NSError> error; ///< why it proves nothing; nil when it proves something
    /// When what the source says was known, in seconds since 1970; nothing when it never was.
    std::optional<double> lastKnown;

    /// @param now seconds since 1970
    /// @param visit as for `AlertReader::read`; what it learnt counts only when there is a message
    [[nodiscard]] static SourceProof
    judge(const AlertSource& source,
          double now,
          const std::function<void(std::string_view entity)>& visit = {});
};

} // namespace orvo
