#include "platform/feeds/alerts/IncidentPeriods.h"

#include "platform/feeds/alerts/HeaderTime.h"

#include <algorithm>
#include <limits>

namespace orvo {

namespace {

constexpr std::uint64_t EndOfYear9999 = 253'402'300'799;
/// Some feeds mean "open" by the last year that their calendar knows, in seconds, up to its end
/// somewhere on earth. Read as milliseconds it would be a day in 1978.
constexpr std::uint64_t BeginningOfYear9999 = 253'370'764'800;
constexpr std::uint64_t LongestDay = 26ULL * 60 * 60; // the end of a day comes up to 26 hours late
/// Below 0, published as what the same bits are without a sign. Some feeds mean "open" by -1, or by
/// the first year that their calendar knows.
constexpr std::uint64_t Negative = 1ULL << 63U;
constexpr std::int64_t LeastGap = 60;
constexpr double Horizon = 24.0 * 60 * 60;

std::int64_t startOf(const IncidentPeriod& period) {
    return period.start.value_or(std::numeric_limits<std::int64_t>::min());
}

bool isOver(const IncidentPeriod& period, double now) {
    return period.end && static_cast<double>(*period.end) < now;
}

/// Whether `later`, which starts no earlier, goes on where `earlier` ends.
bool continues(const IncidentPeriod& earlier, const IncidentPeriod& later) {
    return !earlier.end || !later.start || *later.start - *earlier.end < LeastGap;
}

/// As `wholeSeconds`, for dates up to the year 9999 only.
std::optional<std::int64_t> moment(std::optional<std::uint64_t> published) {
    const std::uint64_t seconds = wholeSeconds(published.value_or(0));
    if (seconds == 0 || seconds > EndOfYear9999)
        return std::nullopt;
    return static_cast<std::int64_t>(seconds);
}

bool isLastYear(std::optional<std::uint64_t> published) {
    return published && *published >= BeginningOfYear9999 &&
           *published <= EndOfYear9999 + LongestDay;
}

const AlertPeriods& publishedPeriods(const Alert& alert) {
    if (!alert.impactPeriods.empty())
        return alert.impactPeriods;
    return alert.communicationPeriods.empty() ? alert.activePeriods : alert.communicationPeriods;
}

} // namespace

namespace IncidentPeriods {

std::optional<IncidentPeriod> fromPublished(const AlertPeriod& period) noexcept {
    const IncidentPeriod result{moment(period.start),
                                isLastYear(period.end) ? std::nullopt : moment(period.end)};
    const std::uint64_t start = period.start.value_or(0);
    const bool neverBegins = start < Negative && wholeSeconds(start) > EndOfYear9999;
    if (neverBegins || (result.start && result.end && *result.end <= *result.start))
        return std::nullopt;
    return result;
}

void addOfAlert(const Alert& alert, std::vector<IncidentPeriod>& periods) {
    const AlertPeriods& published = publishedPeriods(alert);
    if (published.empty())
        periods.emplace_back();
    for (const AlertPeriod& period : published)
        if (const auto result = fromPublished(period))
            periods.push_back(*result);
}

std::optional<std::int64_t> earliestStart(const Alert& alert) noexcept {
    std::optional<std::int64_t> earliest;
    const auto consider = [&](const AlertPeriods& periods) {
        for (const AlertPeriod& period : periods)
            if (const auto start = moment(period.start); start && (!earliest || *start < *earliest))
                earliest = start;
    };
    consider(alert.impactPeriods);
    consider(alert.communicationPeriods);
    if (alert.impactPeriods.empty() && alert.communicationPeriods.empty())
        consider(alert.activePeriods);
    return earliest;
}

void keepCurrentAndComing(std::vector<IncidentPeriod>& periods, double now) {
    std::erase_if(periods, [&](const IncidentPeriod& period) { return isOver(period, now); });
    std::sort(periods.begin(), periods.end(), [](const auto& a, const auto& b) {
        return startOf(a) < startOf(b);
    });
    std::size_t joined = 0;
    for (const IncidentPeriod& period : periods) {
        if (joined == 0 || !continues(periods[joined - 1], period))
            periods[joined++] = period;
        else if (auto& end = periods[joined - 1].end)
            end = period.end ? std::max(end, period.end) : period.end;
    }
    periods.resize(joined);
    std::erase_if(periods, [&](const IncidentPeriod& period) {
        return period.start && static_cast<double>(*period.start) > now + Horizon;
    });
}

bool isCurrent(const IncidentPeriod& period, double now) noexcept {
    return (!period.start || static_cast<double>(*period.start) <= now) && !isOver(period, now);
}

} // namespace IncidentPeriods

} // namespace orvo
