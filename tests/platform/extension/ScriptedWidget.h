#pragma once

#include "platform/extension/WidgetHost.h"
#include "platform/extension/WidgetPresenter.h"
#include "platform/foundation/DispatchQueue.h"
#include "platform/foundation/RunLoop.h"
#include "platform/uikit/UIView.h"
#include "platform/uikit/UIViewController.h"
#include "platform/uikit/UIViewControllerTransitionCoordinator.h"
#include "support/TemporaryProfile.h"
#include "support/TestClock.h"

#include <fmt/format.h>
#include <memory>
#include <string>
#include <vector>

namespace orvo::testing {

using Mode = NCWidgetDisplayMode;

/// A widget that writes down what its host does to it. It offers `largest`, prefers `rows` rows of
/// the compact height in the expanded mode, and is asked for updates, which the test answers.
class ScriptedWidget final : public UIViewController, public NCWidgetProviding {
public:
    void viewDidLoad() override {
        const auto margins = view()->directionalLayoutMargins();
        note("load {}×{}, margins {} {}",
             view()->frame().size.width,
             view()->frame().size.height,
             margins.leading,
             margins.trailing);
    }
    void viewWillAppear(bool animated) override {
        UIViewController::viewWillAppear(animated);
        note("will appear");
        offer();
    }
    void viewDidAppear(bool) override { note("did appear"); }
    void viewWillDisappear(bool) override { note("will disappear"); }
    void viewDidDisappear(bool) override { note("did disappear"); }
    void didReceiveMemoryWarning() override { note("memory warning"); }
    void widgetPerformUpdateWithCompletionHandler(UpdateHandler handler) override {
        note("update");
        if (joins) {
            handler(*joins);
            return;
        }
        handlers.push_back(std::move(handler));
    }
    void widgetActiveDisplayModeDidChange_withMaximumSize(Mode mode, CGSize size) override {
        note("mode {} at most {}×{}, active {}",
             static_cast<int>(mode),
             size.width,
             size.height,
             static_cast<int>(extensionContext()->widgetActiveDisplayMode()));
        prefer();
    }
    void viewWillTransitionToSize_withTransitionCoordinator(
        CGSize size,
        const std::shared_ptr<UIViewControllerTransitionCoordinator>& coordinator) override {
        note("to {}×{}", size.width, size.height);
        coordinator->animateAlongsideTransition_completion([this] { note("alongside"); },
                                                           [this] { note("done"); });
    }

    /// Its content is another one.
    void offer() { extensionContext()->setWidgetLargestAvailableDisplayMode(largest); }
    void prefer() {
        if (silent)
            return;
        const auto context = extensionContext();
        const auto compact = context->widgetMaximumSizeForDisplayMode(Mode::Compact);
        const bool expanded = context->widgetActiveDisplayMode() == Mode::Expanded;
        setPreferredContentSize({compact.width, compact.height * (expanded ? rows : 1)});
    }
    void answer(NCUpdateResult result) {
        const auto answered = std::exchange(handlers, {});
        for (const auto& handler : answered)
            handler(result);
    }
    std::vector<std::string> taken() { return std::exchange(calls, {}); }

    template <class... Arguments>
    void note(fmt::format_string<Arguments...> text, Arguments&&... arguments) {
        calls.push_back(fmt::format(text, std::forward<Arguments>(arguments)...));
    }

    Mode largest = Mode::Expanded;
    int rows = 3;
    bool silent = false; ///< never says what it prefers
    std::optional<NCUpdateResult> joins;
    std::vector<std::string> calls;
    std::vector<UpdateHandler> handlers;
};

/// Notes what it is to show; changes of size run when the test says so.
class ScriptedPresenter final : public WidgetPresenter {
public:
    void widgetHost_transitionToContentSize(WidgetHost&,
                                            CGSize size,
                                            std::function<void()> alongside,
                                            std::function<void()> completion) override {
        sizes.push_back(size);
        begin = std::move(alongside);
        end = std::move(completion);
    }
    void widgetHostDidChangeDisplayMode(WidgetHost& host) override {
        modes.push_back(fmt::format("{}{}",
                                    host.displayMode() == Mode::Expanded ? "expanded" : "compact",
                                    host.offersExpanded() ? ", more" : ""));
    }

    void widgetHostDidChangeView(WidgetHost& host) override { views.push_back(host.view()); }

    std::vector<CGSize> sizes;
    std::vector<std::string> modes;
    std::vector<std::shared_ptr<UIView>> views;
    std::function<void()> begin;
    std::function<void()> end;
};

/// A profile, a stopped clock, and a host with a scripted widget.
struct HostWorld {
    std::shared_ptr<WidgetHost> host(const WidgetHostSettings& settings = {}) {
        const Extension extension({.bundleIdentifier = "a.widget",
                                   .containingApplication = "a.map",
                                   .displayName = "A Widget",
                                   .principalClass = "ScriptedWidget",
                                   .iconName = iconName},
                                  [this] { return widget; });
        return WidgetHost::hostWithExtension_settings(extension, settings);
    }
    /// Lets what waits in the main queue run.
    static void turn() { RunLoop::main().runOnce(); }
    void advance(double seconds) {
        clock->advance(seconds);
        RunLoop::main().checkTimers();
    }

    TemporaryProfile profile;
    StoppedClock clock;
    std::optional<std::string> iconName;
    std::shared_ptr<ScriptedWidget> widget = std::make_shared<ScriptedWidget>();
};

} // namespace orvo::testing
