#pragma once

#include <csignal>
#include <functional>
#include <thread>

namespace orvo {

/// Turns the signals that ask the program to end (SIGINT, SIGTERM) into a call, for its lifetime.
/// Made before the program has other threads, which would take the signals otherwise.
class TerminationSignals {
public:
    /// `handler` is called for each signal, on a thread of its own.
    explicit TerminationSignals(std::function<void()> handler);
    TerminationSignals(const TerminationSignals&) = delete;
    TerminationSignals& operator=(const TerminationSignals&) = delete;
    ~TerminationSignals();

private:
    sigset_t _waited{};
    sigset_t _earlier{};
    std::thread _thread;
};

} // namespace orvo
