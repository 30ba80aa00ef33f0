#include "platform/foundation/NSNotificationCenter.h"

#include "platform/foundation/Exceptions.h"

#include <algorithm>
#include <utility>

namespace orvo {

std::shared_ptr<NSNotification>
NSNotification::notificationWithName_object(std::string name, std::shared_ptr<NSObject> object) {
    auto notification = std::make_shared<NSNotification>();
    notification->_name = std::move(name);
    notification->_object = std::move(object);
    return notification;
}

const std::shared_ptr<NSNotificationCenter>& NSNotificationCenter::defaultCenter() {
    static const auto center = std::make_shared<NSNotificationCenter>();
    return center;
}

void NSNotificationCenter::addObserver_selector_name_object(
    const std::shared_ptr<NSObject>& observer,
    Selector selector,
    std::optional<std::string> name,
    const std::shared_ptr<NSObject>& object) {
    if (!observer || !observer->respondsToSelector(selector))
        throw NSInvalidArgumentException("an observer must respond to " + selector.name());
    std::erase_if(_registrations, [](const auto& one) { return one->observer.expired(); });
    _registrations.push_back(std::make_shared<Registration>(Registration{
        observer, observer.get(), std::move(selector), std::move(name), object.get()}));
}

void NSNotificationCenter::removeObserver(const NSObject& observer) {
    std::erase_if(_registrations, [&](const auto& one) {
        // An address alone may be that of an earlier object that has gone.
        one->isRemoved = one->address == &observer || one->observer.expired();
        return one->isRemoved;
    });
}

void NSNotificationCenter::postNotificationName_object(std::string name,
                                                       std::shared_ptr<NSObject> object) {
    const auto notification =
        NSNotification::notificationWithName_object(std::move(name), std::move(object));
    const auto registrations = _registrations; // observers may add and remove meanwhile
    for (const auto& one : registrations) {
        const bool concerned = (!one->name || *one->name == notification->name()) &&
                               (!one->object || one->object == notification->object().get());
        if (!concerned || one->isRemoved)
            continue;
        if (const auto observer = one->observer.lock())
            observer->performSelector_withObject(one->selector, notification);
    }
}

std::size_t NSNotificationCenter::_observerCount() const {
    return static_cast<std::size_t>(std::ranges::count_if(
        _registrations, [](const auto& one) { return !one->observer.expired(); }));
}

} // namespace orvo
