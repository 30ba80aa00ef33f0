#include "platform/demo/DemoProfile.h"

#include "platform/demo/DemoAlertFeed.h"
#include "platform/demo/DemoCity.h"
#include "platform/demo/DemoError.h"
#include "platform/demo/DemoSchedule.h"
#include "platform/favorites/FavoritesStore.h"
#include "platform/feeds/FeedRegistry.h"
#include "platform/feeds/schedule/LineMaker.h"
#include "platform/feeds/schedule/ScheduleStore.h"
#include "platform/foundation/Environment.h"
#include "platform/foundation/ISO8601.h"
#include "platform/foundation/NSDate.h"

#include <QTimeZone>

#include <cerrno>
#include <fcntl.h>
#include <fmt/format.h>
#include <fstream>
#include <optional>
#include <sys/file.h>
#include <unistd.h>

namespace orvo::DemoProfile {

namespace {

using Path = std::filesystem::path;
using Error = std::shared_ptr<NSError>;

Path folder() {
    return Environment::profile().get().data / "city";
}

/// Locked while a server is running.
Path lockPath() {
    return folder() / "live.lock";
}

/// Says for which time the city was written; it is written last.
Path stampPath() {
    return folder() / "written";
}

Error cannotWrite(const Path& path, const std::error_code& reason) {
    return NSError::errorWithMessage(
        DemoErrorDomain,
        static_cast<std::int64_t>(DemoErrorCode::CannotWrite),
        fmt::format("{} cannot be written: {}", path.string(), reason.message()));
}

/// Whoever reads the file sees the earlier content or the new one.
Error writeFile(const Path& path, std::string_view content) {
    const Path aside = path.string() + ".new";
    errno = 0;
    std::ofstream file(aside, std::ios::binary | std::ios::trunc);
    file.write(content.data(), static_cast<std::streamsize>(content.size()));
    file.close();
    std::error_code failed(errno, std::generic_category());
    if (file)
        std::filesystem::rename(aside, path, failed);
    return !file || failed ? cannotWrite(path, failed) : nullptr;
}

std::optional<double> writtenAt() {
    std::ifstream file(stampPath());
    std::string text;
    std::getline(file, text);
    return ISO8601::parse(text);
}

double now() {
    return NSDate::date()->timeIntervalSince1970();
}

Error writeSchedule(double time) {
    const Path schedule = folder() / "schedule";
    std::error_code failed;
    std::filesystem::create_directories(schedule, failed);
    if (failed)
        return cannotWrite(schedule, failed);
    // Times are shown by the clock of the place; the city lies where its visitor is.
    const std::string timeZone = QTimeZone::systemTimeZoneId().toStdString();
    for (const auto& [name, text] : demoSchedule(time, timeZone)) {
        if (auto error = writeFile(schedule / name, text))
            return error;
    }
    Error error;
    const auto store = ScheduleStore::open(ScheduleStore::defaultPath(), &error);
    return store ? store->importSchedule(
                       DemoCity::FeedName, ScheduleSource::fromPath(schedule), {}, nullptr)
                 : error;
}

Error writeRegistry(const std::string& alerts) {
    FeedConfiguration configuration;
    configuration.name = DemoCity::FeedName;
    configuration.schedule.location = (folder() / "schedule").string();
    configuration.alerts.push_back({.location = alerts});
    const auto registry = FeedRegistry::open();
    return registry->feed(configuration.name) ? registry->replace(configuration)
                                              : registry->add(configuration);
}

Error writeFavorites() {
    Error error;
    const auto store =
        FavoritesStore::open(FavoritesStore::standardPath(), FavoritesStore::Access::Write, &error);
    const auto schedules = ScheduleStore::open(ScheduleStore::defaultPath(), &error);
    if (!store || !schedules)
        return error;
    const auto earlier = store->entries(&error);
    if (error)
        return error;
    for (const auto& entry : earlier) {
        if ((error = store->remove(entry.number)))
            return error;
    }
    for (const auto& routeId : DemoCity::favoriteRouteIds()) {
        const auto line = schedules->line(lineMuid(DemoCity::FeedName, routeId), &error);
        if (error)
            return error;
        if (line && (error = store->addLine(*makeTransitLine(*line))))
            return error;
    }
    const auto& place = DemoCity::favoritePlace();
    return store->addPlace(*FavoritePlace::initWithName_latitude_longitude(
        place.name, place.latitude, place.longitude));
}

Error writeAll(const std::optional<std::string>& liveUrl) {
    const auto onDisk = Environment::keepsWritesInMemory().overrideWith(false);
    const double time = now();
    if (auto error = writeSchedule(time))
        return error;
    const Path alerts = folder() / "alerts.pb";
    if (auto error =
            writeFile(alerts, demoAlertFeed(DemoIncidents::around(time), time)->stringView()))
        return error;
    if (auto error = writeRegistry(liveUrl.value_or(alerts.string())))
        return error;
    if (auto error = writeFavorites())
        return error;
    return writeFile(stampPath(), ISO8601::string(time) + "\n");
}

/// The lock of the one server; nothing while another process has it, or when it cannot be had.
std::optional<int> takeLock() {
    std::error_code ignored;
    std::filesystem::create_directories(folder(), ignored);
    const int file = open(lockPath().c_str(), O_RDWR | O_CREAT | O_CLOEXEC, 0644);
    if (file < 0)
        return std::nullopt;
    if (flock(file, LOCK_EX | LOCK_NB) == 0)
        return file;
    close(file);
    return std::nullopt;
}

/// Whether the alerts come from a server; and whether it still runs.
bool isLive() {
    const auto configuration = FeedRegistry::open()->feed(DemoCity::FeedName);
    return configuration && !configuration->alerts.empty() &&
           configuration->alerts.front().isRemote();
}

/// Looks without making anything: whoever only asks may have no right to write here.
bool serverRuns() {
    const int file = open(lockPath().c_str(), O_RDONLY | O_CLOEXEC);
    if (file < 0)
        return false;
    const bool isLocked = flock(file, LOCK_SH | LOCK_NB) != 0;
    close(file);
    return isLocked;
}

bool isInTime(double written) {
    const double time = now();
    return time >= written && time < written + DemoIncidents::LifetimeSeconds;
}

} // namespace

Live::~Live() {
    close(_lock);
}

std::shared_ptr<NSError> write() {
    return writeAll(std::nullopt);
}

std::unique_ptr<Live> writeLive(const std::string& url, std::shared_ptr<NSError>* error) {
    const auto lock = takeLock();
    if (!lock) {
        if (error)
            *error = NSError::errorWithMessage(
                DemoErrorDomain,
                static_cast<std::int64_t>(DemoErrorCode::CannotServe),
                fmt::format("{} is locked: another orvo demo --serve is running",
                            lockPath().string()));
        return nullptr;
    }
    auto live = std::make_unique<Live>(*lock);
    if (auto failure = writeAll(url)) {
        if (error)
            *error = failure;
        return nullptr;
    }
    return live;
}

std::shared_ptr<NSError> ensure() {
    return isCurrent() ? nullptr : write();
}

bool isCurrent() {
    const auto written = writtenAt();
    if (!written)
        return false;
    // What a server says holds for the machine's own time only.
    if (isLive())
        return !Environment::keepsWritesInMemory().get() && serverRuns();
    return isInTime(*written);
}

double secondsLeft() {
    if (!isCurrent())
        return 0;
    return isLive() ? DemoIncidents::LifetimeSeconds
                    : *writtenAt() + DemoIncidents::LifetimeSeconds - now();
}

} // namespace orvo::DemoProfile
