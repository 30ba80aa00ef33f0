#include "platform/feeds/http/RetryPauses.h"

#include "platform/feeds/http/HttpDate.h"
#include "platform/foundation/AtomicFile.h"
#include "platform/foundation/Environment.h"
#include "platform/foundation/NSDictionary.h"
#include "platform/foundation/NSNumber.h"
#include "platform/foundation/PropertyList.h"

#include <algorithm>
#include <cctype>
#include <charconv>
#include <chrono>
#include <utility>

namespace orvo {

namespace {

constexpr const char* LockName = "lock";

double secondsSince(std::filesystem::file_time_type time) {
    const auto now = std::filesystem::file_time_type::clock::now();
    return std::chrono::duration<double>(now - time).count();
}

/// Takes pauses away that have long ended.
void sweep(const std::filesystem::path& folder) {
    std::error_code error;
    for (const auto& file : std::filesystem::directory_iterator(folder, error)) {
        const auto written = file.last_write_time(error);
        if (!error && file.path().filename() != LockName &&
            secondsSince(written) > RetryPauses::Longest)
            std::filesystem::remove(file.path(), error);
    }
}

} // namespace

std::optional<double> retryDelay(std::string_view retryAfter, std::string_view date, double now) {
    if (retryAfter.empty())
        return std::nullopt;
    if (std::ranges::all_of(retryAfter, [](unsigned char c) { return std::isdigit(c) != 0; })) {
        unsigned seconds = 0;
        const auto result =
            std::from_chars(retryAfter.data(), retryAfter.data() + retryAfter.size(), seconds);
        return result.ec == std::errc() ? std::min<double>(seconds, RetryPauses::Longest)
                                        : RetryPauses::Longest;
    }
    const auto until = parseHttpDate(retryAfter);
    if (!until)
        return std::nullopt;
    return std::clamp(*until - parseHttpDate(date).value_or(now), 0.0, RetryPauses::Longest);
}

RetryPauses::RetryPauses(std::filesystem::path folder)
    : _folder(std::move(folder)) {}

std::filesystem::path RetryPauses::path(const std::string& key) const {
    return _folder / (key + ".plist");
}

std::shared_ptr<NSError>
RetryPauses::note(const std::string& key, double seconds, int status, double monotonicNow) {
    std::shared_ptr<NSError> error;
    if (!Environment::keepsWritesInMemory().get())
        error = write(key, seconds, status);
    const auto file = written(key);
    const std::lock_guard lock(_mutex);
    _ends[key] = {monotonicNow + seconds, status, file};
    return error;
}

std::optional<RetryPauses::Pause> RetryPauses::pending(const std::string& key,
                                                       double monotonicNow) {
    const auto file = written(key);
    {
        const std::lock_guard lock(_mutex);
        const auto known = _ends.find(key);
        if (known != _ends.end() && (known->second.written == file || !file)) {
            const End& end = known->second;
            if (end.at <= monotonicNow)
                return std::nullopt;
            return Pause{end.at - monotonicNow, end.status};
        }
    }
    return file ? pauseOnDisk(key, *file) : std::nullopt;
}

std::shared_ptr<NSError>
RetryPauses::write(const std::string& key, double seconds, int status) const {
    if (auto error = AtomicFile::makeFolder(_folder))
        return error;
    std::shared_ptr<NSError> error;
    const auto lock = FileLock::acquire(_folder / LockName, &error);
    if (!lock)
        return error;
    sweep(_folder);
    const auto list = PropertyList::write(
        *NSDictionary::dictionaryWithTextKeys({{"seconds", NSNumber::numberWithDouble(seconds)},
                                               {"status", NSNumber::numberWithInteger(status)}}),
        &error);
    return list ? AtomicFile::write(*lock, path(key), list->bytes()) : error;
}

std::optional<RetryPauses::FileTime> RetryPauses::written(const std::string& key) const {
    std::error_code error;
    const FileTime time = std::filesystem::last_write_time(path(key), error);
    return error ? std::nullopt : std::optional(time);
}

std::optional<RetryPauses::Pause> RetryPauses::pauseOnDisk(const std::string& key,
                                                           FileTime written) const {
    const auto bytes = AtomicFile::read(path(key));
    const auto list = bytes ? PropertyList::read(bytes->bytes()) : nullptr;
    const auto* const entries = dynamic_cast<const NSDictionary*>(list.get());
    if (!entries)
        return std::nullopt;
    const auto seconds = std::dynamic_pointer_cast<NSNumber>(entries->objectForKey("seconds"));
    const auto status = std::dynamic_pointer_cast<NSNumber>(entries->objectForKey("status"));
    if (!seconds || !status || !(seconds->doubleValue() <= Longest))
        return std::nullopt;
    const double left = seconds->doubleValue() - std::max(secondsSince(written), 0.0);
    if (!(left > 0))
        return std::nullopt;
    return Pause{left, static_cast<int>(status->integerValue())};
}

} // namespace orvo
