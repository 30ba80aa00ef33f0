#pragma once

/// The device's lock state, for whoever opens this library at run time.
extern "C" {

/// What `LBXGetDeviceLockState` answers.
enum LBXDeviceLockState {
    LBXDeviceLockStateUnlocked = 0, ///< or not known: nobody tells
    LBXDeviceLockStateLocked = 1,
};

/// Whether the person's session is locked, as logind on the system bus tells it
/// (`DBUS_SYSTEM_BUS_ADDRESS` is honoured). The answer takes a fifth of a second at most; without a
/// bus, without logind, without a session and without an answer in time it is
/// `LBXDeviceLockStateUnlocked`. `options` is not used and may be null. Any thread.
__attribute__((visibility("default"))) int LBXGetDeviceLockState(const void* options);
}
