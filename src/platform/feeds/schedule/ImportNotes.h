#pragma once

#include "platform/feeds/schedule/ScheduleImport.h"

#include <cstdint>
#include <string_view>
#include <vector>

namespace orvo {

/// Counts rows by file and reason, in the order in which the reasons first came up.
class ImportNotes {
public:
    /// `row` 0 stands for the whole file.
    void add(std::string_view file, std::string_view reason, std::uint64_t row);

    [[nodiscard]] const std::vector<ImportNote>& notes() const noexcept { return _notes; }

private:
    std::vector<ImportNote> _notes; // few: one for each reason
};

} // namespace orvo
