#include "shared/OrvoMap.h"

namespace orvo {

std::shared_ptr<NSArray>
OrvoMap(const std::shared_ptr<const NSFastEnumeration>& collection,
        const std::function<std::shared_ptr<NSObject>(const std::shared_ptr<NSObject>& element,
                                                      std::size_t index)>& block) {
    if (!collection)
        return nullptr;
    NSArray::Elements results;
    std::size_t index = 0;
    collection->enumerate([&](const std::shared_ptr<NSObject>& element) {
        if (auto result = block(element, index))
            results.push_back(std::move(result));
        ++index;
        return true;
    });
    return NSArray::arrayWithObjects(std::move(results));
}

} // namespace orvo
