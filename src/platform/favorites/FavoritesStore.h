#pragma once

#include "platform/favorites/FavoritePlace.h"
#include "platform/favorites/FavoritesError.h"
#include "platform/foundation/NSArray.h"
#include "platform/geoservices/TransitLine.h"

#include <filesystem>
#include <mutex>
#include <vector>

namespace orvo {

class SQLiteDatabase;

/// The person's favourites in one SQLite file. Any number of processes read it while one writes;
/// each change is whole or not at all, whenever a process ends. Any thread.
///
/// A line is kept with its name, system, artwork and origin, so that one that left its schedule can
/// still be shown. Under `Environment::keepsWritesInMemory()` the store works on a copy in memory,
/// which ends with it.
class FavoritesStore final {
public:
    enum class Access {
        Read, ///< makes no file: a store that is not there has no favourites; no changes
        Write,
    };
    /// One favourite with the number that names it as long as it stays one.
    struct Entry {
        std::int64_t number = 0;
        std::shared_ptr<NSObject> favorite; ///< a `FavoriteTransitLine` or a `FavoritePlace`
    };
    enum class Addition {
        Added,
        AlreadyThere, ///< its place in the order stays; a line's kept copy is the new one
    };

    /// `favorites.sqlite` of the profile in use.
    [[nodiscard]] static std::filesystem::path standardPath();
    /// A damaged file is set aside beside itself, which the log says, and the store is empty. Nil
    /// and an error where there is no working on.
    [[nodiscard]] static std::shared_ptr<FavoritesStore>
    open(const std::filesystem::path& path, Access access, std::shared_ptr<NSError>* error);

    ~FavoritesStore();
    FavoritesStore(const FavoritesStore&) = delete;
    FavoritesStore& operator=(const FavoritesStore&) = delete;

    /// In the person's order. Empty with an error when they cannot be read.
    [[nodiscard]] std::vector<Entry> entries(std::shared_ptr<NSError>* error) const;
    /// The same without numbers; nil with an error.
    [[nodiscard]] std::shared_ptr<NSArray> favorites(std::shared_ptr<NSError>* error) const;
    /// The copy kept of a favourite line; nil when there is none, or it cannot be read.
    [[nodiscard]] std::shared_ptr<TransitLine> line(std::uint64_t muid) const;

    /// Adds the line at the end; the same line (`muid`) only once. Nil, or why it failed.
    std::shared_ptr<NSError> addLine(const TransitLine& line, Addition* addition = nullptr);
    /// Adds the place at the end; an equal place only once. Nil, or why it failed.
    std::shared_ptr<NSError> addPlace(const FavoritePlace& place, Addition* addition = nullptr);
    /// Gives the favourite the position `index`, counted from 0 without the favourite itself;
    /// beyond the end is the end. Nil, or why it failed.
    std::shared_ptr<NSError> move(std::int64_t number, std::size_t index);
    /// Nil, or why it failed.
    std::shared_ptr<NSError> remove(std::int64_t number);

private:
    FavoritesStore(std::filesystem::path path, std::unique_ptr<SQLiteDatabase> database);
    [[nodiscard]] std::shared_ptr<NSError> failure(FavoritesError code) const;
    [[nodiscard]] bool placeBetweenNeighbors(std::int64_t number, std::int64_t index);
    [[nodiscard]] std::shared_ptr<NSError> notFound(std::int64_t number) const;

    std::filesystem::path _path;
    mutable std::mutex _mutex; // guards the connection
    std::unique_ptr<SQLiteDatabase> _database;
};

} // namespace orvo
