#pragma once

#include "platform/feeds/schedule/RowReader.h"
#include "platform/feeds/schedule/ScheduleContents.h"

#include <string>

namespace orvo {

/// feed_info.txt, read after agency.txt; only its first row. What it leaves out comes from the
/// first agency.
class FeedInfoReader final : public RowReader {
public:
    explicit FeedInfoReader(ScheduleContents& contents)
        : _contents(contents) {}

    [[nodiscard]] std::string file() const override { return "feed_info.txt"; }
    [[nodiscard]] std::vector<std::string> neededColumns() const override { return {}; }
    void begin(const CsvTable& table) override;
    void readRow(const CsvTable& table) override;
    void end() override;

private:
    std::string readDate(const CsvTable& table, const char* column);

    ScheduleContents& _contents;
    bool _hasRow = false;
};

} // namespace orvo
