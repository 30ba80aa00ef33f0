#pragma once

#include "platform/launchservices/ApplicationRequestHandler.h"

namespace orvo {

/// An application on the session bus: the one owner of its identifier as a name there, which
/// answers the interface `org.freedesktop.Application` at the path that follows from it. Requests
/// come in turns of the main run loop; one that does not fit the interface, or that the handler
/// refuses, is answered with an error. Main thread.
class ApplicationService {
public:
    /// Nil, with `LaunchServicesErrorCode::NoBus` or `AlreadyRuns`, when it cannot serve. The
    /// handler must outlive the service; it is first called after this has returned.
    [[nodiscard]] static std::unique_ptr<ApplicationService>
    start(const std::string& applicationIdentifier,
          ApplicationRequestHandler& handler,
          std::shared_ptr<NSError>* error);

    /// Whether somebody serves the application now. Never starts it.
    [[nodiscard]] static bool isRunning(const std::string& applicationIdentifier);

    ApplicationService(const ApplicationService&) = delete;
    ApplicationService& operator=(const ApplicationService&) = delete;
    /// Gives the name back, and answers what was asked before that: nothing is lost, since the bus
    /// sends what comes later to the next owner.
    ~ApplicationService();

private:
    struct Private;
    explicit ApplicationService(std::unique_ptr<Private> fields);

    std::unique_ptr<Private> _private;
};

} // namespace orvo
