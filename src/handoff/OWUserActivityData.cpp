#include "handoff/OWUserActivityData.h"

#include "handoff/ApplicationProxyOrvoExtras.h"
#include "handoff/SharedSession.h"
#include "platform/foundation/NSString.h"
#include "platform/foundation/NSUserActivity.h"
#include "platform/mapuikit/MapItem.h"
#include "platform/mapuikit/SystemController.h"

namespace orvo {

std::shared_ptr<OWUserActivityData>
OWUserActivityData::initWithActivityType_userInfo(std::optional<std::string> activityType,
                                                  const std::shared_ptr<NSDictionary>& userInfo) {
    auto data = std::make_shared<OWUserActivityData>();
    data->_activityType = std::move(activityType);
    shareSessionWithOrvo();
    data->_userInfo = MapItem::_sharedSessionUserInfoForPunchoutUserInfo(userInfo);
    return data;
}

void OWUserActivityData::openInContext_completionHandler(const std::shared_ptr<NSObject>&,
                                                         CompletionHandler completionHandler) {
    const auto activity = NSUserActivity::initWithActivityType(_activityType);
    if (!activity) {
        if (completionHandler)
            completionHandler(false,
                              NSError::errorWithDomain_code_userInfo(
                                  OWUserActivityErrorDomain,
                                  0,
                                  NSDictionary::dictionaryWithTextKeys(
                                      {{OWUserActivityErrorMissingActivityKey, strong(this)}})));
        return;
    }
    activity->setUserInfo(_userInfo);
    std::shared_ptr<NSError> error;
    const auto application = ApplicationProxyOrvoExtras::_orvo_containingApplicationProxy(&error);
    if (error) {
        if (completionHandler)
            completionHandler(false, error);
        return;
    }
    SystemController::sharedInstance()
        ->openUserActivity_withApplicationProxy_requireOptionKeyPromptUnlockDevice_completionHandler(
            activity, application, true, std::move(completionHandler));
}

bool OWUserActivityData::isEqual(const NSObject* other) const {
    if (this == other)
        return true;
    const auto* data = dynamic_cast<const OWUserActivityData*>(other);
    return data && isEqualToUserActivityData(*data);
}

bool OWUserActivityData::isEqualToUserActivityData(const OWUserActivityData& other) const {
    return _activityType == other._activityType && equal(_userInfo, other._userInfo);
}

std::uint64_t OWUserActivityData::hash() const {
    return hashOf(_activityType) ^ hashOf(_userInfo);
}

} // namespace orvo
