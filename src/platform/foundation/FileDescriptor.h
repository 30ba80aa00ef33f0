#pragma once

namespace orvo {

/// What the kernel knows an open file by; closed at the end of its scope.
class FileDescriptor {
public:
    /// Takes it over. A negative number, as of a file that could not be opened, is none.
    explicit FileDescriptor(int number) noexcept
        : _number(number) {}
    FileDescriptor(const FileDescriptor&) = delete;
    FileDescriptor& operator=(const FileDescriptor&) = delete;
    /// The other has none then.
    FileDescriptor(FileDescriptor&& other) noexcept;
    FileDescriptor& operator=(FileDescriptor&&) = delete;
    ~FileDescriptor();

    [[nodiscard]] int number() const noexcept { return _number; }
    [[nodiscard]] bool isOpen() const noexcept { return _number >= 0; }

private:
    int _number;
};

} // namespace orvo
