// From the bytes of a large feed to the incidents of ten lines, beside a full decode of the same
// bytes by generated code: both in turn in every iteration, so that they have the same machine.
// `share_of_decode` counts what the two sides take to make their results, `share_with_release` also
// to throw them away.

#include "platform/feeds/alerts/IncidentBuilder.h"

#include <benchmark/benchmark.h>

#include <algorithm>
#include <cstdlib>
#include <ctime>
#include <fstream>
#include <gtfs_realtime.pb.h>
#include <iterator>
#include <malloc.h>
#include <memory>
#include <new>
#include <string>

namespace {

/// Bytes that were taken from the heap and not given back, now and at most, while counting.
bool counting = false; // one thread only
std::ptrdiff_t live = 0;
std::ptrdiff_t peak = 0;

void* counted(void* block) {
    if (!block)
        throw std::bad_alloc();
    if (counting) {
        live += static_cast<std::ptrdiff_t>(malloc_usable_size(block));
        peak = std::max(peak, live);
    }
    return block;
}

} // namespace

void* operator new(std::size_t size) {
    return counted(std::malloc(size));
}
/// What lists share is taken with its alignment.
void* operator new(std::size_t size, std::align_val_t alignment) {
    const auto to = static_cast<std::size_t>(alignment);
    return counted(std::aligned_alloc(to, (size + to - 1) / to * to));
}
void operator delete(void* block) noexcept {
    if (counting && block)
        live -= static_cast<std::ptrdiff_t>(malloc_usable_size(block));
    std::free(block);
}
void operator delete(void* block, std::size_t) noexcept {
    operator delete(block);
}
void operator delete(void* block, std::align_val_t) noexcept {
    operator delete(block);
}
void operator delete(void* block, std::size_t, std::align_val_t) noexcept {
    operator delete(block);
}

namespace {

using namespace orvo;

/// The heap keeps its pages from one iteration to the next, for both sides alike: how dear a fresh
/// page is depends on the machine more than on the code.
const bool keepsPages =
    mallopt(M_TRIM_THRESHOLD, 1 << 30) != 0 && mallopt(M_MMAP_THRESHOLD, 1 << 30) != 0;

constexpr double Now = 1750000000; // the capture's own time
constexpr int Routes = 2000;

std::shared_ptr<NSData> feedBytes() {
    const char* const folder = std::getenv("ORVO_TEST_FEEDS");
    std::ifstream file(std::string(folder ? folder : "../shared/data") + "/perf/alerts-5000.pb",
                       std::ios::binary);
    return NSData::dataWithString(std::string(std::istreambuf_iterator<char>(file), {}));
}

std::shared_ptr<const LineIndex> makeIndex() {
    LineIndex::Contents contents;
    contents.feed = "perf";
    contents.timezone = "Europe/Paris";
    for (int i = 0; i < Routes; ++i) {
        ScheduleLine line;
        line.feed = "perf";
        line.routeId = "R" + std::to_string(i);
        line.muid = lineMuid(line.feed, line.routeId);
        line.agencyId = "A1";
        line.shortName = std::to_string(i);
        line.longName = "Line " + line.shortName;
        line.order = i;
        line.agency = {"A1", "Perf Agency", "", "Europe/Paris", ""};
        contents.lines.push_back(line);
    }
    return std::make_shared<LineIndex>(std::move(contents));
}

/// Processor time: other programs on the machine do not count.
double processorSeconds() {
    timespec time{};
    clock_gettime(CLOCK_THREAD_CPUTIME_ID, &time);
    return static_cast<double>(time.tv_sec) + static_cast<double>(time.tv_nsec) * 1e-9;
}

template <class Work>
double secondsOf(const Work& work) {
    const double begin = processorSeconds();
    work();
    return processorSeconds() - begin;
}

/// What one side took: to make its result, and to throw it away again.
struct Seconds {
    double making = 0;
    double release = 0;

    void add(const Seconds& other) {
        making += other.making;
        release += other.release;
    }
    [[nodiscard]] double all() const { return making + release; }
};

/// The yardstick.
Seconds secondsOfDecoding(benchmark::State& state, const NSData& bytes) {
    auto message = std::make_unique<transit_realtime::FeedMessage>();
    return {
        secondsOf([&] {
            if (!message->ParseFromArray(bytes.bytes().data(), static_cast<int>(bytes.length())))
                state.SkipWithError("the yardstick cannot read the feed");
        }),
        secondsOf([&] { message.reset(); })};
}

Seconds secondsOfBuilding(const IncidentBuilder& builder,
                          const std::vector<AlertSource>& sources,
                          const IncidentQuery& query) {
    FeedIncidents answer;
    return {secondsOf([&] { answer = builder.build(sources, query); }),
            secondsOf([&] { answer = {}; })};
}

void build(benchmark::State& state, const IncidentQuery& query) {
    const auto bytes = feedBytes();
    if (bytes->length() == 0)
        return state.SkipWithError("ORVO_TEST_FEEDS does not name the captured feeds");
    if (!keepsPages)
        return state.SkipWithError("the heap cannot be told to keep its pages");
    const IncidentBuilder builder(makeIndex());
    const std::vector<AlertSource> sources = {{bytes, Now, nullptr}};
    Seconds decoding;
    Seconds building;
    live = peak = 0;
    counting = true;
    const FeedIncidents counted = builder.build(sources, query);
    counting = false;
    for (auto _ : state) {
        decoding.add(secondsOfDecoding(state, *bytes));
        const Seconds once = secondsOfBuilding(builder, sources, query);
        building.add(once);
        state.SetIterationTime(once.making);
    }
    std::size_t incidents = 0;
    for (const LineIncidents& line : counted.lines)
        incidents += line.incidents.size();
    state.counters["decode_ms"] = decoding.making * 1e3 / static_cast<double>(state.iterations());
    state.counters["share_of_decode"] = building.making / decoding.making;
    state.counters["share_with_release"] = building.all() / decoding.all();
    state.counters["peak_in_feeds"] =
        1 + static_cast<double>(peak) / static_cast<double>(bytes->length());
    state.counters["incidents"] = static_cast<double>(incidents);
}

/// Ten lines, each so many places behind the one before.
void tenLines(benchmark::State& state) {
    IncidentQuery query{std::vector<std::uint64_t>(), Now, "en", false};
    for (int i = 0; i < 10; ++i)
        query.lines->push_back(lineMuid("perf", "R" + std::to_string(i * state.range(0))));
    build(state, query);
}

void allLines(benchmark::State& state) {
    build(state, {std::nullopt, Now, "en", false});
}

BENCHMARK(tenLines)->ArgName("apart")->Arg(1)->Arg(200)->UseManualTime()->Unit(
    benchmark::kMillisecond);
BENCHMARK(allLines)->UseManualTime()->Unit(benchmark::kMillisecond);

} // namespace
