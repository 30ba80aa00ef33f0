#include "platform/foundation/MemoryPressureFile.h"

#include "platform/foundation/FileDescriptor.h"

#include <array>
#include <charconv>
#include <fcntl.h>
#include <fstream>
#include <iterator>
#include <string>
#include <unistd.h>
#include <utility>

namespace orvo {

namespace {

// Microseconds in which some, or all, tasks waited for memory, within a window. Without privileges
// a window is a multiple of two seconds.
constexpr std::string_view WarningTrigger = "some 150000 2000000";
constexpr std::string_view CriticalTrigger = "full 100000 2000000";
constexpr std::size_t LargestEventsFile = 4096;

FileDescriptor openFile(const std::filesystem::path& path, int flags) {
    return FileDescriptor(::open(path.c_str(), flags | O_CLOEXEC | O_NONBLOCK));
}

/// The trigger stands as long as the file is open.
class PressureTrigger final : public MemoryPressureFile {
public:
    explicit PressureTrigger(FileDescriptor file)
        : _file(std::move(file)) {}
    [[nodiscard]] int fileDescriptor() const noexcept override { return _file.number(); }
    bool hasHappened() override { return true; }

    static std::unique_ptr<MemoryPressureFile> open(const std::filesystem::path& path,
                                                    std::string_view trigger) {
        auto file = openFile(path, O_RDWR);
        // The kernel wants the text with its final zero.
        const std::string text(trigger);
        if (!file.isOpen() || ::write(file.number(), text.c_str(), text.size() + 1) < 0)
            return nullptr;
        return std::make_unique<PressureTrigger>(std::move(file));
    }

private:
    FileDescriptor _file;
};

class GroupEvents final : public MemoryPressureFile {
public:
    GroupEvents(FileDescriptor file, MemoryPressure degree)
        : _file(std::move(file))
        , _degree(degree)
        , _count(count()) {}
    [[nodiscard]] int fileDescriptor() const noexcept override { return _file.number(); }
    /// Reading also makes the file wait for its next change.
    bool hasHappened() override {
        const auto before = std::exchange(_count, count());
        return _count > before;
    }

private:
    [[nodiscard]] std::uint64_t count() const {
        std::array<char, LargestEventsFile> text{};
        const auto size = ::pread(_file.number(), text.data(), text.size(), 0);
        return size > 0 ? eventCount({text.data(), static_cast<std::size_t>(size)}, _degree) : 0;
    }

    FileDescriptor _file;
    MemoryPressure _degree;
    std::uint64_t _count;
};

std::string textOf(const std::filesystem::path& path) {
    std::ifstream file(path);
    return {std::istreambuf_iterator<char>(file), {}};
}

/// The number after `name` and a blank, on a line of its own.
std::uint64_t countNamed(std::string_view name, std::string_view events) {
    while (!events.empty()) {
        const auto line = events.substr(0, events.find('\n'));
        events.remove_prefix(std::min(line.size() + 1, events.size()));
        if (line.size() <= name.size() || !line.starts_with(name) || line[name.size()] != ' ')
            continue;
        std::uint64_t count = 0;
        std::from_chars(line.data() + name.size() + 1, line.data() + line.size(), count);
        return count;
    }
    return 0;
}

std::unique_ptr<MemoryPressureFile> openOfKernel(MemoryPressure degree) {
    const auto places = MemoryPressureFile::places().get();
    switch (degree) {
    case MemoryPressure::Warning:
        return PressureTrigger::open(places.pressure, WarningTrigger);
    case MemoryPressure::Critical:
        return PressureTrigger::open(places.pressure, CriticalTrigger);
    case MemoryPressure::ProcessLimitWarning:
    case MemoryPressure::ProcessLimitCritical:
        break;
    }
    if (places.controlGroup.empty())
        return nullptr;
    auto file = openFile(places.controlGroup / "memory.events", O_RDONLY);
    return file.isOpen() ? std::make_unique<GroupEvents>(std::move(file), degree) : nullptr;
}

} // namespace

std::unique_ptr<MemoryPressureFile> MemoryPressureFile::open(MemoryPressure degree) {
    return opener().get()(degree);
}

EnvironmentSlot<MemoryPressureFile::Opener>& MemoryPressureFile::opener() {
    static EnvironmentSlot<Opener> slot([] { return Opener(openOfKernel); });
    return slot;
}

EnvironmentSlot<MemoryPressureFile::Places>& MemoryPressureFile::places() {
    static EnvironmentSlot<Places> slot([] {
        return Places{"/proc/pressure/memory",
                      controlGroupFolder("/sys/fs/cgroup", textOf("/proc/self/cgroup"))};
    });
    return slot;
}

std::uint64_t MemoryPressureFile::eventCount(std::string_view memoryEvents, MemoryPressure degree) {
    switch (degree) {
    case MemoryPressure::ProcessLimitWarning:
        return countNamed("high", memoryEvents);
    case MemoryPressure::ProcessLimitCritical:
        return countNamed("max", memoryEvents) + countNamed("oom", memoryEvents);
    case MemoryPressure::Warning:
    case MemoryPressure::Critical:
        break;
    }
    return 0;
}

std::filesystem::path MemoryPressureFile::controlGroupFolder(const std::filesystem::path& root,
                                                             std::string_view selfCgroup) {
    constexpr std::string_view unified = "0::/";
    while (!selfCgroup.empty()) {
        const auto line = selfCgroup.substr(0, selfCgroup.find('\n'));
        if (line.starts_with(unified))
            return root / line.substr(unified.size());
        selfCgroup.remove_prefix(std::min(line.size() + 1, selfCgroup.size()));
    }
    return {};
}

} // namespace orvo
