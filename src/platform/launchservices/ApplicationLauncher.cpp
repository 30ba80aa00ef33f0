#include "platform/launchservices/ApplicationLauncher.h"

#include "platform/launchservices/DesktopApplicationLauncher.h"

namespace orvo {

std::shared_ptr<ApplicationLauncher> ApplicationLauncher::sharedLauncher() {
    return launcher().get();
}

EnvironmentSlot<std::shared_ptr<ApplicationLauncher>>& ApplicationLauncher::launcher() {
    static EnvironmentSlot<std::shared_ptr<ApplicationLauncher>> slot([] {
        return std::shared_ptr<ApplicationLauncher>(std::make_shared<DesktopApplicationLauncher>());
    });
    return slot;
}

} // namespace orvo
