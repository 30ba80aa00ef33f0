#pragma once

#include "platform/foundation/Clock.h"
#include "platform/foundation/EnvironmentSlot.h"

#include <cstdint>
#include <filesystem>
#include <functional>
#include <memory>

namespace orvo {

/// Draws a uniform 32-bit number.
using RandomSource = std::function<std::uint32_t()>;

/// The folders of the profile in use. All lie under the person's XDG base directories; none need
/// exist yet.
struct ProfileFolders {
    std::filesystem::path data;  ///< favourites, schedules, defaults
    std::filesystem::path cache; ///< fetched bodies; may be deleted at any time
    std::filesystem::path state; ///< analytics

    /// The person's own profile, `group.com.zentu.Orvo` in each base directory.
    [[nodiscard]] static ProfileFolders standard();
    /// The demonstration city's profile, `group.com.zentu.Orvo.demo`.
    [[nodiscard]] static ProfileFolders demonstration();
};

/// Everything of the process that tests turn and foundation itself needs. Folders above foundation
/// declare slots of their own beside the class that each serves.
class Environment {
public:
    Environment() = delete;

    /// Default: the machine's clock, or the one that `ORVO_NOW` (ISO-8601) starts.
    static EnvironmentSlot<std::shared_ptr<WallClock>>& wallClock();
    static EnvironmentSlot<std::shared_ptr<MonotonicClock>>& monotonicClock();
    /// Default: the kernel's random numbers.
    static EnvironmentSlot<RandomSource>& random();
    /// Default: the person's own profile.
    static EnvironmentSlot<ProfileFolders>& profile();
    /// Whether what the program would write stays in memory (answers for another time, prints).
    /// Default: no.
    static EnvironmentSlot<bool>& keepsWritesInMemory();
};

} // namespace orvo
