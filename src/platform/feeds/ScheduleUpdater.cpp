#include "platform/feeds/ScheduleUpdater.h"

#include "platform/feeds/FeedRegistry.h"
#include "platform/feeds/FileTime.h"
#include "platform/feeds/SharedSourceLoader.h"
#include "platform/feeds/schedule/ScheduleArchive.h"
#include "platform/feeds/schedule/ScheduleError.h"
#include "platform/foundation/DispatchQueue.h"
#include "platform/foundation/Environment.h"
#include "platform/foundation/Log.h"
#include "platform/foundation/NSDate.h"

namespace orvo {

namespace {

constexpr double Day = 24 * 3600;
constexpr double Hour = 3600;
constexpr double ClockTolerance = 60; // a clock is set now and then

double now() {
    return NSDate::date()->timeIntervalSince1970();
}

bool isDue(const FeedConfiguration& feed) {
    const auto last = feed.lastScheduleCheck.value_or(0);
    // A check of the future was made under another clock, unless that was set back but a little.
    return now() - last >= Day || last > now() + ClockTolerance;
}

/// A zip file ends with the list of what is in it: one that was cut has none.
bool isWholeArchive(const std::shared_ptr<NSData>& bytes) {
    std::shared_ptr<NSError> error;
    if (ScheduleArchive::open(ScheduleSource::fromBytes(bytes, {}), error))
        return true;
    const auto code = static_cast<ScheduleErrorCode>(error->code());
    return code == ScheduleErrorCode::NoSchedule || code == ScheduleErrorCode::SeveralSchedules;
}

void writeLog(const ScheduleUpdate& update) {
    const auto log = Log::findOrCreate("Feeds");
    switch (update.outcome) {
    case ScheduleUpdate::Outcome::Imported:
        log->info(
            "%@: a newer schedule with %lu lines was imported", update.feed, update.report.lines);
        break;
    case ScheduleUpdate::Outcome::Unchanged:
        log->debug("%@: the schedule is the current one", update.feed);
        break;
    case ScheduleUpdate::Outcome::Failed:
        log->error("%@: no newer schedule could be had: %@",
                   update.feed,
                   update.error->localizedDescription());
        break;
    }
}

} // namespace

struct ScheduleUpdater::Check {
    std::vector<FeedConfiguration> due;
    std::size_t next = 0;
    std::function<void(std::size_t)> done;
};

EnvironmentSlot<bool>& ScheduleUpdater::checksDaily() {
    static EnvironmentSlot<bool> slot([] { return true; });
    return slot;
}

ScheduleUpdater::Ground ScheduleUpdater::profileGround() {
    Ground ground;
    ground.feeds = [] {
        return FeedRegistry::open()->feeds();
    };
    ground.schedules = [](std::shared_ptr<NSError>* error) {
        return ScheduleStore::open(ScheduleStore::defaultPath(), error);
    };
    ground.load = [](const SourceRequest& request,
                     const LoadOptions& options,
                     SourceLoader::Completion completion) {
        sharedSourceLoader()->load(request, options, std::move(completion));
    };
    ground.lastGoodBody = [](const SourceRequest& request) {
        return sharedSourceLoader()->lastGoodBody(request);
    };
    ground.noteCheck = [](const std::string& feed, double seconds) {
        if (const auto error = FeedRegistry::open()->setLastScheduleCheck(feed, seconds))
            Log::findOrCreate("Feeds")->error("%@", error->localizedDescription());
    };
    return ground;
}

std::shared_ptr<ScheduleUpdater> ScheduleUpdater::make(Ground ground) {
    return std::make_shared<ScheduleUpdater>(std::move(ground));
}

ScheduleUpdater::ScheduleUpdater(Ground ground)
    : _ground(std::move(ground)) {}

void ScheduleUpdater::update(FeedConfiguration feed, Options options, Completion completion) {
    DispatchQueue::globalQueue()->async([self = shared_from_this(),
                                         feed = std::move(feed),
                                         options = std::move(options),
                                         completion = std::move(completion)] {
        self->_ground.noteCheck(feed.name, now());
        if (const auto path = feed.schedule.localPath()) {
            const auto imported = self->importedAt(feed.name);
            const auto changed = FileTime::lastChange(*path);
            // A file that is not there is imported, too: that tells what is wrong with it.
            if (!options.evenUnchanged && imported && changed && *changed < *imported)
                return completion({feed.name, ScheduleUpdate::Outcome::Unchanged, {}, nullptr});
            return completion(self->import(feed, ScheduleSource::fromPath(*path), options));
        }
        auto load = LoadOptions::forSchedule();
        load.progress = options.progress;
        load.isWhole = isWholeArchive;
        const auto earlier = self->_ground.lastGoodBody(feed.schedule);
        self->_ground.load(feed.schedule,
                           load,
                           [self, feed, options, earlier, completion](const SourceBody& body) {
                               self->take(feed, options, earlier, body, completion);
                           });
    });
}

void ScheduleUpdater::take(const FeedConfiguration& feed,
                           const Options& options,
                           const SourceBody& earlier,
                           const SourceBody& body,
                           const Completion& completion) const {
    if (body.error)
        return completion({feed.name, ScheduleUpdate::Outcome::Failed, {}, body.error});
    // The store holds what was kept before, unless that came after the import or was refused.
    const auto imported = importedAt(feed.name);
    const bool isSame = earlier.bytes && equal(earlier.bytes, body.bytes) && imported &&
                        earlier.receivedAt <= *imported;
    if (isSame && !options.evenUnchanged)
        return completion({feed.name, ScheduleUpdate::Outcome::Unchanged, {}, nullptr});
    completion(import(
        feed, ScheduleSource::fromBytes(body.bytes, feed.schedule.displayLocation()), options));
}

ScheduleUpdate ScheduleUpdater::import(const FeedConfiguration& feed,
                                       const ScheduleSource& source,
                                       const Options& options) const {
    ScheduleUpdate update;
    update.feed = feed.name;
    if (const auto schedules = _ground.schedules(&update.error))
        update.error = schedules->importSchedule(feed.name, source, options.import, &update.report);
    update.outcome =
        update.error ? ScheduleUpdate::Outcome::Failed : ScheduleUpdate::Outcome::Imported;
    return update;
}

std::optional<double> ScheduleUpdater::importedAt(const std::string& feed) const {
    const auto schedules = _ground.schedules(nullptr);
    // A store that cannot be asked is written anew, or tells then what is wrong with it.
    const auto info = schedules ? schedules->info(feed) : std::nullopt;
    return info ? std::optional(info->importedAt) : std::nullopt;
}

void ScheduleUpdater::checkSchedules(std::function<void(std::size_t)> done) {
    if (!checksDaily().get() || Environment::keepsWritesInMemory().get() ||
        _isChecking.exchange(true))
        return;
    DispatchQueue::globalQueue()->async([self = shared_from_this(), done = std::move(done)] {
        const auto check = std::make_shared<Check>();
        check->done = done;
        for (auto& feed : self->_ground.feeds()) {
            if (isDue(feed))
                check->due.push_back(std::move(feed));
        }
        self->checkNext(check);
    });
}

void ScheduleUpdater::checkNext(const std::shared_ptr<Check>& check) {
    if (check->next == check->due.size()) {
        _isChecking = false;
        if (check->done)
            check->done(check->due.size());
        return;
    }
    const auto& feed = check->due[check->next++];
    update(feed, {}, [self = shared_from_this(), check](const ScheduleUpdate& update) {
        writeLog(update);
        if (update.outcome == ScheduleUpdate::Outcome::Failed)
            self->_ground.noteCheck(update.feed, now() - Day + Hour);
        self->checkNext(check);
    });
}

} // namespace orvo
