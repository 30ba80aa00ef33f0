#pragma once

#include "platform/foundation/NSDate.h"
#include "platform/foundation/NSObject.h"
#include "platform/foundation/Selector.h"

#include <functional>

namespace orvo {

/// Calls back at a date of the wall clock. It follows the time of day through suspend and clock
/// changes: a date is reached at the date. It never fires before the clock shows later than its
/// date, and at most its tolerance after that while the thread's run loop turns. A scheduled timer
/// is kept alive by its run loop, and keeps its target (or block) alive, until it is invalidated;
/// one that does not repeat is invalidated after it has fired. A repeating timer keeps its phase
/// and skips the dates that it missed. Used on the thread that scheduled it; all timers of a thread
/// that ends are invalidated.
class NSTimer final : public virtual NSObject {
public:
    using Block = std::function<void(const std::shared_ptr<NSTimer>& timer)>;

    /// On the current run loop. The target's method gets the timer as its sender. An interval that
    /// is not above 0 counts as 0.1 ms. `userInfo` may be nil.
    /// @throws NSInvalidArgumentException for a nil target, or one that does not respond to the
    /// selector; for an empty block
    static std::shared_ptr<NSTimer> scheduledTimerWithTimeInterval_target_selector_userInfo_repeats(
        NSTimeInterval interval,
        std::shared_ptr<NSObject> target,
        Selector selector,
        std::shared_ptr<NSObject> userInfo,
        bool repeats);
    static std::shared_ptr<NSTimer> scheduledTimerWithTimeInterval_repeats_block(
        NSTimeInterval interval, bool repeats, Block block);

    ~NSTimer() override;

    /// 0 for one that does not repeat.
    [[nodiscard]] NSTimeInterval timeInterval() const noexcept;
    [[nodiscard]] bool repeats() const noexcept;
    [[nodiscard]] std::shared_ptr<NSObject> userInfo() const;
    /// The next date at which it fires; that of an invalid timer is its last one.
    [[nodiscard]] std::shared_ptr<NSDate> fireDate() const;
    /// A date in the past is reached in the next turn of the run loop. Nothing for an invalid
    /// timer.
    /// @throws NSInvalidArgumentException for nil
    void setFireDate(const std::shared_ptr<NSDate>& date);
    /// Seconds by which it may be late so that wake-ups can be shared; 0 at first. A repeating
    /// timer's next date is counted from its dates, not from its lateness.
    [[nodiscard]] NSTimeInterval tolerance() const noexcept;
    void setTolerance(NSTimeInterval seconds);

    [[nodiscard]] bool isValid() const noexcept;
    /// Fires now, whatever the date, which stays; one that does not repeat is then invalid. Nothing
    /// for an invalid timer.
    void fire();
    /// It never fires again, and lets its target go. Once is enough; more does nothing.
    void invalidate();

private:
    friend class RunLoop;

    /// The date has come.
    void reachDate(double now);
    void call();
    void reschedule();

    struct Private;
    std::unique_ptr<Private> _private;

public:
    /// For the functions above.
    NSTimer();
};

} // namespace orvo
