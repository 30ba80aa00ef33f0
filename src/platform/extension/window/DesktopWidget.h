#pragma once

#include "platform/extension/SystemEvents.h"
#include "platform/extension/WidgetHost.h"
#include "platform/settings/DesktopLanguage.h"
#include "platform/settings/DesktopSettings.h"

#include <functional>
#include <memory>

namespace orvo {

class WidgetWindow;

/// A widget in a window of the desktop, and all that it follows there: looks, language, lock,
/// sleep, network and memory. It begins with the looks that were remembered; nothing of the desktop
/// is asked before the first frame stands. Needs the application object of
/// `makeDesktopApplication`. Main thread.
class DesktopWidget {
public:
    /// Shows it. `closed` is called when the person has closed the window; it may let go of this.
    DesktopWidget(const Extension& extension,
                  const WidgetHostSettings& settings,
                  std::function<void()> closed);
    DesktopWidget(const DesktopWidget&) = delete;
    DesktopWidget& operator=(const DesktopWidget&) = delete;
    /// The widget disappears, and so keeps what it shows.
    ~DesktopWidget();

    [[nodiscard]] const std::shared_ptr<WidgetHost>& host() const noexcept { return _host; }
    [[nodiscard]] const std::shared_ptr<WidgetWindow>& window() const noexcept { return _window; }

private:
    void followDesktop();
    void takeAppearance(const DesktopAppearance& appearance);
    void takeLanguage(const std::string& language);

    DesktopAppearance _appearance = DesktopAppearance::remembered();
    bool _followsLanguage;
    std::shared_ptr<WidgetHost> _host;
    std::shared_ptr<WidgetWindow> _window;
    DesktopSettings _settings;
    DesktopLanguage _language;
    std::shared_ptr<SystemEvents> _events;
};

/// Shows an extension in a window until the person closes it, or somebody stops the main run loop.
/// `began`, which may be empty, is told of the host once the window is open. Answers the exit code.
int runDesktopWidget(
    const Extension& extension,
    const WidgetHostSettings& settings,
    const std::function<void(const std::shared_ptr<WidgetHost>& host)>& began = {});

} // namespace orvo
