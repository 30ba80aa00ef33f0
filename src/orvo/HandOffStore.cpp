#include "orvo/HandOffStore.h"

#include "orvo/HandOffError.h"
#include "platform/foundation/AtomicFile.h"
#include "platform/foundation/Environment.h"
#include "platform/foundation/NSDate.h"
#include "platform/foundation/NSString.h"
#include "platform/foundation/PropertyList.h"

#include <fmt/format.h>

namespace orvo::HandOffStore {

namespace {

constexpr const char* TimeKey = "receivedAt";
constexpr const char* URLKey = "url";
constexpr const char* ActivityKey = "activity";

std::filesystem::path keptPath() {
    return Environment::profile().get().state / "hand-off.plist";
}

} // namespace

std::shared_ptr<NSError> keep(const HandOff& handOff) {
    if (Environment::keepsWritesInMemory().get())
        return nullptr;
    std::vector<std::pair<std::string, std::shared_ptr<NSObject>>> entries{
        {TimeKey, NSDate::date()}};
    if (handOff.url())
        entries.emplace_back(URLKey, NSString::string(*handOff.url()));
    else
        entries.emplace_back(ActivityKey, handOff.activity());

    std::shared_ptr<NSError> error;
    const auto bytes =
        PropertyList::write(*NSDictionary::dictionaryWithTextKeys(std::move(entries)), &error);
    if (!bytes)
        return error;
    const auto path = keptPath();
    auto lockPath = path;
    const auto lock = AtomicFile::lockMakingFolder(lockPath += ".lock", &error);
    return lock ? AtomicFile::write(*lock, path, bytes->bytes()) : error;
}

std::optional<Kept> last(std::shared_ptr<NSError>* error) {
    const auto path = keptPath();
    std::shared_ptr<NSError> reason;
    const auto bytes = AtomicFile::read(path, &reason);
    if (!bytes) {
        if (error)
            *error = reason;
        return std::nullopt;
    }
    const auto root =
        std::dynamic_pointer_cast<NSDictionary>(PropertyList::read(bytes->bytes(), &reason));
    const auto valueFor = [&](const char* key) {
        return root ? root->objectForKey(key) : nullptr;
    };
    const auto time = std::dynamic_pointer_cast<NSDate>(valueFor(TimeKey));
    const auto url = stringValue(valueFor(URLKey).get());
    const auto activity = std::dynamic_pointer_cast<NSData>(valueFor(ActivityKey));
    if (!time || (!url && !activity)) {
        setHandOffError(error,
                        HandOffErrorCode::Unreadable,
                        fmt::format("{} cannot be read: {}",
                                    path.string(),
                                    reason ? reason->localizedDescription()
                                           : "it holds nothing that was handed over."));
        return std::nullopt;
    }
    return Kept{url ? HandOff::ofURL(*url) : HandOff::ofActivity(activity),
                time->timeIntervalSince1970()};
}

} // namespace orvo::HandOffStore
