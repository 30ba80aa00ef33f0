#include "platform/feeds/alerts/AlertStatistics.h"

#include <fmt/format.h>
#include <numeric>

namespace orvo {

namespace {

constexpr std::size_t Reasons = static_cast<std::size_t>(AlertCount::Count_);
constexpr std::size_t MostUnresolved = 100;

constexpr std::array<std::string_view, Reasons> Names = {
    "entries",
    "alerts",
    "entries that are no alerts",
    "deleted entries",
    "unreadable entries",
    "unreadable selectors",
    "alerts that break off",
    "unreadable periods",
    "unreadable texts",
    "unreadable numbers",
    "unreadable ids",
    "empty selectors",
    "selectors with an unknown agency",
    "selectors with an unknown route",
    "selectors with a route type of no line",
    "selectors with a stop of no line",
    "selectors with a stop that the schedule could not be asked about",
    "selectors with a trip but no route",
    "selectors that contradict themselves",
    "alerts without an effect on service",
    "alerts only about step-free access",
    "alerts only for information",
    "alerts that are over or begin later",
    "alerts that concern no line",
    "alerts that repeat another",
    "incidents",
};

} // namespace

void AlertStatistics::addUnresolved(AlertCount reason, std::string_view what) {
    add(reason);
    const auto known = _unresolved.find(std::string(what));
    if (known != _unresolved.end())
        ++known->second;
    else if (_unresolved.size() < MostUnresolved)
        _unresolved.emplace(what, 1);
}

void AlertStatistics::add(const AlertStatistics& other) {
    for (std::size_t i = 0; i < Reasons; ++i)
        _counts[i] += other._counts[i];
    for (const auto& [what, count] : other._unresolved)
        if (_unresolved.contains(what) || _unresolved.size() < MostUnresolved)
            _unresolved[what] += count;
}

std::uint64_t AlertStatistics::unresolvedSelectors() const noexcept {
    const auto first = _counts.begin() + static_cast<std::ptrdiff_t>(AlertCount::EmptySelectors);
    const auto last =
        _counts.begin() + static_cast<std::ptrdiff_t>(AlertCount::ContradictorySelectors);
    return std::accumulate(first, last + 1, std::uint64_t{0});
}

std::uint64_t AlertStatistics::unreadable() const noexcept {
    const auto first =
        _counts.begin() + static_cast<std::ptrdiff_t>(AlertCount::UnreadableEntities);
    const auto last = _counts.begin() + static_cast<std::ptrdiff_t>(AlertCount::UnreadableIds);
    return std::accumulate(first, last + 1, std::uint64_t{0});
}

std::string AlertStatistics::description() const {
    std::string text;
    for (std::size_t i = 0; i < Reasons; ++i)
        if (_counts[i] > 0)
            text += fmt::format("{}: {}\n", Names[i], _counts[i]);
    for (const auto& [what, count] : _unresolved)
        text += fmt::format("unresolved: {} ({}×)\n", what, count);
    return text;
}

std::string_view AlertStatistics::nameOf(AlertCount reason) noexcept {
    return Names[static_cast<std::size_t>(reason)];
}

} // namespace orvo
