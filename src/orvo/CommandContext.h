#pragma once

#include "orvo/console/ExitCode.h"
#include "orvo/console/Terminal.h"
#include "platform/favorites/FavoritesStore.h"
#include "platform/feeds/FeedRegistry.h"
#include "platform/feeds/schedule/ScheduleStore.h"
#include "platform/foundation/NSError.h"

#include <functional>
#include <memory>
#include <string_view>

namespace orvo {

/// What commands share: the terminal, and the stores of the profile in use, each opened when first
/// asked for.
class CommandContext {
public:
    explicit CommandContext(const Terminal& terminal)
        : _terminal(terminal) {}
    CommandContext(const CommandContext&) = delete;
    CommandContext& operator=(const CommandContext&) = delete;

    [[nodiscard]] const Terminal& terminal() const noexcept { return _terminal; }
    /// Seconds since 1970 by the environment's clock.
    [[nodiscard]] double now() const;

    /// Never nil; reading it may fail.
    [[nodiscard]] const std::shared_ptr<FeedRegistry>& registry();
    /// Nil, with the reason in `error`, when it cannot be opened.
    [[nodiscard]] std::shared_ptr<ScheduleStore> schedules(std::shared_ptr<NSError>& error);
    /// The same for who can do without it: nil where it cannot be opened, whatever the reason.
    [[nodiscard]] std::shared_ptr<ScheduleStore> schedulesIfReadable();
    /// Nil, with the reason in `error`, when they cannot be opened; also where the file is damaged
    /// and was set aside by that: it is not as if there were no favourites.
    [[nodiscard]] static std::shared_ptr<FavoritesStore> favorites(FavoritesStore::Access access,
                                                                   std::shared_ptr<NSError>& error);

    /// Turns the main thread's run loop until `done` answers true.
    static void waitUntil(const std::function<bool()>& done);

    /// Say why, and answer the code.
    [[nodiscard]] ExitCode fail(const NSError& error) const;
    [[nodiscard]] ExitCode fail(std::string_view message, std::string_view cure = {}) const;
    [[nodiscard]] ExitCode wrongUsage(std::string_view message, std::string_view cure = {}) const;

private:
    const Terminal& _terminal;
    std::shared_ptr<ScheduleStore> _schedules;
    std::shared_ptr<FeedRegistry> _registry;
};

} // namespace orvo
