#pragma once

#include "platform/extension/SystemEvents.h"

#include <memory>

namespace orvo {

/// Listens to logind and NetworkManager on the system bus, which are asked and never started, and
/// to the kernel's memory pressure.
class DesktopSystemEvents final : public SystemEvents {
public:
    DesktopSystemEvents();
    ~DesktopSystemEvents() override;

    void start(Handlers handlers) override;
    void stop() override;

private:
    struct Private;
    std::unique_ptr<Private> _private;
};

} // namespace orvo
