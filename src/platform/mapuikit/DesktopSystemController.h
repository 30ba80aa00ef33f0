#pragma once

#include "platform/foundation/NSData.h"
#include "platform/mapuikit/SystemController.h"

namespace orvo {

inline constexpr const char* SystemControllerErrorDomain = "OrvoSystemControllerErrorDomain";
enum class SystemControllerErrorCode : std::int64_t {
    NoApplication = 1, ///< a nil application
    CannotEncode = 2,  ///< the user info holds what cannot be handed over
};

/// Hands activities over by the desktop's application interface, as the action
/// `ContinueUserActivity`. On a locked screen the application comes to the front when the person
/// has unlocked it: no desktop lets a program ask for more.
class DesktopSystemController final : public SystemController {
public:
    static constexpr const char* Action = "ContinueUserActivity";

    void openUserActivity_withApplicationProxy_requireOptionKeyPromptUnlockDevice_completionHandler(
        const std::shared_ptr<NSUserActivity>& activity,
        const std::shared_ptr<ApplicationProxy>& application,
        bool requirePromptUnlockDevice,
        CompletionHandler completionHandler) override;
};

/// An activity as it travels: a binary property list with its type and user info. Nil when the user
/// info cannot be held in one.
[[nodiscard]] std::shared_ptr<NSData> encodedUserActivity(const NSUserActivity& activity);
/// The reverse; nil with an error for anything else.
[[nodiscard]] std::shared_ptr<NSUserActivity> decodedUserActivity(const NSData& bytes,
                                                                  std::shared_ptr<NSError>* error);

} // namespace orvo
