#pragma once

#include "platform/foundation/NSArray.h"
#include "platform/foundation/NSObject.h"

#include <unordered_map>

namespace orvo {

/// How a map table holds and compares its keys or values.
struct MapTableOptions {
    enum class Memory { Strong, Weak };
    enum class Personality { Equality, Identity };

    Memory keyMemory = Memory::Strong;
    Personality keyPersonality = Personality::Equality;
    Memory valueMemory = Memory::Strong;
};

/// A mutable map that can compare keys by identity and hold keys or values weakly. An entry whose
/// weak key or value has gone is no longer there. Enumerates in order of first setting. Not
/// synchronised.
///
/// A weak key is always compared by identity: an object that has gone can no longer be asked
/// whether it is equal.
class NSMapTable final : public NSFastEnumeration, public NSCopying {
public:
    [[nodiscard]] static std::shared_ptr<NSMapTable> mapTableWithOptions(MapTableOptions options);
    [[nodiscard]] static std::shared_ptr<NSMapTable> strongToStrongObjectsMapTable();
    [[nodiscard]] static std::shared_ptr<NSMapTable> weakToStrongObjectsMapTable();
    /// Keys and values strong, keys by identity.
    [[nodiscard]] static std::shared_ptr<NSMapTable> identityMapTable();

    [[nodiscard]] std::size_t count() const;
    /// Nil when there is none.
    [[nodiscard]] std::shared_ptr<NSObject> objectForKey(const NSObject* key) const;
    template <class T>
    [[nodiscard]] std::shared_ptr<NSObject> objectForKey(const std::shared_ptr<T>& key) const {
        return objectForKey(static_cast<const NSObject*>(key.get()));
    }
    /// An entry that is there keeps its place and its key.
    /// @throws NSInvalidArgumentException for a nil key or value
    void setObject_forKey(const std::shared_ptr<NSObject>& value,
                          const std::shared_ptr<NSObject>& key);
    void removeObjectForKey(const NSObject* key);
    void removeAllObjects();

    /// The keys that are alive now.
    [[nodiscard]] std::shared_ptr<NSArray> allKeys() const;
    /// The keys, over a snapshot: `visit` may change the table.
    void
    enumerate(const std::function<bool(const std::shared_ptr<NSObject>&)>& visit) const override;
    [[nodiscard]] bool isEqual(const NSObject* other) const override;
    [[nodiscard]] std::uint64_t hash() const override;
    [[nodiscard]] std::string description() const override;
    [[nodiscard]] std::shared_ptr<NSObject> copy() const override;

private:
    struct Reference {
        std::shared_ptr<NSObject> strong;
        std::weak_ptr<NSObject> weak;

        [[nodiscard]] std::shared_ptr<NSObject> get() const {
            return strong ? strong : weak.lock();
        }
    };
    struct Entry {
        std::size_t number = 0;
        Reference key;
        Reference value;
    };
    using Buckets = std::unordered_multimap<std::uint64_t, Entry>;

    [[nodiscard]] bool comparesIdentity() const noexcept;
    [[nodiscard]] std::uint64_t bucketOf(const NSObject& key) const;
    [[nodiscard]] Buckets::const_iterator find(const NSObject& key) const;
    [[nodiscard]] std::vector<const Entry*> livingEntries() const;
    void sweep();

    MapTableOptions _options;
    Buckets _entries;
    std::size_t _nextNumber = 0;
    std::size_t _sweepAt = 32;
};

} // namespace orvo
