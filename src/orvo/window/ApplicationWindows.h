#pragma once

#include "orvo/window/FavoritesEditor.h"
#include "orvo/window/IncidentPage.h"

#include <functional>
#include <memory>
#include <string>

namespace orvo {

/// The windows of the application: one for what is told of lines and incidents, one for the
/// favourites. What is shown next takes the place of what the window showed. They follow the looks
/// of the desktop. Needs the application object that `WindowApplication` makes. Main thread.
class ApplicationWindows {
public:
    ApplicationWindows();
    ApplicationWindows(const ApplicationWindows&) = delete;
    ApplicationWindows& operator=(const ApplicationWindows&) = delete;
    /// Closes them.
    ~ApplicationWindows();

    /// Shows the page, in front of other windows as far as the desktop permits that.
    /// @param activationToken the desktop's leave for that; may be empty
    void show(const IncidentPage& page, const std::string& activationToken);
    /// The favourites, to be edited. Not nil.
    void show(std::shared_ptr<FavoritesEditor> favorites, const std::string& activationToken);

    [[nodiscard]] bool isAnyOpen() const;
    /// Called when the person has closed the last one.
    void setAllClosed(std::function<void()> allClosed);

private:
    struct Private;

    std::unique_ptr<Private> _private;
};

} // namespace orvo
