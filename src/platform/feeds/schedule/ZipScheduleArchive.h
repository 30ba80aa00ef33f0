#pragma once

#include "platform/feeds/schedule/ScheduleArchive.h"

#include <memory>
#include <string>

namespace orvo {

/// A schedule in a zip file, or in the bytes of one. Files are inflated while they are read.
class ZipScheduleArchive final : public ScheduleArchive {
public:
    /// As `ScheduleArchive::open()`, for bytes or a path that is a file.
    [[nodiscard]] static std::unique_ptr<ScheduleArchive> open(const ScheduleSource& source,
                                                               std::shared_ptr<NSError>& error);

    [[nodiscard]] std::unique_ptr<ScheduleStream>
    openFile(std::string_view file, std::shared_ptr<NSError>& error) const override;

private:
    struct Zip; // the library's handle, and the bytes that it reads

    ZipScheduleArchive(ArchiveLayout layout, std::shared_ptr<Zip> zip, std::string name);

    std::shared_ptr<Zip> _zip;
    std::string _name;
};

} // namespace orvo
