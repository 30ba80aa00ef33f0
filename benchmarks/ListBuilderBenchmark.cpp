// From line items to rows: time a line over growing numbers of lines, beside the same work done
// naively (a walk over all rows for each incident), in turn in every iteration.

#include "platform/geoservices/TransitIncidentRecord.h"
#include "platform/geoservices/TransitLineItemRecord.h"
#include "viewmodel/OWTransitIncidentsDataSourceBuilder.h"

#include <benchmark/benchmark.h>

#include <algorithm>
#include <ctime>

namespace {

using namespace orvo;

using LineItems = std::vector<std::shared_ptr<TransitLineItem>>;

std::shared_ptr<TransitArtworkDataSource> shield(const std::string& text) {
    return TransitArtworkDataSource::initWithFields(
        {.artworkSourceType = 1,
         .shieldDataSource = TransitShieldDataSource::initWithFields({.shieldText = text})});
}

/// One to ten incidents a line; every third one is that of the line before, too.
LineItems makeLines(std::int64_t count) {
    LineItems lines;
    const auto mark = shield("S");
    std::uint64_t muid = 1;
    for (std::int64_t i = 0; i < count; ++i) {
        std::vector<std::shared_ptr<TransitIncident>> incidents;
        for (std::int64_t k = 0; k <= i % 10; ++k) {
            if (k % 3 != 2 || muid == 1)
                ++muid;
            incidents.push_back(TransitIncidentRecord::initWithFields(
                {.muid = muid, .title = "Delays", .summary = "Ten minutes"}));
        }
        lines.push_back(TransitLineItemRecord::initWithFields_service(
            {.muid = static_cast<std::uint64_t>(i + 1),
             .name = "Line " + std::to_string(i),
             .artwork = mark,
             .alternateArtwork = mark},
            {.incidents = NSArray::arrayOf(incidents)}));
    }
    return lines;
}

/// Processor time: other programs on the machine do not count.
template <class Work>
double secondsOf(const Work& work) {
    const auto now = [] {
        timespec time{};
        clock_gettime(CLOCK_THREAD_CPUTIME_ID, &time);
        return static_cast<double>(time.tv_sec) + static_cast<double>(time.tv_nsec) * 1e-9;
    };
    const double begin = now();
    work();
    return now() - begin;
}

/// The yardstick: no texts, no artwork, only the search for the row that an incident has already,
/// by a walk over all of them.
std::size_t rowsNaively(const LineItems& lines) {
    std::vector<std::uint64_t> rows;
    for (const auto& line : lines)
        for (const auto& incident : typed<TransitIncident>(line->incidents()))
            if (std::ranges::find(rows, incident->muid()) == rows.end())
                rows.push_back(incident->muid());
    return rows.size();
}

void buildList(benchmark::State& state) {
    const auto lines = makeLines(state.range(0));
    const auto array = NSArray::arrayOf(lines);
    const auto cache = ArtworkDataSourceCache::initWithArtworkManager(nullptr);
    double building = 0;
    double walking = 0;
    for (auto _ : state) {
        const double once = secondsOf([&] {
            benchmark::DoNotOptimize(OWTransitIncidentsDataSourceBuilder::
                                         initWithLineItems_maxNumberOfItems_artworkCache_analytics(
                                             array, 5, cache, nullptr)
                                             ->listItem());
        });
        walking += secondsOf([&] { benchmark::DoNotOptimize(rowsNaively(lines)); });
        building += once;
        state.SetIterationTime(once);
    }
    const double runs = static_cast<double>(state.iterations());
    const double count = static_cast<double>(state.range(0));
    state.counters["us_a_line"] = building * 1e6 / runs / count;
    state.counters["naive_search_us_a_line"] = walking * 1e6 / runs / count;
    state.SetComplexityN(state.range(0));
}

BENCHMARK(buildList)
    ->ArgName("lines")
    ->RangeMultiplier(10)
    ->Range(10, 10'000)
    ->UseManualTime()
    ->Unit(benchmark::kMillisecond)
    ->Complexity(benchmark::oN);

} // namespace
