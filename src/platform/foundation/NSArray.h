#pragma once

#include "platform/foundation/Exceptions.h"
#include "platform/foundation/NSObject.h"

#include <initializer_list>
#include <vector>

namespace orvo {

/// An immutable list of objects. A null `NSArray` pointer is nil; an array without elements is
/// empty. Elements are never nil.
class NSArray final : public NSFastEnumeration, public NSCopying {
public:
    using Elements = std::vector<std::shared_ptr<NSObject>>;

    [[nodiscard]] static std::shared_ptr<NSArray> array();
    /// @throws NSInvalidArgumentException for a nil element
    [[nodiscard]] static std::shared_ptr<NSArray> arrayWithObjects(Elements elements);
    /// The same of a vector of one class.
    template <class T>
    [[nodiscard]] static std::shared_ptr<NSArray>
    arrayOf(const std::vector<std::shared_ptr<T>>& elements) {
        return arrayWithObjects(Elements(elements.begin(), elements.end()));
    }
    template <class T>
    [[nodiscard]] static std::shared_ptr<NSArray>
    arrayOf(std::initializer_list<std::shared_ptr<T>> elements) {
        return arrayWithObjects(Elements(elements.begin(), elements.end()));
    }

    [[nodiscard]] std::size_t count() const noexcept { return _elements.size(); }
    /// @throws NSInvalidArgumentException past the end
    [[nodiscard]] const std::shared_ptr<NSObject>& objectAtIndex(std::size_t index) const;
    [[nodiscard]] const Elements& elements() const noexcept { return _elements; }

    void
    enumerate(const std::function<bool(const std::shared_ptr<NSObject>&)>& visit) const override;
    /// Element by element with `isEqual:`.
    [[nodiscard]] bool isEqual(const NSObject* other) const override;
    /// From the elements' own hashes, so arrays of equal elements hash alike.
    [[nodiscard]] std::uint64_t hash() const override;
    /// `(a, b)`.
    [[nodiscard]] std::string description() const override;
    [[nodiscard]] std::shared_ptr<NSObject> copy() const override;

private:
    Elements _elements;
};

[[noreturn]] void throwWrongElementClass(const NSObject& element, const char* typeName);

/// The elements of an array as objects of class T. A nil array reads as empty.
/// @throws NSInvalidArgumentException when an element is not of that class
template <class T>
[[nodiscard]] std::vector<std::shared_ptr<T>> typed(const NSArray* array) {
    std::vector<std::shared_ptr<T>> result;
    if (!array)
        return result;
    result.reserve(array->count());
    for (const auto& element : array->elements()) {
        auto cast = std::dynamic_pointer_cast<T>(element);
        if (!cast)
            throwWrongElementClass(*element, typeid(T).name());
        result.push_back(std::move(cast));
    }
    return result;
}
template <class T>
[[nodiscard]] std::vector<std::shared_ptr<T>> typed(const std::shared_ptr<NSArray>& array) {
    return typed<T>(array.get());
}

} // namespace orvo
