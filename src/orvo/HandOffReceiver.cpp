#include "orvo/HandOffReceiver.h"

#include "orvo/HandOffError.h"
#include "orvo/HandOffPrinter.h"
#include "orvo/HandOffService.h"
#include "orvo/HandOffStore.h"
#include "orvo/HandOffWindows.h"
#include "platform/foundation/Environment.h"
#include "platform/foundation/RunLoop.h"
#include "platform/launchservices/ApplicationLauncher.h"
#include "platform/launchservices/ApplicationService.h"
#include "platform/mapuikit/DesktopSystemController.h"

#include <ostream>

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

bool isServedByAnother(const NSError& error) {
    return error.domain() == LaunchServicesErrorDomain &&
           error.code() == static_cast<std::int64_t>(LaunchServicesErrorCode::AlreadyRuns);
}

/// Shows it in this process, and whatever is handed over to it until the last window is closed.
/// Nothing when another instance was quicker to serve.
std::optional<ExitCode> showUntilClosed(const HandOff& handOff,
                                        CommandContext& context,
                                        Audience audience,
                                        HandOffWindows& windows) {
    std::shared_ptr<NSError> error;
    HandOffService handler(
        context.terminal(), [] {}, &windows);
    // Without a bus nobody can hand over to this one; it can show all the same.
    const auto service = ApplicationService::start(ApplicationIdentifier, handler, &error);
    if (!service && isServedByAnother(*error))
        return std::nullopt;
    const bool isTerminal = context.terminal().settings().outputIsTerminal;
    error = take(handOff,
                 context,
                 isTerminal ? audience : Audience::Nobody,
                 [&](const HandOff::Content& content) { windows.show(content, context, {}); });
    if (error)
        return context.fail(*error);
    context.terminal().output().flush();
    windows.setAllClosed([] { RunLoop::main().stop(); });
    RunLoop::main().run();
    return ExitCode::Answered;
}

} // namespace

std::shared_ptr<NSError>
take(const HandOff& handOff, CommandContext& context, Audience audience, const Showing& showing) {
    std::shared_ptr<NSError> error;
    const auto content = handOff.content(&error);
    if (!content)
        return error;
    if ((error = HandOffStore::keep(handOff)))
        return error;
    if (showing)
        showing(*content);
    return audience == Audience::Terminal ? HandOffPrinter(context).print(*content) : nullptr;
}

ExitCode takeForCommand(const HandOff& handOff, CommandContext& context, Audience audience) {
    // The thread that asks for the main run loop first is the main thread.
    (void)RunLoop::main();
    std::shared_ptr<NSError> error;
    const auto content = handOff.content(&error);
    if (!content)
        return isForAnotherApplication(*error) ? context.wrongUsage(error->localizedDescription())
                                               : context.fail(*error);
    const bool isKept = !Environment::keepsWritesInMemory().get();
    bool isForRunning = isKept && ApplicationService::isRunning(ApplicationIdentifier);
    const auto windows = isForRunning || !isKept ? nullptr : HandOffWindows::make();
    if (windows) {
        if (const auto code = showUntilClosed(handOff, context, audience, *windows))
            return *code;
        isForRunning = true;
    }
    error = isForRunning ? giveToRunning(handOff) : HandOffStore::keep(handOff);
    const auto untold =
        audience == Audience::Terminal ? HandOffPrinter(context).print(*content) : nullptr;
    if (error)
        return context.fail(*error);
    return untold ? context.fail(*untold) : ExitCode::Answered;
}

} // namespace orvo::HandOffReceiver
