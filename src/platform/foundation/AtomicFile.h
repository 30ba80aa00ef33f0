#pragma once

#include "platform/foundation/FileLock.h"
#include "platform/foundation/NSData.h"
#include "platform/foundation/NSError.h"

#include <filesystem>
#include <span>

/// Small files of the person's that several processes share: each is at every moment the whole of
/// what somebody wrote, also when that somebody is killed. Readers need no lock. Errors name the
/// file and the reason. Any thread.
namespace orvo::AtomicFile {

/// Of `NSPOSIXErrorDomain`, with the system's words for `code` (an `errno`).
[[nodiscard]] std::shared_ptr<NSError> systemError(const std::filesystem::path& path, int code);

/// The content. Nil without an error when there is no such file; nil with one when it cannot be
/// read, or is no ordinary file.
[[nodiscard]] std::shared_ptr<NSData> read(const std::filesystem::path& path,
                                           std::shared_ptr<NSError>* error = nullptr);

/// Replaces the file whole, and makes it when there is none (mode 0600): written aside as
/// `PATH.new`, flushed to the disk, renamed; then its folder is flushed. Nil when all went well;
/// after an error the file is as it was, unless only the last step failed. The lock is the one that
/// all writers of this file take.
[[nodiscard]] std::shared_ptr<NSError>
write(const FileLock& lock, const std::filesystem::path& path, std::span<const std::uint8_t> bytes);

/// Renames the file to `PATH.damaged-N`, with the least N from 1 that is free. Its new path; empty
/// with an error.
[[nodiscard]] std::filesystem::path setAside(const FileLock& lock,
                                             const std::filesystem::path& path,
                                             std::shared_ptr<NSError>* error = nullptr);

/// Makes the folder (mode 0700) and those above it where they do not exist. Nil when it is there.
[[nodiscard]] std::shared_ptr<NSError> makeFolder(const std::filesystem::path& path);

/// `FileLock::acquire`, after the folder of the lock was made.
[[nodiscard]] std::unique_ptr<FileLock> lockMakingFolder(const std::filesystem::path& path,
                                                         std::shared_ptr<NSError>* error);

} // namespace orvo::AtomicFile
