#include "platform/feeds/FileTime.h"

#include <algorithm>
#include <sys/stat.h>

namespace orvo::FileTime {

namespace {

// A schedule may lie in one folder within the folder.
constexpr int DeepestFolder = 1;

std::optional<double> ownChange(const std::filesystem::path& path) {
    struct stat status {};
    if (::stat(path.c_str(), &status) != 0)
        return std::nullopt;
    // The change of the entry: a copy that keeps its original's date is new all the same.
    return static_cast<double>(status.st_ctim.tv_sec) +
           static_cast<double>(status.st_ctim.tv_nsec) / 1e9;
}

} // namespace

std::optional<double> lastChange(const std::filesystem::path& path) {
    auto latest = ownChange(path);
    std::error_code problem;
    if (!latest || !std::filesystem::is_directory(path, problem))
        return latest;
    std::filesystem::recursive_directory_iterator entry(path, problem);
    for (; !problem && entry != std::filesystem::end(entry); entry.increment(problem)) {
        latest = std::max(*latest, ownChange(entry->path()).value_or(0));
        if (entry.depth() >= DeepestFolder)
            entry.disable_recursion_pending();
    }
    return latest;
}

} // namespace orvo::FileTime
