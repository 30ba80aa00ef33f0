#pragma once

#include "platform/foundation/DispatchSource.h"

#include <memory>

namespace orvo {

/// Waits for the kernel to tell that memory becomes scarce; costs nothing while it waits. Silent
/// where the kernel does not tell.
class MemoryPressureSource final : public DispatchSource {
public:
    MemoryPressureSource(MemoryPressure mask, std::shared_ptr<DispatchQueue> queue);
    ~MemoryPressureSource() override;

    void setEventHandler(DispatchQueue::Block handler) override;
    void activate() override;
    void cancel() override;

private:
    struct Private;
    std::unique_ptr<Private> _private;
};

} // namespace orvo
