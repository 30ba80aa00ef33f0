#include "platform/feeds/schedule/ScheduleArchive.h"

#include "platform/feeds/schedule/FolderScheduleArchive.h"
#include "platform/feeds/schedule/ScheduleError.h"
#include "platform/feeds/schedule/ZipScheduleArchive.h"

#include <filesystem>
#include <system_error>

namespace orvo {

std::unique_ptr<ScheduleArchive> ScheduleArchive::open(const ScheduleSource& source,
                                                       std::shared_ptr<NSError>& error) {
    if (source.bytes())
        return ZipScheduleArchive::open(source, error);
    std::error_code failure;
    const auto status = std::filesystem::status(source.path(), failure);
    if (std::filesystem::is_directory(status))
        return FolderScheduleArchive::open(source, error);
    if (std::filesystem::is_regular_file(status))
        return ZipScheduleArchive::open(source, error);
    if (failure)
        error =
            scheduleError(ScheduleErrorCode::CannotRead, source.name() + ": " + failure.message());
    else
        error = scheduleError(ScheduleErrorCode::NotAnArchive,
                              source.name() + ": is neither a file nor a folder");
    return nullptr;
}

std::uint64_t ScheduleArchive::statedSize(std::string_view file) const {
    const ArchiveEntry* entry = _layout.entry(file);
    return entry ? entry->size : 0;
}

} // namespace orvo
