#pragma once

#include "platform/foundation/NSError.h"
#include "platform/sqlite/SQLiteDatabase.h"

#include <chrono>
#include <filesystem>
#include <memory>
#include <optional>

/// The tables in which schedules are kept, and their version.
namespace orvo::ScheduleTables {

/// What went wrong with the file, in words for the person.
[[nodiscard]] std::shared_ptr<NSError> failureOf(const SQLiteFailure& failure,
                                                 const std::filesystem::path& path);

/// Opens the file for writing, and makes it, its folder and the tables when missing. Any number of
/// processes may do so at once. Waits up to `patience` for other writers.
/// @return nil, with the reason in `error`: it cannot be opened, or was written by a later version
[[nodiscard]] std::unique_ptr<SQLiteDatabase> openForWriting(const std::filesystem::path& path,
                                                             std::chrono::seconds patience,
                                                             std::shared_ptr<NSError>& error);

/// Opens the file for reading only. Waits up to `patience` for who holds it exclusively.
/// @return nil without an error when there is no file, or one that has no tables yet
[[nodiscard]] std::unique_ptr<SQLiteDatabase> openForReading(const std::filesystem::path& path,
                                                             std::chrono::seconds patience,
                                                             std::shared_ptr<NSError>& error);

/// An empty store in memory, or a copy of the file's.
[[nodiscard]] std::unique_ptr<SQLiteDatabase>
openInMemory(const std::optional<std::filesystem::path>& copied, std::shared_ptr<NSError>& error);

} // namespace orvo::ScheduleTables
