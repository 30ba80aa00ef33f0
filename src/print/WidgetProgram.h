#pragma once

#include "orvo/console/ExitCode.h"
#include "orvo/console/Terminal.h"
#include "platform/demo/DemoVisit.h"
#include "platform/extension/Extension.h"
#include "platform/foundation/Environment.h"
#include "platform/foundation/NSTimer.h"
#include "platform/foundation/Text.h"
#include "platform/uikit/UITraitCollection.h"
#include "print/WidgetOptions.h"
#include "print/WidgetPrinter.h"

#include <functional>
#include <memory>
#include <optional>
#include <string>
#include <vector>

namespace orvo {

class WidgetHost;
class WidgetScene;
struct WidgetHostSettings;

/// What shows a widget in a window of the desktop.
struct WidgetWindowing {
    /// Tells of the host once the window is open.
    using Began = std::function<void(const std::shared_ptr<WidgetHost>& host)>;

    /// Makes the program's application object.
    std::function<void()> makeApplication;
    /// Until the window is closed, or somebody stops the main run loop. Answers the exit code.
    std::function<int(
        const Extension& extension, const WidgetHostSettings& settings, const Began& began)>
        run;
};

/// The widget's program on the command line. What the options say of profile, clock and language
/// holds while it lives. Main thread.
class WidgetProgram {
public:
    /// Runs that extension, which is the transit widget. `windowing`: nothing where there is no
    /// display.
    WidgetProgram(Extension extension,
                  Terminal terminal,
                  std::optional<WidgetWindowing> windowing = std::nullopt);
    WidgetProgram(const WidgetProgram&) = delete;
    WidgetProgram& operator=(const WidgetProgram&) = delete;

    /// The words of the command line without the program's name.
    [[nodiscard]] ExitCode run(const std::vector<std::string>& words);

private:
    /// Turns the environment; false, with the reason said, when that fails.
    [[nodiscard]] bool applyEnvironment(const WidgetOptions& options);
    [[nodiscard]] std::unique_ptr<WidgetScene> scene(const WidgetOptions& options) const;
    /// The same, with what a fetch has brought.
    [[nodiscard]] std::unique_ptr<WidgetScene> updatedScene(const WidgetOptions& options) const;
    /// Until the person closes it, or a signal asks it to end.
    [[nodiscard]] ExitCode showWindow(const WidgetOptions& options);
    [[nodiscard]] ExitCode print(const WidgetOptions& options) const;
    /// Until a signal asks it to end, or nobody reads any more.
    [[nodiscard]] ExitCode follow(const WidgetOptions& options);
    [[nodiscard]] ExitCode open(const WidgetOptions& options) const;
    /// Of both modes, where there are both, into the folder that the options name.
    [[nodiscard]] ExitCode drawPictures(const WidgetScene& scene,
                                        const WidgetOptions& options) const;
    /// A picture or a dump.
    [[nodiscard]] ExitCode draw(const WidgetOptions& options) const;
    [[nodiscard]] ExitCode fail(const std::string& reason) const;

    /// Favourites that cannot be read have no row of their own and look like none: says so, once
    /// for each reason. Whether there was one.
    bool tellUnreadableFavorites();
    /// Before each update that follows: the demonstration goes on when its hour is over. What fails
    /// is said once.
    void renewDemonstration();
    /// The same in a window, which is asked for nothing while it stands idle: at the end of the
    /// demonstration's hour.
    void keepDemonstration(const std::shared_ptr<WidgetHost>& host);
    [[nodiscard]] std::unique_ptr<WidgetPrinter> printer(const WidgetOptions& options) const;

    Extension _extension;
    Terminal _terminal;
    std::optional<WidgetWindowing> _windowing;
    std::optional<EnvironmentSlot<std::shared_ptr<WallClock>>::Override> _clock;
    std::optional<EnvironmentSlot<bool>::Override> _keepsWritesInMemory;
    std::optional<EnvironmentSlot<std::string>::Override> _language;
    std::optional<EnvironmentSlot<UITraitCollection>::Override> _traits;
    std::string _saidOfFavorites;
    std::string _saidOfDemonstration;
    std::unique_ptr<DemoVisit> _demonstration; ///< nil on the person's own profile
    std::shared_ptr<NSTimer> _endOfDemonstration;
    std::optional<EnvironmentSlot<bool>::Override> _checksSchedules;
};

} // namespace orvo
