#pragma once

#include "platform/feeds/FeedConfiguration.h"
#include "platform/feeds/http/SourceLoader.h"
#include "platform/feeds/schedule/ScheduleStore.h"
#include "platform/foundation/EnvironmentSlot.h"

#include <atomic>
#include <cstdint>
#include <functional>
#include <memory>
#include <optional>
#include <string>
#include <vector>

namespace orvo {

/// What became of asking for a newer schedule.
struct ScheduleUpdate {
    enum class Outcome {
        Imported,
        Unchanged, ///< the schedule in the store is the current one
        Failed     ///< the schedule in the store stays as it was
    };
    std::string feed;
    Outcome outcome = Outcome::Failed;
    ImportReport report;            ///< of an import
    std::shared_ptr<NSError> error; ///< of a failure: names feed, place and reason
};

/// Asks for newer schedules and imports them. Any thread.
class ScheduleUpdater final : public std::enable_shared_from_this<ScheduleUpdater> {
public:
    /// What the updater stands on. Each function is called on worker queues.
    struct Ground {
        std::function<std::vector<FeedConfiguration>()> feeds;
        /// Nil, with an error, when the schedules cannot be opened.
        std::function<std::shared_ptr<ScheduleStore>(std::shared_ptr<NSError>*)> schedules;
        std::function<void(const SourceRequest&, const LoadOptions&, SourceLoader::Completion)>
            load;
        /// The body kept of an earlier load; without bytes where there is none.
        std::function<SourceBody(const SourceRequest&)> lastGoodBody;
        /// Keeps when a feed's schedule was asked for, in seconds since 1970.
        std::function<void(const std::string& feed, double seconds)> noteCheck;
    };
    struct Options {
        ImportOptions import;
        /// As in `LoadOptions`.
        std::function<void(std::uint64_t soFar, std::optional<std::uint64_t> total)> progress;
        /// Import also what is already in the store.
        bool evenUnchanged = false;
    };
    /// Called once, on a worker queue and never inside the call that asked.
    using Completion = std::function<void(const ScheduleUpdate&)>;

    /// Whether the program lives on after an answer, so that it has the time to look for newer
    /// schedules. Default: yes; a program that ends with its answer turns it off.
    static EnvironmentSlot<bool>& checksDaily();

    /// Of the profile in use.
    [[nodiscard]] static Ground profileGround();
    [[nodiscard]] static std::shared_ptr<ScheduleUpdater> make(Ground ground);

    explicit ScheduleUpdater(Ground ground);
    ScheduleUpdater(const ScheduleUpdater&) = delete;
    ScheduleUpdater& operator=(const ScheduleUpdater&) = delete;

    /// Asks for the feed's schedule now, conditionally, and imports it where it is new.
    void update(FeedConfiguration feed, Options options, Completion completion);

    /// The same, in the background and one after the other, for every feed that was not asked for a
    /// day; what comes of it is logged. A feed whose update failed is due again after an hour. Does
    /// nothing while an earlier check runs, where `checksDaily()` says no, and where writes are
    /// kept in memory. `done`, which may be empty, is called on a worker queue with how many feeds
    /// were due.
    void checkSchedules(std::function<void(std::size_t)> done);

private:
    struct Check;
    void checkNext(const std::shared_ptr<Check>& check);
    void take(const FeedConfiguration& feed,
              const Options& options,
              const SourceBody& earlier,
              const SourceBody& body,
              const Completion& completion) const;
    [[nodiscard]] ScheduleUpdate import(const FeedConfiguration& feed,
                                        const ScheduleSource& source,
                                        const Options& options) const;
    [[nodiscard]] std::optional<double> importedAt(const std::string& feed) const;

    Ground _ground;
    std::atomic<bool> _isChecking = false;
};

} // namespace orvo
