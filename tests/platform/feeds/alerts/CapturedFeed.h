#pragma once

#include "TestLines.h"
#include "platform/feeds/schedule/ScheduleStore.h"
#include "support/TemporaryProfile.h"

#include <gtest/gtest.h>

#include <cstdlib>
#include <filesystem>
#include <fstream>
#include <iterator>
#include <string>

namespace orvo::testing {

/// The folder of captured feeds; empty where there is none.
inline std::filesystem::path capturedFeeds() {
    const char* const folder = std::getenv("ORVO_TEST_FEEDS");
    if (!folder || !std::filesystem::is_directory(folder))
        return {};
    return folder;
}

inline std::string bytesOf(const std::filesystem::path& path) {
    std::ifstream file(path, std::ios::binary);
    return {std::istreambuf_iterator<char>(file), {}};
}

/// One captured feed with its schedule.
class CapturedFeed {
public:
    /// @param folder of the captured feeds; `static.zip` in it is the schedule
    explicit CapturedFeed(const std::string& folder)
        : _folder(capturedFeeds() / folder) {
        std::shared_ptr<NSError> error;
        const auto store = ScheduleStore::open(_temporary.path() / "schedules.sqlite", &error);
        if (store)
            error = store->importSchedule(
                "captured", ScheduleSource::fromPath(_folder / "static.zip"), {}, nullptr);
        if (error)
            throw std::runtime_error(error->localizedDescription());
        _index = store->lineIndex("captured");
    }

    [[nodiscard]] const std::shared_ptr<const LineIndex>& index() const { return _index; }
    [[nodiscard]] std::string bytes(const std::string& file) const {
        return bytesOf(_folder / file);
    }
    [[nodiscard]] IncidentQuery all(double now, const std::string& language = "en") const {
        return {std::nullopt, now, language, false};
    }
    /// The answer for all lines, the message fetched at `now`.
    [[nodiscard]] Answer
    answer(const std::string& file, double now, const std::string& language = "en") const {
        return {_index, {source(bytes(file), now)}, all(now, language)};
    }
    [[nodiscard]] std::vector<std::string> routes() const {
        std::vector<std::string> routes;
        for (const ScheduleLine& line : _index->lines())
            routes.push_back(line.routeId);
        return routes;
    }

private:
    std::filesystem::path _folder;
    TemporaryFolder _temporary;
    std::shared_ptr<const LineIndex> _index;
};

} // namespace orvo::testing
