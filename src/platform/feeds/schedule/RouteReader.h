#pragma once

#include "platform/feeds/schedule/RowReader.h"
#include "platform/feeds/schedule/ScheduleContents.h"
#include "platform/foundation/SeededStringHash.h"

#include <cstdint>
#include <string>
#include <vector>

namespace orvo {

/// routes.txt, read after agency.txt. Where two rows have one route_id, the first counts. Lines are
/// ordered by route_sort_order, those without one after the others, and then as they stand.
class RouteReader final : public RowReader {
public:
    /// `feed` is the short name of the feed that the lines belong to.
    RouteReader(ScheduleContents& contents, std::string feed);

    [[nodiscard]] std::string file() const override { return "routes.txt"; }
    [[nodiscard]] std::vector<std::string> neededColumns() const override { return {"route_id"}; }
    [[nodiscard]] bool isNeeded() const override { return true; }
    void begin(const CsvTable& table) override;
    void readRow(const CsvTable& table) override;
    void end() override;

private:
    struct Columns {
        std::size_t id, agency, shortName, longName, type, url, color, textColor, sortOrder;
    };
    void setAgency(ScheduleLine& line, std::string_view agencyId, std::uint64_t row);
    int routeType(std::string_view text, std::uint64_t row);

    ScheduleContents& _contents;
    std::string _feed;
    Columns _columns{};
    SeededTextSet<std::string> _ids;
};

} // namespace orvo
