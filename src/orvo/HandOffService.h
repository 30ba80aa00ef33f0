#pragma once

#include "orvo/HandOffReceiver.h"
#include "platform/launchservices/ApplicationRequestHandler.h"

#include <functional>

namespace orvo {

class HandOffWindows;

/// Answers what the application is asked over the bus: takes what is handed over, each in the
/// profile that it is about, and shows it where there are windows.
class HandOffService final : public ApplicationRequestHandler {
public:
    /// `onRequest` is called before each request is looked at. `windows` may be nil; they must
    /// outlive the service.
    HandOffService(const Terminal& terminal,
                   std::function<void()> onRequest,
                   HandOffWindows* windows = nullptr)
        : _terminal(terminal)
        , _onRequest(std::move(onRequest))
        , _windows(windows) {}

    /// Shows the favourites.
    [[nodiscard]] std::shared_ptr<NSError> activate(const ApplicationRequest& request) override;
    /// One after the other, up to the first that cannot be taken.
    [[nodiscard]] std::shared_ptr<NSError> openURLs(const std::vector<std::string>& urls,
                                                    const ApplicationRequest& request) override;
    /// There is one action: to go on with an activity.
    [[nodiscard]] std::shared_ptr<NSError>
    activateAction(const std::string& action,
                   const std::shared_ptr<NSData>& parameter,
                   const ApplicationRequest& request) override;
    void busIsGone() override;
    /// What to do then; nothing at first.
    void setOnBusGone(std::function<void()> onBusGone) { _onBusGone = std::move(onBusGone); }

private:
    [[nodiscard]] std::shared_ptr<NSError> take(const std::vector<HandOff>& handOffs,
                                                const ApplicationRequest& request) const;

    const Terminal& _terminal;
    std::function<void()> _onRequest;
    std::function<void()> _onBusGone;
    HandOffWindows* _windows;
};

/// The hand-off that an action with its parameter (may be nil) means; nothing, with an error, for
/// an action that there is not, or one without its parameter.
[[nodiscard]] std::optional<HandOff> handOffOfAction(const std::string& action,
                                                     const std::shared_ptr<NSData>& parameter,
                                                     std::shared_ptr<NSError>* error);

} // namespace orvo
