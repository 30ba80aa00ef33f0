#include "platform/foundation/NSUserActivity.h"

#include <algorithm>

namespace orvo {

namespace {

bool isNameCharacter(char c) {
    return (c >= 'a' && c <= 'z') || (c >= 'A' && c <= 'Z') || (c >= '0' && c <= '9') || c == '-' ||
           c == '_';
}

bool isReverseDomainName(const std::string& text) {
    constexpr std::size_t longest = 255;
    if (text.empty() || text.size() > longest || text.front() == '.' || text.back() == '.' ||
        text.find('.') == std::string::npos || text.find("..") != std::string::npos)
        return false;
    return std::ranges::all_of(text, [](char c) { return c == '.' || isNameCharacter(c); });
}

} // namespace

std::shared_ptr<NSUserActivity>
NSUserActivity::initWithActivityType(const std::optional<std::string>& activityType) {
    if (!activityType || !isReverseDomainName(*activityType))
        return nullptr;
    auto activity = std::make_shared<NSUserActivity>();
    activity->_activityType = *activityType;
    return activity;
}

} // namespace orvo
