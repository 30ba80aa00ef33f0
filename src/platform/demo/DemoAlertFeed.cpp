#include "platform/demo/DemoAlertFeed.h"

#include <protozero/pbf_builder.hpp>

#include <cmath>

namespace orvo {

namespace {

// Field numbers of the GTFS-Realtime format.
enum class FeedMessage : protozero::pbf_tag_type { Header = 1, Entity = 2 };
enum class FeedHeader : protozero::pbf_tag_type { Version = 1, Timestamp = 3 };
enum class FeedEntity : protozero::pbf_tag_type { Id = 1, Alert = 5 };
enum class Alert : protozero::pbf_tag_type {
    ActivePeriod = 1,
    InformedEntity = 5,
    Cause = 6,
    Effect = 7,
    Header = 10,
    Description = 11,
    Severity = 14,
};
enum class TimeRange : protozero::pbf_tag_type { Start = 1, End = 2 };
enum class EntitySelector : protozero::pbf_tag_type { AgencyId = 1, RouteId = 2, StopId = 5 };
enum class TranslatedString : protozero::pbf_tag_type { Translation = 1 };
enum class Translation : protozero::pbf_tag_type { Text = 1, Language = 2 };

std::uint64_t wholeSeconds(double time) {
    return static_cast<std::uint64_t>(std::llround(time));
}

std::string encoded(const DemoIncident::Text& text) {
    std::string bytes;
    protozero::pbf_builder<TranslatedString> string(bytes);
    for (const auto& [words, language] :
         {std::pair(text.english, "en"), std::pair(text.german, "de")}) {
        protozero::pbf_builder<Translation> translation(string, TranslatedString::Translation);
        translation.add_string(Translation::Text, words);
        translation.add_string(Translation::Language, language);
    }
    return bytes;
}

std::string encoded(const DemoIncident::Period& period) {
    std::string bytes;
    protozero::pbf_builder<TimeRange> range(bytes);
    if (period.start)
        range.add_uint64(TimeRange::Start, wholeSeconds(*period.start));
    if (period.end)
        range.add_uint64(TimeRange::End, wholeSeconds(*period.end));
    return bytes;
}

std::string encoded(const DemoIncident::Selector& selector) {
    std::string bytes;
    protozero::pbf_builder<EntitySelector> builder(bytes);
    if (!selector.agencyId.empty())
        builder.add_string(EntitySelector::AgencyId, selector.agencyId);
    if (!selector.routeId.empty())
        builder.add_string(EntitySelector::RouteId, selector.routeId);
    if (!selector.stopId.empty())
        builder.add_string(EntitySelector::StopId, selector.stopId);
    return bytes;
}

std::string encoded(const DemoIncident& incident) {
    std::string bytes;
    protozero::pbf_builder<Alert> alert(bytes);
    for (const auto& period : incident.periods)
        alert.add_message(Alert::ActivePeriod, encoded(period));
    for (const auto& selector : incident.selectors)
        alert.add_message(Alert::InformedEntity, encoded(selector));
    alert.add_enum(Alert::Cause, static_cast<std::int32_t>(incident.cause));
    alert.add_enum(Alert::Effect, static_cast<std::int32_t>(incident.effect));
    alert.add_message(Alert::Header, encoded(incident.header));
    alert.add_message(Alert::Description, encoded(incident.description));
    alert.add_enum(Alert::Severity, static_cast<std::int32_t>(incident.severity));
    return bytes;
}

} // namespace

std::shared_ptr<NSData> demoAlertFeed(const std::vector<DemoIncident>& incidents,
                                      double timestamp) {
    std::string bytes;
    protozero::pbf_builder<FeedMessage> message(bytes);
    {
        protozero::pbf_builder<FeedHeader> header(message, FeedMessage::Header);
        header.add_string(FeedHeader::Version, "2.0");
        header.add_uint64(FeedHeader::Timestamp, wholeSeconds(timestamp));
    }
    for (const auto& incident : incidents) {
        protozero::pbf_builder<FeedEntity> entity(message, FeedMessage::Entity);
        entity.add_string(FeedEntity::Id, incident.id);
        entity.add_message(FeedEntity::Alert, encoded(incident));
    }
    return NSData::dataWithString(bytes);
}

} // namespace orvo
