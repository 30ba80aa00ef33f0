#include "platform/feeds/http/BodyStore.h"

#include "platform/foundation/AtomicFile.h"
#include "platform/foundation/Environment.h"
#include "platform/foundation/Hashing.h"
#include "platform/foundation/PropertyList.h"

#include <chrono>
#include <fmt/format.h>

namespace orvo {

namespace {

constexpr const char* LockName = "lock";

bool keepsInMemory() {
    return Environment::keepsWritesInMemory().get();
}

bool hasBytes(const NSData& bytes, const BodyRecord& record) {
    return bytes.length() == record.length && stableHash(bytes.stringView()) == record.checksum;
}

} // namespace

BodyStore::BodyStore(std::filesystem::path folder)
    : _folder(std::move(folder)) {}

std::filesystem::path BodyStore::recordPath(const std::string& key) const {
    return _folder / (key + ".plist");
}

std::filesystem::path BodyStore::bodyPath(const std::string& key, const BodyRecord& record) const {
    return _folder / fmt::format("{}-{:016x}.body", key, record.checksum);
}

std::optional<BodyRecord> BodyStore::record(const std::string& key) const {
    {
        const std::lock_guard lock(_mutex);
        if (const auto found = _inMemory.find(key); found != _inMemory.end())
            return found->second.record;
    }
    return recordOnDisk(key);
}

std::optional<BodyRecord> BodyStore::recordOnDisk(const std::string& key) const {
    const auto bytes = AtomicFile::read(recordPath(key));
    if (!bytes)
        return std::nullopt;
    auto record = BodyRecord::fromPropertyList(PropertyList::read(bytes->bytes()).get());
    std::error_code error;
    if (!record || std::filesystem::file_size(bodyPath(key, *record), error) != record->length ||
        error)
        return std::nullopt;
    return record;
}

std::shared_ptr<NSData> BodyStore::body(const std::string& key, const BodyRecord& record) const {
    {
        const std::lock_guard lock(_mutex);
        const auto kept = _inMemory.find(key);
        if (kept != _inMemory.end() && kept->second.record.hasBytesOf(record))
            return kept->second.bytes;
        const auto used = _inUse.find(key);
        if (used != _inUse.end() && used->second.checksum == record.checksum)
            if (auto bytes = used->second.bytes.lock())
                return bytes;
    }
    auto bytes = AtomicFile::read(bodyPath(key, record));
    if (!bytes || !hasBytes(*bytes, record))
        return nullptr;
    const std::lock_guard lock(_mutex);
    _inUse[key] = {record.checksum, bytes};
    return bytes;
}

std::shared_ptr<NSError>
BodyStore::save(const std::string& key, BodyRecord record, std::shared_ptr<NSData> bytes) {
    record.length = bytes->length();
    record.checksum = stableHash(bytes->stringView());
    std::shared_ptr<NSError> error;
    const bool onlyInMemory = keepsInMemory();
    if (!onlyInMemory)
        error = saveOnDisk(key, record, *bytes);
    const std::lock_guard lock(_mutex);
    _inUse[key] = {record.checksum, bytes};
    if (onlyInMemory || error)
        _inMemory[key] = {std::move(record), std::move(bytes)};
    else
        _inMemory.erase(key);
    return error;
}

std::shared_ptr<NSError> BodyStore::update(const std::string& key, const BodyRecord& record) {
    {
        const std::lock_guard lock(_mutex);
        if (const auto kept = _inMemory.find(key); kept != _inMemory.end()) {
            if (kept->second.record.hasBytesOf(record))
                kept->second.record = record;
            return nullptr;
        }
    }
    if (!keepsInMemory())
        return updateOnDisk(key, record);
    auto bytes = body(key, record);
    const std::lock_guard lock(_mutex);
    if (bytes)
        _inMemory[key] = {record, std::move(bytes)};
    return nullptr;
}

std::shared_ptr<NSError>
BodyStore::saveOnDisk(const std::string& key, const BodyRecord& record, const NSData& bytes) {
    std::shared_ptr<NSError> error;
    const auto lock = AtomicFile::lockMakingFolder(_folder / LockName, &error);
    if (!lock)
        return error;
    const auto list = PropertyList::write(*record.propertyList(), &error);
    if (!list)
        return error;
    const auto earlier = recordOnDisk(key);
    const bool isNew = !earlier || !earlier->hasBytesOf(record);
    // The bytes first: a record never speaks of bytes that are not there. Bytes of the same name
    // may be damaged, so they are written again when they are said to have come again.
    if ((error = AtomicFile::write(*lock, bodyPath(key, record), bytes.bytes())))
        return error;
    if ((error = AtomicFile::write(*lock, recordPath(key), list->bytes())))
        return error;
    std::error_code ignored;
    if (earlier && isNew)
        std::filesystem::remove(bodyPath(key, *earlier), ignored);
    if (!earlier)
        sweep();
    return nullptr;
}

std::shared_ptr<NSError> BodyStore::updateOnDisk(const std::string& key, const BodyRecord& record) {
    std::shared_ptr<NSError> error;
    const auto lock = FileLock::acquire(_folder / LockName, &error);
    if (!lock)
        return error;
    const auto current = recordOnDisk(key);
    if (!current || !current->hasBytesOf(record))
        return nullptr;
    const auto list = PropertyList::write(*record.propertyList(), &error);
    return list ? AtomicFile::write(*lock, recordPath(key), list->bytes()) : error;
}

/// By the file system's own time: the environment's may stand in another year.
void BodyStore::sweep() const {
    const auto now = std::filesystem::file_time_type::clock::now();
    std::error_code error;
    for (const auto& file : std::filesystem::directory_iterator(_folder, error)) {
        const auto written = file.last_write_time(error);
        if (!error && file.path().filename() != LockName &&
            std::chrono::duration<double>(now - written).count() > LongestStay)
            std::filesystem::remove(file.path(), error);
    }
}

} // namespace orvo
