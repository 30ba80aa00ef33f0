#pragma once

#include "platform/foundation/WakeSignal.h"

#include <deque>
#include <functional>
#include <memory>
#include <mutex>
#include <thread>

namespace orvo {

/// A thread with an event loop of the toolkit's, for objects that live there. Blocks are handed
/// over through a list and a signal of our own, so that all that crosses the threads is guarded by
/// one lock that the thread sanitizer sees.
class _NetworkThread : public std::enable_shared_from_this<_NetworkThread> {
public:
    using Block = std::function<void()>;

    /// `last` is what the thread does before it ends.
    explicit _NetworkThread(Block last);
    _NetworkThread(const _NetworkThread&) = delete;
    _NetworkThread& operator=(const _NetworkThread&) = delete;

    /// Starts the thread when there is none yet. Blocks run in order. After `end()` nothing
    /// happens. Any thread.
    void async(Block block);
    /// Ends the thread and waits for that, unless this is the thread. Blocks that have not run are
    /// dropped. It comes by itself when the process ends. Any thread.
    void end();

private:
    void run();
    /// False when the thread is to end.
    [[nodiscard]] bool runBlocks();

    const Block _last;
    WakeSignal _signal;
    std::mutex _mutex;
    std::deque<Block> _blocks;
    bool _isEnding = false;
    std::thread _thread;
};

} // namespace orvo
