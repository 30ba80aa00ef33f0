#pragma once

#include "platform/foundation/EnvironmentSlot.h"
#include "platform/foundation/NSObject.h"

#include <functional>
#include <string>

namespace orvo {

/// The user's session, as it is shared with the map application. Immutable.
class UserSessionEntity final : public virtual NSObject {
public:
    [[nodiscard]] static std::shared_ptr<UserSessionEntity>
    entityWithSessionID(std::string sessionID);

    [[nodiscard]] const std::string& sessionID() const noexcept { return _sessionID; }

private:
    std::string _sessionID;
};

/// Keeps one session identifier for each run of the program, made when first asked for. It says
/// nothing about the person and is never kept between runs. Any thread.
class UserSession : public virtual NSObject {
public:
    using Callback = std::function<void(const std::shared_ptr<UserSessionEntity>&)>;

    [[nodiscard]] static std::shared_ptr<UserSession> sharedInstance();
    /// What `sharedInstance()` answers. Default: one object for the process.
    static EnvironmentSlot<std::shared_ptr<UserSession>>& instance();

    /// The session now. With `resetSession` a new identifier is made first. With
    /// `shareSessionIDWithOrvo` the identifier is from then on the one that hand-offs carry. The
    /// callback may be empty; it is called before this returns.
    virtual std::shared_ptr<UserSessionEntity>
    orvoSessionEntityWithCallback_shareSessionIDWithOrvo_resetSession(const Callback& callback,
                                                                      bool shareSessionIDWithOrvo,
                                                                      bool resetSession);

    /// The identifier that hand-offs carry; empty before any was shared.
    [[nodiscard]] virtual std::string sharedSessionID() const;

private:
    mutable std::mutex _mutex;
    std::string _sessionID;
    std::string _sharedSessionID;
};

} // namespace orvo
