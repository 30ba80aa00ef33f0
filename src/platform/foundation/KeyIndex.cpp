#include "platform/foundation/KeyIndex.h"

#include "platform/foundation/SeededStringHash.h"

namespace orvo {

std::uint64_t KeyIndex::hashOfKey(const NSObject& key) const {
    return scattered(_personality == Personality::Identity ? reinterpret_cast<std::uintptr_t>(&key)
                                                           : key.hash());
}

bool KeyIndex::same(const NSObject& a, const NSObject& b) const {
    return _personality == Personality::Identity ? &a == &b : &a == &b || a.isEqual(&b);
}

std::optional<std::size_t> KeyIndex::find(const NSObject& key) const {
    const auto [begin, end] = _positions.equal_range(hashOfKey(key));
    for (auto entry = begin; entry != end; ++entry)
        if (same(*entry->second.key, key))
            return entry->second.position;
    return std::nullopt;
}

void KeyIndex::insert(const NSObject& key, std::size_t position) {
    _positions.emplace(hashOfKey(key), Entry{&key, position});
}

void KeyIndex::erase(const NSObject& key) {
    const auto [begin, end] = _positions.equal_range(hashOfKey(key));
    for (auto entry = begin; entry != end; ++entry)
        if (same(*entry->second.key, key)) {
            _positions.erase(entry);
            return;
        }
}

} // namespace orvo
