// A saved state of fifty lines, archived and read back, beside its bare content: the same lines as
// plain messages, without an archive around them; in turn in every iteration.

#include "platform/favorites/TransitStorageIncident.h"
#include "platform/favorites/TransitStorageLineItem.h"
#include "platform/foundation/CodingClass.h"
#include "platform/foundation/NSKeyedArchiver.h"
#include "platform/geoservices/TransitIncidentRecord.h"
#include "platform/geoservices/TransitLineItemRecord.h"
#include "widget/OWTransitIncidentViewControllerState.h"

#include <benchmark/benchmark.h>

#include <ctime>

namespace {

using namespace orvo;

constexpr int Lines = 50;

std::vector<std::shared_ptr<TransitLineItem>> makeLines() {
    std::vector<std::shared_ptr<TransitLineItem>> lines;
    for (int i = 0; i < Lines; ++i) {
        std::vector<std::shared_ptr<TransitIncident>> incidents;
        for (int k = 0; k <= i % 10; ++k)
            incidents.push_back(TransitIncidentRecord::initWithFields(
                {.muid = static_cast<std::uint64_t>(i * 10 + k + 1),
                 .startDate = NSDate::dateWithTimeIntervalSince1970(1'750'000'000),
                 .title = "Delays",
                 .summary = "Ten minutes",
                 .fullDescription = std::string(400, 'x')}));
        lines.push_back(TransitLineItemRecord::initWithFields_service(
            {.muid = static_cast<std::uint64_t>(i + 1), .name = "Line " + std::to_string(i)},
            {.incidents = NSArray::arrayOf(incidents)}));
    }
    return lines;
}

std::shared_ptr<NSData>
archiveOf(const std::shared_ptr<OWTransitIncidentViewControllerState>& savedState) {
    return NSKeyedArchiver::archivedDataWithRootObject_requiringSecureCoding_error(savedState,
                                                                                   true);
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

EnvironmentSlot<std::shared_ptr<const CodingClassTable>>::Override storableClasses() {
    return CodingClassTable::current().overrideWith(std::make_shared<const CodingClassTable>(
        CodingClassTable{CodingClass::of<TransitStorageIncident>("TransitStorageIncident"),
                         CodingClass::of<TransitStorageLineItem>("TransitStorageLineItem"),
                         CodingClass::of<OWTransitIncidentViewControllerState>(
                             "OWTransitIncidentViewControllerState")}));
}

void report(benchmark::State& state, double archiving, double yardstick, std::size_t bytes) {
    state.counters["bare_us"] = yardstick * 1e6 / static_cast<double>(state.iterations());
    state.counters["of_bare"] = archiving / yardstick;
    state.counters["bytes"] = static_cast<double>(bytes);
}

void write(benchmark::State& state) {
    const auto classes = storableClasses();
    const auto lines = makeLines();
    const auto savedState = OWTransitIncidentViewControllerState::initWithLineItemsResult_expanded(
        Result::resultWithValue(NSArray::arrayOf(lines)), true);
    double archiving = 0;
    double bare = 0;
    std::size_t bytes = 0;
    for (auto _ : state) {
        const double once = secondsOf([&] { bytes = archiveOf(savedState)->length(); });
        bare += secondsOf([&] {
            for (const auto& line : lines)
                benchmark::DoNotOptimize(TransitStorageLineItem::initWithLineItem(line)->data());
        });
        archiving += once;
        state.SetIterationTime(once);
    }
    report(state, archiving, bare, bytes);
}

void read(benchmark::State& state) {
    const auto classes = storableClasses();
    const auto lines = makeLines();
    const auto archive =
        archiveOf(OWTransitIncidentViewControllerState::initWithLineItemsResult_expanded(
            Result::resultWithValue(NSArray::arrayOf(lines)), true));
    std::vector<std::shared_ptr<NSData>> messages;
    for (const auto& line : lines)
        messages.push_back(TransitStorageLineItem::initWithLineItem(line)->data());
    double unarchiving = 0;
    double bare = 0;
    for (auto _ : state) {
        const double once = secondsOf([&] {
            if (!OWTransitIncidentViewControllerState::unarchiveFromData_error(archive, nullptr))
                state.SkipWithError("the archive cannot be read");
        });
        bare += secondsOf([&] {
            for (const auto& message : messages)
                benchmark::DoNotOptimize(
                    protoMessageWithBytes<TransitStorageLineItem>(message->bytes()));
        });
        unarchiving += once;
        state.SetIterationTime(once);
    }
    report(state, unarchiving, bare, archive->length());
}

BENCHMARK(write)->UseManualTime()->Unit(benchmark::kMicrosecond);
BENCHMARK(read)->UseManualTime()->Unit(benchmark::kMicrosecond);

} // namespace
