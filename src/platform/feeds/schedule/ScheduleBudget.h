#pragma once

#include "platform/feeds/schedule/ScheduleImport.h"
#include "platform/foundation/NSError.h"

#include <memory>
#include <string>

namespace orvo {

/// Counts what one import has cost so far against its limits.
class ScheduleBudget {
public:
    explicit ScheduleBudget(ScheduleLimits limits)
        : _limits(limits) {}

    [[nodiscard]] std::uint64_t bytes() const noexcept { return _bytes; }
    [[nodiscard]] std::uint64_t rows() const noexcept { return _rows; }
    [[nodiscard]] const ScheduleLimits& limits() const noexcept { return _limits; }

    /// @return the refusal, naming `file`, when the limit is passed
    [[nodiscard]] std::shared_ptr<NSError> spendBytes(std::uint64_t bytes, const std::string& file);
    [[nodiscard]] std::shared_ptr<NSError> spendRow(const std::string& file);

private:
    ScheduleLimits _limits;
    std::uint64_t _bytes = 0;
    std::uint64_t _rows = 0;
};

} // namespace orvo
