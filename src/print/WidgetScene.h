#pragma once

#include "platform/extension/WidgetHost.h"
#include "print/PrintedWidget.h"

#include <functional>
#include <memory>

namespace orvo {

class OWTransitIncidentsViewController;
class WidgetCard;

/// The widget in a host without a screen. What it shows can be printed, tapped and drawn. Main
/// thread, whose run loop turns while something is waited for.
class WidgetScene {
public:
    /// The widget of the program that is being run.
    /// @throws NSInvalidArgumentException when its principal class is another than the widget's
    WidgetScene(const Extension& extension, const WidgetHostSettings& settings);
    WidgetScene(const WidgetScene&) = delete;
    WidgetScene& operator=(const WidgetScene&) = delete;
    /// It disappears, and so keeps what it shows.
    ~WidgetScene();

    [[nodiscard]] const std::shared_ptr<WidgetHost>& host() const noexcept { return _host; }
    [[nodiscard]] const std::shared_ptr<OWTransitIncidentsViewController>&
    controller() const noexcept {
        return _controller;
    }

    /// Shows what was kept, and begins to fetch.
    void appear();
    /// Until a fetch has ended, and its rows are shown in the mode that they allow.
    void update();
    void disappear();

    /// Both modes' rows.
    [[nodiscard]] PrintedWidget printed() const;
    /// The card with all rows of the present mode, laid out.
    [[nodiscard]] std::shared_ptr<WidgetCard> card() const;

private:
    std::shared_ptr<WidgetHost> _host;
    std::shared_ptr<OWTransitIncidentsViewController> _controller;
};

} // namespace orvo
