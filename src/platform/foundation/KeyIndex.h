#pragma once

#include "platform/foundation/NSObject.h"

#include <optional>
#include <unordered_map>

namespace orvo {

/// Finds the position of a key among positions numbered by somebody else, by content (`isEqual:`
/// and `hash`) or by identity. What the collections of this folder are built on. Positions, never
/// addresses, decide any order.
class KeyIndex {
public:
    enum class Personality { Equality, Identity };

    explicit KeyIndex(Personality personality = Personality::Equality)
        : _personality(personality) {}

    [[nodiscard]] std::optional<std::size_t> find(const NSObject& key) const;
    /// The key must not be present, and must stay alive and unchanged while it is.
    void insert(const NSObject& key, std::size_t position);
    void erase(const NSObject& key);
    void clear() noexcept { _positions.clear(); }

private:
    struct Entry {
        const NSObject* key;
        std::size_t position;
    };
    [[nodiscard]] std::uint64_t hashOfKey(const NSObject& key) const;
    [[nodiscard]] bool same(const NSObject& a, const NSObject& b) const;

    Personality _personality;
    std::unordered_multimap<std::uint64_t, Entry> _positions;
};

} // namespace orvo
