#pragma once

#include "platform/foundation/NSError.h"

#include <filesystem>
#include <memory>

namespace orvo {

/// Keeps all others out, other processes and other threads, for as long as the object lives; its
/// end, the process's own included, lets the next in. The lock lies on a file made for it (mode
/// 0600) that stays: were it deleted, two could each hold a lock on a file of that name.
class FileLock {
public:
    /// Waits until all others are out. Nil with an error when the file cannot be made or locked;
    /// its folder must exist.
    [[nodiscard]] static std::unique_ptr<FileLock> acquire(const std::filesystem::path& path,
                                                           std::shared_ptr<NSError>* error);

    FileLock(const FileLock&) = delete;
    FileLock& operator=(const FileLock&) = delete;
    ~FileLock();

private:
    explicit FileLock(int descriptor)
        : _descriptor(descriptor) {}

    int _descriptor;
};

} // namespace orvo
