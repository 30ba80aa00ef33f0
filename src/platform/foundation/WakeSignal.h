#pragma once

namespace orvo {

/// A flag of the kernel's that a waiting run loop wakes for. Any thread.
class WakeSignal {
public:
    /// @throws std::system_error when the process may open no more files
    WakeSignal();
    WakeSignal(const WakeSignal&) = delete;
    WakeSignal& operator=(const WakeSignal&) = delete;
    ~WakeSignal();

    /// Readable while the flag is up.
    [[nodiscard]] int fileDescriptor() const noexcept { return _fd; }
    void raise() noexcept;
    void lower() noexcept;

private:
    int _fd;
};

} // namespace orvo
