#pragma once

#include "platform/foundation/DispatchQueue.h"

#include <condition_variable>
#include <cstddef>
#include <deque>
#include <mutex>

namespace orvo {

/// Blocks on their way to the worker threads that wait for them. Any thread.
class BlockList {
public:
    /// What `append` found.
    enum class Waiters { Enough, TooFew, Closed };

    /// Says whether more blocks lie here than threads wait. A closed list drops the block.
    Waiters append(DispatchQueue::Block block);
    /// The first block; waits for one. Empty when the list is closed and holds no more.
    [[nodiscard]] DispatchQueue::Block take();
    /// No more blocks are accepted; those in the list are still handed out.
    void finish();
    /// No more blocks are accepted, and those in the list are dropped.
    void abandon();

private:
    std::mutex _mutex;
    std::condition_variable _changed;
    std::deque<DispatchQueue::Block> _blocks;
    std::size_t _waiting = 0;
    bool _closed = false;
};

} // namespace orvo
