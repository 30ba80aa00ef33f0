#include "platform/feeds/schedule/ScheduleBudget.h"

#include "platform/feeds/schedule/ScheduleError.h"

#include <fmt/format.h>

namespace orvo {

namespace {

std::string sizeInWords(std::uint64_t bytes) {
    constexpr std::uint64_t mebibyte = std::uint64_t{1} << 20;
    if (bytes >= mebibyte)
        return fmt::format("{} MiB", bytes / mebibyte);
    return fmt::format("{} bytes", bytes);
}

} // namespace

std::shared_ptr<NSError> ScheduleBudget::spendBytes(std::uint64_t bytes, const std::string& file) {
    if (bytes <= _limits.inflatedBytes - _bytes) {
        _bytes += bytes;
        return nullptr;
    }
    return scheduleError(ScheduleErrorCode::TooLarge,
                         fmt::format("{}: the schedule has more than {} of text, the most that is "
                                     "read",
                                     file,
                                     sizeInWords(_limits.inflatedBytes)));
}

std::shared_ptr<NSError> ScheduleBudget::spendRow(const std::string& file) {
    if (_rows < _limits.rows) {
        ++_rows;
        return nullptr;
    }
    return scheduleError(ScheduleErrorCode::TooLarge,
                         fmt::format("{}: the schedule has more than {} rows, the most that are "
                                     "read",
                                     file,
                                     _limits.rows));
}

} // namespace orvo
