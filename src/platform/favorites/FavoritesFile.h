#pragma once

#include "platform/favorites/FavoritesError.h"
#include "platform/favorites/FavoritesStore.h"
#include "platform/sqlite/SQLiteDatabase.h"

#include <optional>

namespace orvo {

/// The store's file: how it is opened, laid out, and set aside when it is damaged.
class FavoritesFile {
public:
    /// The layout that this version reads and writes.
    static constexpr std::int64_t Version = 1;

    /// A sound database of that layout. Nil, and why, where there is none to be had.
    [[nodiscard]] static std::unique_ptr<SQLiteDatabase> open(const std::filesystem::path& path,
                                                              FavoritesStore::Access access,
                                                              std::shared_ptr<NSError>* error);

private:
    explicit FavoritesFile(const std::filesystem::path& path)
        : _path(path) {}

    /// False also for a file without content; nothing, and why in `_failure`, where that cannot be
    /// known: favourites that are hidden are not none.
    [[nodiscard]] std::optional<bool> isThere();
    [[nodiscard]] FavoritesError errorCode() const;
    [[nodiscard]] std::unique_ptr<SQLiteDatabase> openForReading();
    [[nodiscard]] std::unique_ptr<SQLiteDatabase> openForWriting();
    [[nodiscard]] std::unique_ptr<SQLiteDatabase> openCopy();
    [[nodiscard]] std::unique_ptr<SQLiteDatabase> openEmpty();
    [[nodiscard]] bool layOut(SQLiteDatabase& database);
    [[nodiscard]] bool isUsable(SQLiteDatabase& database);

    const std::filesystem::path& _path;
    SQLiteFailure _failure; // of the latest attempt
};

} // namespace orvo
