#pragma once

#include "platform/foundation/NSArray.h"
#include "platform/foundation/NSData.h"
#include "platform/foundation/NSDictionary.h"
#include "platform/foundation/NSError.h"
#include "platform/foundation/NSObject.h"

#include <filesystem>
#include <optional>
#include <string>

namespace orvo {

/// Settings of one suite, shared by every program of the group: a binary property list file
/// `SUITE.plist` in the profile's data folder. Every write replaces the file whole (written aside,
/// flushed to the disk, renamed), under a lock between processes, and keeps the other keys as they
/// are on the disk; every read sees what any process wrote last. A damaged file is set aside as
/// `SUITE.plist.damaged-N`, said in the log, and counts as empty; one that cannot be read at all
/// counts as empty and is never written over. Values are property-list objects: `NSString`,
/// `NSNumber`, `NSData`, `NSDate`, `NSArray`, `NSDictionary`. Any thread.
///
/// While `Environment::keepsWritesInMemory()` holds, nothing on the disk changes: what would be
/// written lies over what is read there, for all objects of the suite, and is forgotten when that
/// override ends.
class NSUserDefaults final : public virtual NSObject {
public:
    /// A new object each time; all objects of one suite show the same content.
    /// Nil for a name that can be no file's: empty, or with a slash or a zero byte.
    [[nodiscard]] static std::shared_ptr<NSUserDefaults>
    initWithSuiteName(const std::string& suite);

    [[nodiscard]] const std::string& suiteName() const noexcept { return _suite; }

    /// Nil when absent.
    [[nodiscard]] std::shared_ptr<NSObject> objectForKey(const std::string& key) const;
    /// Nil when absent or of another class.
    [[nodiscard]] std::shared_ptr<NSData> dataForKey(const std::string& key) const;
    [[nodiscard]] std::optional<std::string> stringForKey(const std::string& key) const;
    /// False when absent; a number is true unless 0; the texts YES, true (in large or small
    /// letters) and 1 are true.
    [[nodiscard]] bool boolForKey(const std::string& key) const;
    /// 0 when absent; of a text the whole number that it begins with.
    [[nodiscard]] std::int64_t integerForKey(const std::string& key) const;
    /// All keys and values, in the order in which they were first set.
    [[nodiscard]] std::shared_ptr<NSDictionary> dictionaryRepresentation() const;

    /// Why what is kept counts as empty though a file is there: it cannot be read, or is damaged
    /// and stays where it is. Nil otherwise, also without a file.
    [[nodiscard]] std::shared_ptr<NSError> unreadable() const;

    /// Nil removes. A write that fails leaves the file as it was; the error says file and reason,
    /// nil when all went well.
    /// @throws NSInvalidArgumentException for an object that no property list can hold
    std::shared_ptr<NSError> setObject_forKey(const std::shared_ptr<NSObject>& value,
                                              const std::string& key);
    std::shared_ptr<NSError> setBool_forKey(bool value, const std::string& key);
    std::shared_ptr<NSError> removeObjectForKey(const std::string& key);

private:
    [[nodiscard]] std::filesystem::path _path() const;

    std::string _suite;
};

} // namespace orvo
