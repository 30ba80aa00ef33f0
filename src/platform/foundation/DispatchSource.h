#pragma once

#include "platform/foundation/DispatchQueue.h"
#include "platform/foundation/EnvironmentSlot.h"
#include "platform/foundation/NSObject.h"

#include <cstdint>
#include <functional>
#include <memory>

namespace orvo {

/// Memory becomes scarce: on the machine, or for this program within the limit it has been given.
enum class MemoryPressure : std::uint32_t {
    Warning = 0x2,
    Critical = 0x4,
    ProcessLimitWarning = 0x10,
    ProcessLimitCritical = 0x20,
};

/// Calls its handler on a queue whenever something happens. Nothing happens before it is activated,
/// or after it is cancelled; a handler already on the queue may still run. Main thread.
class DispatchSource : public virtual NSObject {
public:
    /// For one degree of scarcity.
    [[nodiscard]] static std::shared_ptr<DispatchSource>
    memoryPressureSource(MemoryPressure mask, std::shared_ptr<DispatchQueue> queue);

    using Factory = std::function<std::shared_ptr<DispatchSource>(MemoryPressure,
                                                                  std::shared_ptr<DispatchQueue>)>;
    /// What makes them. Default: `MemoryPressureSource`.
    static EnvironmentSlot<Factory>& memoryPressureFactory();

    /// Before it is activated.
    virtual void setEventHandler(DispatchQueue::Block handler) = 0;
    virtual void activate() = 0;
    /// Once is enough; more does nothing.
    virtual void cancel() = 0;
};

} // namespace orvo
