#pragma once

#include "platform/feeds/schedule/RowReader.h"
#include "platform/feeds/schedule/ScheduleContents.h"
#include "platform/feeds/schedule/TripIndex.h"
#include "platform/foundation/SeededStringHash.h"

#include <cstdint>
#include <string_view>

namespace orvo {

/// trips.txt, read after routes.txt: only which line each trip belongs to.
class TripReader final : public RowReader {
public:
    TripReader(ScheduleContents& contents, TripIndex& trips)
        : _contents(contents)
        , _trips(trips) {}

    [[nodiscard]] std::string file() const override { return "trips.txt"; }
    [[nodiscard]] std::vector<std::string> neededColumns() const override {
        return {"trip_id", "route_id"};
    }
    void begin(const CsvTable& table) override;
    void readRow(const CsvTable& table) override;
    void end() override { _trips.sort(); }

private:
    ScheduleContents& _contents;
    TripIndex& _trips;
    std::size_t _tripId = CsvTable::NoColumn;
    std::size_t _routeId = CsvTable::NoColumn;
    SeededTextMap<std::string_view, std::uint32_t> _lines; // views into the contents
};

} // namespace orvo
