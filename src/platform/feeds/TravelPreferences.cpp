#include "platform/feeds/TravelPreferences.h"

#include "platform/foundation/NSUserDefaults.h"

namespace orvo::TravelPreferences {

bool asksForStepFree() {
    return NSUserDefaults::initWithSuiteName(SuiteName)->boolForKey(StepFreeKey);
}

std::shared_ptr<NSError> unreadable() {
    return NSUserDefaults::initWithSuiteName(SuiteName)->unreadable();
}

std::shared_ptr<NSError> setAsksForStepFree(bool stepFree) {
    return NSUserDefaults::initWithSuiteName(SuiteName)->setBool_forKey(stepFree, StepFreeKey);
}

} // namespace orvo::TravelPreferences
