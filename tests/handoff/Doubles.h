#pragma once

#include "platform/foundation/NSExtensionContext.h"
#include "platform/geoservices/UserSession.h"
#include "platform/launchservices/ApplicationProxy.h"
#include "platform/mapuikit/SystemController.h"
#include "platform/uikit/UIViewController.h"

#include <string>
#include <vector>

namespace orvo::testing {

/// What was asked, in order.
using Journal = std::shared_ptr<std::vector<std::string>>;

class RecordingUserSession final : public UserSession {
public:
    explicit RecordingUserSession(Journal journal)
        : _journal(std::move(journal)) {}

    std::shared_ptr<UserSessionEntity>
    orvoSessionEntityWithCallback_shareSessionIDWithOrvo_resetSession(const Callback& callback,
                                                                      bool share,
                                                                      bool reset) override {
        _journal->push_back(std::string("session callback=") + (callback ? "1" : "0") +
                            " share=" + (share ? "1" : "0") + " reset=" + (reset ? "1" : "0"));
        return UserSessionEntity::entityWithSessionID("S1");
    }
    std::string sharedSessionID() const override {
        _journal->push_back("conversion");
        return identifier;
    }

    std::string identifier = "S1"; ///< what conversions add; empty for nothing

private:
    Journal _journal;
};

/// Keeps what it was asked to open, and calls no handler by itself.
class RecordingSystemController final : public SystemController {
public:
    explicit RecordingSystemController(Journal journal)
        : _journal(std::move(journal)) {}

    void openUserActivity_withApplicationProxy_requireOptionKeyPromptUnlockDevice_completionHandler(
        const std::shared_ptr<NSUserActivity>& givenActivity,
        const std::shared_ptr<ApplicationProxy>& givenApplication,
        bool requirePromptUnlockDevice,
        CompletionHandler completionHandler) override {
        _journal->push_back("open activity");
        activity = givenActivity;
        application = givenApplication;
        promptsUnlock = requirePromptUnlockDevice;
        handler = std::move(completionHandler);
        ++calls;
    }

    std::shared_ptr<NSUserActivity> activity;
    std::shared_ptr<ApplicationProxy> application;
    bool promptsUnlock = false;
    CompletionHandler handler;
    int calls = 0;

private:
    Journal _journal;
};

class RecordingExtensionContext final : public NSExtensionContext {
public:
    explicit RecordingExtensionContext(Journal journal)
        : _journal(std::move(journal)) {}

    void openURL_completionHandler(const std::shared_ptr<NSURL>& url,
                                   std::function<void(bool)> completionHandler) override {
        _journal->push_back("open " + descriptionOf(url));
        handler = std::move(completionHandler);
    }
    NCWidgetDisplayMode widgetActiveDisplayMode() const override {
        return NCWidgetDisplayMode::Compact;
    }
    NCWidgetDisplayMode widgetLargestAvailableDisplayMode() const override {
        return NCWidgetDisplayMode::Compact;
    }
    void setWidgetLargestAvailableDisplayMode(NCWidgetDisplayMode) override {}
    CGSize widgetMaximumSizeForDisplayMode(NCWidgetDisplayMode) const override { return {}; }

    std::function<void(bool)> handler;

private:
    Journal _journal;
};

/// All of the platform that opening touches, for the scope of a test.
struct OpeningDoubles {
    Journal journal = std::make_shared<std::vector<std::string>>();
    std::shared_ptr<RecordingUserSession> session = std::make_shared<RecordingUserSession>(journal);
    std::shared_ptr<RecordingSystemController> system =
        std::make_shared<RecordingSystemController>(journal);
    std::shared_ptr<RecordingExtensionContext> context =
        std::make_shared<RecordingExtensionContext>(journal);
    std::shared_ptr<UIViewController> controller = std::make_shared<UIViewController>();
    EnvironmentSlot<std::shared_ptr<UserSession>>::Override sessionOverride =
        UserSession::instance().overrideWith(session);
    EnvironmentSlot<std::shared_ptr<SystemController>>::Override systemOverride =
        SystemController::instance().overrideWith(system);

    OpeningDoubles() { controller->setExtensionContext(context); }
};

} // namespace orvo::testing
