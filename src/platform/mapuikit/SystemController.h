#pragma once

#include "platform/foundation/EnvironmentSlot.h"
#include "platform/foundation/NSError.h"
#include "platform/foundation/NSURL.h"
#include "platform/foundation/NSUserActivity.h"
#include "platform/launchservices/ApplicationProxy.h"

#include <functional>

namespace orvo {

/// Asks the desktop to open another application.
class SystemController : public virtual NSObject {
public:
    using CompletionHandler =
        std::function<void(bool success, const std::shared_ptr<NSError>& error)>;

    [[nodiscard]] static std::shared_ptr<SystemController> sharedInstance();
    /// What `sharedInstance()` answers.
    static EnvironmentSlot<std::shared_ptr<SystemController>>& instance();

    /// Hands `activity` to the application and lets it come to the front. With
    /// `requirePromptUnlockDevice` a locked screen is asked to unlock first, where the system lets
    /// a program ask. The handler, which may be empty, is called once, on the main queue, never
    /// inside the call: with true when the application took it, else with false and the reason. A
    /// nil application cannot be opened.
    virtual void
    openUserActivity_withApplicationProxy_requireOptionKeyPromptUnlockDevice_completionHandler(
        const std::shared_ptr<NSUserActivity>& activity,
        const std::shared_ptr<ApplicationProxy>& application,
        bool requirePromptUnlockDevice,
        CompletionHandler completionHandler) = 0;
};

} // namespace orvo
