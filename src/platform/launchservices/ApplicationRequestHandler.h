#pragma once

#include "platform/foundation/NSData.h"
#include "platform/foundation/NSError.h"

#include <memory>
#include <string>
#include <vector>

namespace orvo {

/// What goes along with a request, beside what is asked.
struct ApplicationRequest {
    bool usesDemonstration = false; ///< it is about the demonstration city's profile
    /// Lets a window come to the front; empty where the desktop gave none.
    std::string activationToken;
};

/// What an application can be asked by others. Each answers nil when it took it, else why not, in
/// words for the person who asked. Main thread.
class ApplicationRequestHandler {
public:
    ApplicationRequestHandler() = default;
    ApplicationRequestHandler(const ApplicationRequestHandler&) = delete;
    ApplicationRequestHandler& operator=(const ApplicationRequestHandler&) = delete;
    virtual ~ApplicationRequestHandler() = default;

    /// Started, or called to the front.
    [[nodiscard]] virtual std::shared_ptr<NSError> activate(const ApplicationRequest& request) = 0;
    [[nodiscard]] virtual std::shared_ptr<NSError> openURLs(const std::vector<std::string>& urls,
                                                            const ApplicationRequest& request) = 0;
    /// `parameter` is nil where there is none.
    [[nodiscard]] virtual std::shared_ptr<NSError>
    activateAction(const std::string& action,
                   const std::shared_ptr<NSData>& parameter,
                   const ApplicationRequest& request) = 0;
    /// The bus is gone, as when the session ends: nobody can ask any more.
    virtual void busIsGone() {}
};

} // namespace orvo
