#pragma once

#include "platform/foundation/Log.h"

namespace orvo {

/// Where the widget tells of itself.
[[nodiscard]] inline std::shared_ptr<Log> widgetLog() {
    return Log::findOrCreate("TransitWidget");
}

} // namespace orvo
