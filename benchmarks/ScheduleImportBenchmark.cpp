// How long a schedule takes to import, beside the bare libraries doing the least that an import
// must do.
#include "platform/feeds/schedule/ScheduleStore.h"

#include <benchmark/benchmark.h>
#include <sqlite3.h>

#include <cstdlib>
#include <filesystem>
#include <stdexcept>
#include <string>
#include <string_view>
#include <zip.h>

namespace orvo {
namespace {

constexpr int LineCount = 2000;

std::string routesFile(int lines) {
    std::string text = "route_id,agency_id,route_short_name,route_long_name,route_type\n";
    for (int line = 0; line < lines; ++line) {
        const std::string number = std::to_string(line);
        text += "R" + number + ",A1," + number + ",Central Station - District " + number + ",3\n";
    }
    return text;
}

std::string stopTimesFile(int rows) {
    std::string text = "trip_id,arrival_time,departure_time,stop_id,stop_sequence\n";
    for (int row = 0; row < rows; ++row)
        text += "T" + std::to_string(row / 30) + ",08:00:00,08:00:30,S" +
                std::to_string(row % 500) + "," + std::to_string(row % 30) + "\n";
    return text;
}

/// A folder of its own with a zip file in it.
class Schedule {
public:
    explicit Schedule(int lines, int stopTimes = 0) {
        std::string pattern = (std::filesystem::temp_directory_path() / "orvo-XXXXXX").string();
        if (!mkdtemp(pattern.data()))
            throw std::runtime_error("cannot make a temporary folder");
        folder = pattern;
        zip_t* zip = zip_open(zipPath().c_str(), ZIP_CREATE | ZIP_TRUNCATE, nullptr);
        const std::string agency = "agency_id,agency_name,agency_timezone\nA1,City,Europe/Paris\n";
        const std::string routes = routesFile(lines);
        std::string trips = "route_id,trip_id\n";
        for (int trip = 0; trip * 30 < stopTimes; ++trip)
            trips += "R" + std::to_string(trip % lines) + ",T" + std::to_string(trip) + "\n";
        const std::string times = stopTimesFile(stopTimes);
        add(zip, "agency.txt", agency);
        add(zip, "routes.txt", routes);
        if (stopTimes > 0) {
            add(zip, "trips.txt", trips);
            add(zip, "stop_times.txt", times);
        }
        if (zip_close(zip) != 0)
            throw std::runtime_error("cannot write the zip file");
    }
    Schedule(const Schedule&) = delete;
    Schedule& operator=(const Schedule&) = delete;
    ~Schedule() {
        std::error_code ignored;
        std::filesystem::remove_all(folder, ignored);
    }

    std::filesystem::path zipPath() const { return folder / "schedule.zip"; }

    std::filesystem::path folder;

private:
    static void add(zip_t* zip, const char* name, const std::string& text) {
        zip_file_add(zip, name, zip_source_buffer(zip, text.data(), text.size(), 0), 0);
    }
};

void import(ScheduleStore& store, const Schedule& schedule) {
    if (const auto error =
            store.importSchedule("city", ScheduleSource::fromPath(schedule.zipPath()), {}, nullptr))
        throw std::runtime_error(error->localizedDescription());
}

void importLines(benchmark::State& state) {
    const Schedule schedule(LineCount);
    const auto store = ScheduleStore::open(schedule.folder / "schedules.sqlite", nullptr);
    for (auto _ : state)
        import(*store, schedule);
    state.SetItemsProcessed(state.iterations() * LineCount);
}
BENCHMARK(importLines)->Unit(benchmark::kMillisecond);

/// Inflates routes.txt, splits it at each comma and line break, and puts the fields into one table
/// in one transaction: no checks, no indices, nothing remembered.
void bareLibraries(benchmark::State& state) {
    const Schedule schedule(LineCount);
    sqlite3* database = nullptr;
    sqlite3_open((schedule.folder / "bare.sqlite").c_str(), &database);
    sqlite3_exec(database,
                 "PRAGMA journal_mode = WAL; PRAGMA synchronous = FULL;"
                 "CREATE TABLE line (id TEXT, agency TEXT, short TEXT, long TEXT, type TEXT)",
                 nullptr,
                 nullptr,
                 nullptr);
    sqlite3_stmt* insert = nullptr;
    sqlite3_prepare_v2(database, "INSERT INTO line VALUES (?, ?, ?, ?, ?)", -1, &insert, nullptr);
    for (auto _ : state) {
        zip_t* zip = zip_open(schedule.zipPath().c_str(), ZIP_RDONLY, nullptr);
        zip_file_t* file = zip_fopen(zip, "routes.txt", 0);
        std::string text(std::size_t{1} << 20, '\0');
        text.resize(static_cast<std::size_t>(zip_fread(file, text.data(), text.size())));
        zip_fclose(file);
        zip_discard(zip);
        sqlite3_exec(database, "BEGIN IMMEDIATE; DELETE FROM line", nullptr, nullptr, nullptr);
        std::string_view rest(text);
        while (!rest.empty()) {
            for (int column = 1; column <= 5; ++column) {
                const std::size_t end = rest.find_first_of(",\n");
                sqlite3_bind_text(
                    insert, column, rest.data(), static_cast<int>(end), SQLITE_STATIC);
                rest.remove_prefix(end + 1);
            }
            sqlite3_step(insert);
            sqlite3_reset(insert);
        }
        sqlite3_exec(database, "COMMIT", nullptr, nullptr, nullptr);
    }
    sqlite3_finalize(insert);
    sqlite3_close(database);
    state.SetItemsProcessed(state.iterations() * LineCount);
}
BENCHMARK(bareLibraries)->Unit(benchmark::kMillisecond);

void importStopTimes(benchmark::State& state) {
    const int rows = static_cast<int>(state.range(0));
    const Schedule schedule(100, rows);
    const auto store = ScheduleStore::open(schedule.folder / "schedules.sqlite", nullptr);
    for (auto _ : state)
        import(*store, schedule);
    state.SetItemsProcessed(state.iterations() * rows);
}
BENCHMARK(importStopTimes)->Arg(1'000'000)->Unit(benchmark::kMillisecond);

void searchLines(benchmark::State& state) {
    const int lines = static_cast<int>(state.range(0));
    const Schedule schedule(lines);
    const auto store = ScheduleStore::open(schedule.folder / "schedules.sqlite", nullptr);
    import(*store, schedule);
    for (auto _ : state)
        benchmark::DoNotOptimize(store->search("distr 17", 20));
    state.SetItemsProcessed(state.iterations() * lines);
}
BENCHMARK(searchLines)->Arg(LineCount)->Arg(10 * LineCount)->Unit(benchmark::kMillisecond);

void loadIndex(benchmark::State& state) {
    const Schedule schedule(LineCount);
    const auto store = ScheduleStore::open(schedule.folder / "schedules.sqlite", nullptr);
    import(*store, schedule);
    for (auto _ : state)
        benchmark::DoNotOptimize(store->lineIndex("city"));
    state.SetItemsProcessed(state.iterations() * LineCount);
}
BENCHMARK(loadIndex)->Unit(benchmark::kMillisecond);

} // namespace
} // namespace orvo
