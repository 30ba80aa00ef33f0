#include "platform/feeds/schedule/ScheduleStore.h"

#include "platform/feeds/schedule/LineSearch.h"
#include "platform/feeds/schedule/ScheduleError.h"
#include "platform/feeds/schedule/ScheduleQueries.h"
#include "platform/feeds/schedule/ScheduleReader.h"
#include "platform/feeds/schedule/ScheduleTables.h"
#include "platform/feeds/schedule/ScheduleWriter.h"
#include "platform/foundation/Environment.h"
#include "platform/foundation/Exceptions.h"
#include "platform/foundation/Log.h"
#include "platform/foundation/NSDate.h"
#include "platform/foundation/Text.h"

#include <chrono>
#include <functional>
#include <mutex>
#include <utility>

namespace orvo {

namespace {

constexpr std::chrono::seconds ReaderPatience(5);
constexpr std::chrono::seconds WriterPatience(60); // another import may be writing

double now() {
    return Environment::wallClock().get()->timeIntervalSinceReferenceDate() +
           NSTimeIntervalSince1970;
}

/// While it lives, all that is read is of one moment.
class Snapshot {
public:
    explicit Snapshot(SQLiteDatabase& database)
        : _database(database) {
        _database.execute("BEGIN");
    }
    Snapshot(const Snapshot&) = delete;
    Snapshot& operator=(const Snapshot&) = delete;
    ~Snapshot() { _database.execute("COMMIT"); }

private:
    SQLiteDatabase& _database;
};

/// Whether there is no such file, and could be one: not where something hides it, or stands in its
/// way.
bool isCertainlyMissing(const std::filesystem::path& path) {
    std::error_code unknown;
    auto status = std::filesystem::status(path, unknown);
    bool isFile = true;
    for (auto place = std::filesystem::absolute(path);
         status.type() == std::filesystem::file_type::not_found;
         isFile = false) {
        place = place.parent_path();
        status = std::filesystem::status(place, unknown);
    }
    return !isFile && status.type() == std::filesystem::file_type::directory;
}

/// What can be read where nothing can be written: the file, or, where there is none, a store
/// without schedules. Nil, with `failure` as it was, when neither is true.
std::unique_ptr<SQLiteDatabase> openWithoutWriting(const std::filesystem::path& path,
                                                   std::shared_ptr<NSError>& failure) {
    std::shared_ptr<NSError> unread;
    constexpr std::chrono::seconds Short(1); // who wanted to write has waited already
    auto database = ScheduleTables::openForReading(path, Short, unread);
    if (!database && !unread && isCertainlyMissing(path))
        database = ScheduleTables::openInMemory(std::nullopt, unread);
    if (database)
        failure.reset();
    return database;
}

} // namespace

struct ScheduleStore::Implementation {
    std::filesystem::path path;
    mutable std::mutex mutex; // guards all below
    std::unique_ptr<SQLiteDatabase> database;
    std::unique_ptr<ScheduleQueries> queries;
    bool isInMemory = false;

    void use(std::unique_ptr<SQLiteDatabase> opened) {
        database = std::move(opened);
        queries = std::make_unique<ScheduleQueries>(*database);
    }

    /// Runs `read` on one moment's state of the store.
    template <class Result>
    Result answer(const std::function<Result(ScheduleQueries&)>& read,
                  std::shared_ptr<NSError>* error = nullptr) const {
        const std::lock_guard lock(mutex);
        const Snapshot snapshot(*database);
        Result result = read(*queries);
        if (!queries->takeFailure())
            return result;
        const auto failure = ScheduleTables::failureOf(database->failure(), path);
        Log::findOrCreate("Schedule")->error("%@", failure->localizedDescription());
        if (error)
            *error = failure;
        return Result{};
    }

