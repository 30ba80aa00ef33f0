#pragma once

#include "platform/foundation/KeyIndex.h"
#include "platform/foundation/NSObject.h"

#include <vector>

namespace orvo {

class NSArray;

/// An immutable list without two equal elements. It keeps the order in which they were given, the
/// first of equals standing. What stands for a set, too, where nobody asks for an order:
/// enumeration then repeats from run to run.
class NSOrderedSet final : public NSFastEnumeration, public NSCopying {
public:
    using Elements = std::vector<std::shared_ptr<NSObject>>;

    [[nodiscard]] static std::shared_ptr<NSOrderedSet> orderedSet();
    /// @throws NSInvalidArgumentException for a nil element
    [[nodiscard]] static std::shared_ptr<NSOrderedSet>
    orderedSetWithObjects(const Elements& elements);

    [[nodiscard]] std::size_t count() const noexcept { return _elements.size(); }
    [[nodiscard]] bool containsObject(const NSObject& object) const;
    [[nodiscard]] const Elements& elements() const noexcept { return _elements; }
    /// Nil when empty.
    [[nodiscard]] std::shared_ptr<NSObject> firstObject() const;

    void
    enumerate(const std::function<bool(const std::shared_ptr<NSObject>&)>& visit) const override;
    /// The same elements in the same order.
    [[nodiscard]] bool isEqual(const NSObject* other) const override;
    [[nodiscard]] std::uint64_t hash() const override;
    /// `{(a, b)}`.
    [[nodiscard]] std::string description() const override;
    [[nodiscard]] std::shared_ptr<NSObject> copy() const override;

private:
    Elements _elements;
    KeyIndex _index;
};

} // namespace orvo
