#pragma once

#include "platform/demo/DemoIncidents.h"
#include "platform/foundation/NSData.h"

#include <memory>
#include <vector>

namespace orvo {

/// The incidents as a GTFS-Realtime message whose header says `timestamp` (seconds since 1970). The
/// same content gives the same bytes.
[[nodiscard]] std::shared_ptr<NSData> demoAlertFeed(const std::vector<DemoIncident>& incidents,
                                                    double timestamp);

} // namespace orvo
