#pragma once

#include "platform/launchservices/ApplicationLauncher.h"

#include <filesystem>
#include <optional>

namespace orvo {

/// Reaches an application by the interface `org.freedesktop.Application` on the session bus, which
/// starts it where it does not run. Without a bus, or without such a service on it, its program is
/// started directly: `PROGRAM open URL…`, or `PROGRAM receive ACTION` with the parameter on
/// standard input. An activation token that this process was started with is passed on, and that it
/// uses the demonstration city's profile (`--demo`). Main thread.
class DesktopApplicationLauncher final : public ApplicationLauncher {
public:
    /// The program of an application: beside this one, in the build tree's other folder, else on
    /// the search path. Nothing when there is none.
    using ProgramLookup = std::function<std::optional<std::filesystem::path>(
        const std::string& applicationIdentifier)>;
    static EnvironmentSlot<ProgramLookup>& programLookup();

    void openURLs(const std::string& applicationIdentifier,
                  const std::vector<std::string>& urls,
                  CompletionHandler completionHandler) override;
    void activateAction(const std::string& applicationIdentifier,
                        const std::string& action,
                        const std::shared_ptr<NSData>& parameter,
                        CompletionHandler completionHandler) override;
};

} // namespace orvo
