#pragma once

#include "platform/foundation/DispatchQueue.h"
#include "platform/foundation/WakeSignal.h"

#include <cstdint>
#include <deque>
#include <mutex>

namespace orvo {

/// The main thread's queue: a list of blocks, and a signal that is up while blocks wait in it.
class MainQueue final : public DispatchQueue {
public:
    [[nodiscard]] static const std::shared_ptr<MainQueue>& shared();

    void async(Block block) override;
    [[nodiscard]] bool isCurrent() const override;

    /// To be watched by the main thread's run loop; readable while blocks wait.
    [[nodiscard]] int fileDescriptor() const noexcept { return _signal.fileDescriptor(); }
    /// Runs the blocks submitted before the call, in order. A block may turn the run loop: the
    /// inner turn takes up the rest.
    void drain();

private:
    [[nodiscard]] Block takeSubmittedBefore(std::uint64_t end);
    void raise();

    std::mutex _mutex;
    std::deque<Block> _blocks;
    std::uint64_t _firstNumber = 0; // of the block at the front
    bool _raised = false;
    WakeSignal _signal;
};

} // namespace orvo
