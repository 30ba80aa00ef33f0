#pragma once

#include "platform/extension/Extension.h"
#include "platform/extension/NCWidgetProviding.h"
#include "platform/foundation/CGGeometry.h"
#include "platform/foundation/NSExtensionContext.h"
#include "platform/uikit/UITraitCollection.h"

#include <cstdint>
#include <functional>
#include <memory>
#include <optional>

namespace orvo {

class UIView;
class UIViewController;
class WidgetPresenter;
class WidgetUpdateSchedule;
class _HeldWidget;
class _WidgetContext;

/// What a host is told at its beginning.
struct WidgetHostSettings {
    static constexpr CGFloat StandardWidth = 359;

    CGFloat width = StandardWidth; ///< of the widget, in points
    /// The most that the expanded widget may be high, in points (a screen's free height less the
    /// card's header); nothing where there is no screen: 5.6 rows.
    std::optional<CGFloat> freeHeight = std::nullopt;
    /// That many rows, whatever the height; 0 is no limit.
    std::optional<std::uint64_t> maxRows = std::nullopt;
    /// The mode to begin with; nothing is the one that the person last chose on this profile, which
    /// is then kept too.
    std::optional<NCWidgetDisplayMode> mode = std::nullopt;
    /// Whether the language is the desktop's, and changes with it; false where the person named
    /// one.
    bool followsLanguage = true;
};

/// Holds a widget: makes its controller and leads it through its life, asks it for updates, and
/// decides how large it is and in which mode it is shown. It draws nothing and knows no window.
/// Main thread.
///
/// The widget is visible while it is shown and the screen is unlocked. It is asked for an update
/// when it becomes visible, when the machine wakes or the network goes or returns meanwhile, and
/// again 1, 2, 5 and then every 15 minutes after an answer that was a failure. While it is not
/// visible it is left alone.
///
/// Where the widget offers only the compact mode, that is shown from the next turn of the main
/// queue on, and the person's choice again once it can be.
class WidgetHost final : public virtual NSObject {
public:
    /// The widget's layout margins at its sides, in points.
    static constexpr CGFloat SideMargin = 16;
    /// Of the compact widget at the text size L, in points.
    static constexpr CGFloat CompactHeight = 110;

    [[nodiscard]] static std::shared_ptr<WidgetHost>
    hostWithExtension_settings(const Extension& extension, const WidgetHostSettings& settings);
    WidgetHost();
    /// A widget that is visible disappears first.
    ~WidgetHost() override;

    [[nodiscard]] const ExtensionDescription& extensionDescription() const noexcept {
        return _extensionDescription;
    }
    /// Another one after `startWidgetAnew`.
    [[nodiscard]] const std::shared_ptr<UIViewController>& controller() const noexcept;
    /// Held weakly. Without one a change of size happens at once.
    void setPresenter(const std::shared_ptr<WidgetPresenter>& presenter) { _presenter = presenter; }

    /// Called whenever the widget has said something of its content, inside that: it may have other
    /// rows. Empty for nothing.
    void setContentTold(std::function<void()> told) { _contentTold = std::move(told); }

    // What is shown
    /// The widget's root view. Loaded when first asked for, and then told its mode, before it ever
    /// appears. Whoever shows it gives it its place; its size is `contentSize()`, except during a
    /// transition.
    [[nodiscard]] const std::shared_ptr<UIView>& view();
    /// In points: the width, and the height that the widget prefers, at least 0 and at most what
    /// the mode allows. Until the widget has said what it prefers, as high as what it shows.
    [[nodiscard]] CGSize contentSize() const noexcept { return _contentSize; }
    /// What the widget prefers, however much that is, in points.
    [[nodiscard]] CGFloat preferredHeight() const;
    [[nodiscard]] NCWidgetDisplayMode displayMode() const;
    /// Whether the person can change the mode: there is more to show than the compact mode shows.
    [[nodiscard]] bool offersExpanded() const;
    [[nodiscard]] CGSize maximumSizeForDisplayMode(NCWidgetDisplayMode mode) const;
    [[nodiscard]] bool isVisible() const noexcept { return _visible; }

    // What a person does
    /// Changes the mode and keeps the choice for the next start. Nothing for a mode that is not
    /// offered.
    void setDisplayMode(NCWidgetDisplayMode mode);

    // What happens around it
    void setShown(bool shown);
    void setLocked(bool locked);
    void setWidth(CGFloat width);
    /// As in the settings.
    void setFreeHeight(std::optional<CGFloat> height);
    /// The traits of the system, and with them of the widget: the maxima change before anything
    /// else hears of it.
    void setTraits(const UITraitCollection& traits);
    void machineDidWake();
    void networkDidChange();
    void didReceiveMemoryWarning();
    /// The widget ends, and keeps what it shows, and a new one begins with that: in another
    /// language, say, in which nothing of the old one could go on. Size and mode stay until the new
    /// one says something else.
    void startWidgetAnew();

    /// Asks for an update, besides those above; several may run at once. The handler, which may be
    /// empty, is called once, never inside this call. While the widget is not visible, too.
    void requestUpdate(NCWidgetProviding::UpdateHandler handler = {});

private:
    /// While it lives, changes of size and mode wait: what one call of the widget brings is one
    /// change.
    class Hold;

    void _initWithExtension_settings(const Extension& extension,
                                     const WidgetHostSettings& settings);
    void makeWidget();
    void loadView();
    void updateVisibility();
    void updateMaxima(UIContentSizeCategory category);
    [[nodiscard]] CGFloat heightLimit() const;
    void updateContentSize();
    void transitionTo(CGSize size);
    void showMode(NCWidgetDisplayMode mode);
    void largestModeWasTold();
    [[nodiscard]] NCWidgetDisplayMode wantedMode() const;
    void settleMode();

    ExtensionDescription _extensionDescription;
    std::function<std::shared_ptr<UIViewController>()> _makePrincipalObject;
    WidgetHostSettings _settings;
    std::shared_ptr<_WidgetContext> _context;
    std::unique_ptr<_HeldWidget> _widget;
    std::shared_ptr<WidgetUpdateSchedule> _schedule;
    std::weak_ptr<WidgetPresenter> _presenter;
    std::function<void()> _contentTold;
    NCWidgetDisplayMode _chosenMode = NCWidgetDisplayMode::Compact;
    NCWidgetDisplayMode _toldLargestMode = NCWidgetDisplayMode::Compact;
    CGSize _contentSize;
    std::size_t _requestsRunning = 0;
    int _holds = 0;
    bool _shown = false;
    bool _locked = false;
    bool _visible = false;
    bool _modeWillSettle = false;
};

} // namespace orvo
