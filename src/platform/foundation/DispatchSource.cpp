#include "platform/foundation/DispatchSource.h"

#include "platform/foundation/MemoryPressureSource.h"

#include <utility>

namespace orvo {

std::shared_ptr<DispatchSource>
DispatchSource::memoryPressureSource(MemoryPressure mask, std::shared_ptr<DispatchQueue> queue) {
    return memoryPressureFactory().get()(mask, std::move(queue));
}

EnvironmentSlot<DispatchSource::Factory>& DispatchSource::memoryPressureFactory() {
    static EnvironmentSlot<Factory> slot([] {
        return Factory([](MemoryPressure mask, std::shared_ptr<DispatchQueue> queue) {
            return std::make_shared<MemoryPressureSource>(mask, std::move(queue));
        });
    });
    return slot;
}

} // namespace orvo
