#pragma once

#include "platform/feeds/schedule/RowReader.h"
#include "platform/feeds/schedule/ScheduleContents.h"
#include "platform/feeds/schedule/TripIndex.h"
#include "platform/foundation/SeededStringHash.h"

#include <cstdint>
#include <optional>
#include <string>
#include <string_view>

namespace orvo {

/// stop_times.txt, read after stops.txt and trips.txt: only which lines serve a stop. A station is
/// served by the lines of its stops. Memory grows with what is learnt, not with the file.
class StopTimeReader final : public RowReader {
public:
    StopTimeReader(ScheduleContents& contents, const TripIndex& trips)
        : _contents(contents)
        , _trips(trips) {}

    [[nodiscard]] std::string file() const override { return "stop_times.txt"; }
    [[nodiscard]] std::vector<std::string> neededColumns() const override {
        return {"trip_id", "stop_id"};
    }
    void begin(const CsvTable& table) override;
    void readRow(const CsvTable& table) override;
    void end() override;

private:
    std::optional<std::uint32_t> lineOfTrip(std::string_view tripId);
    std::uint32_t numberOfStop(std::string_view stopId, std::uint64_t row);
    void addStations();
    void removeRepetitions();

    ScheduleContents& _contents;
    const TripIndex& _trips;
    std::size_t _tripId = CsvTable::NoColumn;
    std::size_t _stopId = CsvTable::NoColumn;
    std::size_t _pickup = CsvTable::NoColumn;
    std::size_t _dropOff = CsvTable::NoColumn;
    SeededTextMap<std::string_view, std::uint32_t> _stops; // views into the contents
    std::string _lastTripId;                               // rows of one trip stand together
    std::optional<std::uint32_t> _lastLine;
    std::size_t _compactedSize = 0;
};

} // namespace orvo
