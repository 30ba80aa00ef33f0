#include "platform/feeds/schedule/ArchiveLayout.h"

#include "platform/feeds/schedule/ScheduleError.h"
#include "platform/feeds/schedule/ScheduleText.h"

#include <algorithm>
#include <fmt/format.h>
#include <set>
#include <utility>

namespace orvo {

namespace {

constexpr std::string_view RoutesFile = "routes.txt";

struct SplitPath {
    std::string folder; ///< with its last slash; empty for the top
    std::string file;   ///< small letters
    bool isHidden = false;
};

SplitPath split(std::string path) {
    // Some archivers of other systems write their own separator.
    std::ranges::replace(path, '\\', '/');
    while (path.starts_with("./"))
        path.erase(0, 2);
    const auto slash = path.rfind('/');
    SplitPath split;
    split.isHidden = path.starts_with(".") || path.starts_with("__MACOSX/") ||
                     path.find("/.") != std::string::npos ||
                     path.find("/__MACOSX/") != std::string::npos;
    split.folder = slash == std::string::npos ? std::string() : path.substr(0, slash + 1);
    split.file =
        ScheduleText::asciiLowercase(slash == std::string::npos ? path : path.substr(slash + 1));
    return split;
}

std::string folderInWords(const std::string& folder) {
    return folder.empty() ? "at its top" : "in " + ScheduleText::cleanName(folder);
}

std::shared_ptr<NSError> severalSchedules(const std::string& name,
                                          const std::set<std::string>& folders) {
    return scheduleError(ScheduleErrorCode::SeveralSchedules,
                         fmt::format("{}: holds more than one schedule, {} and {}; add each on its "
                                     "own",
                                     name,
                                     folderInWords(*folders.begin()),
                                     folderInWords(*std::next(folders.begin()))));
}

std::shared_ptr<NSError> noSchedule(const std::string& name, const std::string& archiveInside) {
    if (archiveInside.empty())
        return scheduleError(ScheduleErrorCode::NoSchedule,
                             name + ": holds no routes.txt, so it is no schedule");
    return scheduleError(ScheduleErrorCode::NoSchedule,
                         fmt::format("{}: holds no routes.txt but another archive, {}; take that "
                                     "out and add it",
                                     name,
                                     ScheduleText::cleanName(archiveInside)));
}

std::shared_ptr<NSError> deepSchedule(const std::string& name, const std::string& folder) {
    return scheduleError(
        ScheduleErrorCode::NoSchedule,
        fmt::format("{}: its schedule lies too deep, {}; only one enclosing folder "
                    "is looked into",
                    name,
                    folderInWords(folder)));
}

/// `folder` ends with a slash.
bool isDeep(const std::string& folder) {
    return std::ranges::count(folder, '/') > 1;
}

} // namespace

std::optional<ArchiveLayout> ArchiveLayout::find(std::vector<ArchiveEntry> entries,
                                                 const std::string& name,
                                                 std::shared_ptr<NSError>& error) {
    std::set<std::string> schedules;
    std::string archiveInside;
    for (const ArchiveEntry& entry : entries) {
        const SplitPath path = split(entry.path);
        if (path.isHidden)
            continue;
        if (path.file == RoutesFile)
            schedules.insert(path.folder);
        else if (path.file.ends_with(".zip"))
            archiveInside = entry.path;
    }
    if (schedules.empty()) {
        error = noSchedule(name, archiveInside);
        return std::nullopt;
    }
    if (schedules.size() > 1) {
        error = severalSchedules(name, schedules);
        return std::nullopt;
    }
    if (isDeep(*schedules.begin())) {
        error = deepSchedule(name, *schedules.begin());
        return std::nullopt;
    }
    ArchiveLayout layout;
    for (ArchiveEntry& entry : entries) {
        const SplitPath path = split(entry.path);
        const bool isFolder = path.file.empty();
        if (path.folder != *schedules.begin() || path.isHidden || isFolder)
            continue;
        if (!layout._entries.emplace(path.file, std::move(entry)).second) {
            error = scheduleError(ScheduleErrorCode::SeveralSchedules,
                                  fmt::format("{}: holds {} twice in one place",
                                              name,
                                              ScheduleText::cleanName(path.file)));
            return std::nullopt;
        }
    }
    return layout;
}

const ArchiveEntry* ArchiveLayout::entry(std::string_view file) const {
    const auto found = _entries.find(file);
    return found == _entries.end() ? nullptr : &found->second;
}

} // namespace orvo
