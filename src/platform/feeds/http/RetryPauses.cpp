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
#include <cmath>
#include <utility>

namespace orvo {

namespace {

constexpr const char* LockName = "lock";
constexpr double Slack = 60; // seconds by which clocks may be set while a pause lasts

/// The machine's, in seconds since 1970.
double systemNow() {
    return std::chrono::duration<double>(std::chrono::system_clock::now().time_since_epoch())
        .count();
}

/// Takes pauses away that have long ended, or were noted in a future that was none.
void sweep(const std::filesystem::path& folder) {
    const auto now = std::filesystem::file_time_type::clock::now();
    std::error_code error;
    const std::filesystem::directory_iterator end;
    for (std::filesystem::directory_iterator file(folder, error); !error && file != end;
         file.increment(error)) {
        std::error_code ignored;
        const auto written = file->last_write_time(ignored);
        const double age = std::chrono::duration<double>(now - written).count();
        if (!ignored && file->path().filename() != LockName && std::abs(age) > RetryPauses::Longest)
            std::filesystem::remove(file->path(), ignored);
    }
}

std::optional<double> number(const NSDictionary& entries, const char* key) {
    const auto number = std::dynamic_pointer_cast<NSNumber>(entries.objectForKey(key));
    return number ? std::optional(number->doubleValue()) : std::nullopt;
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
    const Kept pause{systemNow() + seconds, seconds, status};
    {
        const std::lock_guard lock(_mutex);
        _ends[key] = {monotonicNow + seconds, status, pause.until};
    }
    return Environment::keepsWritesInMemory().get() ? nullptr : write(key, pause);
}

void RetryPauses::forget(const std::string& key) {
    const std::lock_guard lock(_mutex);
    _ends.erase(key);
    std::error_code ignored;
    if (!Environment::keepsWritesInMemory().get())
        std::filesystem::remove(path(key), ignored);
}

std::optional<RetryPauses::Pause> RetryPauses::pending(const std::string& key,
                                                       double monotonicNow) {
    const auto file = kept(key);
    const std::lock_guard lock(_mutex);
    const auto known = _ends.find(key);
    const bool isNew = file && (known == _ends.end() || known->second.until != file->until);
    const double left = isNew ? file->until - systemNow() : 0;
    if (left > 0 && left <= file->seconds + Slack)
        _ends[key] = {monotonicNow + std::min(left, file->seconds), file->status, file->until};
    const auto end = _ends.find(key);
    if (end == _ends.end() || end->second.at <= monotonicNow)
        return std::nullopt;
    return Pause{end->second.at - monotonicNow, end->second.status};
}

std::shared_ptr<NSError> RetryPauses::write(const std::string& key, const Kept& pause) const {
    std::shared_ptr<NSError> error;
    const auto lock = AtomicFile::lockMakingFolder(_folder / LockName, &error);
    if (!lock)
        return error;
    sweep(_folder);
    const auto entries = NSDictionary::dictionaryWithTextKeys(
        {{"until", NSNumber::numberWithDouble(pause.until)},
         {"seconds", NSNumber::numberWithDouble(pause.seconds)},
         {"status", NSNumber::numberWithInteger(pause.status)}});
    const auto list = PropertyList::write(*entries, &error);
    return list ? AtomicFile::write(*lock, path(key), list->bytes()) : error;
}

/// Nothing for a file that no program of ours can have written.
std::optional<RetryPauses::Kept> RetryPauses::kept(const std::string& key) const {
    const auto bytes = AtomicFile::read(path(key));
    const auto list = bytes ? PropertyList::read(bytes->bytes()) : nullptr;
    const auto* const entries = dynamic_cast<const NSDictionary*>(list.get());
    if (!entries)
        return std::nullopt;
    const auto until = number(*entries, "until");
    const auto seconds = number(*entries, "seconds");
    const auto status = number(*entries, "status");
    if (!until || !seconds || !status || !std::isfinite(*until) ||
        !(*seconds >= 0 && *seconds <= Longest) || !(*status >= 100 && *status < 600))
        return std::nullopt;
    return Kept{*until, *seconds, static_cast<int>(*status)};
}

} // namespace orvo
