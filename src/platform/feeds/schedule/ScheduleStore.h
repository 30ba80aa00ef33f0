#pragma once

#include "platform/feeds/schedule/LineIndex.h"
#include "platform/feeds/schedule/ScheduleImport.h"
#include "platform/feeds/schedule/ScheduleInfo.h"
#include "platform/feeds/schedule/ScheduleLine.h"
#include "platform/feeds/schedule/ScheduleSource.h"
#include "platform/foundation/NSError.h"

#include <cstdint>
#include <filesystem>
#include <memory>
#include <optional>
#include <string>
#include <string_view>
#include <vector>

namespace orvo {

/// The schedules of all feeds, in one database file. Any thread, and any number of processes: who
/// reads sees a schedule as it was before or after an import, never in between.
///
/// Names are answered in the person's language (`Text::locale()`) where the schedule translates
/// them, else in the schedule's own. A read that fails is logged, answers nothing, and sets `error`
/// (which may be nil), which is otherwise left as it is: who would take nothing for an answer asks
/// with an error. What an index asks later tells such a failure from a stop without lines.
///
/// While `Environment::keepsWritesInMemory()` holds, the file is only read; the first change
/// continues on a copy in memory.
class ScheduleStore : public std::enable_shared_from_this<ScheduleStore> {
public:
    /// Where the profile in use keeps its schedules.
    [[nodiscard]] static std::filesystem::path defaultPath();
    /// Opens the file, and makes it and its folder when missing. Where they cannot be written the
    /// store can be read, one that is missing as one without schedules, and changes fail.
    /// @return nil when that fails, with the reason in `error` (which may be nil)
    [[nodiscard]] static std::shared_ptr<ScheduleStore> open(const std::filesystem::path& path,
                                                             std::shared_ptr<NSError>* error);
    ScheduleStore(const ScheduleStore&) = delete;
    ScheduleStore& operator=(const ScheduleStore&) = delete;
    ~ScheduleStore();

    /// The short names of all feeds that have a schedule, in order of name.
    [[nodiscard]] std::vector<std::string> feeds(std::shared_ptr<NSError>* error = nullptr) const;
    /// Nothing for a feed without a schedule.
    [[nodiscard]] std::optional<ScheduleInfo> info(std::string_view feed,
                                                   std::shared_ptr<NSError>* error = nullptr) const;
    /// The feed's lines in the schedule's order; only those that are in the schedule.
    [[nodiscard]] std::vector<ScheduleLine> lines(std::string_view feed,
                                                  std::shared_ptr<NSError>* error = nullptr) const;
    /// The line, whether in its schedule or departed; nothing when it was never known.
    [[nodiscard]] std::optional<ScheduleLine> line(std::uint64_t muid,
                                                   std::shared_ptr<NSError>* error = nullptr) const;
    /// What the alert rules need of a feed; names are the schedule's own, never translated. Nil for
    /// a feed without a schedule.
    [[nodiscard]] std::shared_ptr<const LineIndex>
    lineIndex(std::string_view feed, std::shared_ptr<NSError>* error = nullptr) const;

    /// The lines in which each word of `text` stands, in the short name, the long name or the
    /// agency's name, best first: the very short name, the very long name, the beginning of the
    /// short name, beginnings of words of the names, of the agency too, then any place; then by
    /// feed and in the schedule's order. Case and accents do not count. Empty for a text without
    /// words. Names are those in the person's language; where none fits, the schedule's own.
    [[nodiscard]] std::vector<ScheduleLine> search(std::string_view text,
                                                   std::size_t limit,
                                                   std::shared_ptr<NSError>* error = nullptr) const;
    /// The lines whose short or long name is `name`, by feed and in the schedule's order, as
    /// `search` compares them.
    [[nodiscard]] std::vector<ScheduleLine>
    linesNamed(std::string_view name, std::shared_ptr<NSError>* error = nullptr) const;
    /// At most `limit` lines that were probably meant by a misspelt `text`, nearest first, as
    /// `LineSearch::near` says; for a text by which `search` finds none.
    [[nodiscard]] std::vector<ScheduleLine> linesNear(
        std::string_view text, std::size_t limit, std::shared_ptr<NSError>* error = nullptr) const;

    /// Reads the schedule whole and then puts it in the place of the feed's earlier one, in one
    /// transaction. A line that is not in the new one stays known with `present` false.
    /// @param report may be nil; is set only on success
    /// @return nil, or why the earlier schedule was left as it is
    [[nodiscard]] std::shared_ptr<NSError> importSchedule(const std::string& feed,
                                                          const ScheduleSource& source,
                                                          const ImportOptions& options,
                                                          ImportReport* report);
    /// Forgets the feed's schedule; its lines stay known with `present` false. Nothing happens for
    /// an unknown feed.
    [[nodiscard]] std::shared_ptr<NSError> removeSchedule(const std::string& feed);

private:
    struct Implementation;
    explicit ScheduleStore(std::unique_ptr<Implementation> implementation);

    std::unique_ptr<Implementation> _implementation;
};

} // namespace orvo
