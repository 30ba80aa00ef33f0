#include "platform/foundation/NSDictionary.h"

#include "platform/foundation/Exceptions.h"
#include "platform/foundation/NSString.h"

namespace orvo {

std::shared_ptr<NSDictionary> NSDictionary::dictionary() {
    return std::make_shared<NSDictionary>();
}

std::shared_ptr<NSDictionary> NSDictionary::dictionaryWithEntries(Entries entries) {
    auto result = std::make_shared<NSDictionary>();
    result->_entries.reserve(entries.size());
    for (auto& [key, value] : entries) {
        if (!key || !value)
            throw NSInvalidArgumentException(
                "attempt to insert nil key or object into a dictionary");
        if (const auto position = result->_index.find(*key)) {
            result->_entries[*position].second = std::move(value);
            continue;
        }
        result->_index.insert(*key, result->_entries.size());
        result->_entries.emplace_back(std::move(key), std::move(value));
    }
    return result;
}

std::shared_ptr<NSDictionary> NSDictionary::dictionaryWithTextKeys(
    std::vector<std::pair<std::string, std::shared_ptr<NSObject>>> entries) {
    Entries boxed;
    boxed.reserve(entries.size());
    for (auto& [key, value] : entries)
        boxed.emplace_back(NSString::string(std::move(key)), std::move(value));
    return dictionaryWithEntries(std::move(boxed));
}

std::shared_ptr<NSObject> NSDictionary::objectForKey(const NSObject& key) const {
    const auto position = _index.find(key);
    return position ? _entries[*position].second : nullptr;
}

std::shared_ptr<NSObject> NSDictionary::objectForKey(std::string_view key) const {
    return objectForKey(*NSString::string(std::string(key)));
}

void NSDictionary::enumerate(
    const std::function<bool(const std::shared_ptr<NSObject>&)>& visit) const {
    for (const auto& [key, value] : _entries)
        if (!visit(key))
            return;
}

bool NSDictionary::isEqual(const NSObject* other) const {
    const auto* dictionary = dynamic_cast<const NSDictionary*>(other);
    if (!dictionary || dictionary->count() != count())
        return false;
    for (const auto& [key, value] : _entries)
        if (!value->isEqual(dictionary->objectForKey(*key).get()))
            return false;
    return true;
}

std::uint64_t NSDictionary::hash() const {
    std::uint64_t hash = _entries.size();
    for (const auto& [key, value] : _entries)
        hash += key->hash() * 31 + value->hash(); // a sum, since the order does not count
    return hash;
}

std::string NSDictionary::description() const {
    std::string text = "{";
    for (const auto& [key, value] : _entries) {
        if (text.size() > 1)
            text += "; ";
        text += key->description() + " = " + value->description();
    }
    return text + "}";
}

std::shared_ptr<NSObject> NSDictionary::copy() const {
    return std::const_pointer_cast<NSObject>(shared_from_this());
}

} // namespace orvo
