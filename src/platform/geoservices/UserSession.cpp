#include "platform/geoservices/UserSession.h"

#include "platform/foundation/Environment.h"

#include <fmt/format.h>

namespace orvo {

namespace {

std::string newSessionID() {
    const auto random = Environment::random().get();
    return fmt::format("{:08x}{:08x}{:08x}{:08x}", random(), random(), random(), random());
}

} // namespace

std::shared_ptr<UserSessionEntity> UserSessionEntity::entityWithSessionID(std::string sessionID) {
    auto entity = std::make_shared<UserSessionEntity>();
    entity->_sessionID = std::move(sessionID);
    return entity;
}

std::shared_ptr<UserSession> UserSession::sharedInstance() {
    return instance().get();
}

EnvironmentSlot<std::shared_ptr<UserSession>>& UserSession::instance() {
    static EnvironmentSlot<std::shared_ptr<UserSession>> slot(
        [] { return std::make_shared<UserSession>(); });
    return slot;
}

std::shared_ptr<UserSessionEntity>
UserSession::orvoSessionEntityWithCallback_shareSessionIDWithOrvo_resetSession(
    const Callback& callback, bool shareSessionIDWithOrvo, bool resetSession) {
    std::shared_ptr<UserSessionEntity> entity;
    {
        const std::lock_guard lock(_mutex);
        if (_sessionID.empty() || resetSession)
            _sessionID = newSessionID();
        if (shareSessionIDWithOrvo)
            _sharedSessionID = _sessionID;
        entity = UserSessionEntity::entityWithSessionID(_sessionID);
    }
    if (callback)
        callback(entity);
    return entity;
}

std::string UserSession::sharedSessionID() const {
    const std::lock_guard lock(_mutex);
    return _sharedSessionID;
}

} // namespace orvo
