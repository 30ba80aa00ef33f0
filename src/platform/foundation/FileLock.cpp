#include "platform/foundation/FileLock.h"

#include "platform/foundation/AtomicFile.h"

#include <cerrno>
#include <fcntl.h>
#include <sys/file.h>
#include <unistd.h>

namespace orvo {

std::unique_ptr<FileLock> FileLock::acquire(const std::filesystem::path& path,
                                            std::shared_ptr<NSError>* error) {
    const int descriptor = open(path.c_str(), O_RDWR | O_CREAT | O_CLOEXEC | O_NOFOLLOW, 0600);
    if (descriptor < 0) {
        if (error)
            *error = AtomicFile::systemError(path, errno);
        return nullptr;
    }
    std::unique_ptr<FileLock> lock(new FileLock(descriptor));
    while (flock(descriptor, LOCK_EX) != 0) {
        if (errno == EINTR)
            continue;
        if (error)
            *error = AtomicFile::systemError(path, errno);
        return nullptr;
    }
    return lock;
}

FileLock::~FileLock() {
    close(_descriptor);
}

} // namespace orvo
