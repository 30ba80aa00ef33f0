#include "platform/extension/SystemEvents.h"

#include "platform/extension/DesktopSystemEvents.h"

namespace orvo {

std::shared_ptr<SystemEvents> SystemEvents::systemEvents() {
    return factory().get()();
}

EnvironmentSlot<std::function<std::shared_ptr<SystemEvents>()>>& SystemEvents::factory() {
    using Factory = std::function<std::shared_ptr<SystemEvents>()>;
    static EnvironmentSlot<Factory> slot([] {
        return Factory([]() -> std::shared_ptr<SystemEvents> {
            return std::make_shared<DesktopSystemEvents>();
        });
    });
    return slot;
}

} // namespace orvo
