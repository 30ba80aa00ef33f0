#pragma once

#include "platform/settings/DesktopAppearance.h"

#include <functional>
#include <memory>

namespace orvo {

/// Follows the looks of the desktop, as its settings portal tells them on the session bus. Silent
/// where there is no bus or no portal. Main thread.
class DesktopSettings {
public:
    DesktopSettings();
    DesktopSettings(const DesktopSettings&) = delete;
    DesktopSettings& operator=(const DesktopSettings&) = delete;
    ~DesktopSettings();

    /// Connects, and asks without waiting for the answer. `changed` is called with the first answer
    /// and whenever something is another; never inside this call.
    void start(std::function<void(const DesktopAppearance&)> changed);
    void stop();

private:
    struct Private;

    std::unique_ptr<Private> _private;
};

} // namespace orvo
