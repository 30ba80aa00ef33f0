#include "platform/foundation/NSMutableSet.h"

#include "platform/foundation/Exceptions.h"

#include <algorithm>

namespace orvo {

std::shared_ptr<NSMutableSet> NSMutableSet::set() {
    return std::make_shared<NSMutableSet>();
}

bool NSMutableSet::containsObject(const NSObject& object) const {
    return _index.find(object).has_value();
}

void NSMutableSet::addObject(const std::shared_ptr<NSObject>& object) {
    if (!object)
        throw NSInvalidArgumentException("attempt to insert nil object into a set");
    if (_index.find(*object))
        return;
    _index.insert(*object, _nextNumber);
    _elements.emplace(_nextNumber++, object);
}

void NSMutableSet::removeObject(const NSObject& object) {
    const auto number = _index.find(object);
    if (!number)
        return;
    const auto element =
        _elements.at(*number); // kept to the end: `object` may be this very element
    _index.erase(*element);
    _elements.erase(*number);
}

void NSMutableSet::enumerate(
    const std::function<bool(const std::shared_ptr<NSObject>&)>& visit) const {
    for (const auto& [number, element] : _elements)
        if (!visit(element))
            return;
}

bool NSMutableSet::isEqual(const NSObject* other) const {
    const auto* set = dynamic_cast<const NSMutableSet*>(other);
    return set && set->count() == count() && std::ranges::all_of(_elements, [&](const auto& entry) {
               return set->containsObject(*entry.second);
           });
}

std::uint64_t NSMutableSet::hash() const {
    std::uint64_t hash = _elements.size();
    for (const auto& [number, element] : _elements)
        hash += element->hash();
    return hash;
}

std::string NSMutableSet::description() const {
    return copy()->description();
}

std::shared_ptr<NSObject> NSMutableSet::copy() const {
    NSOrderedSet::Elements elements;
    for (const auto& [number, element] : _elements)
        elements.push_back(element);
    return NSOrderedSet::orderedSetWithObjects(elements);
}

} // namespace orvo
