#pragma once

#include "platform/extension/NCWidgetProviding.h"
#include "platform/foundation/NSExtensionContext.h"
#include "platform/uikit/UIGeometry.h"
#include "platform/uikit/UITraitCollection.h"

#include <functional>
#include <memory>
#include <optional>

namespace orvo {

class UIView;
class UIViewController;

/// The widget that a host holds: one controller, led through its life in the order in which a
/// widget may expect it. A controller that provides no widget is shown all the same. Main thread.
class _HeldWidget {
public:
    /// @param context what it sees of its host; it tells the mode and how large the widget may be
    /// @param heightPreferred called whenever the widget says how high it prefers to be, inside
    /// that
    _HeldWidget(std::shared_ptr<UIViewController> controller,
                std::shared_ptr<NSExtensionContext> context,
                std::function<void()> heightPreferred);
    _HeldWidget(const _HeldWidget&) = delete;
    _HeldWidget& operator=(const _HeldWidget&) = delete;
    ~_HeldWidget();

    [[nodiscard]] const std::shared_ptr<UIViewController>& controller() const noexcept {
        return _controller;
    }
    [[nodiscard]] bool isLoaded() const;
    /// Its root view. Only of a widget that is loaded.
    [[nodiscard]] const std::shared_ptr<UIView>& view() const;

    /// Makes its view, of that size and with those margins when the widget hears that it was
    /// loaded, and then tells it its mode.
    void load(CGSize size, const NSDirectionalEdgeInsets& margins);
    /// The mode that the context now has, and how large that may be.
    void tellMode();
    void appear();
    void disappear();
    /// A widget that is visible disappears; what it prefers is no more heard.
    void end();
    /// All of the views that it is shown in hear of it; nothing for one that is not loaded.
    void traitsDidChange(const UITraitCollection& previous);
    /// The handler, which may be empty, is called once; later, with nothing new, where the
    /// controller provides no widget.
    void requestUpdate(NCWidgetProviding::UpdateHandler handler);

    /// In points, at least 0; nothing until the widget has said it.
    [[nodiscard]] std::optional<CGFloat> preferredHeight() const;
    /// How far down the contents of its view reach when that has so much height, in points, with
    /// what could be scrolled to. Only of a widget that is loaded.
    [[nodiscard]] CGFloat heightOfContentsWithin(CGFloat height) const;

private:
    [[nodiscard]] std::shared_ptr<NCWidgetProviding> provider() const;

    std::shared_ptr<UIViewController> _controller;
    std::shared_ptr<NSExtensionContext> _context;
    bool _hasPreference = false;
    bool _visible = false;
};

} // namespace orvo
