#pragma once

#include "platform/feeds/FeedLookup.h"

#include <atomic>
#include <unordered_map>
#include <variant>

namespace orvo {

/// One lookup from its question to its answer: plans which feeds to ask, gets their sources side by
/// side, then judges them at one moment.
class FeedLookupRun : public std::enable_shared_from_this<FeedLookupRun> {
public:
    using LineNumbers = std::vector<std::uint64_t>;
    struct AllLines {
        std::optional<std::vector<std::string>> feeds; ///< nothing for all feeds
    };
    using Question = std::variant<LineNumbers, AllLines>;

    FeedLookupRun(FeedLookup::Ground ground, Question question, FeedLookup::Completion completion);

    void start();

private:
    struct Feed {
        FeedConfiguration configuration;
        std::shared_ptr<const LineIndex> index; // without lines where there is no schedule
        bool hasSchedule = false;
        std::vector<std::uint64_t> lines; // those wanted that are in the schedule
        std::vector<AlertSource> sources; // one for each of the configuration's, as they come
    };
    struct Line {
        std::shared_ptr<FeedTransitLine> line;
        std::string timeZone;
        std::optional<double> knownAt;   // when a schedule that has it came, in seconds since 1970
        std::shared_ptr<NSError> unread; // why its schedule could not be asked; nil when it could
    };

    // On worker queues, one after the other.
    void begin();
    [[nodiscard]] std::shared_ptr<NSError> plan();
    [[nodiscard]] std::shared_ptr<NSError> planFeeds(const AllLines& wanted,
                                                     const std::vector<FeedConfiguration>& all,
                                                     const ScheduleStore& schedules);
    [[nodiscard]] std::shared_ptr<NSError> planLines(const std::vector<FeedConfiguration>& all,
                                                     const ScheduleStore& schedules);
    using LinesOfFeeds = std::unordered_map<std::string, LineNumbers>;
    /// What is known of a line. It is put among its feed's where it is in the schedule.
    [[nodiscard]] Line
    lineOf(std::uint64_t muid, const ScheduleStore& schedules, LinesOfFeeds& linesOfFeeds) const;
    /// @return why the schedule could not be read: then the feed is not added; nil when it is
    [[nodiscard]] std::shared_ptr<NSError> addFeed(const FeedConfiguration& configuration,
                                                   LineNumbers lines,
                                                   const ScheduleStore& schedules);
    void load();
    void sourceArrived();
    void answer();

    void judge(const Feed& feed);
    [[nodiscard]] std::shared_ptr<NSError> errorOfAllFeeds() const;
    [[nodiscard]] std::shared_ptr<FeedTransitLineItem> itemOf(std::uint64_t muid) const;
    [[nodiscard]] std::shared_ptr<NSArray> incidentsOf(const Line& line) const;

    const FeedLookup::Ground _ground;
    const FeedLookup::Completion _completion;
    const Question _question;
    LineNumbers _wanted; // the lines in the order asked
    std::vector<Feed> _feeds;
    std::unordered_map<std::uint64_t, Line> _lines;
    std::atomic<std::size_t> _awaited = 0; // sources that have not come yet
    IncidentQuery _moment;                 // now, language and preferences of the answer
    std::unordered_map<std::uint64_t, LineIncidents> _known;
    FeedLookup::Answer _answer;
};

} // namespace orvo
