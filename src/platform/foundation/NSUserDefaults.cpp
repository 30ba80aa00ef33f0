#include "platform/foundation/NSUserDefaults.h"

#include "platform/foundation/AtomicFile.h"
#include "platform/foundation/Environment.h"
#include "platform/foundation/Exceptions.h"
#include "platform/foundation/Log.h"
#include "platform/foundation/NSNumber.h"
#include "platform/foundation/NSString.h"
#include "platform/foundation/PropertyList.h"

#include <algorithm>
#include <charconv>
#include <map>
#include <mutex>
#include <utility>

namespace orvo {

namespace {

/// What a file holds. Neither error: the content, empty where there is no file.
struct StoredDefaults {
    std::shared_ptr<NSDictionary> content = NSDictionary::dictionary();
    std::shared_ptr<NSError> unreadable; ///< the system does not give the file out
    std::shared_ptr<NSError> damage;     ///< its bytes are no settings
};

StoredDefaults storedDefaults(const std::filesystem::path& path) {
    StoredDefaults stored;
    const auto bytes = AtomicFile::read(path, &stored.unreadable);
    if (!bytes)
        return stored;
    const auto list = PropertyList::read(bytes->bytes(), &stored.damage);
    if (auto content = std::dynamic_pointer_cast<NSDictionary>(list))
        stored.content = content;
    else if (list)
        stored.damage = NSError::errorWithMessage(
            PropertyList::ErrorDomain,
            static_cast<std::int64_t>(PropertyList::ErrorCode::Unsupported),
            "property list: the root is no dictionary");
    return stored;
}

std::shared_ptr<Log> defaultsLog() {
    return Log::findOrCreate("UserDefaults");
}

std::unique_ptr<FileLock> lockDefaults(const std::filesystem::path& path,
                                       std::shared_ptr<NSError>* error) {
    auto lock = path;
    lock += ".lock";
    return FileLock::acquire(lock, error);
}

/// Nil when the damaged file is out of the way.
std::shared_ptr<NSError>
setDefaultsAside(const FileLock& lock, const std::filesystem::path& path, const NSError& damage) {
    std::shared_ptr<NSError> error;
    const auto aside = AtomicFile::setAside(lock, path, &error);
    if (error)
        defaultsLog()->error("%s is damaged (%s) and cannot be set aside: %s",
                             path.string(),
                             damage.localizedDescription(),
                             error->localizedDescription());
    else
        defaultsLog()->error("%s was damaged (%s) and now lies at %s; the settings begin anew",
                             path.string(),
                             damage.localizedDescription(),
                             aside.string());
    return error;
}

std::shared_ptr<NSDictionary> readDefaults(const std::filesystem::path& path, bool mayWrite) {
    auto stored = storedDefaults(path);
    if (stored.damage && mayWrite) {
        // Another process may just have set it aside and begun anew: look again under the lock.
        if (const auto lock = lockDefaults(path, nullptr)) {
            stored = storedDefaults(path);
            if (stored.damage && !setDefaultsAside(*lock, path, *stored.damage))
                return stored.content;
        }
    }
    if (const auto& error = stored.damage ? stored.damage : stored.unreadable)
        defaultsLog()->error(
            "%s counts as empty: %s", path.string(), error->localizedDescription());
    return stored.content;
}

/// The entries with `key` at its place, or at the end; nil removes it.
std::shared_ptr<NSDictionary> withValue(const NSDictionary& content,
                                        const std::string& key,
                                        const std::shared_ptr<NSObject>& value) {
    auto entries = content.entries();
    const auto name = NSString::string(key);
    if (value)
        entries.emplace_back(name, value);
    else
        std::erase_if(entries, [&](const auto& entry) { return entry.first->isEqual(name.get()); });
    return NSDictionary::dictionaryWithEntries(std::move(entries));
}

std::shared_ptr<NSError> writeDefaults(const std::filesystem::path& path,
                                       const std::string& key,
                                       const std::shared_ptr<NSObject>& value) {
    if (auto error = AtomicFile::makeFolder(path.parent_path()))
        return error;
    std::shared_ptr<NSError> error;
    const auto lock = lockDefaults(path, &error);
    if (!lock)
        return error;
    const auto stored = storedDefaults(path);
    if (stored.unreadable)
        return stored.unreadable;
    if (stored.damage)
        if ((error = setDefaultsAside(*lock, path, *stored.damage)))
            return error;
    if (!value && !stored.content->objectForKey(key))
        return nullptr;
    const auto bytes = PropertyList::write(*withValue(*stored.content, key, value), &error);
    return bytes ? AtomicFile::write(*lock, path, bytes->bytes()) : error;
}

/// What is not to reach the disk, by file; a nil value is a removed key. It is forgotten when
/// `Environment::keepsWritesInMemory()` changes.
class MemoryDefaults {
public:
    static MemoryDefaults& shared() {
        static MemoryDefaults defaults;
        return defaults;
    }

