#include "platform/geoservices/UserSession.h"

#include <gtest/gtest.h>

namespace orvo {
namespace {

TEST(UserSession, SharedInstanceIsOneObject) {
    EXPECT_EQ(UserSession::sharedInstance(), UserSession::sharedInstance());
}

TEST(UserSession, KeepsItsIdentifierUntilReset) {
    UserSession session;
    const auto ask = [&](bool reset) {
        return session
            .orvoSessionEntityWithCallback_shareSessionIDWithOrvo_resetSession({}, false, reset)
            ->sessionID();
    };
    const auto first = ask(false);
    EXPECT_EQ(first.size(), 32U);
    EXPECT_EQ(ask(false), first);
    EXPECT_NE(ask(true), first);
}

TEST(UserSession, SharesItsIdentifierOnlyWhenAsked) {
    UserSession session;
    session.orvoSessionEntityWithCallback_shareSessionIDWithOrvo_resetSession({}, false, false);
    EXPECT_EQ(session.sharedSessionID(), "");
    const auto entity =
        session.orvoSessionEntityWithCallback_shareSessionIDWithOrvo_resetSession({}, true, false);
    EXPECT_EQ(session.sharedSessionID(), entity->sessionID());
}

TEST(UserSession, CallbackGetsTheEntityBeforeTheCallReturns) {
    UserSession session;
    std::shared_ptr<UserSessionEntity> received;
    const auto entity = session.orvoSessionEntityWithCallback_shareSessionIDWithOrvo_resetSession(
        [&](const auto& answered) { received = answered; }, true, false);
    EXPECT_EQ(received, entity);
}

} // namespace
} // namespace orvo
