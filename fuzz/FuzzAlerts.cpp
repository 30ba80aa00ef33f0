#include "platform/feeds/alerts/IncidentBuilder.h"

#include <cstdlib>

namespace {

using namespace orvo;

/// Two lines of one agency; the stop S1 is served by the first.
std::shared_ptr<const LineIndex> index() {
    LineIndex::Contents contents;
    contents.feed = "fuzz";
    contents.language = "en";
    for (const char* const route : {"R1", "R2"}) {
        ScheduleLine line;
        line.muid = lineMuid("fuzz", route);
        line.feed = "fuzz";
        line.routeId = route;
        line.shortName = route;
        line.agencyId = "A1";
        line.order = static_cast<std::int64_t>(contents.lines.size());
        contents.lines.push_back(line);
    }
    contents.stops.linesServingStop = [](std::string_view stop) -> std::vector<std::uint64_t> {
        if (stop == "S1")
            return {lineMuid("fuzz", "R1")};
        return {};
    };
    return std::make_shared<LineIndex>(std::move(contents));
}

std::vector<std::uint64_t> muids(const LineIncidents& line) {
    std::vector<std::uint64_t> result;
    for (const auto& incident : line.incidents)
        result.push_back(incident->muid());
    return result;
}

} // namespace

/// Whatever the bytes, a line asked about alone is told the same as among all lines; and a message
/// that cannot be read leaves no line clear.
extern "C" int LLVMFuzzerTestOneInput(const std::uint8_t* data, std::size_t size) {
    static const auto lines = index();
    constexpr double Now = 1750000000;
    const std::vector<AlertSource> sources = {{NSData::dataWithBytes({data, size}), Now, nullptr}};
    const IncidentBuilder builder(lines);
    const FeedIncidents all = builder.build(sources, {std::nullopt, Now, "en", true});
    for (const LineIncidents& line : all.lines) {
        if (all.error && (!line.isUnknown || line.incidents.empty()))
            std::abort();
        const FeedIncidents one =
            builder.build(sources, {std::vector<std::uint64_t>{line.muid}, Now, "en", true});
        if (muids(one.lines.at(0)) != muids(line) || one.lines[0].isUnknown != line.isUnknown)
            std::abort();
    }
    return 0;
}
