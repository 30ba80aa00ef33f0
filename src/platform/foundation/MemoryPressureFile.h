#pragma once

#include "platform/foundation/DispatchSource.h"

#include <cstdint>
#include <filesystem>
#include <memory>
#include <string_view>

namespace orvo {

/// A file by which the kernel tells that memory becomes scarce: the machine's pressure (a trigger
/// that we set), or the events of the control group that the program runs in. It is polled for
/// `POLLPRI`.
class MemoryPressureFile {
public:
    MemoryPressureFile() = default;
    MemoryPressureFile(const MemoryPressureFile&) = delete;
    MemoryPressureFile& operator=(const MemoryPressureFile&) = delete;
    virtual ~MemoryPressureFile() = default;

    /// Belongs to this object.
    [[nodiscard]] virtual int fileDescriptor() const noexcept = 0;
    /// After the file was found ready: whether it is about the degree asked for.
    [[nodiscard]] virtual bool hasHappened() = 0;

    /// Nil where this kernel has none, or gives it to nobody: that degree is then never told.
    [[nodiscard]] static std::unique_ptr<MemoryPressureFile> open(MemoryPressure degree);

    using Opener = std::function<std::unique_ptr<MemoryPressureFile>(MemoryPressure)>;
    /// What `open` does.
    static EnvironmentSlot<Opener>& opener();

    /// Where the kernel shows them. Default: `/proc/pressure/memory`, and the group's folder in
    /// `/sys/fs/cgroup`; empty where there is none.
    struct Places {
        std::filesystem::path pressure;
        std::filesystem::path controlGroup;
    };
    static EnvironmentSlot<Places>& places();

    /// What a `memory.events` file counts for a degree: throttled at the soft limit for the
    /// warning, at the hard limit or out of memory for the critical one; 0 for what it does not
    /// tell.
    [[nodiscard]] static std::uint64_t eventCount(std::string_view memoryEvents,
                                                  MemoryPressure degree);
    /// The group's folder below `root` as `/proc/self/cgroup` names it (`0::/path`); empty where
    /// it names none.
    [[nodiscard]] static std::filesystem::path controlGroupFolder(const std::filesystem::path& root,
                                                                  std::string_view selfCgroup);
};

} // namespace orvo
