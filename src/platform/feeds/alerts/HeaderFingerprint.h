#pragma once

#include <cstdint>
#include <string_view>

namespace orvo {

/// A hash of how a published text begins once it is normalised (`IncidentContent::normalised`):
/// texts that are the same then have the same one; others may. It is for passing over most of a
/// feed quickly. `text` need not be valid UTF-8.
[[nodiscard]] std::uint64_t headerFingerprint(std::string_view text);

} // namespace orvo
