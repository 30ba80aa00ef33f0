#pragma once

#include "orvo/CommandContext.h"
#include "orvo/HandOff.h"
#include "orvo/window/ApplicationWindows.h"

#include <functional>
#include <memory>
#include <string>

namespace orvo {

/// Shows what is handed over in the application's windows. Main thread.
class HandOffWindows {
public:
    /// Nil where this process has no application object for windows.
    [[nodiscard]] static std::unique_ptr<HandOffWindows> make();
    HandOffWindows(const HandOffWindows&) = delete;
    HandOffWindows& operator=(const HandOffWindows&) = delete;
    virtual ~HandOffWindows() = default;

    /// What it is about is read from the profile in use; the window keeps to that profile.
    virtual void show(const HandOff::Content& content,
                      CommandContext& context,
                      const std::string& activationToken) = 0;
    [[nodiscard]] virtual bool isAnyOpen() const = 0;
    /// Called when the person has closed the last one.
    virtual void setAllClosed(std::function<void()> allClosed) = 0;

protected:
    HandOffWindows() = default;
};

} // namespace orvo
