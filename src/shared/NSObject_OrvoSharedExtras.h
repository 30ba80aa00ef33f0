#pragma once

#include "platform/foundation/NSObject.h"

#include <functional>

namespace orvo::OrvoSharedExtras {

/// The first object that passes `test` on the way from `self` through what `next` answers for each;
/// nil when the way ends before. A way that leads in a circle without one that passes has no end.
[[nodiscard]] std::shared_ptr<NSObject> _orvo_objectPassingTest_nextObject(
    std::shared_ptr<NSObject> self,
    const std::function<bool(const std::shared_ptr<NSObject>&)>& test,
    const std::function<std::shared_ptr<NSObject>(const std::shared_ptr<NSObject>&)>& next);

/// Updates that are wanted often and done once. A wanted selector is performed on `self` in a later
/// turn of the main queue, together with all others wanted until then, each once and in no certain
/// order; `self` is kept until that is done. What is wanted from inside a performed method is
/// dropped with the batch. Main thread, without locks. Nothing for a nil `self`.
void _orvo_setNeedsUpdateWithSelector(const std::shared_ptr<NSObject>& self,
                                      const Selector& selector);
/// False withdraws the selector from the batch.
void _orvo_setNeedsUpdate_withSelector(const std::shared_ptr<NSObject>& self,
                                       bool needsUpdate,
                                       const Selector& selector);
/// Whether the selector is wanted. It still is while its batch is performed.
[[nodiscard]] bool _orvo_needsUpdateWithSelector(const std::shared_ptr<NSObject>& self,
                                                 const Selector& selector);

} // namespace orvo::OrvoSharedExtras
