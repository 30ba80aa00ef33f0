#include "orvo/HandOffService.h"

#include "orvo/HandOffError.h"
#include "orvo/HandOffWindows.h"
#include "platform/demo/DemoVisit.h"
#include "platform/foundation/Environment.h"
#include "platform/mapuikit/DesktopSystemController.h"

#include <fmt/format.h>
#include <ostream>

namespace orvo {

namespace {

/// A process that was started for the demonstration city is asked about the person's own lines too.
std::optional<EnvironmentSlot<ProfileFolders>::Override> ownProfile() {
    if (Environment::profile().get().state != ProfileFolders::demonstration().state)
        return std::nullopt;
    return Environment::profile().overrideWith(ProfileFolders::standard());
}

} // namespace

std::optional<HandOff> handOffOfAction(const std::string& action,
                                       const std::shared_ptr<NSData>& parameter,
                                       std::shared_ptr<NSError>* error) {
    if (action != DesktopSystemController::Action) {
        setHandOffError(error,
                        HandOffErrorCode::Unknown,
                        fmt::format("There is no action \"{}\"; the one there is: {}.",
                                    action,
                                    DesktopSystemController::Action));
        return std::nullopt;
    }
    if (!parameter) {
        setHandOffError(error,
                        HandOffErrorCode::Unreadable,
                        fmt::format("The action {} needs an activity as its parameter.", action));
        return std::nullopt;
    }
    return HandOff::ofActivity(parameter);
}

std::shared_ptr<NSError> HandOffService::activate(const ApplicationRequest& request) {
    return take({HandOff::ofURL("orvo://?favorites=2&t=r")}, request);
}

std::shared_ptr<NSError> HandOffService::openURLs(const std::vector<std::string>& urls,
                                                  const ApplicationRequest& request) {
    std::vector<HandOff> handOffs;
    handOffs.reserve(urls.size());
    for (const auto& url : urls)
        handOffs.push_back(HandOff::ofURL(url));
    return take(handOffs, request);
}

std::shared_ptr<NSError> HandOffService::activateAction(const std::string& action,
                                                        const std::shared_ptr<NSData>& parameter,
                                                        const ApplicationRequest& request) {
    std::shared_ptr<NSError> error;
    const auto handOff = handOffOfAction(action, parameter, &error);
    return handOff ? take({*handOff}, request) : error;
}

void HandOffService::busIsGone() {
    if (_onBusGone)
        _onBusGone();
}

std::shared_ptr<NSError> HandOffService::take(const std::vector<HandOff>& handOffs,
                                              const ApplicationRequest& request) const {
    _onRequest();
    std::shared_ptr<NSError> error;
    std::unique_ptr<DemoVisit> demonstration;
    const auto own = request.usesDemonstration ? std::nullopt : ownProfile();
    if (request.usesDemonstration) {
        demonstration = DemoVisit::begin(DemoVisit::Purpose::Look, &error);
        if (!demonstration)
            return error;
    }
    // Where nobody looks nothing is printed: it would end up in the journal, which is no place for
    // where somebody rides.
    const auto audience = _terminal.settings().outputIsTerminal
                              ? HandOffReceiver::Audience::Terminal
                              : HandOffReceiver::Audience::Nobody;
    for (const auto& handOff : handOffs) {
        CommandContext context(_terminal); // the profile's stores, as they are now
        HandOffReceiver::Showing showing;
        if (_windows)
            showing = [&](const HandOff::Content& content) {
                _windows->show(content, context, request.activationToken);
            };
        if ((error = HandOffReceiver::take(handOff, context, audience, showing)))
            break;
    }
    _terminal.output().flush();
    return error;
}

} // namespace orvo
