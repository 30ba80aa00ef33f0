#include "platform/foundation/MainQueue.h"

#include "platform/foundation/RunLoop.h"

namespace orvo {

const std::shared_ptr<MainQueue>& MainQueue::shared() {
    // Never destroyed: workers may submit until the very end of the process.
    static const auto& queue = *new auto(std::make_shared<MainQueue>());
    return queue;
}

void MainQueue::async(Block block) {
    const std::lock_guard lock(_mutex);
    _blocks.push_back(std::move(block));
    raise();
}

bool MainQueue::isCurrent() const {
    return RunLoop::isMainThread();
}

void MainQueue::drain() {
    std::uint64_t end = 0;
    {
        const std::lock_guard lock(_mutex);
        end = _firstNumber + _blocks.size();
        _raised = false;
        _signal.lower();
    }
    while (const auto block = takeSubmittedBefore(end))
        block();
}

DispatchQueue::Block MainQueue::takeSubmittedBefore(std::uint64_t end) {
    const std::lock_guard lock(_mutex);
    if (_blocks.empty() || _firstNumber >= end)
        return {};
    auto block = std::move(_blocks.front());
    _blocks.pop_front();
    ++_firstNumber;
    // The block about to run may wait in an inner turn for one of those behind it.
    if (!_blocks.empty())
        raise();
    return block;
}

void MainQueue::raise() {
    if (!_raised)
        _signal.raise();
    _raised = true;
}

} // namespace orvo
