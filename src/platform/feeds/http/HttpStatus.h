#pragma once

#include <string>

namespace orvo {

/// `503 Service Unavailable`: the number and what it means; the number alone for an unknown one.
/// The server's own words are not repeated: they could hold anything.
[[nodiscard]] std::string describeHttpStatus(int status);

} // namespace orvo
