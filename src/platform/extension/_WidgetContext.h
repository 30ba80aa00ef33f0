#pragma once

#include "platform/foundation/NSError.h"
#include "platform/foundation/NSExtensionContext.h"

#include <string>

namespace orvo {

/// What the widget of a host sees of it. It knows the host by a call only, so that a widget which
/// outlives its host still gets answers. Main thread.
class _WidgetContext final : public NSExtensionContext {
public:
    /// URLs are opened by the application of that identifier.
    [[nodiscard]] static std::shared_ptr<_WidgetContext>
    contextWithApplicationIdentifier(std::string identifier);

    void openURL_completionHandler(const std::shared_ptr<NSURL>& url,
                                   std::function<void(bool success)> completionHandler) override;
    [[nodiscard]] NCWidgetDisplayMode widgetActiveDisplayMode() const override {
        return _activeMode;
    }
    [[nodiscard]] NCWidgetDisplayMode widgetLargestAvailableDisplayMode() const override {
        return _largestMode;
    }
    void setWidgetLargestAvailableDisplayMode(NCWidgetDisplayMode mode) override;
    [[nodiscard]] CGSize widgetMaximumSizeForDisplayMode(NCWidgetDisplayMode mode) const override {
        return mode == NCWidgetDisplayMode::Compact ? _compactMaximum : _expandedMaximum;
    }

    // For the host
    void setActiveMode(NCWidgetDisplayMode mode) noexcept { _activeMode = mode; }
    void setMaxima(CGSize compact, CGSize expanded) noexcept {
        _compactMaximum = compact;
        _expandedMaximum = expanded;
    }
    /// Called whenever the widget has said what the largest mode is, also where it is as before.
    void setLargestModeTold(std::function<void()> told) { _largestModeTold = std::move(told); }

private:
    std::string _applicationIdentifier;
    NCWidgetDisplayMode _activeMode = NCWidgetDisplayMode::Compact;
    NCWidgetDisplayMode _largestMode = NCWidgetDisplayMode::Compact;
    CGSize _compactMaximum;
    CGSize _expandedMaximum;
    std::function<void()> _largestModeTold;
};

} // namespace orvo
