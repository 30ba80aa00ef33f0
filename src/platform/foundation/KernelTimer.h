#pragma once

namespace orvo {

/// One alarm on the machine's time of day. It goes off at its moment also when the clock is set or
/// the machine was asleep, and as soon as somebody sets the clock.
class KernelTimer {
public:
    /// @throws std::system_error when the process may open no more files
    KernelTimer();
    KernelTimer(const KernelTimer&) = delete;
    KernelTimer& operator=(const KernelTimer&) = delete;
    ~KernelTimer();

    /// Readable when the alarm has gone off.
    [[nodiscard]] int fileDescriptor() const noexcept { return _fd; }
    /// Seconds from now by the machine's time of day, in place of what was armed. Below 0 counts as
    /// 0; what is decades away is brought nearer, so that the clock's being set is still noticed.
    void armIn(double seconds) noexcept;
    void disarm() noexcept;
    /// Takes note that it went off.
    void acknowledge() noexcept;

private:
    int _fd;
};

} // namespace orvo