    void set(const std::filesystem::path& path,
             const std::string& key,
             const std::shared_ptr<NSObject>& value) {
        const std::lock_guard lock(_mutex);
        forgetEarlier();
        _byFile[path].insert_or_assign(key, value);
    }
    [[nodiscard]] std::shared_ptr<NSDictionary> over(const std::filesystem::path& path,
                                                     std::shared_ptr<NSDictionary> content) {
        const std::lock_guard lock(_mutex);
        forgetEarlier();
        if (const auto values = _byFile.find(path); values != _byFile.end())
            for (const auto& [key, value] : values->second)
                content = withValue(*content, key, value);
        return content;
    }

private:
    void forgetEarlier() {
        const auto now = Environment::keepsWritesInMemory().generation();
        if (std::exchange(_generation, now) != now)
            _byFile.clear();
    }

    std::mutex _mutex;
    std::uint64_t _generation = 0;
    std::map<std::filesystem::path, std::map<std::string, std::shared_ptr<NSObject>>> _byFile;
};

} // namespace

std::shared_ptr<NSUserDefaults> NSUserDefaults::initWithSuiteName(const std::string& suite) {
    if (suite.empty() || suite.find_first_of(std::string_view("/\0", 2)) != std::string::npos)
        return nullptr;
    auto defaults = std::make_shared<NSUserDefaults>();
    defaults->_suite = suite;
    return defaults;
}

std::filesystem::path NSUserDefaults::_path() const {
    return Environment::profile().get().data / (_suite + ".plist");
}

std::shared_ptr<NSDictionary> NSUserDefaults::dictionaryRepresentation() const {
    const auto path = _path();
    if (Environment::keepsWritesInMemory().get())
        return MemoryDefaults::shared().over(path, readDefaults(path, false));
    return readDefaults(path, true);
}

std::shared_ptr<NSError> NSUserDefaults::unreadable() const {
    const auto path = _path();
    const auto stored = storedDefaults(path);
    if (!stored.damage)
        return stored.unreadable;
    return NSError::errorWithMessage(PropertyList::ErrorDomain,
                                     stored.damage->code(),
                                     path.string() +
                                         " is damaged: " + stored.damage->localizedDescription());
}

std::shared_ptr<NSObject> NSUserDefaults::objectForKey(const std::string& key) const {
    return dictionaryRepresentation()->objectForKey(key);
}

std::shared_ptr<NSData> NSUserDefaults::dataForKey(const std::string& key) const {
    return std::dynamic_pointer_cast<NSData>(objectForKey(key));
}

std::optional<std::string> NSUserDefaults::stringForKey(const std::string& key) const {
    return stringValue(objectForKey(key).get());
}

bool NSUserDefaults::boolForKey(const std::string& key) const {
    const auto object = objectForKey(key);
    if (const auto* number = dynamic_cast<const NSNumber*>(object.get()))
        return number->boolValue();
    auto text = stringValue(object.get()).value_or("");
    std::ranges::transform(text, text.begin(), [](char c) {
        return c >= 'A' && c <= 'Z' ? static_cast<char>(c | 0x20) : c;
    });
    return text == "yes" || text == "true" || text == "1";
}

std::int64_t NSUserDefaults::integerForKey(const std::string& key) const {
    const auto object = objectForKey(key);
    if (const auto* number = dynamic_cast<const NSNumber*>(object.get()))
        return number->integerValue();
    const auto text = stringValue(object.get()).value_or("");
    std::int64_t value = 0; // stays where the text begins with none
    std::from_chars(text.data(), text.data() + text.size(), value);
    return value;
}

std::shared_ptr<NSError> NSUserDefaults::setObject_forKey(const std::shared_ptr<NSObject>& value,
                                                          const std::string& key) {
    std::shared_ptr<NSError> error;
    if (value && !PropertyList::write(*value, &error))
        throw NSInvalidArgumentException("attempt to set a value that is no property list for the "
                                         "key " +
                                         key + ": " + error->localizedDescription());
    const auto path = _path();
    if (Environment::keepsWritesInMemory().get()) {
        MemoryDefaults::shared().set(path, key, value);
        return nullptr;
    }
    return writeDefaults(path, key, value);
}

std::shared_ptr<NSError> NSUserDefaults::setBool_forKey(bool value, const std::string& key) {
    return setObject_forKey(NSNumber::numberWithBool(value), key);
}

std::shared_ptr<NSError> NSUserDefaults::removeObjectForKey(const std::string& key) {
    return setObject_forKey(nullptr, key);
}

} // namespace orvo
