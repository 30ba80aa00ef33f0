#pragma once

#include <functional>
#include <memory>
#include <optional>

namespace orvo {

/// What a run loop waits with. Used on the loop's own thread.
class LoopPort {
public:
    LoopPort() = default;
    LoopPort(const LoopPort&) = delete;
    LoopPort& operator=(const LoopPort&) = delete;
    virtual ~LoopPort() = default;

    /// Stands on the toolkit's event loop, and makes an application object if there is none.
    [[nodiscard]] static std::unique_ptr<LoopPort> application();
    /// Waits for file descriptors and nothing else.
    [[nodiscard]] static std::unique_ptr<LoopPort> plain();

    /// Calls `ready` in a turn in which the descriptor is readable. For the port's whole life.
    virtual void watch(int fileDescriptor, std::function<void()> ready) = 0;
    /// One turn: waits until something is there, at most the seconds given (0: not at all; nothing
    /// given: without end), and hands it out.
    virtual void turn(std::optional<double> longestWait) = 0;
    /// Turns until `leave`, and answers the code given there. Nests.
    virtual int run() = 0;
    /// Ends the innermost `run` after the turn under way. False when there is none.
    virtual bool leave(int exitCode) = 0;
};

} // namespace orvo
