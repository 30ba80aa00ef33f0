#pragma once

#include "platform/feeds/http/SourceLoader.h"

#include <memory>

namespace orvo {

/// The process's loader over the cache folder of the profile in use, so that all who ask for one
/// source share the request, and a server's wish for a pause. Any thread.
[[nodiscard]] std::shared_ptr<SourceLoader> sharedSourceLoader();

} // namespace orvo
