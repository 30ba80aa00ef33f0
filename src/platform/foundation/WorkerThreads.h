#pragma once

#include "platform/foundation/BlockList.h"

#include <memory>
#include <string>
#include <vector>

namespace orvo {

/// Every worker thread of the process. When the process ends they finish the blocks that they are
/// in, later blocks are dropped, and the end waits for them, but not for ever: a thread that stays
/// in its block is left behind. Any thread.
class WorkerThreads {
public:
    [[nodiscard]] static WorkerThreads& shared();

    /// Starts a thread that runs the blocks of `list` until the list is closed and empty. The
    /// system's tools show the beginning of its name.
    void start(const std::shared_ptr<BlockList>& list, const std::string& name);
    /// Whether the caller is a worker of that list.
    [[nodiscard]] static bool runs(const BlockList& list);
    /// The whole name that the caller's thread was started with; empty where it is no worker.
    [[nodiscard]] static const std::string& currentName();

private:
    WorkerThreads();

    void work(const std::shared_ptr<BlockList>& list, const std::string& name);
    void endAll();

    std::mutex _mutex;
    std::condition_variable _ended;
    std::vector<std::shared_ptr<BlockList>> _lists; // one entry a living thread
    bool _ending = false;
};

} // namespace orvo
