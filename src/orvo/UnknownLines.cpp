#include "orvo/UnknownLines.h"

#include "orvo/LineReference.h"
#include "orvo/console/Counted.h"

#include <algorithm>
#include <fmt/ranges.h>
#include <ostream>

namespace orvo::UnknownLines {

namespace {

constexpr std::size_t MostNamed = 3;

struct Unknown {
    std::string feed;
    std::string reason;
    std::string cure;
    std::vector<std::string> lines;
};

const FeedConfiguration* find(const std::vector<FeedConfiguration>& feeds,
                              const std::string& name) {
    const auto found = std::ranges::find(feeds, name, &FeedConfiguration::name);
    return found == feeds.end() ? nullptr : &*found;
}

std::string cureFor(const IncidentReport::Line& line,
                    const FeedConfiguration* feed,
                    const ScheduleStore* schedules) {
    if (!feed)
        return "Add its feed again with orvo feeds add, or remove it with: orvo favorites remove";
    if (schedules && !schedules->info(feed->name))
        return fmt::format("Get its schedule with: orvo feeds update {}", feed->name);
    const auto known = schedules ? schedules->line(line.muid) : std::nullopt;
    if (known && !known->present)
        return fmt::format("Look for the line that took its place with: orvo lines {}", feed->name);
    return fmt::format("See what its sources say with: orvo feeds check {}", feed->name);
}

std::string nameOf(const IncidentReport::Line& line) {
    return line.feed && line.routeId && !line.routeId->empty()
               ? LineReference::nameOf(*line.feed, *line.routeId)
               : line.name;
}

std::string messageOf(const Unknown& unknown) {
    const std::string which = unknown.lines.size() <= MostNamed
                                  ? fmt::format("{}", fmt::join(unknown.lines, ", "))
                                  : Counted::text(unknown.lines.size(), "line", "lines") +
                                        (unknown.feed.empty() ? "" : " of " + unknown.feed);
    std::string reason = unknown.reason;
    while (!reason.empty() && reason.back() == '.')
        reason.pop_back();
    return fmt::format(
        "the status of {} is unknown{}{}", which, reason.empty() ? "" : ": ", reason);
}

} // namespace

std::vector<Group> of(const IncidentReport& report,
                      const std::vector<FeedConfiguration>& feeds,
                      const ScheduleStore* schedules) {
    std::vector<Unknown> all;
    for (const auto& line : report.lines) {
        const auto incident =
            std::ranges::find_if(line.incidents, [](const auto& one) { return one.isUnknown; });
        if (incident == line.incidents.end())
            continue;
        Unknown unknown{line.feed.value_or(""), incident->reason, "", {nameOf(line)}};
        const auto* feed = find(feeds, unknown.feed);
        unknown.cure = cureFor(line, feed, schedules);
        if (feed) {
            for (const auto& source : feed->alerts)
                unknown.reason = source.withoutSecrets(unknown.reason);
        }
        const auto same = std::ranges::find_if(all, [&](const auto& other) {
            return other.feed == unknown.feed && other.reason == unknown.reason &&
                   other.cure == unknown.cure;
        });
        if (same == all.end())
            all.push_back(std::move(unknown));
        else
            same->lines.push_back(unknown.lines.front());
    }
    std::vector<Group> groups;
    groups.reserve(all.size());
    for (const auto& unknown : all)
        groups.push_back({messageOf(unknown), unknown.cure});
    return groups;
}

void warn(const IncidentReport& report, CommandContext& context) {
    std::shared_ptr<NSError> ignored;
    const auto schedules = context.schedules(ignored);
    context.terminal().output().flush();
    for (const auto& group : of(report, context.registry()->feeds(), schedules.get()))
        context.terminal().warning(group.message, group.cure);
}

} // namespace orvo::UnknownLines
