#pragma once

#include "platform/foundation/NSUserDefaults.h"

namespace orvo::OrvoGroup {

/// The settings that the map application shares with its extensions: the saved state and the debug
/// switches. A new object each time.
[[nodiscard]] std::shared_ptr<NSUserDefaults> __orvo_groupUserDefaults();

} // namespace orvo::OrvoGroup
