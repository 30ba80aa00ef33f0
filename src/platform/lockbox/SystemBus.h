#pragma once

#include <chrono>
#include <optional>

struct sd_bus;

namespace orvo::lockbox {

/// A connection of its own to the system bus, with one span of patience for everything that is
/// asked of it: nothing here waits longer than that, whatever the other side does. One thread.
class SystemBus {
public:
    static constexpr std::chrono::milliseconds Patience{200};

    /// Connects; a bus that is not there, or does not answer, shows in the questions.
    SystemBus();
    SystemBus(const SystemBus&) = delete;
    SystemBus& operator=(const SystemBus&) = delete;
    ~SystemBus();

    /// A truth value among an object's properties; nothing when it cannot be had in time. The
    /// service is not started for it.
    [[nodiscard]] std::optional<bool> readFlag(const char* service,
                                               const char* path,
                                               const char* interface,
                                               const char* property) noexcept;

private:
    /// Until the patience ends; never negative.
    [[nodiscard]] std::chrono::microseconds timeLeft() const noexcept;
    [[nodiscard]] bool waitUntilReady() noexcept;

    std::chrono::steady_clock::time_point _deadline = std::chrono::steady_clock::now() + Patience;
    sd_bus* _bus = nullptr;
};

} // namespace orvo::lockbox
