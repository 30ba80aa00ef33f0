#include "print/TerminationSignals.h"

#include <pthread.h>

namespace orvo {

namespace {

/// Only ever sent to the waiting thread, by the destructor.
constexpr int EndOfWaiting = SIGUSR1;

} // namespace

TerminationSignals::TerminationSignals(std::function<void()> handler) {
    sigemptyset(&_waited);
    for (const int signal : {SIGINT, SIGTERM, EndOfWaiting})
        sigaddset(&_waited, signal);
    pthread_sigmask(SIG_BLOCK, &_waited, &_earlier);
    _thread = std::thread([waited = _waited, handler = std::move(handler)] {
        int signal = 0;
        while (sigwait(&waited, &signal) == 0 && signal != EndOfWaiting)
            handler();
    });
}

TerminationSignals::~TerminationSignals() {
    pthread_kill(_thread.native_handle(), EndOfWaiting);
    _thread.join();
    pthread_sigmask(SIG_SETMASK, &_earlier, nullptr);
}

} // namespace orvo
