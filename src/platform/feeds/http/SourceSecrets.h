#pragma once

#include "platform/feeds/http/SourceRequest.h"

#include <string>
#include <string_view>

namespace orvo {

/// The parts of a remote location that must not be seen.
struct SourceSecrets {
    std::string location;       ///< what is left without them
    std::string userInfo;       ///< `user:password` as it stood in the location, percent-encoded
    SourceRequest::Pairs query; ///< known key parameters, decoded
};

/// Takes the secrets out of a location; out of a plain path there are none.
[[nodiscard]] SourceSecrets secretsApart(std::string_view location);
/// Whether a parameter of this name is known to be a key.
[[nodiscard]] bool isKeyParameter(std::string_view name);

} // namespace orvo
