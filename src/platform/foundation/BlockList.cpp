#include "platform/foundation/BlockList.h"

namespace orvo {

BlockList::Waiters BlockList::append(DispatchQueue::Block block) {
    const std::lock_guard lock(_mutex);
    if (_closed)
        return Waiters::Closed;
    _blocks.push_back(std::move(block));
    _changed.notify_one();
    return _blocks.size() > _waiting ? Waiters::TooFew : Waiters::Enough;
}

DispatchQueue::Block BlockList::take() {
    std::unique_lock lock(_mutex);
    ++_waiting;
    _changed.wait(lock, [&] { return _closed || !_blocks.empty(); });
    --_waiting;
    if (_blocks.empty())
        return {};
    auto block = std::move(_blocks.front());
    _blocks.pop_front();
    return block;
}

void BlockList::finish() {
    const std::lock_guard lock(_mutex);
    _closed = true;
    _changed.notify_all();
}

void BlockList::abandon() {
    std::deque<DispatchQueue::Block> dropped; // their captures go after the lock
    const std::lock_guard lock(_mutex);
    _closed = true;
    dropped.swap(_blocks);
    _changed.notify_all();
}

} // namespace orvo
