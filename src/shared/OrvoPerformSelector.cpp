#include "shared/OrvoPerformSelector.h"

namespace orvo {

std::shared_ptr<NSObject> OrvoPerformSelector(const std::shared_ptr<NSObject>& object,
                                              const Selector& selector) {
    return object ? object->performSelector(selector) : nullptr;
}

} // namespace orvo
