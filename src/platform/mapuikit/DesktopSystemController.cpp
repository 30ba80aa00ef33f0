#include "platform/mapuikit/DesktopSystemController.h"

#include "platform/foundation/DispatchQueue.h"
#include "platform/foundation/NSString.h"
#include "platform/foundation/PropertyList.h"
#include "platform/launchservices/ApplicationLauncher.h"

namespace orvo {

namespace {

constexpr const char* TypeKey = "activityType";
constexpr const char* UserInfoKey = "userInfo";

std::shared_ptr<NSError> controllerError(SystemControllerErrorCode code, const char* message) {
    return NSError::errorWithMessage(
        SystemControllerErrorDomain, static_cast<std::int64_t>(code), message);
}

void answerLater(SystemController::CompletionHandler handler, std::shared_ptr<NSError> error) {
    if (handler)
        DispatchQueue::mainQueue()->async(
            [handler = std::move(handler), error = std::move(error)] { handler(!error, error); });
}

} // namespace

void DesktopSystemController::
    openUserActivity_withApplicationProxy_requireOptionKeyPromptUnlockDevice_completionHandler(
        const std::shared_ptr<NSUserActivity>& activity,
        const std::shared_ptr<ApplicationProxy>& application,
        bool,
        CompletionHandler completionHandler) {
    if (!application) {
        answerLater(std::move(completionHandler),
                    controllerError(SystemControllerErrorCode::NoApplication,
                                    "There is no application to open."));
        return;
    }
    const auto payload = encodedUserActivity(*activity);
    if (!payload) {
        answerLater(std::move(completionHandler),
                    controllerError(SystemControllerErrorCode::CannotEncode,
                                    "The activity's content cannot be handed over."));
        return;
    }
    ApplicationLauncher::sharedLauncher()->activateAction(
        application->bundleIdentifier(),
        Action,
        payload,
        [handler = std::move(completionHandler)](const std::shared_ptr<NSError>& error) {
            if (handler)
                handler(!error, error);
        });
}

std::shared_ptr<NSData> encodedUserActivity(const NSUserActivity& activity) {
    std::vector<std::pair<std::string, std::shared_ptr<NSObject>>> entries{
        {TypeKey, NSString::string(activity.activityType())}};
    if (activity.userInfo())
        entries.emplace_back(UserInfoKey, activity.userInfo());
    return PropertyList::write(*NSDictionary::dictionaryWithTextKeys(std::move(entries)));
}

std::shared_ptr<NSUserActivity> decodedUserActivity(const NSData& bytes,
                                                    std::shared_ptr<NSError>* error) {
    const auto root =
        std::dynamic_pointer_cast<NSDictionary>(PropertyList::read(bytes.bytes(), error));
    const auto activity =
        root ? NSUserActivity::initWithActivityType(stringValue(root->objectForKey(TypeKey).get()))
             : nullptr;
    if (!activity) {
        if (error && !*error)
            *error = controllerError(SystemControllerErrorCode::CannotEncode,
                                     "The bytes received are no activity.");
        return nullptr;
    }
    activity->setUserInfo(std::dynamic_pointer_cast<NSDictionary>(root->objectForKey(UserInfoKey)));
    return activity;
}

} // namespace orvo
