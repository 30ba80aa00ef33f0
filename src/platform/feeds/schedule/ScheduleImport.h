#pragma once

#include <cstdint>
#include <functional>
#include <string>
#include <vector>

namespace orvo {

/// What a schedule may cost at most.
struct ScheduleLimits {
    std::uint64_t inflatedBytes = std::uint64_t{512} << 20; ///< of all files that are read
    std::uint64_t rows = 4'000'000; ///< of all files that are read, without their headers
};

/// How far an import is.
struct ImportProgress {
    std::string file; ///< the file being read, `stop_times.txt`; empty while the store is written
    double fraction = 0; ///< of the whole import, 0 to 1, never falling
};

struct ImportOptions {
    /// Called on the importing thread, a few hundred times at most; may be empty.
    std::function<void(const ImportProgress&)> progress;
    ScheduleLimits limits;
};

/// Rows that were passed over, or taken with a doubt, for one reason.
struct ImportNote {
    std::string file;           ///< `routes.txt`
    std::string reason;         ///< in words: `no route_id, left out`
    std::uint64_t count = 0;    ///< rows
    std::uint64_t firstRow = 0; ///< the header is row 1; 0 when it concerns the whole file

    friend bool operator==(const ImportNote&, const ImportNote&) = default;
};

/// What an import did.
struct ImportReport {
    std::size_t lines = 0;
    std::size_t newLines = 0;      ///< that the feed did not have before
    std::size_t departedLines = 0; ///< that the feed had before and has no more
    std::size_t agencies = 0;
    std::size_t stops = 0;
    std::uint64_t rows = 0; ///< read in all files, without their headers
    std::vector<ImportNote> notes;
};

} // namespace orvo
