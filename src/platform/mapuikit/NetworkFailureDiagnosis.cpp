#include "platform/mapuikit/NetworkFailureDiagnosis.h"

#include "platform/mapuikit/DesktopNetworkState.h"

namespace orvo {

std::uint64_t CurrentNetworkFailureDiagnosis() {
    return NetworkFailureDiagnosisSource().get()();
}

EnvironmentSlot<std::function<std::uint64_t()>>& NetworkFailureDiagnosisSource() {
    static EnvironmentSlot<std::function<std::uint64_t()>> slot([] {
        return std::function<std::uint64_t()>(
            [] { return static_cast<std::uint64_t>(diagnosisOf(desktopNetworkState())); });
    });
    return slot;
}

} // namespace orvo
