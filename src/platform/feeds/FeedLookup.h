#pragma once

#include "platform/feeds/FeedConfiguration.h"
#include "platform/feeds/FeedStatistics.h"
#include "platform/feeds/http/SourceLoader.h"
#include "platform/feeds/schedule/ScheduleStore.h"
#include "platform/geoservices/FeedTransitLine.h"
#include "platform/geoservices/FeedTransitLineItem.h"

#include <cstdint>
#include <functional>
#include <memory>
#include <optional>
#include <string>
#include <vector>

namespace orvo {

/// Domain of the lookup's own errors; those of its parts are passed on as they are.
inline constexpr const char* FeedLookupErrorDomain = "OrvoFeedLookupErrorDomain";
/// Code of `FeedLookupErrorDomain`: several feeds were asked, and none could be read. The message
/// has a line for each.
inline constexpr std::int64_t FeedLookupErrorNoFeedReadable = 1;

/// Answers what is known of lines now: asks every alert source of their feeds anew, judges the
/// alerts against the schedules, and never calls a line clear without proof. Any thread.
///
/// A line is clear only when every alert source of its feed was got whole, or confirmed, at most
/// ten minutes before the answer, and the line is in its schedule. A line without that proof
/// carries one incident that says so. A line that left its schedule, or whose feed was removed, is
/// answered from what was last known of it.
class FeedLookup final : public std::enable_shared_from_this<FeedLookup> {
public:
    /// What the lookup stands on. Each function is called on worker queues, anew for every lookup.
    struct Ground {
        /// The person's feeds in their order. On failure sets the error.
        std::function<std::vector<FeedConfiguration>(std::shared_ptr<NSError>*)> feeds;
        /// Nil, with an error, when the schedules cannot be opened.
        std::function<std::shared_ptr<ScheduleStore>(std::shared_ptr<NSError>*)> schedules;
        /// Gets a source. Calls back once, on any thread.
        std::function<void(const SourceRequest&, std::function<void(SourceBody)>)> load;
        /// What was kept of a line that no schedule ever had; nil where nothing was.
        std::function<std::shared_ptr<FeedTransitLine>(std::uint64_t muid)> lastKnownLine;
        /// Whether the person asked for step-free travel.
        std::function<bool()> asksForStepFree;
    };
    struct Answer {
        double at = 0; ///< the time for which it holds, in seconds since 1970
        /// In the order asked, one for each line asked for; empty with an error.
        std::vector<std::shared_ptr<FeedTransitLineItem>> items;
        std::vector<FeedStatistics> feeds; ///< in the person's order; with an error, too
        /// Not nil when nothing could be answered: names the feed, or the file, and the cause.
        std::shared_ptr<NSError> error;
    };
    /// Called once, on a worker queue and never inside the call that asked.
    using Completion = std::function<void(const Answer&)>;

    [[nodiscard]] static std::shared_ptr<FeedLookup> make(Ground ground);
    /// Feeds, schedules, sources and preferences of the profile in use; nothing for lines that no
    /// schedule ever had.
    ///
    /// @param insists whether servers are asked also in a pause that they asked for, since a person
    /// wants to know
    [[nodiscard]] static Ground profileGround(bool insists = false);

    explicit FeedLookup(Ground ground);
    FeedLookup(const FeedLookup&) = delete;
    FeedLookup& operator=(const FeedLookup&) = delete;

    /// The lines of these numbers. No number: an empty answer, and no source is asked. The lookup
    /// lives until it has answered.
    void lookUpLines(std::vector<std::uint64_t> muids, Completion completion) const;
    /// Every line in the schedules of these feeds; without names, of all feeds. By feed in the
    /// order asked, then in the schedule's order.
    void lookUpFeeds(std::optional<std::vector<std::string>> names, Completion completion) const;

private:
    Ground _ground;
};

} // namespace orvo
