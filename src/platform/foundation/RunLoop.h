#pragma once

#include "platform/foundation/NSDate.h"

#include <functional>
#include <memory>

namespace orvo {

class NSTimer;
class TimerSchedule;

/// Waits for what comes and hands it out: blocks of the main queue, timers, and whatever the
/// toolkit brings. One a thread; the main thread's stands on the toolkit's event loop, and so works
/// too where that is run by somebody else. But for `main`, `stop` and `isMainThread` used on its
/// own thread.
class RunLoop {
public:
    RunLoop(const RunLoop&) = delete;
    RunLoop& operator=(const RunLoop&) = delete;
    ~RunLoop();

    /// The main thread's. The first call on the main thread makes the application object if there
    /// is none; a program that wants one of its own kind makes it earlier.
    [[nodiscard]] static RunLoop& main();
    /// The calling thread's, made on first use.
    [[nodiscard]] static RunLoop& current();
    /// Whether the caller is the main thread: the one in which the process began.
    [[nodiscard]] static bool isMainThread();

    /// Runs until `stop()`; answers the code given to it. Nests.
    int run();
    /// Ends the innermost `run()`, after the turn under way. Where none is under way the next one
    /// ends at once. Any thread.
    void stop(int exitCode = 0);
    /// Hands out what is ready now, without waiting: blocks submitted before the call, and timers
    /// scheduled before it that are due.
    void runOnce();
    /// Runs until `done` answers true, asked first and after every turn, or until `limit` seconds
    /// of the machine's monotonic time have passed. Answers what `done` answered last.
    bool runUntil(const std::function<bool()>& done, NSTimeInterval limit);

    /// Fires the timers that are due by the environment's clock, and arms the kernel's timer for
    /// the rest. The loop calls it by itself; whoever turns an injected clock calls it afterwards.
    void checkTimers();
    /// How many timers are scheduled and valid.
    [[nodiscard]] std::size_t scheduledTimers() const;

private:
    friend class NSTimer;
    struct Private;
    RunLoop();
    [[nodiscard]] const std::shared_ptr<TimerSchedule>& timers() const;

    std::unique_ptr<Private> _private;
};

} // namespace orvo
