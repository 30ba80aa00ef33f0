#include "orvo/HandOff.h"

#include "handoff/OrvoActivity.h"
#include "orvo/HandOffError.h"
#include "orvo/HandOffSize.h"
#include "orvo/HandOffURL.h"
#include "platform/foundation/NSKeyedUnarchiver.h"
#include "platform/geoservices/Bzip2.h"
#include "platform/mapuikit/DesktopSystemController.h"

#include <fmt/format.h>

namespace orvo {

namespace {

constexpr const char* LineActivity = "com.zentu.Orvo.Transit.Incident";
constexpr const char* LineKey = "bs";
constexpr const char* IncidentsActivity = "com.zentu.Orvo.Transit.IncidentList";
constexpr const char* IncidentsKey = "incidentListKey";

std::optional<HandOff::Content> refuse(std::shared_ptr<NSError>* error, std::string message) {
    setHandOffError(error, HandOffErrorCode::Unreadable, std::move(message));
    return std::nullopt;
}

std::shared_ptr<NSData> uncompressed(const NSData& stream) {
    std::uint8_t* bytes = nullptr;
    std::size_t length = 0;
    if (!Bzip2UncompressAtMost(
            HandOff::MaximumBytes, stream.bytes().data(), stream.length(), &bytes, &length))
        return nullptr;
    return NSData::dataWithBytesNoCopy(bytes, length);
}

constexpr HandOffSize Limit{.messageBytes = HandOff::MaximumBytes,
                            .records = HandOff::MaximumRecords};

std::optional<HandOff::Content> refuseSize(std::shared_ptr<NSError>* error) {
    setHandOffError(error,
                    HandOffErrorCode::TooLarge,
                    fmt::format("The activity's incidents have more than {} bytes, or concern more "
                                "than {} lines and stops.",
                                HandOff::MaximumBytes,
                                HandOff::MaximumRecords));
    return std::nullopt;
}

std::optional<HandOff::Content> lineOf(const NSData& payload, std::shared_ptr<NSError>* error) {
    const auto message = uncompressed(payload);
    if (!message)
        return refuse(error,
                      fmt::format("The activity's content is no whole bzip2 stream of at most {} "
                                  "bytes.",
                                  HandOff::MaximumBytes));
    if (!HandOffSize::ofActivity(message->bytes()).isWithin(Limit))
        return refuseSize(error);
    const auto activity = protoMessageWithBytes<OrvoActivity>(message->bytes());
    if (!activity)
        return refuse(error, "The activity's content is no message that the widget writes.");
    // A record without anything known in it would be shown as a line with good service.
    const auto& line = activity->lineItem();
    if (!line || (line->muid() == 0 && line->name().value_or("").empty()))
        return refuse(error, "The activity names no line.");
    return HandOff::Line{line};
}

std::optional<HandOff::Content> incidentsOf(const std::shared_ptr<NSData>& payload,
                                            std::shared_ptr<NSError>* error) {
    if (!HandOffSize::ofArchive(*payload, Limit).isWithin(Limit))
        return refuseSize(error);
    std::shared_ptr<NSError> reason;
    const auto root = NSKeyedUnarchiver::unarchivedObjectOfClasses_fromData_error(
        {"NSArray", "TransitStorageIncident"}, payload, &reason);
    const auto list = std::dynamic_pointer_cast<NSArray>(root);
    if (!list)
        return refuse(error,
                      fmt::format("The activity's content is no archive of incidents{}",
                                  reason ? ": " + reason->localizedDescription() : "."));
    HandOff::Incidents incidents;
    for (const auto& element : list->elements()) {
        auto incident = std::dynamic_pointer_cast<TransitStorageIncident>(element);
        if (!incident)
            return refuse(error, "The activity's archive holds something else than incidents.");
        incidents.incidents.push_back(std::move(incident));
    }
    return incidents;
}

std::optional<HandOff::Content> contentOfActivity(const NSData& bytes,
                                                  std::shared_ptr<NSError>* error) {
    if (bytes.length() > HandOff::MaximumBytes) {
        setHandOffError(error,
                        HandOffErrorCode::TooLarge,
                        fmt::format("The activity has more than {} bytes.", HandOff::MaximumBytes));
        return std::nullopt;
    }
    std::shared_ptr<NSError> reason;
    const auto activity = decodedUserActivity(bytes, &reason);
    if (!activity)
        return refuse(error, "What came is no activity: " + reason->localizedDescription());
    const bool isLine = activity->activityType() == LineActivity;
    if (!isLine && activity->activityType() != IncidentsActivity) {
        setHandOffError(
            error,
            HandOffErrorCode::Unknown,
            fmt::format("There is nothing to show for an activity {}.", activity->activityType()));
        return std::nullopt;
    }
    const char* key = isLine ? LineKey : IncidentsKey;
    const auto payload =
        activity->userInfo()
            ? std::dynamic_pointer_cast<NSData>(activity->userInfo()->objectForKey(key))
            : nullptr;
    if (!payload)
        return refuse(error, fmt::format("The activity has no bytes under the key {}.", key));
    return isLine ? lineOf(*payload, error) : incidentsOf(payload, error);
}

} // namespace

HandOff HandOff::ofURL(std::string url) {
    HandOff handOff;
    handOff._url = std::move(url);
    return handOff;
}

HandOff HandOff::ofActivity(std::shared_ptr<NSData> bytes) {
    HandOff handOff;
    handOff._activity = std::move(bytes);
    return handOff;
}

std::optional<HandOff::Content> HandOff::content(std::shared_ptr<NSError>* error) const {
    if (!_url)
        return contentOfActivity(*_activity, error);
    return HandOffURL::parse(*_url, error) ? std::optional<Content>(Favorites()) : std::nullopt;
}

} // namespace orvo
