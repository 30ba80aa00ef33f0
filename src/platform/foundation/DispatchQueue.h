#pragma once

#include <functional>
#include <memory>
#include <string>

namespace orvo {

/// Runs blocks later, never inside the call that submits them. Any thread may submit.
class DispatchQueue {
public:
    using Block = std::function<void()>;

    DispatchQueue() = default;
    DispatchQueue(const DispatchQueue&) = delete;
    DispatchQueue& operator=(const DispatchQueue&) = delete;
    virtual ~DispatchQueue() = default;

    /// The main thread's: its blocks run in order of submission, in turns of `RunLoop::main()`.
    [[nodiscard]] static const std::shared_ptr<DispatchQueue>& mainQueue();
    /// Worker threads, a few for the process; blocks run side by side and in no certain order.
    [[nodiscard]] static const std::shared_ptr<DispatchQueue>& globalQueue();
    /// A thread of its own: blocks run one after the other, in order of submission. Blocks
    /// submitted before the last reference goes still run; the last reference may go inside one of
    /// them.
    [[nodiscard]] static std::shared_ptr<DispatchQueue> serialQueue(std::string label);

    virtual void async(Block block) = 0;
    /// Whether the caller runs on this queue.
    [[nodiscard]] virtual bool isCurrent() const = 0;
};

} // namespace orvo
