#include "platform/favorites/FavoritesStore.h"

#include "platform/favorites/FavoriteLines.h"
#include "platform/favorites/FavoriteTransitLine.h"
#include "platform/favorites/FavoritesError.h"
#include "platform/foundation/Hashing.h"
#include "platform/sqlite/SQLiteStatement.h"
#include "support/LogCapture.h"
#include "support/TemporaryProfile.h"

#include <gmock/gmock.h>
#include <gtest/gtest.h>

#include <algorithm>
#include <fstream>
#include <map>

namespace orvo {
namespace {

using ::testing::ElementsAre;
using testing::favoriteLine;
using ::testing::HasSubstr;
using ::testing::IsEmpty;

class FavoritesStoreTest : public ::testing::Test {
protected:
    std::filesystem::path path() const { return _folder.path() / "data" / "favorites.sqlite"; }
    std::shared_ptr<FavoritesStore>
    open(FavoritesStore::Access access = FavoritesStore::Access::Write) {
        std::shared_ptr<NSError> error;
        auto store = FavoritesStore::open(path(), access, &error);
        EXPECT_EQ(descriptionOf(error), "(null)");
        return store;
    }
    static std::vector<std::string> names(const FavoritesStore& store) {
        std::vector<std::string> names;
        std::shared_ptr<NSError> error;
        for (const auto& entry : store.entries(&error))
            names.push_back(entry.favorite->description());
        EXPECT_EQ(descriptionOf(error), "(null)");
        return names;
    }
    static std::int64_t number(const FavoritesStore& store, const std::string& name) {
        for (const auto& entry : store.entries(nullptr)) {
            if (entry.favorite->description() == name)
                return entry.number;
        }
        return -1;
    }
    static void addLines(FavoritesStore& store, const std::vector<std::string>& names) {
        for (const auto& name : names)
            EXPECT_EQ(store.addLine(*favoriteLine(stableHash(name), name)), nullptr);
    }
    std::vector<std::filesystem::path> files() const {
        std::vector<std::filesystem::path> files;
        for (const auto& entry : std::filesystem::directory_iterator(path().parent_path()))
            if (entry.path().extension() != ".lock")
                files.push_back(entry.path().filename());
        std::ranges::sort(files);
        return files;
    }
    void writeGarbage() const {
        std::filesystem::create_directories(path().parent_path());
        std::ofstream(path()) << std::string(5000, 'x');
    }
    void execute(const char* sql) const {
        const auto database = SQLiteDatabase::open(path(), SQLiteDatabase::Mode::Write, nullptr);
        ASSERT_TRUE(database->execute(sql)) << database->failure().reason;
    }

