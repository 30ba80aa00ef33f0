#pragma once

#include "orvo/CommandContext.h"
#include "platform/feeds/ScheduleUpdater.h"

namespace orvo {

/// Gets feeds' schedules and imports them, with progress on the terminal, and waits for it.
class ScheduleImporter {
public:
    enum class Wish {
        WhenNewer,
        InAnyCase,
    };

    explicit ScheduleImporter(CommandContext& context);

    /// The feed need not be registered yet.
    [[nodiscard]] ScheduleUpdate run(const FeedConfiguration& feed, Wish wish);

    /// Says what rows were passed over, and why, as notes on the terminal.
    void sayNotes(const ImportReport& report) const;

private:
    [[nodiscard]] ScheduleUpdater::Options optionsFor(const std::string& feed, Wish wish) const;

    CommandContext& _context;
};

} // namespace orvo
