#pragma once

#include "platform/foundation/EnvironmentSlot.h"
#include "platform/foundation/NSObject.h"

#include <functional>
#include <memory>

namespace orvo {

/// What happens on the machine that a host must know. Told on the main thread, never inside
/// `start`.
class SystemEvents : public virtual NSObject {
public:
    struct Handlers {
        std::function<void(bool locked)> lockDidChange; ///< first told after `start` where locked
        std::function<void()> machineDidWake;
        std::function<void()> networkDidChange;
        std::function<void()> memoryIsScarce;
    };

    /// The desktop's: logind and NetworkManager on the system bus, the kernel's memory pressure.
    /// Silent where nobody tells.
    [[nodiscard]] static std::shared_ptr<SystemEvents> systemEvents();
    /// What makes them. Default: the desktop's.
    static EnvironmentSlot<std::function<std::shared_ptr<SystemEvents>()>>& factory();

    /// Connects to the services without waiting for them. Handlers may be empty.
    virtual void start(Handlers handlers) = 0;
    virtual void stop() = 0;
};

} // namespace orvo
