#include "orvo/ServiceCommand.h"

#include "orvo/HandOffService.h"
#include "orvo/HandOffWindows.h"
#include "platform/foundation/NSTimer.h"
#include "platform/foundation/RunLoop.h"
#include "platform/launchservices/ApplicationService.h"

#include <charconv>
#include <fmt/format.h>

namespace orvo {

namespace {

constexpr std::uint32_t StandardIdleSeconds = 600;

std::optional<std::uint32_t> seconds(const std::string& text) {
    std::uint32_t value = 0;
    const char* end = text.data() + text.size();
    const auto result = std::from_chars(text.data(), end, value);
    return result.ec == std::errc() && result.ptr == end ? std::optional(value) : std::nullopt;
}

/// Ends the main run loop when nothing was asked for some time, or nobody can ask any more, and no
/// window is open.
class IdleEnd {
public:
    /// `windows` may be nil.
    IdleEnd(std::uint32_t idleSeconds, const HandOffWindows* windows)
        : _idleSeconds(idleSeconds)
        , _windows(windows) {
        if (_idleSeconds > 0)
            _timer = NSTimer::scheduledTimerWithTimeInterval_repeats_block(
                _idleSeconds, true, [this](const std::shared_ptr<NSTimer>&) {
                    endUnlessLookedAt();
                });
    }
    IdleEnd(const IdleEnd&) = delete;
    IdleEnd& operator=(const IdleEnd&) = delete;
    ~IdleEnd() {
        if (_timer)
            _timer->invalidate();
    }

    void postpone() const {
        if (_timer)
            _timer->setFireDate(NSDate::dateWithTimeIntervalSinceNow(_idleSeconds));
    }
    void busIsGone() {
        _isBusGone = true;
        endUnlessLookedAt();
    }
    void windowsAreClosed() const {
        postpone();
        if (_isBusGone)
            endUnlessLookedAt();
    }

private:
    void endUnlessLookedAt() const {
        if (!_windows || !_windows->isAnyOpen())
            RunLoop::main().stop();
    }

    std::uint32_t _idleSeconds;
    const HandOffWindows* _windows;
    bool _isBusGone = false;
    std::shared_ptr<NSTimer> _timer;
};

} // namespace

CommandSpec ServiceCommand::spec() const {
    return {.path = {"service"},
            .summary = "Serve the map application on the session bus",
            .description =
                "Takes what the widget and the desktop hand over: URLs and activities. The bus "
                "starts it by itself where orvo is installed. On a display it shows each in a "
                "window, on a terminal it tells each; everywhere it keeps the last one for: orvo "
                "show. It ends when nothing has been asked of it for some time and no window is "
                "open, and with its bus.",
            .options = {{"idle",
                         "SECONDS",
                         fmt::format("after how long; {} if you say nothing, 0 for never",
                                     StandardIdleSeconds)}},
            .examples = {{"orvo service --idle 0", "until you press Ctrl-C"}}};
}

ExitCode ServiceCommand::run(const Arguments& arguments, CommandContext& context) {
    const auto given = arguments.value("idle");
    const auto idle = given ? seconds(*given) : StandardIdleSeconds;
    if (!idle)
        return context.wrongUsage(fmt::format("--idle cannot be {}", *given),
                                  "Write a number of seconds.");
    auto& loop = RunLoop::main();
    const auto windows = HandOffWindows::make();
    IdleEnd end(*idle, windows.get());
    HandOffService handler(
        context.terminal(), [&] { end.postpone(); }, windows.get());
    handler.setOnBusGone([&] { end.busIsGone(); });
    if (windows)
        windows->setAllClosed([&] { end.windowsAreClosed(); });
    std::shared_ptr<NSError> error;
    const auto service =
        ApplicationService::start(HandOffReceiver::ApplicationIdentifier, handler, &error);
    if (!service)
        return context.fail(*error);
    loop.run();
    return ExitCode::Answered;
}

} // namespace orvo
