#pragma once

#include "platform/foundation/EnvironmentSlot.h"
#include "platform/foundation/NSData.h"
#include "platform/foundation/NSError.h"

#include <functional>
#include <string>
#include <vector>

namespace orvo {

inline constexpr const char* LaunchServicesErrorDomain = "OrvoLaunchServicesErrorDomain";
enum class LaunchServicesErrorCode : std::int64_t {
    ApplicationNotFound = 1, ///< neither a service on the bus nor a program
    Refused = 2,             ///< the application answered with an error
    NotStarted = 3,          ///< its program could not be started
    NoBus = 4,               ///< there is no session bus
    AlreadyRuns = 5,         ///< another process serves it
};

/// Starts applications and hands them things.
class ApplicationLauncher : public virtual NSObject {
public:
    /// Told nil when the application took it, else why not: once, on the main queue, never inside
    /// the call. May be empty.
    using CompletionHandler = std::function<void(const std::shared_ptr<NSError>& error)>;

    [[nodiscard]] static std::shared_ptr<ApplicationLauncher> sharedLauncher();
    /// What `sharedLauncher()` answers. Default: the desktop's.
    static EnvironmentSlot<std::shared_ptr<ApplicationLauncher>>& launcher();

    virtual void openURLs(const std::string& applicationIdentifier,
                          const std::vector<std::string>& urls,
                          CompletionHandler completionHandler) = 0;
    /// `parameter` may be nil.
    virtual void activateAction(const std::string& applicationIdentifier,
                                const std::string& action,
                                const std::shared_ptr<NSData>& parameter,
                                CompletionHandler completionHandler) = 0;
};

} // namespace orvo
