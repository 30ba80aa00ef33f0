#pragma once

#include "platform/foundation/NSDictionary.h"
#include "platform/foundation/NSURL.h"

#include <string>

namespace orvo {

/// A place or line of the map. Here only what hands the user's session on to the map application.
/// Any thread.
class MapItem : public virtual NSObject {
public:
    /// The user-info key of the session's identifier, an `NSString`.
    static constexpr const char* SharedSessionKey = "com.zentu.Orvo.sharedSession";
    /// The same in a URL.
    static constexpr const char* SharedSessionParameter = "session";

    /// The user info (nil counts as empty) with the shared session's identifier under
    /// `SharedSessionKey`; unchanged while no session is shared. Asked again, it answers an equal
    /// one.
    [[nodiscard]] static std::shared_ptr<NSDictionary>
    _sharedSessionUserInfoForPunchoutUserInfo(const std::shared_ptr<NSDictionary>& userInfo);

    /// The URL with the identifier as its query parameter, in place of one that is there. Nil for a
    /// text that is no URL.
    [[nodiscard]] static std::shared_ptr<NSURL>
    _sharedSessionURLForPunchoutURL(const std::string& url);
};

} // namespace orvo
