#pragma once

#include "platform/foundation/EnvironmentSlot.h"
#include "platform/mapuikit/NetworkFailureDiagnosis.h"

#include <filesystem>
#include <optional>
#include <vector>

namespace orvo {

/// One radio of the machine, as the kernel tells it.
struct RadioState {
    bool isMobile = false;  ///< mobile data ("wwan")
    bool isBlocked = false; ///< by its switch or by software
};

/// What the desktop's services know of the network.
struct DesktopNetworkState {
    /// Whether the machine reaches the internet; nothing where no service tells.
    std::optional<bool> isOnline;
    std::vector<RadioState> radios;
    /// Whether the network service has mobile data switched off, and whether it has a mobile device
    /// at all.
    bool isMobileDataDisabled = false;
    bool hasMobileDevice = false;
    bool hasWiredOrWirelessDevice = false; ///< any other way out
};

/// Asks NetworkManager on the system bus, where it runs, and the radios below `RadiosFolder()`.
/// Answers within a second, else with what is known. Any thread.
[[nodiscard]] DesktopNetworkState desktopNetworkState();
/// Where the kernel tells of its radios. Default: `/sys/class/rfkill`.
EnvironmentSlot<std::filesystem::path>& RadiosFolder();
/// The radios of a folder laid out as that one; one that cannot be read is left out.
[[nodiscard]] std::vector<RadioState> radiosIn(const std::filesystem::path& folder);

/// What a state means: no connection at all is airplane mode where every radio is blocked, mobile
/// data switched off where that would be the only way out, else no internet. A machine that is
/// online has no specific cause, and of one of which nothing is known the cause is unknown.
[[nodiscard]] NetworkFailureDiagnosis diagnosisOf(const DesktopNetworkState& state);

} // namespace orvo
