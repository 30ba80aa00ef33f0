#include "shared/NSObject_OrvoSharedExtras.h"

#include "platform/foundation/DispatchQueue.h"
#include "platform/foundation/NSMutableSet.h"
#include "platform/foundation/NSNumber.h"
#include "platform/foundation/NSString.h"
#include "shared/OrvoPerformSelector.h"

namespace orvo::OrvoSharedExtras {

namespace {

// Associated objects are found by the address of their key.
constexpr char pendingSelectorsKey = 0;
constexpr char scheduledKey = 0;

std::shared_ptr<NSMutableSet> pendingSelectors(const NSObject& self) {
    return std::dynamic_pointer_cast<NSMutableSet>(self.associatedObject(&pendingSelectorsKey));
}

std::shared_ptr<NSString> nameOf(const Selector& selector) {
    return NSString::string(NSStringFromSelector(selector));
}

void performPendingSelectors(const std::shared_ptr<NSObject>& self) {
    if (const auto pending = pendingSelectors(*self)) {
        const auto names = std::dynamic_pointer_cast<NSFastEnumeration>(pending->copy());
        names->enumerate([&](const std::shared_ptr<NSObject>& name) {
            OrvoPerformSelector(self, NSSelectorFromString(*stringValue(name.get())));
            return true;
        });
    }
    // Only now: what the performed methods asked for goes too, or an update that asks for itself
    // would run for ever.
    self->setAssociatedObject(&pendingSelectorsKey, nullptr, AssociationPolicy::RetainNonatomic);
    self->setAssociatedObject(&scheduledKey, nullptr, AssociationPolicy::CopyNonatomic);
}

void addPendingSelector(const std::shared_ptr<NSObject>& self, const Selector& selector) {
    auto pending = pendingSelectors(*self);
    if (!pending) {
        pending = NSMutableSet::set();
        self->setAssociatedObject(
            &pendingSelectorsKey, pending, AssociationPolicy::RetainNonatomic);
    }
    pending->addObject(nameOf(selector));

    if (self->associatedObject(&scheduledKey))
        return;
    self->setAssociatedObject(
        &scheduledKey, NSNumber::numberWithBool(true), AssociationPolicy::CopyNonatomic);
    DispatchQueue::mainQueue()->async([self] { performPendingSelectors(self); });
}

} // namespace

std::shared_ptr<NSObject> _orvo_objectPassingTest_nextObject(
    std::shared_ptr<NSObject> self,
    const std::function<bool(const std::shared_ptr<NSObject>&)>& test,
    const std::function<std::shared_ptr<NSObject>(const std::shared_ptr<NSObject>&)>& next) {
    auto object = std::move(self);
    while (object && !test(object))
        object = next(object);
    return object;
}

void _orvo_setNeedsUpdateWithSelector(const std::shared_ptr<NSObject>& self,
                                      const Selector& selector) {
    _orvo_setNeedsUpdate_withSelector(self, true, selector);
}

void _orvo_setNeedsUpdate_withSelector(const std::shared_ptr<NSObject>& self,
                                       bool needsUpdate,
                                       const Selector& selector) {
    if (!self)
        return;
    if (needsUpdate)
        addPendingSelector(self, selector);
    else if (const auto pending = pendingSelectors(*self))
        pending->removeObject(*nameOf(selector));
}

bool _orvo_needsUpdateWithSelector(const std::shared_ptr<NSObject>& self,
                                   const Selector& selector) {
    const auto pending = self ? pendingSelectors(*self) : nullptr;
    return pending && pending->containsObject(*nameOf(selector));
}

} // namespace orvo::OrvoSharedExtras
