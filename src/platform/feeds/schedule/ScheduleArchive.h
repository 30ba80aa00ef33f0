#pragma once

#include "platform/feeds/schedule/ArchiveLayout.h"
#include "platform/feeds/schedule/ScheduleSource.h"
#include "platform/feeds/schedule/ScheduleStream.h"

#include <cstdint>
#include <memory>
#include <string>
#include <string_view>
#include <utility>

namespace orvo {

/// The files of one schedule, wherever it is kept. Nothing is written anywhere.
class ScheduleArchive {
public:
    /// @return nil, with the reason in `error`, when the source cannot be read, is neither a zip
    /// file nor a folder, or does not hold exactly one schedule
    [[nodiscard]] static std::unique_ptr<ScheduleArchive> open(const ScheduleSource& source,
                                                               std::shared_ptr<NSError>& error);
    ScheduleArchive(const ScheduleArchive&) = delete;
    ScheduleArchive& operator=(const ScheduleArchive&) = delete;
    virtual ~ScheduleArchive() = default;

    [[nodiscard]] bool has(std::string_view file) const { return _layout.entry(file) != nullptr; }
    /// What the archive says the file's length is, inflated, which need not be true; 0 for a file
    /// that it does not have.
    [[nodiscard]] std::uint64_t statedSize(std::string_view file) const;

    /// The bytes of a file that `has()`. The archive must outlive the stream.
    /// @return nil, with the reason in `error`, when it cannot be opened
    [[nodiscard]] virtual std::unique_ptr<ScheduleStream>
    openFile(std::string_view file, std::shared_ptr<NSError>& error) const = 0;

protected:
    explicit ScheduleArchive(ArchiveLayout layout)
        : _layout(std::move(layout)) {}
    [[nodiscard]] const ArchiveLayout& layout() const noexcept { return _layout; }

private:
    ArchiveLayout _layout;
};

} // namespace orvo
