#pragma once

#include "platform/foundation/NSOrderedSet.h"

#include <map>

namespace orvo {

/// A set by content that can grow and shrink. It enumerates in order of adding. Not synchronised.
class NSMutableSet final : public NSFastEnumeration, public NSCopying {
public:
    [[nodiscard]] static std::shared_ptr<NSMutableSet> set();

    [[nodiscard]] std::size_t count() const noexcept { return _elements.size(); }
    [[nodiscard]] bool containsObject(const NSObject& object) const;
    /// Nothing when an equal element is there.
    /// @throws NSInvalidArgumentException for nil
    void addObject(const std::shared_ptr<NSObject>& object);
    void removeObject(const NSObject& object);

    /// Changes made by `visit` do not disturb the walk only over a `copy()`.
    void
    enumerate(const std::function<bool(const std::shared_ptr<NSObject>&)>& visit) const override;
    /// The same elements, in whatever order.
    [[nodiscard]] bool isEqual(const NSObject* other) const override;
    [[nodiscard]] std::uint64_t hash() const override;
    [[nodiscard]] std::string description() const override;
    /// An immutable `NSOrderedSet` of the elements now.
    [[nodiscard]] std::shared_ptr<NSObject> copy() const override;

private:
    std::map<std::size_t, std::shared_ptr<NSObject>> _elements; // by number of adding
    std::size_t _nextNumber = 0;
    KeyIndex _index;
};

} // namespace orvo
