#include "platform/foundation/NSArray.h"

#include "platform/foundation/Hashing.h"

#include <algorithm>
#include <fmt/format.h>

namespace orvo {

std::shared_ptr<NSArray> NSArray::array() {
    return std::make_shared<NSArray>();
}

std::shared_ptr<NSArray> NSArray::arrayWithObjects(Elements elements) {
    if (std::ranges::find(elements, nullptr) != elements.end())
        throw NSInvalidArgumentException("attempt to insert nil object into an array");
    auto result = std::make_shared<NSArray>();
    result->_elements = std::move(elements);
    return result;
}

const std::shared_ptr<NSObject>& NSArray::objectAtIndex(std::size_t index) const {
    if (index >= _elements.size())
        throw NSInvalidArgumentException(fmt::format(
            "index {} beyond bounds of an array of {} elements", index, _elements.size()));
    return _elements[index];
}

void NSArray::enumerate(const std::function<bool(const std::shared_ptr<NSObject>&)>& visit) const {
    for (const auto& element : _elements)
        if (!visit(element))
            return;
}

bool NSArray::isEqual(const NSObject* other) const {
    const auto* array = dynamic_cast<const NSArray*>(other);
    return array && std::ranges::equal(_elements,
                                       array->_elements,
                                       [](const auto& a, const auto& b) { return equal(a, b); });
}

std::uint64_t NSArray::hash() const {
    std::uint64_t hash = _elements.size();
    for (const auto& element : _elements)
        hash = hash * 31 + element->hash();
    return hash;
}

std::string NSArray::description() const {
    std::string text = "(";
    for (const auto& element : _elements) {
        if (text.size() > 1)
            text += ", ";
        text += element->description();
    }
    return text + ")";
}

std::shared_ptr<NSObject> NSArray::copy() const {
    return std::const_pointer_cast<NSObject>(shared_from_this());
}

void throwWrongElementClass(const NSObject& element, const char* typeName) {
    throw NSInvalidArgumentException(fmt::format(
        "an element of class {} stands where {} is expected", element.className(), typeName));
}

} // namespace orvo
