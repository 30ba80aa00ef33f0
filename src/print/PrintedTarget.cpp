#include "print/PrintedTarget.h"

#include "handoff/NSDataOrvoExtra.h"
#include "handoff/NSURLOWOpenable.h"
#include "handoff/OWUserActivityData.h"
#include "handoff/OrvoActivity.h"
#include "platform/favorites/TransitStorageIncident.h"
#include "platform/foundation/NSArray.h"
#include "platform/foundation/NSKeyedUnarchiver.h"

#include <fmt/format.h>

namespace orvo {

namespace {

constexpr const char* LineKey = "bs";

std::shared_ptr<NSData> payload(const NSDictionary& userInfo, const char* key) {
    return std::dynamic_pointer_cast<NSData>(userInfo.objectForKey(key));
}

std::optional<std::uint64_t> lineMuid(const std::shared_ptr<NSData>& compressed) {
    const auto bytes = compressed ? NSDataOrvoExtra::bzip2UncompressedData(*compressed) : nullptr;
    const auto activity = bytes ? protoMessageWithBytes<OrvoActivity>(bytes->bytes()) : nullptr;
    if (!activity || !activity->lineItem())
        return std::nullopt;
    return activity->lineItem()->muid();
}

std::optional<std::vector<std::uint64_t>> incidentMuids(const NSDictionary& userInfo) {
    const auto archive = payload(userInfo, "incidentListKey");
    if (!archive)
        return std::nullopt;
    const auto incidents = std::dynamic_pointer_cast<NSArray>(
        NSKeyedUnarchiver::unarchivedObjectOfClasses_fromData_error(
            {"NSArray", "TransitStorageIncident"}, archive));
    if (!incidents)
        return std::nullopt;
    std::vector<std::uint64_t> muids;
    for (const auto& incident : typed<TransitStorageIncident>(incidents))
        muids.push_back(incident->muid());
    return muids;
}

} // namespace

std::optional<PrintedTarget> PrintedTarget::of(const std::shared_ptr<OWOpenable>& openable,
                                               const PrintedTarget* before) {
    if (!openable)
        return std::nullopt;
    PrintedTarget target;
    if (const auto url = std::dynamic_pointer_cast<NSURLOWOpenable>(openable)) {
        target.url = url->url()->absoluteString();
        return target;
    }
    const auto activity = std::dynamic_pointer_cast<OWUserActivityData>(openable);
    if (!activity)
        return std::nullopt;
    target.activityType = activity->activityType().value_or("");
    target.userInfo = activity->userInfo();
    if (target.userInfo) {
        target.incidentMuids = orvo::incidentMuids(*target.userInfo);
        const auto line = payload(*target.userInfo, LineKey);
        const bool isSame =
            line && before && before->userInfo && payload(*before->userInfo, LineKey) == line;
        target.lineMuid = isSame ? before->lineMuid : orvo::lineMuid(line);
    }
    return target;
}

std::string PrintedTarget::text() const {
    if (url)
        return *url;
    if (incidentMuids)
        return fmt::format("{}: {} {}",
                           activityType,
                           incidentMuids->size(),
                           incidentMuids->size() == 1 ? "incident" : "incidents");
    return lineMuid ? fmt::format("{}: line {}", activityType, *lineMuid) : activityType;
}

} // namespace orvo
