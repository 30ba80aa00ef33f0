#include "platform/foundation/DispatchQueue.h"

#include "platform/foundation/MainQueue.h"
#include "platform/foundation/WorkerThreads.h"

#include <algorithm>
#include <thread>

namespace orvo {

namespace {

/// Blocks in order on one thread, which starts with the first of them.
class SerialQueue final : public DispatchQueue {
public:
    explicit SerialQueue(std::string label)
        : _label(std::move(label))
        , _list(std::make_shared<BlockList>()) {}
    // Does not wait for the thread: the caller may be what its last block waits for, or be it.
    ~SerialQueue() override { _list->finish(); }

    void async(Block block) override {
        _list->append(std::move(block));
        std::call_once(_started, [&] { WorkerThreads::shared().start(_list, _label); });
    }
    [[nodiscard]] bool isCurrent() const override { return WorkerThreads::runs(*_list); }

private:
    std::string _label;
    std::shared_ptr<BlockList> _list;
    std::once_flag _started;
};

/// Starts another thread, up to a few, when a block finds all of them busy. They stay.
class GlobalQueue final : public DispatchQueue {
public:
    void async(Block block) override {
        if (_list->append(std::move(block)) != BlockList::Waiters::TooFew)
            return;
        const std::lock_guard lock(_mutex);
        if (_threads == mostThreads())
            return;
        ++_threads;
        WorkerThreads::shared().start(_list, "worker");
    }
    [[nodiscard]] bool isCurrent() const override { return WorkerThreads::runs(*_list); }

private:
    // Blocks also wait for disks and networks, so a small machine gets more than its cores.
    static unsigned mostThreads() {
        return std::clamp(std::thread::hardware_concurrency(), 4U, 8U);
    }

    std::shared_ptr<BlockList> _list = std::make_shared<BlockList>();
    std::mutex _mutex;
    unsigned _threads = 0;
};

} // namespace

const std::shared_ptr<DispatchQueue>& DispatchQueue::mainQueue() {
    static const auto& queue = *new std::shared_ptr<DispatchQueue>(MainQueue::shared());
    return queue;
}

const std::shared_ptr<DispatchQueue>& DispatchQueue::globalQueue() {
    static const auto& queue = *new std::shared_ptr<DispatchQueue>(std::make_shared<GlobalQueue>());
    return queue;
}

std::shared_ptr<DispatchQueue> DispatchQueue::serialQueue(std::string label) {
    return std::make_shared<SerialQueue>(std::move(label));
}

} // namespace orvo
