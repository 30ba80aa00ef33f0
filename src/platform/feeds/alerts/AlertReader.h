#pragma once

#include "platform/foundation/NSError.h"

#include <cstdint>
#include <functional>
#include <memory>
#include <optional>
#include <span>
#include <string_view>
#include <vector>

namespace orvo {

inline constexpr const char* AlertErrorDomain = "AlertErrorDomain";

/// Codes of `AlertErrorDomain`.
enum class AlertErrorCode : std::int64_t {
    Empty = 1,  ///< no bytes at all
    NotAlerts,  ///< a web page, JSON, or anything else that is no GTFS-Realtime message
    Truncated,  ///< ends in the middle of something
    NoHeader,   ///< walked to its end, but without a header
    NotFetched, ///< nothing was ever got from the source
    TooOld,     ///< the last good answer is more than ten minutes old
    Stale,      ///< the message says that it was made more than a day ago
    NoSource,   ///< the feed has no source of alerts
    Difference, ///< tells only what changed since an earlier message
};

/// A GTFS-Realtime message whose outer structure was walked from end to end. It views the bytes
/// that it was read from, which must outlive it.
struct AlertMessage {
    std::uint64_t timestamp = 0;            ///< of the header, as published; 0 when it has none
    std::vector<std::string_view> entities; ///< each entity's bytes, in order
};

/// Reads the outer structure of GTFS-Realtime messages by hand: in bounded space and without
/// recursion, whatever the bytes. `EntityReader` reads what the entities hold.
namespace AlertReader {

/// Walks the message's outer structure. A message with nothing but a header is valid. Unknown
/// fields are stepped over. One that tells only what changed since another is none: what it leaves
/// out may be as disturbed as before.
/// @return nothing when the bytes are no whole message: then this was a failed fetch. The reason is
/// in `error` (which may be nil), in words for a person: `it ends in the middle of an entry`
///
/// `visit` is called with each entity as it is met, while its bytes are at hand, and may be empty;
/// what it learnt counts only when a message is answered.
[[nodiscard]] std::optional<AlertMessage>
read(std::span<const std::uint8_t> data,
     std::shared_ptr<NSError>* error,
     const std::function<void(std::string_view entity)>& visit = {});

} // namespace AlertReader

} // namespace orvo
