#include "handoff/NSDataOrvoExtra.h"
#include "orvo/HandOff.h"
#include "platform/foundation/CodingClass.h"
#include "platform/foundation/NSUserActivity.h"
#include "platform/mapuikit/DesktopSystemController.h"

#include <cstdlib>

namespace orvo {
namespace {

std::shared_ptr<NSData>
activityWith(const char* type, const char* key, std::shared_ptr<NSData> payload) {
    const auto activity = NSUserActivity::initWithActivityType(type);
    activity->setUserInfo(NSDictionary::dictionaryWithTextKeys({{key, std::move(payload)}}));
    return encodedUserActivity(*activity);
}

/// The first byte chooses how deep the others lie: a URL, an activity, the message in one, the
/// archive in one.
HandOff handOffOf(std::uint8_t kind, const std::shared_ptr<NSData>& bytes) {
    switch (kind) {
    case 'u':
        return HandOff::ofURL(std::string(bytes->stringView()));
    case 'm':
        return HandOff::ofActivity(activityWith(
            "com.zentu.Orvo.Transit.Incident", "bs", NSDataOrvoExtra::bzip2CompressedData(*bytes)));
    case 'l':
        return HandOff::ofActivity(
            activityWith("com.zentu.Orvo.Transit.IncidentList", "incidentListKey", bytes));
    default:
        return HandOff::ofActivity(bytes);
    }
}

} // namespace
} // namespace orvo

/// Whatever comes, it is content or an error with a reason, and never both.
extern "C" int LLVMFuzzerTestOneInput(const std::uint8_t* data, std::size_t size) {
    using namespace orvo;
    static const auto classes =
        CodingClassTable::current().overrideWith(std::make_shared<const CodingClassTable>(
            CodingClassTable{CodingClass::of<TransitStorageIncident>("TransitStorageIncident"),
                             CodingClass::of<TransitStorageLineItem>("TransitStorageLineItem")}));
    if (size == 0)
        return 0;
    std::shared_ptr<NSError> error;
    const auto content =
        handOffOf(data[0], NSData::dataWithBytes({data + 1, size - 1})).content(&error);
    if (content.has_value() == (error != nullptr) ||
        (error && error->localizedDescription().empty()))
        std::abort();
    return 0;
}
