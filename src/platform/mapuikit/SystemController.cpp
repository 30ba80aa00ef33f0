#include "platform/mapuikit/SystemController.h"

#include "platform/mapuikit/DesktopSystemController.h"

namespace orvo {

std::shared_ptr<SystemController> SystemController::sharedInstance() {
    return instance().get();
}

EnvironmentSlot<std::shared_ptr<SystemController>>& SystemController::instance() {
    static EnvironmentSlot<std::shared_ptr<SystemController>> slot([] {
        return std::shared_ptr<SystemController>(std::make_shared<DesktopSystemController>());
    });
    return slot;
}

} // namespace orvo