    testing::TemporaryFolder _folder;
};

TEST_F(FavoritesStoreTest, LiesInTheProfileInUse) {
    const testing::TemporaryProfile profile;
    EXPECT_EQ(FavoritesStore::standardPath(), profile.path() / "data" / "favorites.sqlite");
}

TEST_F(FavoritesStoreTest, KeepsLinesAndPlacesInTheOrderAdded) {
    addLines(*open(), {"1"});
    EXPECT_EQ(open()->addPlace(*FavoritePlace::initWithName_latitude_longitude("Home", 1.5, -2.5)),
              nullptr);
    addLines(*open(), {"2"});
    const auto store = open(FavoritesStore::Access::Read);
    EXPECT_THAT(names(*store), ElementsAre("1", "Home", "2"));
    const auto favorites = store->favorites(nullptr);
    ASSERT_EQ(favorites->count(), 3U);
    EXPECT_NE(dynamic_cast<FavoriteTransitLine*>(favorites->objectAtIndex(0).get()), nullptr);
    const auto* place = dynamic_cast<FavoritePlace*>(favorites->objectAtIndex(1).get());
    ASSERT_NE(place, nullptr);
    EXPECT_EQ(place->latitude(), 1.5);
    EXPECT_EQ(place->longitude(), -2.5);
}

TEST_F(FavoritesStoreTest, ReadingMakesNoFile) {
    EXPECT_THAT(names(*open(FavoritesStore::Access::Read)), IsEmpty());
    EXPECT_FALSE(std::filesystem::exists(path().parent_path()));
}

TEST_F(FavoritesStoreTest, AFileThatAnotherProcessIsAboutToLayOutReadsAsNoFavorites) {
    std::filesystem::create_directories(path().parent_path());
    std::ofstream(path()).flush();
    EXPECT_THAT(names(*open(FavoritesStore::Access::Read)), IsEmpty());
    addLines(*open(), {"1"});
    EXPECT_THAT(names(*open()), ElementsAre("1"));
}

TEST_F(FavoritesStoreTest, ALineKeepsEverythingThatShowsIt) {
    const auto line = favoriteLine(0xF000000000000001U, "U4");
    EXPECT_EQ(open()->addLine(*line), nullptr);
    const auto kept = open()->line(line->muid());
    const auto* feedLine = dynamic_cast<FeedTransitLine*>(kept.get());
    ASSERT_NE(feedLine, nullptr);
    EXPECT_EQ(feedLine->origin(), (FeedLineOrigin{"city", "route-U4"}));
    EXPECT_EQ(kept->muid(), line->muid());
    EXPECT_EQ(kept->name(), "U4");
    EXPECT_TRUE(equal(kept->identifier(), line->identifier()));
    EXPECT_EQ(kept->system()->name(), "City Transit");
    EXPECT_TRUE(equal(kept->system()->artwork(), line->system()->artwork()));
    EXPECT_TRUE(equal(kept->alternateArtwork(), line->alternateArtwork()));
    EXPECT_TRUE(equal(kept->modeArtwork(), line->modeArtwork()));
    EXPECT_EQ(kept->artwork(), nullptr);
    EXPECT_TRUE(kept->isBus());
    EXPECT_TRUE(kept->hasLineColorString());
    EXPECT_EQ(kept->lineColorString(), "009FE3");
    EXPECT_EQ(open()->line(2), nullptr);
}

TEST_F(FavoritesStoreTest, ALineWhoseRecordCannotBeReadKeepsItsNames) {
    addLines(*open(), {"1"});
    execute("UPDATE favorite SET record = x'ff'");
    const auto kept = open()->line(stableHash("1"));
    ASSERT_NE(kept, nullptr);
    EXPECT_EQ(kept->name(), "1");
    EXPECT_EQ(kept->identifier()->muid(), stableHash("1"));
    EXPECT_EQ(kept->system()->name(), "City Transit");
    EXPECT_EQ(dynamic_cast<FeedTransitLine&>(*kept).origin().routeId, "route-1");
}

TEST_F(FavoritesStoreTest, AFavoriteOfAnUnknownKindIsPassedOver) {
    addLines(*open(), {"1", "2"});
    execute("INSERT INTO favorite (position, kind, name) VALUES (0, 'guide', 'new')");
    EXPECT_THAT(names(*open()), ElementsAre("1", "2"));
}

TEST_F(FavoritesStoreTest, TheSameLineIsKeptOnceWithItsNewCopyInItsOldPlace) {
    const auto store = open();
    addLines(*store, {"1", "2"});
    FavoritesStore::Addition addition{};
    EXPECT_EQ(store->addLine(*favoriteLine(stableHash("1"), "1 new"), &addition), nullptr);
    EXPECT_EQ(addition, FavoritesStore::Addition::AlreadyThere);
    EXPECT_THAT(names(*store), ElementsAre("1 new", "2"));
    EXPECT_EQ(store->addLine(*favoriteLine(3, "3"), &addition), nullptr);
    EXPECT_EQ(addition, FavoritesStore::Addition::Added);
}

TEST_F(FavoritesStoreTest, AnEqualPlaceIsKeptOnce) {
    const auto store = open();
    FavoritesStore::Addition addition{};
    const auto add = [&](const char* name, double latitude, double longitude) {
        EXPECT_EQ(store->addPlace(
                      *FavoritePlace::initWithName_latitude_longitude(name, latitude, longitude),
                      &addition),
                  nullptr);
        return addition;
    };
    EXPECT_EQ(add("Home", 1, 2), FavoritesStore::Addition::Added);
    EXPECT_EQ(add("Home", 1, 2), FavoritesStore::Addition::AlreadyThere);
    EXPECT_EQ(add("Home", 1, 2.5), FavoritesStore::Addition::Added);
    EXPECT_EQ(add("Work", 1, 2), FavoritesStore::Addition::Added);
    EXPECT_THAT(names(*store), ElementsAre("Home", "Home", "Work"));
}

TEST_F(FavoritesStoreTest, MovesUpDownToTheEndsAndBeyond) {
    const auto store = open();
    addLines(*store, {"a", "b", "c", "d"});
    const auto move = [&](const char* name, std::size_t index) {
        EXPECT_EQ(store->move(number(*store, name), index), nullptr);
        return names(*store);
    };
    EXPECT_THAT(move("d", 0), ElementsAre("d", "a", "b", "c"));
    EXPECT_THAT(move("d", 2), ElementsAre("a", "b", "d", "c"));
    EXPECT_THAT(move("a", 3), ElementsAre("b", "d", "c", "a"));
    EXPECT_THAT(move("b", 99), ElementsAre("d", "c", "a", "b"));
    EXPECT_THAT(move("c", 1), ElementsAre("d", "c", "a", "b"));
}

TEST_F(FavoritesStoreTest, TheOnlyFavoriteMovesToItsOwnPlace) {
    const auto store = open();
    addLines(*store, {"a"});
    EXPECT_EQ(store->move(number(*store, "a"), 0), nullptr);
    EXPECT_THAT(names(*store), ElementsAre("a"));
}

TEST_F(FavoritesStoreTest, OrderHoldsWhenNoRoomIsLeftBetweenNeighbors) {
    const auto store = open();
    addLines(*store, {"a", "b", "c", "d"});
    // Each move halves the room in front of the second; the gap is used up long before the end.
    for (int round = 0; round < 30; ++round) {
        EXPECT_EQ(store->move(number(*store, "c"), 1), nullptr);
        EXPECT_THAT(names(*store), ElementsAre("a", "c", "b", "d"));
        EXPECT_EQ(store->move(number(*store, "b"), 1), nullptr);
        EXPECT_THAT(names(*store), ElementsAre("a", "b", "c", "d"));
    }
}

TEST_F(FavoritesStoreTest, AMoveTouchesOneRow) {
    const auto store = open();
    addLines(*store, {"a", "b", "c", "d"});
    execute("CREATE TABLE touched (number);"
            "CREATE TRIGGER t AFTER UPDATE ON favorite BEGIN"
            " INSERT INTO touched VALUES (new.number); END");
    EXPECT_EQ(store->move(number(*store, "d"), 1), nullptr);
    const auto database = SQLiteDatabase::open(path(), SQLiteDatabase::Mode::Read, nullptr);
    SQLiteStatement count(*database, "SELECT count(*) FROM touched");
    ASSERT_TRUE(count.step());
    EXPECT_EQ(count.integer(0), 1);
}

TEST_F(FavoritesStoreTest, RemovesOneAndKeepsTheOthersInOrder) {
    const auto store = open();
    addLines(*store, {"a", "b", "c"});
    EXPECT_EQ(store->remove(number(*store, "b")), nullptr);
    EXPECT_THAT(names(*store), ElementsAre("a", "c"));
}

TEST_F(FavoritesStoreTest, ANumberIsNeverGivenTwice) {
    const auto store = open();
    addLines(*store, {"a"});
    const auto first = number(*store, "a");
    EXPECT_EQ(store->remove(first), nullptr);
    addLines(*store, {"b"});
    EXPECT_NE(number(*store, "b"), first);
}

TEST_F(FavoritesStoreTest, AnUnknownNumberIsAnErrorThatNamesFileAndNumber) {
    const auto store = open();
    addLines(*store, {"a"});
    for (const auto& error : {store->move(77, 0), store->remove(77)}) {
        ASSERT_NE(error, nullptr);
        EXPECT_EQ(error->domain(), FavoritesErrorDomain);
        EXPECT_EQ(error->code(), static_cast<std::int64_t>(FavoritesError::NotFound));
        EXPECT_EQ(error->localizedDescription(), path().string() + ": there is no favorite 77");
    }
}

TEST_F(FavoritesStoreTest, ThousandsKeepTheirOrder) {
    constexpr std::uint64_t Count = 5000;
    const auto store = open();
    {
        const auto database = SQLiteDatabase::open(path(), SQLiteDatabase::Mode::Write, nullptr);
        SQLiteTransaction transaction(*database);
        SQLiteStatement insert(*database,
                               "INSERT INTO favorite (position, kind, name, muid)"
                               " VALUES (?1 * 1048576, 'line', printf('%05d', ?1), ?1)");
        for (std::uint64_t muid = 1; muid <= Count; ++muid)
            ASSERT_TRUE(insert.bind(muid).run());
        ASSERT_TRUE(transaction.commit());
    }
    auto expected = names(*store);
    ASSERT_EQ(expected.size(), Count);
    EXPECT_TRUE(std::ranges::is_sorted(expected));
    EXPECT_EQ(store->move(number(*store, "04999"), 2), nullptr);
    std::rotate(expected.begin() + 2, expected.begin() + 4998, expected.begin() + 4999);
    EXPECT_EQ(names(*store), expected);
}

TEST_F(FavoritesStoreTest, IsReadWhileAnotherWrites) {
    addLines(*open(), {"a"});
    const auto writer = SQLiteDatabase::open(path(), SQLiteDatabase::Mode::Write, nullptr);
    const SQLiteTransaction transaction(*writer);
    ASSERT_TRUE(writer->execute("DELETE FROM favorite"));
    EXPECT_THAT(names(*open(FavoritesStore::Access::Read)), ElementsAre("a"));
}

TEST_F(FavoritesStoreTest, AnOpenStoreShowsWhatAnotherWrote) {
    const auto reader = [&] {
        addLines(*open(), {"a"});
        return open(FavoritesStore::Access::Read);
    }();
    addLines(*open(), {"b"});
    EXPECT_THAT(names(*reader), ElementsAre("a", "b"));
}

TEST_F(FavoritesStoreTest, WritesKeptInMemoryEndWithTheStore) {
    addLines(*open(), {"a"});
    const auto inMemory = Environment::keepsWritesInMemory().overrideWith(true);
    const auto store = open();
    addLines(*store, {"b"});
    EXPECT_THAT(names(*store), ElementsAre("a", "b"));
    EXPECT_THAT(names(*open()), ElementsAre("a"));
}

TEST_F(FavoritesStoreTest, WritesKeptInMemoryNeedNoFileAndMakeNone) {
    const auto inMemory = Environment::keepsWritesInMemory().overrideWith(true);
    const auto store = open();
    addLines(*store, {"b"});
    EXPECT_THAT(names(*store), ElementsAre("b"));
    EXPECT_FALSE(std::filesystem::exists(path().parent_path()));
}

TEST_F(FavoritesStoreTest, ADamagedFileIsSetAsideAndSaidInTheLog) {
    const testing::LogCapture log;
    writeGarbage();
    addLines(*open(), {"a"});
    EXPECT_THAT(names(*open()), ElementsAre("a"));
    EXPECT_THAT(files(), ElementsAre("favorites.sqlite", "favorites.sqlite.damaged-1"));
    ASSERT_EQ(log.records().size(), 1U);
    EXPECT_EQ(log.records()[0].level, LogLevel::Error);
    EXPECT_THAT(log.messages()[0], HasSubstr(path().string() + ": the file is damaged ("));
    EXPECT_THAT(log.messages()[0], HasSubstr("favorites.sqlite.damaged-1"));
}

TEST_F(FavoritesStoreTest, ASecondDamagedFileIsKeptToo) {
    const testing::LogCapture log;
    for (int round = 0; round < 2; ++round) {
        writeGarbage();
        EXPECT_THAT(names(*open(FavoritesStore::Access::Read)), IsEmpty());
    }
    EXPECT_THAT(files(), ElementsAre("favorites.sqlite.damaged-1", "favorites.sqlite.damaged-2"));
}

TEST_F(FavoritesStoreTest, APageDamagedInTheMiddleIsNoticed) {
    const testing::LogCapture log;
    std::vector<std::string> many;
    for (int number = 0; number < 100; ++number)
        many.push_back(std::to_string(number));
    addLines(*open(), many);
    {
        std::fstream file(path(), std::ios::in | std::ios::out | std::ios::binary);
        file.seekp(3 * 4096);
        file << std::string(4096, '\xA5');
    }
    EXPECT_THAT(names(*open()), IsEmpty());
    EXPECT_EQ(log.records().size(), 1U);
}

TEST_F(FavoritesStoreTest, ADamagedFileStaysWhileWritesAreKeptInMemory) {
    const testing::LogCapture log;
    writeGarbage();
    const auto inMemory = Environment::keepsWritesInMemory().overrideWith(true);
    std::shared_ptr<NSError> error;
    EXPECT_EQ(FavoritesStore::open(path(), FavoritesStore::Access::Read, &error), nullptr);
    EXPECT_THAT(error->localizedDescription(), HasSubstr(path().string()));
    EXPECT_THAT(files(), ElementsAre("favorites.sqlite"));
}

TEST_F(FavoritesStoreTest, AFileOfALaterVersionIsLeftAsItIs) {
    addLines(*open(), {"a"});
    execute("PRAGMA user_version = 9");
    for (const auto access : {FavoritesStore::Access::Read, FavoritesStore::Access::Write}) {
        std::shared_ptr<NSError> error;
        EXPECT_EQ(FavoritesStore::open(path(), access, &error), nullptr);
        ASSERT_NE(error, nullptr);
        EXPECT_EQ(error->code(), static_cast<std::int64_t>(FavoritesError::CannotOpen));
        EXPECT_EQ(error->localizedDescription(),
                  path().string() + ": the favorites cannot be opened: it has layout 9, and this"
                                    " program knows 1");
    }
    execute("PRAGMA user_version = 1");
    EXPECT_THAT(names(*open()), ElementsAre("a"));
}

TEST_F(FavoritesStoreTest, AFolderThatCannotBeMadeIsAnErrorThatNamesIt) {
    std::ofstream(_folder.path() / "data") << "a file where the folder should be";
    std::shared_ptr<NSError> error;
    EXPECT_EQ(FavoritesStore::open(path(), FavoritesStore::Access::Write, &error), nullptr);
    ASSERT_NE(error, nullptr);
    EXPECT_THAT(error->localizedDescription(), HasSubstr(path().string()));
    EXPECT_THAT(error->localizedDescription(), HasSubstr("/data: File exists"));
}

TEST_F(FavoritesStoreTest, AFileThatIsHiddenIsNotNone) {
    const auto tooLong = _folder.path() / std::string(300, 'x') / "favorites.sqlite";
    std::filesystem::create_symlink("loop", _folder.path() / "loop");
    const std::map<std::filesystem::path, std::string> reasons{
        {tooLong, "File name too long"},
        {_folder.path() / "loop" / "favorites.sqlite", "Too many levels of symbolic links"},
        {_folder.path(), "Is a directory"}};
    for (const bool inMemory : {false, true}) {
        const auto kept = Environment::keepsWritesInMemory().overrideWith(inMemory);
        for (const auto& [hidden, reason] : reasons) {
            std::shared_ptr<NSError> error;
            EXPECT_EQ(FavoritesStore::open(hidden, FavoritesStore::Access::Read, &error), nullptr);
            ASSERT_NE(error, nullptr) << hidden;
            EXPECT_EQ(error->code(), static_cast<std::int64_t>(FavoritesError::CannotOpen));
            EXPECT_EQ(error->localizedDescription(),
                      hidden.string() + ": the favorites cannot be opened: " + reason);
        }
    }
}

TEST_F(FavoritesStoreTest, AStoreThatWasOpenedForReadingCannotBeChanged) {
    addLines(*open(), {"a"});
    const auto store = open(FavoritesStore::Access::Read);
    const auto error = store->addLine(*favoriteLine(1, "b"));
    ASSERT_NE(error, nullptr);
    EXPECT_EQ(error->code(), static_cast<std::int64_t>(FavoritesError::CannotWrite));
    EXPECT_THAT(names(*store), ElementsAre("a"));
}

TEST_F(FavoritesStoreTest, AReadThatFailsIsAnErrorThatNamesFileAndReason) {
    const auto store = open();
    execute("DROP TABLE favorite");
    std::shared_ptr<NSError> error;
    EXPECT_EQ(store->favorites(&error), nullptr);
    ASSERT_NE(error, nullptr);
    EXPECT_EQ(error->code(), static_cast<std::int64_t>(FavoritesError::CannotRead));
    EXPECT_EQ(error->localizedDescription(),
              path().string() + ": the favorites cannot be read: no such table: favorite");
    const auto writeError = store->addLine(*favoriteLine(1, "a"));
    ASSERT_NE(writeError, nullptr);
    EXPECT_EQ(writeError->code(), static_cast<std::int64_t>(FavoritesError::CannotWrite));
}

} // namespace
} // namespace orvo
