#pragma once

#include "platform/foundation/EnvironmentSlot.h"

#include <cstdint>
#include <functional>

namespace orvo {

/// Why the network does not answer, as `CurrentNetworkFailureDiagnosis` says it.
enum class NetworkFailureDiagnosis : std::uint64_t {
    None = 0,             ///< no specific cause: the machine is online
    AirplaneMode = 1,     ///< every radio is switched off
    CellDataDisabled = 2, ///< the only way out would be mobile data, and that is switched off
    NoInternet = 3,       ///< no connection
    Unknown = 4,          ///< nothing tells the state of the network
};

/// The state of the network now, from the services of the desktop. Any thread.
[[nodiscard]] std::uint64_t CurrentNetworkFailureDiagnosis();
/// What it asks.
EnvironmentSlot<std::function<std::uint64_t()>>& NetworkFailureDiagnosisSource();

} // namespace orvo
