#include "platform/foundation/NSMapTable.h"

#include <algorithm>

namespace orvo {

std::shared_ptr<NSMapTable> NSMapTable::mapTableWithOptions(MapTableOptions options) {
    auto table = std::make_shared<NSMapTable>();
    table->_options = options;
    return table;
}

std::shared_ptr<NSMapTable> NSMapTable::strongToStrongObjectsMapTable() {
    return mapTableWithOptions({});
}

std::shared_ptr<NSMapTable> NSMapTable::weakToStrongObjectsMapTable() {
    return mapTableWithOptions({.keyMemory = MapTableOptions::Memory::Weak});
}

std::shared_ptr<NSMapTable> NSMapTable::identityMapTable() {
    return mapTableWithOptions({.keyPersonality = MapTableOptions::Personality::Identity});
}

bool NSMapTable::comparesIdentity() const noexcept {
    return _options.keyMemory == MapTableOptions::Memory::Weak ||
           _options.keyPersonality == MapTableOptions::Personality::Identity;
}

std::uint64_t NSMapTable::bucketOf(const NSObject& key) const {
    return comparesIdentity() ? reinterpret_cast<std::uintptr_t>(&key) : key.hash();
}

NSMapTable::Buckets::const_iterator NSMapTable::find(const NSObject& key) const {
    const auto [begin, end] = _entries.equal_range(bucketOf(key));
    for (auto entry = begin; entry != end; ++entry) {
        // A dead weak key never matches, even where a new object stands at its address.
        const auto alive = entry->second.key.get();
        if (alive && (alive.get() == &key || (!comparesIdentity() && alive->isEqual(&key))))
            return entry;
    }
    return _entries.end();
}

std::vector<const NSMapTable::Entry*> NSMapTable::livingEntries() const {
    std::vector<const Entry*> living;
    for (const auto& [bucket, entry] : _entries)
        if (entry.key.get() && entry.value.get())
            living.push_back(&entry);
    std::ranges::sort(living, {}, &Entry::number);
    return living;
}

std::size_t NSMapTable::count() const {
    return livingEntries().size();
}

std::shared_ptr<NSObject> NSMapTable::objectForKey(const NSObject* key) const {
    if (!key)
        return nullptr;
    const auto entry = find(*key);
    return entry == _entries.end() ? nullptr : entry->second.value.get();
}

void NSMapTable::setObject_forKey(const std::shared_ptr<NSObject>& value,
                                  const std::shared_ptr<NSObject>& key) {
    if (!key || !value)
        throw NSInvalidArgumentException("attempt to insert nil key or object into a map table");
    const auto reference = [](const std::shared_ptr<NSObject>& object,
                              MapTableOptions::Memory memory) {
        return memory == MapTableOptions::Memory::Weak ? Reference{nullptr, object}
                                                       : Reference{object, {}};
    };
    Buckets::node_type replaced; // goes last: its destructor may come back to this table
    auto number = _nextNumber++;
    auto keptKey = reference(key, _options.keyMemory);
    if (const auto found = find(*key); found != _entries.end()) {
        number = found->second.number;
        keptKey = found->second.key;
        replaced = _entries.extract(found);
    }
    if (_entries.size() >= _sweepAt)
        sweep();
    _entries.emplace(bucketOf(*key),
                     Entry{number, std::move(keptKey), reference(value, _options.valueMemory)});
}

void NSMapTable::sweep() {
    std::erase_if(_entries, [](const auto& item) {
        return !item.second.key.get() || !item.second.value.get();
    });
    _sweepAt = std::max<std::size_t>(32, _entries.size() * 2);
}

void NSMapTable::removeObjectForKey(const NSObject* key) {
    if (!key)
        return;
    if (const auto entry = find(*key); entry != _entries.end())
        const auto removed = _entries.extract(entry); // goes when the table is whole again
}

void NSMapTable::removeAllObjects() {
    const auto removed = std::exchange(_entries, {});
}

std::shared_ptr<NSArray> NSMapTable::allKeys() const {
    NSArray::Elements keys;
    for (const auto* entry : livingEntries())
        if (auto key = entry->key.get())
            keys.push_back(std::move(key));
    return NSArray::arrayWithObjects(std::move(keys));
}

void NSMapTable::enumerate(
    const std::function<bool(const std::shared_ptr<NSObject>&)>& visit) const {
    allKeys()->enumerate(visit);
}

bool NSMapTable::isEqual(const NSObject* other) const {
    const auto* table = dynamic_cast<const NSMapTable*>(other);
    if (!table || table->count() != count())
        return false;
    const auto entries = livingEntries();
    return std::ranges::all_of(entries, [&](const Entry* entry) {
        return equal(entry->value.get(), table->objectForKey(entry->key.get()));
    });
}

// Only the number of entries can be said of tables that are equal but hold keys by identity.
std::uint64_t NSMapTable::hash() const {
    return count();
}

std::string NSMapTable::description() const {
    std::string text = "NSMapTable {";
    for (const auto* entry : livingEntries())
        text += " " + descriptionOf(entry->key.get()) + " -> " + descriptionOf(entry->value.get()) +
                ";";
    return text + " }";
}

std::shared_ptr<NSObject> NSMapTable::copy() const {
    auto table = mapTableWithOptions(_options);
    for (const auto* entry : livingEntries()) {
        const auto key = entry->key.get();
        const auto value = entry->value.get();
        if (key && value)
            table->setObject_forKey(value, key);
    }
    return table;
}

} // namespace orvo
