#include "orvo/HandOffReceiver.h"

#include "orvo/HandOffError.h"
#include "orvo/HandOffPrinter.h"
#include "orvo/HandOffStore.h"
#include "platform/foundation/Environment.h"
#include "platform/foundation/RunLoop.h"
#include "platform/launchservices/ApplicationLauncher.h"
#include "platform/launchservices/ApplicationService.h"
#include "platform/mapuikit/DesktopSystemController.h"

namespace orvo::HandOffReceiver {

namespace {

/// Nil when the running instance took it.
std::shared_ptr<NSError> giveToRunning(const HandOff& handOff) {
    std::shared_ptr<NSError> error;
    bool isDone = false;
    const auto done = [&](const std::shared_ptr<NSError>& answer) {
        error = answer;
        isDone = true;
    };
    const auto launcher = ApplicationLauncher::sharedLauncher();
    if (handOff.url())
        launcher->openURLs(ApplicationIdentifier, {*handOff.url()}, done);
    else
        launcher->activateAction(
            ApplicationIdentifier, DesktopSystemController::Action, handOff.activity(), done);
    CommandContext::waitUntil([&] { return isDone; });
    return error;
}

bool isForAnotherApplication(const NSError& error) {
    return error.domain() == HandOffErrorDomain &&
           error.code() == static_cast<std::int64_t>(HandOffErrorCode::NotOurs);
}

} // namespace

std::shared_ptr<NSError> take(const HandOff& handOff, CommandContext& context, Audience audience) {
    std::shared_ptr<NSError> error;
    const auto content = handOff.content(&error);
    if (!content)
        return error;
    if ((error = HandOffStore::keep(handOff)))
        return error;
    return audience == Audience::Terminal ? HandOffPrinter(context).print(*content) : nullptr;
}

ExitCode takeForCommand(const HandOff& handOff, CommandContext& context) {
    // The thread that asks for the main run loop first is the main thread.
    (void)RunLoop::main();
    std::shared_ptr<NSError> error;
    const auto content = handOff.content(&error);
    if (!content)
        return isForAnotherApplication(*error) ? context.wrongUsage(error->localizedDescription())
                                               : context.fail(*error);
    const bool isForRunning = !Environment::keepsWritesInMemory().get() &&
                              ApplicationService::isRunning(ApplicationIdentifier);
    error = isForRunning ? giveToRunning(handOff) : HandOffStore::keep(handOff);
    const auto untold = HandOffPrinter(context).print(*content);
    if (error)
        return context.fail(*error);
    return untold ? context.fail(*untold) : ExitCode::Answered;
}

} // namespace orvo::HandOffReceiver
