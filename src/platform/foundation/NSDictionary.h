#pragma once

#include "platform/foundation/KeyIndex.h"
#include "platform/foundation/NSObject.h"

#include <string_view>
#include <utility>
#include <vector>

namespace orvo {

/// An immutable map by content of its keys. It enumerates its keys in the order in which they were
/// given; equality ignores the order. Keys and values are never nil.
class NSDictionary final : public NSFastEnumeration, public NSCopying {
public:
    using Entry = std::pair<std::shared_ptr<NSObject>, std::shared_ptr<NSObject>>;
    using Entries = std::vector<Entry>;

    [[nodiscard]] static std::shared_ptr<NSDictionary> dictionary();
    /// A key given twice keeps its first place and its last value.
    /// @throws NSInvalidArgumentException for a nil key or value
    [[nodiscard]] static std::shared_ptr<NSDictionary> dictionaryWithEntries(Entries entries);
    /// The same with text keys.
    [[nodiscard]] static std::shared_ptr<NSDictionary>
    dictionaryWithTextKeys(std::vector<std::pair<std::string, std::shared_ptr<NSObject>>> entries);

    [[nodiscard]] std::size_t count() const noexcept { return _entries.size(); }
    /// Nil when there is none.
    [[nodiscard]] std::shared_ptr<NSObject> objectForKey(const NSObject& key) const;
    [[nodiscard]] std::shared_ptr<NSObject> objectForKey(std::string_view key) const;
    [[nodiscard]] const Entries& entries() const noexcept { return _entries; }

    /// The keys.
    void
    enumerate(const std::function<bool(const std::shared_ptr<NSObject>&)>& visit) const override;
    [[nodiscard]] bool isEqual(const NSObject* other) const override;
    [[nodiscard]] std::uint64_t hash() const override;
    /// `{a = 1; b = 2}`.
    [[nodiscard]] std::string description() const override;
    [[nodiscard]] std::shared_ptr<NSObject> copy() const override;

private:
    Entries _entries;
    KeyIndex _index;
};

} // namespace orvo