    /// What `find` finds among all lines by their names in the person's language. Where that is
    /// nothing, by those that the schedules themselves have: a sign may show them.
    template <class Find>
    std::vector<ScheduleLine> found(const Find& find, std::shared_ptr<NSError>* error) const {
        using Lines = std::vector<ScheduleLine>;
        const std::string locale = Text::locale().get();
        LineSearch search(locale); // others need not wait for it
        Lines own;
        auto lines = answer<Lines>(
            [&](ScheduleQueries& reading) {
                own = reading.allLines();
                return reading.translated(own, locale);
            },
            error);
        const bool isTranslated = lines != own;
        lines = find(search, std::move(lines));
        if (!lines.empty() || !isTranslated)
            return lines;
        own = find(search, std::move(own));
        return answer<Lines>(
            [&](ScheduleQueries& reading) { return reading.translated(std::move(own), locale); },
            error);
    }

    std::shared_ptr<NSError> change(const std::function<void(ScheduleWriter&)>& write);
    std::shared_ptr<NSError> changeInMemory(const std::function<void(ScheduleWriter&)>& write);
    std::shared_ptr<NSError> changeAsOne(SQLiteDatabase& changed,
                                         const std::function<void(ScheduleWriter&)>& write) const;
};

std::shared_ptr<NSError> ScheduleStore::Implementation::changeAsOne(
    SQLiteDatabase& changed, const std::function<void(ScheduleWriter&)>& write) const {
    SQLiteTransaction transaction(changed);
    if (transaction.isOpen()) {
        ScheduleWriter writer(changed);
        write(writer);
        if (!writer.hasFailed() && transaction.commit())
            return nullptr;
    }
    return ScheduleTables::failureOf(changed.failure(), path);
}

std::shared_ptr<NSError>
ScheduleStore::Implementation::change(const std::function<void(ScheduleWriter&)>& write) {
    {
        const std::lock_guard lock(mutex);
        if (isInMemory || Environment::keepsWritesInMemory().get())
            return changeInMemory(write);
    }
    // A connection of its own, so that readers go on while it waits and writes.
    std::shared_ptr<NSError> error;
    const auto writing = ScheduleTables::openForWriting(path, WriterPatience, error);
    return writing ? changeAsOne(*writing, write) : error;
}

std::shared_ptr<NSError>
ScheduleStore::Implementation::changeInMemory(const std::function<void(ScheduleWriter&)>& write) {
    if (!isInMemory) {
        std::shared_ptr<NSError> error;
        auto copy = ScheduleTables::openInMemory(path, error);
        if (!copy)
            return error;
        use(std::move(copy));
        isInMemory = true;
    }
    return changeAsOne(*database, write);
}

std::filesystem::path ScheduleStore::defaultPath() {
    return Environment::profile().get().data / "schedules.sqlite";
}

ScheduleStore::ScheduleStore(std::unique_ptr<Implementation> implementation)
    : _implementation(std::move(implementation)) {}

ScheduleStore::~ScheduleStore() = default;

std::shared_ptr<ScheduleStore> ScheduleStore::open(const std::filesystem::path& path,
                                                   std::shared_ptr<NSError>* error) {
    auto implementation = std::make_unique<Implementation>();
    implementation->path = path;
    std::shared_ptr<NSError> failure;
    std::unique_ptr<SQLiteDatabase> database;
    if (!Environment::keepsWritesInMemory().get()) {
        database = ScheduleTables::openForWriting(path, ReaderPatience, failure);
        if (!database)
            database = openWithoutWriting(path, failure);
    } else {
        database = ScheduleTables::openForReading(path, ReaderPatience, failure);
        implementation->isInMemory = !database && !failure;
        if (implementation->isInMemory)
            database = ScheduleTables::openInMemory(std::nullopt, failure);
    }
    if (!database) {
        if (error)
            *error = failure;
        return nullptr;
    }
    implementation->use(std::move(database));
    return std::shared_ptr<ScheduleStore>(new ScheduleStore(std::move(implementation)));
}

std::vector<std::string> ScheduleStore::feeds(std::shared_ptr<NSError>* error) const {
    return _implementation->answer<std::vector<std::string>>(
        [](ScheduleQueries& queries) { return queries.feeds(); }, error);
}

std::optional<ScheduleInfo> ScheduleStore::info(std::string_view feed,
                                                std::shared_ptr<NSError>* error) const {
    return _implementation->answer<std::optional<ScheduleInfo>>(
        [feed](ScheduleQueries& queries) { return queries.info(feed); }, error);
}

std::vector<ScheduleLine> ScheduleStore::lines(std::string_view feed,
                                               std::shared_ptr<NSError>* error) const {
    return _implementation->answer<std::vector<ScheduleLine>>(
        [feed, locale = Text::locale().get()](ScheduleQueries& queries) {
            return queries.translated(queries.lines(feed), locale);
        },
        error);
}

std::optional<ScheduleLine> ScheduleStore::line(std::uint64_t muid,
                                                std::shared_ptr<NSError>* error) const {
    auto lines = _implementation->answer<std::vector<ScheduleLine>>(
        [muid, locale = Text::locale().get()](ScheduleQueries& queries) {
            return queries.translated(queries.linesWithMuid(muid), locale);
        },
        error);
    if (lines.empty())
        return std::nullopt;
    return std::move(lines.front());
}

std::shared_ptr<const LineIndex> ScheduleStore::lineIndex(std::string_view feed,
                                                          std::shared_ptr<NSError>* error) const {
    return _implementation->answer<std::shared_ptr<const LineIndex>>(
        [feed,
         self = shared_from_this()](ScheduleQueries& queries) -> std::shared_ptr<const LineIndex> {
            const auto info = queries.info(feed);
            if (!info)
                return nullptr;
            LineIndex::Contents contents;
            contents.feed = info->feed;
            contents.language = info->language;
            contents.timezone = info->timezone;
            contents.lines = queries.lines(feed);
            contents.stops.linesServingStop = [self, name = info->feed](std::string_view stop) {
                return self->_implementation->answer<std::optional<std::vector<std::uint64_t>>>(
                    [&](ScheduleQueries& later) { return later.linesServingStop(name, stop); });
            };
            contents.stops.stopName = [self, name = info->feed](std::string_view stop) {
                return self->_implementation->answer<std::optional<std::string>>(
                    [&](ScheduleQueries& later) { return later.stopName(name, stop); });
            };
            return std::make_shared<const LineIndex>(std::move(contents));
        },
        error);
}

std::vector<ScheduleLine> ScheduleStore::search(std::string_view text,
                                                std::size_t limit,
                                                std::shared_ptr<NSError>* error) const {
    return _implementation->found(
        [&](LineSearch& search, std::vector<ScheduleLine> lines) {
            return search.best(std::move(lines), text, limit);
        },
        error);
}

std::vector<ScheduleLine> ScheduleStore::linesNamed(std::string_view name,
                                                    std::shared_ptr<NSError>* error) const {
    return _implementation->found(
        [&](LineSearch& search, std::vector<ScheduleLine> lines) {
            return search.named(std::move(lines), name);
        },
        error);
}

std::vector<ScheduleLine> ScheduleStore::linesNear(std::string_view text,
                                                   std::size_t limit,
                                                   std::shared_ptr<NSError>* error) const {
    return _implementation->found(
        [&](LineSearch& search, std::vector<ScheduleLine> lines) {
            return search.near(std::move(lines), text, limit);
        },
        error);
}

std::shared_ptr<NSError> ScheduleStore::importSchedule(const std::string& feed,
                                                       const ScheduleSource& source,
                                                       const ImportOptions& options,
                                                       ImportReport* report) {
    if (feed.empty())
        throw NSInvalidArgumentException("a schedule is imported under the name of a feed");
    std::shared_ptr<NSError> error;
    const auto contents = ScheduleReader(feed, options).read(source, error);
    if (!contents)
        return error;
    if (options.progress)
        options.progress({std::string(), ScheduleReader::ShareOfImport});
    ImportReport written;
    error = _implementation->change(
        [&](ScheduleWriter& writer) { written = writer.write(*contents, now()); });
    if (error)
        return error;
    if (options.progress)
        options.progress({std::string(), 1});
    if (report)
        *report = std::move(written);
    return nullptr;
}

std::shared_ptr<NSError> ScheduleStore::removeSchedule(const std::string& feed) {
    return _implementation->change([&feed](ScheduleWriter& writer) { writer.remove(feed); });
}

} // namespace orvo
