#pragma once

#include "platform/foundation/EnvironmentSlot.h"

#include <filesystem>
#include <functional>

namespace orvo {

/// Answers a lock state.
using DeviceLockStateFunction = std::function<int()>;

/// The device's lock state as the key store tells it. Default: the key store's library, opened at
/// run time, once for the process, below the system root; its absence is said in the system log,
/// and the state is then 0. Any thread.
EnvironmentSlot<DeviceLockStateFunction>& DeviceLockStateSource();

/// Opens the key store's library below the system root and answers what it asks: what the default
/// source does, once. Answers an empty function when there is no such library, or when it lacks the
/// function.
[[nodiscard]] DeviceLockStateFunction SoftLinkDeviceLockState();

/// Asks `DeviceLockStateSource()` once.
[[nodiscard]] int DeviceLockState();

/// The folder under which the key store's paths begin. Default: `ORVO_SYSTEM_ROOT`; else
/// `lib/orvo-transit-widget` beside the folder of the program, where it is installed; else the
/// build tree.
EnvironmentSlot<std::filesystem::path>& DeviceLockStateSystemRoot();

} // namespace orvo
