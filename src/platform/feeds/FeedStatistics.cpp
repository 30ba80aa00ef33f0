#include "platform/feeds/FeedStatistics.h"

#include "platform/foundation/ISO8601.h"

#include <fmt/format.h>

namespace orvo {

namespace {

std::string describe(std::size_t number, const AlertSourceReport& source) {
    auto text = fmt::format("source {}: ", number);
    text += source.error ? source.error->localizedDescription() : "read";
    if (source.fetchedAt > 0)
        text += fmt::format(", fetched {}", ISO8601::string(source.fetchedAt));
    if (source.headerTime)
        text += fmt::format(", made {}", ISO8601::string(*source.headerTime));
    return text + "\n";
}

} // namespace

std::string FeedStatistics::description() const {
    auto text = fmt::format("feed: {}\n", feed);
    if (!hasSchedule)
        text += "no schedule\n";
    text += fmt::format("lines: {}\nlines with incidents: {}\nunknown lines: {}\n",
                        lines,
                        linesWithIncidents,
                        unknownLines);
    for (std::size_t index = 0; index < sources.size(); ++index)
        text += describe(index + 1, sources[index]);
    text += alerts.description();
    if (error)
        text += fmt::format("error: {}\n", error->localizedDescription());
    return text;
}

} // namespace orvo
