#include "orvo/LineReference.h"

#include <algorithm>
#include <fmt/format.h>
#include <fmt/ranges.h>

namespace orvo::LineReference {

namespace {

constexpr std::size_t MostNamed = 8;

Answer ambiguous(const std::string& text, const std::vector<ScheduleLine>& lines) {
    std::vector<std::string> names;
    for (const auto& line : lines) {
        if (names.size() == MostNamed) {
            names.emplace_back("…");
            break;
        }
        names.push_back(nameOf(line.feed, line.routeId));
    }
    return {std::nullopt,
            fmt::format("{} lines are called {}", lines.size(), text),
            fmt::format("Choose one of {}.", fmt::join(names, ", "))};
}

} // namespace

std::string nameOf(std::string_view feed, std::string_view routeId) {
    return fmt::format("{}:{}", feed, routeId);
}

Answer resolve(const ScheduleStore& schedules, const std::string& text) {
    std::shared_ptr<NSError> unread;
    const auto unreadable = [&] {
        return Answer{std::nullopt, unread->localizedDescription(), {}};
    };
    const auto feeds = schedules.feeds(&unread);
    if (unread)
        return unreadable();
    // A line's own name may hold a colon too, so only a known feed before it counts.
    const std::size_t colon = text.find(':');
    const std::string feed = text.substr(0, colon);
    if (colon != std::string::npos && std::ranges::count(feeds, feed) > 0) {
        auto line = schedules.line(lineMuid(feed, text.substr(colon + 1)), &unread);
        if (unread)
            return unreadable();
        if (line && line->present)
            return {std::move(line), {}, {}};
        return {std::nullopt,
                fmt::format("the schedule of {} has no line {}", feed, text.substr(colon + 1)),
                fmt::format("Find its lines with: orvo lines {}", feed)};
    }
    const auto lines = schedules.linesNamed(text, &unread);
    if (unread)
        return unreadable();
    if (lines.size() == 1)
        return {lines.front(), {}, {}};
    if (lines.size() > 1)
        return ambiguous(text, lines);
    if (feeds.empty())
        return {std::nullopt, "there is no schedule yet", NoScheduleCure};
    return {std::nullopt,
            fmt::format("no line is called {}", text),
            colon == std::string::npos
                ? fmt::format("Look for it with: orvo lines \"{}\"", text)
                : fmt::format("Nor is there a feed {}: see orvo feeds list", feed)};
}

} // namespace orvo::LineReference
