#pragma once

#include "platform/feeds/http/BodyRecord.h"
#include "platform/foundation/NSData.h"
#include "platform/foundation/NSError.h"

#include <filesystem>
#include <map>
#include <memory>
#include <mutex>
#include <optional>
#include <string>

namespace orvo {

/// The last good body of each remote source, by the key of its request, in a folder that several
/// processes share: `KEY.plist` with what is known of it, `KEY-CHECKSUM.body` with its bytes. A
/// damaged entry counts as absent. Nobody else writes to the folder. While
/// `Environment::keepsWritesInMemory()` holds, the folder is only read, and what is saved lies over
/// it in memory. Any thread.
class BodyStore {
public:
    /// Seconds after which a file that nobody wrote again is deleted when something new is saved.
    static constexpr double LongestStay = 90.0 * 24 * 3600;

    /// The folder need not exist yet.
    explicit BodyStore(std::filesystem::path folder);
    BodyStore(const BodyStore&) = delete;
    BodyStore& operator=(const BodyStore&) = delete;

    /// Nothing when no body is kept. Its bytes are not read yet.
    [[nodiscard]] std::optional<BodyRecord> record(const std::string& key) const;
    /// The bytes of that record; nil when they are gone, others, or damaged.
    [[nodiscard]] std::shared_ptr<NSData> body(const std::string& key,
                                               const BodyRecord& record) const;

    /// Replaces the entry. Length and checksum of the record are set here. Nil, or why the earlier
    /// entry was left as it was; the bytes are then kept in memory.
    [[nodiscard]] std::shared_ptr<NSError>
    save(const std::string& key, BodyRecord record, std::shared_ptr<NSData> bytes);
    /// Replaces what is known of bytes that stay. Nothing when another process has saved other ones
    /// since.
    [[nodiscard]] std::shared_ptr<NSError> update(const std::string& key, const BodyRecord& record);

private:
    struct InMemory {
        BodyRecord record;
        std::shared_ptr<NSData> bytes;
    };
    struct InUse {
        std::uint64_t checksum = 0;
        std::weak_ptr<NSData> bytes;
    };

    [[nodiscard]] std::optional<BodyRecord> recordOnDisk(const std::string& key) const;
    [[nodiscard]] std::filesystem::path recordPath(const std::string& key) const;
    [[nodiscard]] std::filesystem::path bodyPath(const std::string& key,
                                                 const BodyRecord& record) const;
    std::shared_ptr<NSError>
    saveOnDisk(const std::string& key, const BodyRecord& record, const NSData& bytes);
    std::shared_ptr<NSError> updateOnDisk(const std::string& key, const BodyRecord& record);
    void sweep() const;

    std::filesystem::path _folder;
    mutable std::mutex _mutex;
    std::map<std::string, InMemory> _inMemory;
    mutable std::map<std::string, InUse> _inUse; // so that bytes somebody holds are not read again
};

} // namespace orvo
