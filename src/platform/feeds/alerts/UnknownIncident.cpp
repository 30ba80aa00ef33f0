#include "platform/feeds/alerts/UnknownIncident.h"

#include "platform/feeds/alerts/FeedAffectedEntity.h"
#include "platform/feeds/alerts/IncidentWords.h"
#include "platform/foundation/Hashing.h"

#include <algorithm>
#include <utility>

namespace orvo {

namespace {

std::uint64_t muidOf(const UnknownLine& line) {
    std::string content = line.feed;
    content += '\0';
    content += std::to_string(line.muid);
    content += '\0';
    content += "unknown";
    return std::max<std::uint64_t>(stableHash(content), 1);
}

/// A sentence with its cause, which may be no sentence, behind a colon.
std::string because(std::string sentence, const std::string& cause) {
    if (cause.empty())
        return sentence;
    if (sentence.ends_with('.'))
        sentence.pop_back();
    return sentence + ": " + cause;
}

std::string reasonInWords(const UnknownStatus& status, const IncidentWords& words) {
    switch (status.reason) {
    case UnknownStatus::Reason::SourceFailed:
        return because(words.sourceFailed(), status.cause);
    case UnknownStatus::Reason::SelectorLost:
        return status.cause.empty() ? words.selectorLost()
                                    : words.selectorLost() + "\n\n" + status.cause;
    case UnknownStatus::Reason::LineDeparted:
        return words.lineDeparted();
    case UnknownStatus::Reason::ScheduleUnread:
        return because(words.scheduleUnread(), status.cause);
    case UnknownStatus::Reason::NothingToAsk:
        return words.nothingToAsk();
    }
    return {};
}

} // namespace

std::shared_ptr<FeedTransitIncident> makeUnknownIncident(const UnknownLine& line,
                                                         const UnknownStatus& status,
                                                         double now,
                                                         const std::string& language) {
    const IncidentWords words(language);
    std::optional<double> age;
    if (status.lastKnown)
        age = std::max(now - *status.lastKnown, 0.0);

    TransitIncidentRecord::Fields fields;
    fields.muid = muidOf(line);
    fields.title = words.statusUnknown();
    fields.summary = words.lastKnown(line.systemName, age);
    fields.fullDescription = *fields.summary + "\n\n" + reasonInWords(status, words);
    fields.iconType = static_cast<std::int32_t>(IncidentEffect::UnknownEffect);
    fields.affectedEntities = NSArray::arrayOf(
        {FeedAffectedEntity::initWithMuid_stops_firstStop_endStop(line.muid, nullptr, 0, 0)});

    FeedTransitIncident::Details details;
    details.feed = line.feed;
    details.isUnknown = true;
    if (!line.timeZone.empty())
        details.timeZone = line.timeZone;
    return FeedTransitIncident::initWithFields_details(std::move(fields), std::move(details));
}

} // namespace orvo
