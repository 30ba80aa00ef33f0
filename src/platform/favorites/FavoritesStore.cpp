#include "platform/favorites/FavoritesStore.h"

#include "platform/favorites/FavoriteTransitLineRecord.h"
#include "platform/favorites/FavoritesFile.h"
#include "platform/favorites/StoredTransitLine.h"
#include "platform/foundation/Environment.h"
#include "platform/geoservices/FeedTransitLine.h"
#include "platform/geoservices/TransitSystemRecord.h"
#include "platform/sqlite/SQLiteStatement.h"

#include <algorithm>
#include <fmt/format.h>

namespace orvo {

namespace {

/// Between the positions of neighbours, when first given.
constexpr std::int64_t Gap = std::int64_t{1} << 20U;

enum Column { Number, Kind, Name, Muid, Feed, RouteId, SystemName, Record, Latitude, Longitude };

/// A query for favourites whose rows `Column` numbers.
std::string select(std::string_view condition) {
    return fmt::format("SELECT number, kind, name, muid, feed, route_id, system_name, record,"
                       " latitude, longitude FROM favorite {}",
                       condition);
}

/// The line of a row whose record cannot be read: what the row itself tells.
std::shared_ptr<TransitLine> lineFromColumns(const SQLiteStatement& row) {
    TransitLineRecord::Fields fields;
    fields.muid = row.unsignedInteger(Muid);
    fields.name = row.textOrNil(Name);
    fields.identifier = MapItemIdentifier::identifierWithMuid(fields.muid);
    fields.system = TransitSystemRecord::initWithFields({row.textOrNil(SystemName), nullptr});
    return FeedTransitLine::initWithFields_origin(std::move(fields),
                                                  {row.text(Feed), row.text(RouteId)});
}

std::shared_ptr<TransitLine> lineFrom(const SQLiteStatement& row) {
    auto line = StoredTransitLine::decode(row.bytes(Record));
    return line && line->muid() == row.unsignedInteger(Muid) ? line : lineFromColumns(row);
}

/// Nil for a kind that a later version of the program added.
std::shared_ptr<NSObject> favoriteFrom(const SQLiteStatement& row) {
    const auto kind = row.text(Kind);
    if (kind == "line")
        return FavoriteTransitLineRecord::initWithTransitLine(lineFrom(row));
    if (kind == "place")
        return FavoritePlace::initWithName_latitude_longitude(
            row.text(Name), row.real(Latitude), row.real(Longitude));
    return nullptr;
}

void report(FavoritesStore::Addition* addition, std::int64_t changedRows) {
    if (addition)
        *addition = changedRows > 0 ? FavoritesStore::Addition::Added
                                    : FavoritesStore::Addition::AlreadyThere;
}

} // namespace

std::filesystem::path FavoritesStore::standardPath() {
    return Environment::profile().get().data / "favorites.sqlite";
}

std::shared_ptr<FavoritesStore> FavoritesStore::open(const std::filesystem::path& path,
                                                     Access access,
                                                     std::shared_ptr<NSError>* error) {
    auto database = FavoritesFile::open(path, access, error);
    if (!database)
        return nullptr;
    return std::shared_ptr<FavoritesStore>(new FavoritesStore(path, std::move(database)));
}

FavoritesStore::FavoritesStore(std::filesystem::path path, std::unique_ptr<SQLiteDatabase> database)
    : _path(std::move(path))
    , _database(std::move(database)) {}

FavoritesStore::~FavoritesStore() = default;

std::vector<FavoritesStore::Entry> FavoritesStore::entries(std::shared_ptr<NSError>* error) const {
    const std::lock_guard lock(_mutex);
    std::vector<Entry> entries;
    SQLiteStatement row(*_database, select("ORDER BY position, number"));
    while (row.step()) {
        if (auto favorite = favoriteFrom(row))
            entries.push_back({row.integer(Number), std::move(favorite)});
    }
    if (!row.hasFailed())
        return entries;
    if (error)
        *error = failure(FavoritesError::CannotRead);
    return {};
}

std::shared_ptr<NSArray> FavoritesStore::favorites(std::shared_ptr<NSError>* error) const {
    std::shared_ptr<NSError> problem;
    NSArray::Elements elements;
    for (auto& entry : entries(&problem))
        elements.push_back(std::move(entry.favorite));
    if (!problem)
        return NSArray::arrayWithObjects(std::move(elements));
    if (error)
        *error = std::move(problem);
    return nullptr;
}

std::shared_ptr<TransitLine> FavoritesStore::line(std::uint64_t muid) const {
    const std::lock_guard lock(_mutex);
    SQLiteStatement row(*_database, select("WHERE kind = 'line' AND muid = ?"));
    return row.bind(muid).step() ? lineFrom(row) : nullptr;
}

std::shared_ptr<NSError> FavoritesStore::addLine(const TransitLine& line, Addition* addition) {
    const std::lock_guard lock(_mutex);
    const auto record = StoredTransitLine::encode(line);
    const auto origin = StoredTransitLine::originOf(line);
    const auto system = line.system();
    SQLiteTransaction transaction(*_database);
    if (!transaction.isOpen())
        return failure(FavoritesError::CannotWrite);
    SQLiteStatement update(*_database,
                           "UPDATE favorite SET name = ?, feed = ?, route_id = ?, system_name = ?,"
                           " record = ? WHERE kind = 'line' AND muid = ?");
    SQLiteStatement insert(
        *_database,
        "INSERT INTO favorite (name, feed, route_id, system_name, record, muid, kind, position)"
        " VALUES (?, ?, ?, ?, ?, ?, 'line',"
        " (SELECT coalesce(max(position), 0) + ? FROM favorite))");
    const auto bindLine = [&](SQLiteStatement& statement) -> SQLiteStatement& {
        statement.bind(line.name());
        statement.bind(origin ? std::optional(origin->feed) : std::nullopt);
        statement.bind(origin ? std::optional(origin->routeId) : std::nullopt);
        statement.bind(system ? system->name() : std::nullopt);
        return statement.bind(record->bytes()).bind(line.muid());
    };
    if (!bindLine(update).run())
        return failure(FavoritesError::CannotWrite);
    const bool wasThere = _database->changes() > 0;
    if (!wasThere && !bindLine(insert).bind(Gap).run())
        return failure(FavoritesError::CannotWrite);
    if (!transaction.commit())
        return failure(FavoritesError::CannotWrite);
    report(addition, wasThere ? 0 : 1);
    return nullptr;
}

std::shared_ptr<NSError> FavoritesStore::addPlace(const FavoritePlace& place, Addition* addition) {
    const std::lock_guard lock(_mutex);
    SQLiteStatement insert(
        *_database,
        "INSERT INTO favorite (name, latitude, longitude, kind, position)"
        " VALUES (?, ?, ?, 'place', (SELECT coalesce(max(position), 0) + ? FROM favorite))"
        " ON CONFLICT DO NOTHING");
    insert.bind(std::string_view(place.name())).bind(place.latitude()).bind(place.longitude());
    if (!insert.bind(Gap).run())
        return failure(FavoritesError::CannotWrite);
    report(addition, _database->changes());
    return nullptr;
}

std::shared_ptr<NSError> FavoritesStore::move(std::int64_t number, std::size_t index) {
    const std::lock_guard lock(_mutex);
    SQLiteTransaction transaction(*_database);
    if (!transaction.isOpen())
        return failure(FavoritesError::CannotWrite);
    SQLiteStatement query(*_database, "SELECT count(*), sum(number = ?) FROM favorite");
    if (!query.bind(number).step())
        return failure(FavoritesError::CannotRead);
    const auto others = query.integer(0) - 1;
    if (query.integer(1) == 0)
        return notFound(number);
    query.reset();
    const auto wanted =
        index < static_cast<std::size_t>(others) ? static_cast<std::int64_t>(index) : others;
    if (!placeBetweenNeighbors(number, wanted) || !transaction.commit())
        return failure(FavoritesError::CannotWrite);
    return nullptr;
}

bool FavoritesStore::placeBetweenNeighbors(std::int64_t number, std::int64_t index) {
    SQLiteStatement neighbor(*_database,
                             "SELECT position FROM favorite WHERE number <> ?"
                             " ORDER BY position, number LIMIT 1 OFFSET ?");
    const auto positionAt = [&](std::int64_t at) -> std::optional<std::int64_t> {
        neighbor.reset();
        if (at < 0 || !neighbor.bind(number).bind(at).step())
            return std::nullopt;
        return neighbor.integer(0);
    };
    for (int attempt = 0; attempt < 2 && !neighbor.hasFailed(); ++attempt) {
        const auto before = positionAt(index - 1);
        const auto after = positionAt(index);
        neighbor.reset();
        const auto low = before ? *before : (after ? *after - 2 * Gap : 0);
        const auto high = after ? *after : low + 2 * Gap;
        if (high - low >= 2) {
            SQLiteStatement update(*_database, "UPDATE favorite SET position = ? WHERE number = ?");
            return update.bind(low + (high - low) / 2).bind(number).run();
        }
        // No room is left between the two: spread all of them anew.
        SQLiteStatement spread(
            *_database,
            "WITH ranked AS (SELECT number AS n, row_number() OVER (ORDER BY position, number) AS r"
            " FROM favorite) UPDATE favorite SET position = ranked.r * ? FROM ranked"
            " WHERE ranked.n = favorite.number");
        if (!spread.bind(Gap).run())
            return false;
    }
    return false;
}

std::shared_ptr<NSError> FavoritesStore::remove(std::int64_t number) {
    const std::lock_guard lock(_mutex);
    SQLiteStatement statement(*_database, "DELETE FROM favorite WHERE number = ?");
    if (!statement.bind(number).run())
        return failure(FavoritesError::CannotWrite);
    return _database->changes() > 0 ? nullptr : notFound(number);
}

std::shared_ptr<NSError> FavoritesStore::failure(FavoritesError code) const {
    const char* what = code == FavoritesError::CannotRead ? "cannot be read" : "cannot be changed";
    return favoritesError(
        _database->failure().isLocked() ? FavoritesError::Locked : code,
        fmt::format("{}: the favorites {}: {}", _path.string(), what, _database->failure().reason));
}

std::shared_ptr<NSError> FavoritesStore::notFound(std::int64_t number) const {
    return favoritesError(FavoritesError::NotFound,
                          fmt::format("{}: there is no favorite {}", _path.string(), number));
}

} // namespace orvo
