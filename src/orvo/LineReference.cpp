#include "orvo/LineReference.h"

#include "orvo/console/DisplayText.h"
#include "platform/feeds/schedule/LineSearch.h"
#include "platform/foundation/Text.h"

#include <algorithm>
#include <fmt/format.h>
#include <fmt/ranges.h>
#include <iterator>
#include <utility>

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

/// With the name that tells most; the route's own id tells nothing more.
std::string describe(const ScheduleLine& line) {
    const auto& name = line.longName.empty() ? line.name() : line.longName;
    const auto reference = nameOf(line.feed, line.routeId);
    if (line.feed.empty())
        return DisplayText::oneLine(name);
    return DisplayText::oneLine(name == line.routeId ? reference
                                                     : fmt::format("{} ({})", reference, name));
}

/// As a question, where it is few enough. `near`: one more than can be named, if there are so many;
/// what is misspelt is asked for in any case, the rest of what a search finds is better told by it.
std::string askedFor(std::vector<ScheduleLine> near, bool isFoundBySearch) {
    if (isFoundBySearch && near.size() > MostMeant)
        return {};
    near.resize(std::min(near.size(), MostMeant));
    return didYouMean(near);
}

Answer unknownRoute(const std::string& feed,
                    const std::string& routeId,
                    const std::vector<ScheduleLine>& lines) {
    LineSearch search(Text::locale().get());
    auto meant = search.named(lines, routeId);
    if (meant.empty())
        meant = search.near(lines, routeId, MostMeant + 1);
    auto cure = askedFor(std::move(meant), !search.best(lines, routeId, 1).empty());
    if (cure.empty())
        cure = fmt::format("Find its lines with: orvo lines {}", feed);
    return {std::nullopt,
            fmt::format("the schedule of {} has no line {}", feed, routeId),
            std::move(cure)};
}

Answer unknownName(const std::string& name,
                   const ScheduleStore& schedules,
                   std::shared_ptr<NSError>& unread) {
    const std::size_t colon = name.find(':');
    auto cure = askedFor(schedules.linesNear(name, MostMeant + 1, &unread),
                         !schedules.search(name, 1, &unread).empty());
    if (cure.empty())
        cure =
            colon == std::string::npos
                ? fmt::format("Look for it with: orvo lines \"{}\"", name)
                : fmt::format("Nor is there a feed {}: see orvo feeds list", name.substr(0, colon));
    return {std::nullopt, fmt::format("no line is called {}", name), std::move(cure)};
}

} // namespace

std::string nameOf(std::string_view feed, std::string_view routeId) {
    return fmt::format("{}:{}", feed, routeId);
}

std::string didYouMean(const std::vector<ScheduleLine>& lines) {
    if (lines.empty())
        return {};
    std::vector<std::string> names;
    std::ranges::transform(lines, std::back_inserter(names), describe);
    return fmt::format(
        "Did you mean {}{}?", names.size() > 1 ? "one of " : "", fmt::join(names, ", "));
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
        const auto lines = schedules.lines(feed, &unread);
        return unread ? unreadable() : unknownRoute(feed, text.substr(colon + 1), lines);
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
    auto answer = unknownName(text, schedules, unread);
    return unread ? unreadable() : answer;
}

} // namespace orvo::LineReference
