#pragma once

#include "platform/feeds/schedule/ScheduleArchive.h"

#include <filesystem>
#include <string>

namespace orvo {

/// A schedule in a plain folder, or in a folder at most two levels inside it.
class FolderScheduleArchive final : public ScheduleArchive {
public:
    /// As `ScheduleArchive::open()`, for a path that is a folder.
    [[nodiscard]] static std::unique_ptr<ScheduleArchive> open(const ScheduleSource& source,
                                                               std::shared_ptr<NSError>& error);

    [[nodiscard]] std::unique_ptr<ScheduleStream>
    openFile(std::string_view file, std::shared_ptr<NSError>& error) const override;

private:
    FolderScheduleArchive(ArchiveLayout layout, std::filesystem::path folder);

    std::filesystem::path _folder;
};

} // namespace orvo
