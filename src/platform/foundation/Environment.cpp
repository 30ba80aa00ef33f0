#include "platform/foundation/Environment.h"

#include "platform/foundation/ISO8601.h"
#include "platform/foundation/NSDate.h"

#include <cstdlib>
#include <sys/random.h>

namespace orvo {

namespace {

/// The base directory specification: an unset, empty or relative variable means the default.
std::filesystem::path baseDirectory(const char* variable, const char* belowHome) {
    if (const char* value = std::getenv(variable); value && *value == '/')
        return value;
    const char* home = std::getenv("HOME");
    return std::filesystem::path(home && *home == '/' ? home : "/") / belowHome;
}

ProfileFolders foldersNamed(const char* name) {
    return {baseDirectory("XDG_DATA_HOME", ".local/share") / name,
            baseDirectory("XDG_CACHE_HOME", ".cache") / name,
            baseDirectory("XDG_STATE_HOME", ".local/state") / name};
}

std::shared_ptr<WallClock> defaultWallClock() {
    if (const char* now = std::getenv("ORVO_NOW"))
        if (const auto seconds = ISO8601::parse(now))
            return WallClock::startingAt(*seconds - NSTimeIntervalSince1970);
    return WallClock::system();
}

std::uint32_t kernelRandom() {
    std::uint32_t number = 0;
    // At most 256 bytes are never cut short; only a signal before the pool is ready can interrupt.
    while (getrandom(&number, sizeof number, 0) != static_cast<ssize_t>(sizeof number)) {
    }
    return number;
}

} // namespace

ProfileFolders ProfileFolders::standard() {
    return foldersNamed("group.com.zentu.Orvo");
}
ProfileFolders ProfileFolders::demonstration() {
    return foldersNamed("group.com.zentu.Orvo.demo");
}

EnvironmentSlot<std::shared_ptr<WallClock>>& Environment::wallClock() {
    static auto& slot = *new EnvironmentSlot<std::shared_ptr<WallClock>>(defaultWallClock);
    return slot;
}

EnvironmentSlot<std::shared_ptr<MonotonicClock>>& Environment::monotonicClock() {
    static auto& slot =
        *new EnvironmentSlot<std::shared_ptr<MonotonicClock>>(MonotonicClock::system);
    return slot;
}

EnvironmentSlot<RandomSource>& Environment::random() {
    static auto& slot =
        *new EnvironmentSlot<RandomSource>([] { return RandomSource(kernelRandom); });
    return slot;
}

EnvironmentSlot<ProfileFolders>& Environment::profile() {
    static auto& slot = *new EnvironmentSlot<ProfileFolders>(ProfileFolders::standard);
    return slot;
}

EnvironmentSlot<bool>& Environment::keepsWritesInMemory() {
    static auto& slot = *new EnvironmentSlot<bool>([] { return false; });
    return slot;
}

} // namespace orvo
