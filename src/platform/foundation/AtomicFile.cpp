#include "platform/foundation/AtomicFile.h"

#include "platform/foundation/FileDescriptor.h"

#include <array>
#include <cerrno>
#include <fcntl.h>
#include <fmt/format.h>
#include <sys/stat.h>
#include <system_error>
#include <unistd.h>
#include <utility>

namespace orvo::AtomicFile {

namespace {

/// 0, or the reason in `errno`'s numbers.
int writeWhole(int descriptor, std::span<const std::uint8_t> bytes) {
    while (!bytes.empty()) {
        const auto count = ::write(descriptor, bytes.data(), bytes.size());
        if (count < 0 && errno != EINTR)
            return errno;
        if (count > 0)
            bytes = bytes.subspan(static_cast<std::size_t>(count));
    }
    return 0;
}

int writeAside(const std::filesystem::path& path, std::span<const std::uint8_t> bytes) {
    // What a killed writer left behind under this name is cut off.
    const FileDescriptor file(
        open(path.c_str(), O_WRONLY | O_CREAT | O_TRUNC | O_CLOEXEC | O_NOFOLLOW, 0600));
    if (!file.isOpen() || fchmod(file.number(), 0600) != 0)
        return errno;
    if (const int reason = writeWhole(file.number(), bytes))
        return reason;
    return fsync(file.number()) == 0 ? 0 : errno;
}

int flushFolder(const std::filesystem::path& path) {
    const FileDescriptor folder(open(path.c_str(), O_RDONLY | O_DIRECTORY | O_CLOEXEC));
    if (!folder.isOpen())
        return errno;
    // Some file systems cannot flush a folder, and say so; there is nothing more to do there.
    return fsync(folder.number()) == 0 || errno == EINVAL ? 0 : errno;
}

void setError(std::shared_ptr<NSError>* error, const std::filesystem::path& path, int code) {
    if (error)
        *error = systemError(path, code);
}

} // namespace

std::shared_ptr<NSError> systemError(const std::filesystem::path& path, int code) {
    return NSError::errorWithMessage(
        NSPOSIXErrorDomain,
        code,
        fmt::format("{}: {}", path.string(), std::generic_category().message(code)));
}

std::shared_ptr<NSData> read(const std::filesystem::path& path, std::shared_ptr<NSError>* error) {
    // Opening a pipe that nobody writes to would wait without an end.
    const FileDescriptor file(open(path.c_str(), O_RDONLY | O_CLOEXEC | O_NONBLOCK));
    if (!file.isOpen()) {
        if (errno != ENOENT)
            setError(error, path, errno);
        return nullptr;
    }
    struct stat status {};
    if (fstat(file.number(), &status) != 0) {
        setError(error, path, errno);
        return nullptr;
    }
    if (S_ISDIR(status.st_mode)) {
        setError(error, path, EISDIR);
        return nullptr;
    }
    if (!S_ISREG(status.st_mode)) {
        if (error)
            *error = NSError::errorWithMessage(
                NSPOSIXErrorDomain, EINVAL, path.string() + ": is no regular file");
        return nullptr;
    }
    std::vector<std::uint8_t> bytes;
    std::array<std::uint8_t, 1U << 16U> part{};
    while (true) {
        const auto count = ::read(file.number(), part.data(), part.size());
        if (count == 0)
            return NSData::dataWithVector(std::move(bytes));
        if (count > 0) {
            bytes.insert(bytes.end(), part.begin(), part.begin() + count);
        } else if (errno != EINTR) {
            setError(error, path, errno);
            return nullptr;
        }
    }
}

std::shared_ptr<NSError>
write(const FileLock&, const std::filesystem::path& path, std::span<const std::uint8_t> bytes) {
    auto aside = path;
    aside += ".new";
    if (const int reason = writeAside(aside, bytes)) {
        unlink(aside.c_str());
        return systemError(aside, reason);
    }
    if (rename(aside.c_str(), path.c_str()) != 0) {
        const int reason = errno;
        unlink(aside.c_str());
        return systemError(path, reason);
    }
    if (const int reason = flushFolder(path.parent_path()))
        return systemError(path.parent_path(), reason);
    return nullptr;
}

std::filesystem::path
setAside(const FileLock&, const std::filesystem::path& path, std::shared_ptr<NSError>* error) {
    for (int number = 1;; ++number) {
        auto aside = path;
        aside += fmt::format(".damaged-{}", number);
        std::error_code reason;
        if (std::filesystem::exists(std::filesystem::symlink_status(aside, reason)))
            continue;
        std::filesystem::rename(path, aside, reason);
        if (!reason)
            return aside;
        setError(error, path, reason.value());
        return {};
    }
}

std::shared_ptr<NSError> makeFolder(const std::filesystem::path& path) {
    std::error_code reason;
    std::filesystem::create_directories(path.parent_path(), reason);
    if (reason)
        return systemError(path.parent_path(), reason.value());
    if (mkdir(path.c_str(), 0700) != 0 &&
        !(errno == EEXIST && std::filesystem::is_directory(path, reason)))
        return systemError(path, errno);
    return nullptr;
}

std::unique_ptr<FileLock> lockMakingFolder(const std::filesystem::path& path,
                                           std::shared_ptr<NSError>* error) {
    if (auto problem = makeFolder(path.parent_path())) {
        if (error)
            *error = std::move(problem);
        return nullptr;
    }
    return FileLock::acquire(path, error);
}

} // namespace orvo::AtomicFile
