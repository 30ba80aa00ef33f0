#pragma once

#include "platform/foundation/NSDictionary.h"
#include "platform/foundation/NSObject.h"

#include <optional>
#include <string>

namespace orvo {

/// What the person is doing, in a form that another program can go on with.
class NSUserActivity final : public virtual NSObject {
public:
    /// Nil for a type that is nil, empty, longer than 255 bytes, or no reverse domain name
    /// (letters, digits, `-`, `_`, parts joined by dots).
    [[nodiscard]] static std::shared_ptr<NSUserActivity>
    initWithActivityType(const std::optional<std::string>& activityType);

    [[nodiscard]] const std::string& activityType() const noexcept { return _activityType; }
    /// Nil at first.
    [[nodiscard]] const std::shared_ptr<NSDictionary>& userInfo() const noexcept {
        return _userInfo;
    }
    void setUserInfo(std::shared_ptr<NSDictionary> userInfo) { _userInfo = std::move(userInfo); }

private:
    std::string _activityType;
    std::shared_ptr<NSDictionary> _userInfo;
};

} // namespace orvo
