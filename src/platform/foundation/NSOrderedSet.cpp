#include "platform/foundation/NSOrderedSet.h"

#include "platform/foundation/Exceptions.h"

#include <algorithm>

namespace orvo {

std::shared_ptr<NSOrderedSet> NSOrderedSet::orderedSet() {
    return std::make_shared<NSOrderedSet>();
}

std::shared_ptr<NSOrderedSet> NSOrderedSet::orderedSetWithObjects(const Elements& elements) {
    auto set = std::make_shared<NSOrderedSet>();
    for (const auto& element : elements) {
        if (!element)
            throw NSInvalidArgumentException("attempt to insert nil object into an ordered set");
        if (set->_index.find(*element))
            continue;
        set->_index.insert(*element, set->_elements.size());
        set->_elements.push_back(element);
    }
    return set;
}

bool NSOrderedSet::containsObject(const NSObject& object) const {
    return _index.find(object).has_value();
}

std::shared_ptr<NSObject> NSOrderedSet::firstObject() const {
    return _elements.empty() ? nullptr : _elements.front();
}

void NSOrderedSet::enumerate(
    const std::function<bool(const std::shared_ptr<NSObject>&)>& visit) const {
    for (const auto& element : _elements)
        if (!visit(element))
            return;
}

bool NSOrderedSet::isEqual(const NSObject* other) const {
    const auto* set = dynamic_cast<const NSOrderedSet*>(other);
    return set && std::ranges::equal(_elements, set->_elements, [](const auto& a, const auto& b) {
               return equal(a, b);
           });
}

std::uint64_t NSOrderedSet::hash() const {
    std::uint64_t hash = _elements.size();
    for (const auto& element : _elements)
        hash = hash * 31 + element->hash();
    return hash;
}

std::string NSOrderedSet::description() const {
    std::string text = "{(";
    for (const auto& element : _elements) {
        if (text.size() > 2)
            text += ", ";
        text += element->description();
    }
    return text + ")}";
}

std::shared_ptr<NSObject> NSOrderedSet::copy() const {
    return std::const_pointer_cast<NSObject>(shared_from_this());
}

} // namespace orvo
