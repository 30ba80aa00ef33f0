#include "platform/lockbox/Lockbox.h"

#include "platform/lockbox/SystemBus.h"

int LBXGetDeviceLockState(const void*) {
    // The session that this process belongs to; for one that a user's service manager started, the
    // user's session on a display. logind finds it out itself.
    constexpr const char* SessionPath = "/org/freedesktop/login1/session/auto";
    orvo::lockbox::SystemBus bus;
    return bus.readFlag("org.freedesktop.login1",
                        SessionPath,
                        "org.freedesktop.login1.Session",
                        "LockedHint") == true
               ? LBXDeviceLockStateLocked
               : LBXDeviceLockStateUnlocked;
}
