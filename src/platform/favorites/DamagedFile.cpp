#include "platform/favorites/DamagedFile.h"

#include "platform/foundation/AtomicFile.h"
#include "platform/foundation/Environment.h"
#include "platform/foundation/Log.h"

#include <sys/stat.h>

namespace orvo {

DamagedFile::DamagedFile(std::filesystem::path path)
    : _path(std::move(path))
    , _file(currentFile()) {}

bool DamagedFile::setAside(const std::string& reason) const {
    const auto log = Log::findOrCreate("Favorites");
    if (Environment::keepsWritesInMemory().get()) {
        log->error("%@: the file is damaged (%@) and is left as it is", _path.string(), reason);
        return false;
    }
    // The store's own file must never be opened for that: closing it would drop the locks that
    // SQLite holds on it in this process.
    std::shared_ptr<NSError> error;
    const auto lock = FileLock::acquire(_path.string() + ".lock", &error);
    if (lock && currentFile() != _file)
        return true;
    const auto name = lock ? AtomicFile::setAside(*lock, _path, &error) : std::filesystem::path();
    if (name.empty()) {
        log->error("%@: the file is damaged (%@) and cannot be set aside: %@",
                   _path.string(),
                   reason,
                   error->localizedDescription());
        return false;
    }
    // With its journal beside it, a new file in this place would not be read as what it is.
    std::error_code ignored;
    for (const char* suffix : {"-wal", "-shm"})
        std::filesystem::rename(_path.string() + suffix, name.string() + suffix, ignored);
    log->error("%@: the file is damaged (%@); it was set aside as %@",
               _path.string(),
               reason,
               name.filename().string());
    return true;
}

std::optional<std::uint64_t> DamagedFile::currentFile() const {
    struct stat status {};
    if (::stat(_path.c_str(), &status) != 0)
        return std::nullopt;
    return status.st_ino;
}

} // namespace orvo
