#include "platform/feeds/FeedLookup.h"

#include "platform/feeds/FeedLookupRun.h"
#include "platform/feeds/FeedRegistry.h"
#include "platform/feeds/SharedSourceLoader.h"
#include "platform/feeds/TravelPreferences.h"
#include "platform/feeds/alerts/AlertReader.h"

namespace orvo {

namespace {

/// Why the bytes are no message of alerts; nil when they are one.
std::shared_ptr<NSError> problemOfAlerts(const NSData& bytes) {
    std::shared_ptr<NSError> error;
    return AlertReader::read(bytes.bytes(), &error) ? nullptr : error;
}

} // namespace

FeedLookup::Ground FeedLookup::profileGround(bool insists) {
    Ground ground;
    ground.feeds = [](std::shared_ptr<NSError>* error) {
        return FeedRegistry::open()->feeds(error);
    };
    ground.schedules = [](std::shared_ptr<NSError>* error) {
        return ScheduleStore::open(ScheduleStore::defaultPath(), error);
    };
    ground.load = [insists](const SourceRequest& request,
                            std::function<void(SourceBody)> completion) {
        // An error page that was sent as if all were well must not take the place of the last good
        // body.
        LoadOptions options;
        options.check = problemOfAlerts;
        options.inPause = insists;
        sharedSourceLoader()->load(request, options, std::move(completion));
    };
    ground.lastKnownLine = [](std::uint64_t) {
        return nullptr;
    };
    ground.asksForStepFree = TravelPreferences::asksForStepFree;
    return ground;
}

std::shared_ptr<FeedLookup> FeedLookup::make(Ground ground) {
    return std::make_shared<FeedLookup>(std::move(ground));
}

FeedLookup::FeedLookup(Ground ground)
    : _ground(std::move(ground)) {}

void FeedLookup::lookUpLines(std::vector<std::uint64_t> muids, Completion completion) const {
    std::make_shared<FeedLookupRun>(_ground, std::move(muids), std::move(completion))->start();
}

void FeedLookup::lookUpFeeds(std::optional<std::vector<std::string>> names,
                             Completion completion) const {
    std::make_shared<FeedLookupRun>(
        _ground, FeedLookupRun::AllLines{std::move(names)}, std::move(completion))
        ->start();
}

} // namespace orvo
