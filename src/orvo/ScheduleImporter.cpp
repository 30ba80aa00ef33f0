#include "orvo/ScheduleImporter.h"

#include "platform/foundation/DispatchQueue.h"
#include "platform/foundation/RunLoop.h"

#include <fmt/format.h>

namespace orvo {

namespace {

/// `3.4 MB`.
std::string sizeText(std::uint64_t bytes) {
    constexpr double Million = 1e6;
    return fmt::format("{:.1f} MB", static_cast<double>(bytes) / Million);
}

/// Shows a line from any thread.
void show(const Terminal& terminal, std::string line) {
    DispatchQueue::mainQueue()->async(
        [&terminal, line = std::move(line)] { terminal.progress(line); });
}

} // namespace

ScheduleImporter::ScheduleImporter(CommandContext& context)
    : _context(context) {
    (void)RunLoop::main();
}

ScheduleUpdate ScheduleImporter::run(const FeedConfiguration& feed, Wish wish) {
    ScheduleUpdate failed;
    failed.feed = feed.name;
    auto schedules = _context.schedules(failed.error);
    if (!schedules)
        return failed;
    auto ground = ScheduleUpdater::profileGround();
    ground.schedules = [schedules](std::shared_ptr<NSError>*) {
        return schedules;
    };
    // Who registers the feed notes the time with it.
    ground.noteCheck = [](const std::string&, double) {
    };
    std::optional<ScheduleUpdate> ended;
    _context.terminal().progress(fmt::format("Loading {} …", feed.name));
    ScheduleUpdater::make(std::move(ground))
        ->update(feed, optionsFor(feed.name, wish), [&](const ScheduleUpdate& update) {
            DispatchQueue::mainQueue()->async([&ended, update] { ended = update; });
        });
    CommandContext::waitUntil([&] { return ended.has_value(); });
    _context.terminal().endProgress();
    return *ended;
}

ScheduleUpdater::Options ScheduleImporter::optionsFor(const std::string& feed, Wish wish) const {
    const auto& terminal = _context.terminal();
    ScheduleUpdater::Options options;
    options.evenUnchanged = wish == Wish::InAnyCase;
    options.import.progress = [&terminal, feed](const ImportProgress& progress) {
        constexpr double Percent = 100;
        show(terminal,
             fmt::format(
                 "Importing {}: {:.0f} % {}", feed, progress.fraction * Percent, progress.file));
    };
    options.progress = [&terminal, feed](std::uint64_t soFar, std::optional<std::uint64_t> total) {
        const std::string of = total ? " of " + sizeText(*total) : "";
        show(terminal, fmt::format("Loading {}: {}{}", feed, sizeText(soFar), of));
    };
    return options;
}

void ScheduleImporter::sayNotes(const ImportReport& report) const {
    for (const auto& note : report.notes) {
        const std::string where =
            note.firstRow == 0 ? "" : fmt::format(" (first: row {})", note.firstRow);
        _context.terminal().note(
            fmt::format("  {}: {} × {}{}", note.file, note.count, note.reason, where));
    }
}

} // namespace orvo
