#pragma once

#include "platform/feeds/schedule/LineTranslator.h"
#include "platform/feeds/schedule/ScheduleInfo.h"
#include "platform/feeds/schedule/ScheduleLine.h"
#include "platform/sqlite/SQLiteDatabase.h"

#include <cstdint>
#include <map>
#include <optional>
#include <string>
#include <string_view>
#include <utility>
#include <vector>

namespace orvo {

/// What is asked of the store's tables. One thread at a time.
class ScheduleQueries {
public:
    explicit ScheduleQueries(SQLiteDatabase& database)
        : _database(database) {}
    ScheduleQueries(const ScheduleQueries&) = delete;
    ScheduleQueries& operator=(const ScheduleQueries&) = delete;

    /// Whether an answer since the last call is worth nothing; the database knows why.
    [[nodiscard]] bool takeFailure() { return std::exchange(_hasFailed, false); }

    [[nodiscard]] std::vector<std::string> feeds();
    [[nodiscard]] std::optional<ScheduleInfo> info(std::string_view feed);

    /// Those in the schedule, in its order.
    [[nodiscard]] std::vector<ScheduleLine> lines(std::string_view feed);
    /// Those in any schedule, by feed and in its order.
    [[nodiscard]] std::vector<ScheduleLine> allLines();
    /// One line, departed ones too, or none.
    [[nodiscard]] std::vector<ScheduleLine> linesWithMuid(std::uint64_t muid);
    /// The same lines with the names that their schedules have for them in `language`.
    [[nodiscard]] std::vector<ScheduleLine> translated(std::vector<ScheduleLine> lines,
                                                       const std::string& language);

    [[nodiscard]] std::vector<std::uint64_t> linesServingStop(std::string_view feed,
                                                              std::string_view stopId);
    [[nodiscard]] std::optional<std::string> stopName(std::string_view feed,
                                                      std::string_view stopId);

private:
    class Select;
    struct Translator {
        std::int64_t generation = 0;
        std::string language;
        LineTranslator translator;
    };
    const LineTranslator& translator(const std::string& feed, const std::string& language);
    std::vector<ScheduleTranslation> translations(std::int64_t feedNumber);

    SQLiteDatabase& _database;
    bool _hasFailed = false;
    std::map<std::string, Translator> _translators; // by feed
};

} // namespace orvo
