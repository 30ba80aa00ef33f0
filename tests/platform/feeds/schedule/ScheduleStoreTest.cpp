#include "platform/feeds/schedule/ScheduleStore.h"

#include "TestSchedules.h"
#include "platform/feeds/schedule/ScheduleError.h"
#include "platform/feeds/schedule/ScheduleTables.h"
#include "platform/foundation/Exceptions.h"
#include "platform/foundation/Text.h"
#include "platform/sqlite/SQLiteDatabase.h"
#include "support/LogCapture.h"
#include "support/TemporaryProfile.h"
#include "support/TestClock.h"

#include <gmock/gmock.h>
#include <gtest/gtest.h>

#include <utility>

namespace orvo {
namespace {

using ::testing::ElementsAre;
using testing::Files;
using ::testing::HasSubstr;
using ::testing::IsEmpty;
using ::testing::Optional;
using ::testing::SizeIs;

class ScheduleStoreTest : public ::testing::Test {
protected:
    std::filesystem::path path() const { return folder.path() / "data" / "schedules.sqlite"; }
    std::shared_ptr<ScheduleStore> open() {
        auto opened = ScheduleStore::open(path(), &error);
        EXPECT_TRUE(opened) << (error ? error->localizedDescription() : "");
        return opened;
    }
    std::string import(const Files& files, const std::string& feed = "city") {
        error = store->importSchedule(
            feed, ScheduleSource::fromBytes(testing::zipOf(files), "city.zip"), {}, &report);
        return error ? error->localizedDescription() : "";
    }
    static std::vector<std::string> routesOf(const std::vector<ScheduleLine>& lines) {
        std::vector<std::string> routes;
        for (const auto& line : lines)
            routes.push_back(line.routeId);
        return routes;
    }

    testing::TemporaryFolder folder;
    testing::StoppedClock clock{1750000000};
    EnvironmentSlot<std::string>::Override locale = Text::locale().overrideWith("fr-FR");
    std::shared_ptr<NSError> error;
    ImportReport report;
    std::shared_ptr<ScheduleStore> store = open();
};

TEST_F(ScheduleStoreTest, AnswersWhatWasImported) {
    ASSERT_EQ(import(testing::smallSchedule()), "");
    EXPECT_THAT(store->feeds(), ElementsAre("city"));
    EXPECT_THAT(routesOf(store->lines("city")), ElementsAre("R1", "R2", "R3"));
    const auto line = store->line(lineMuid("city", "R2"));
    ASSERT_TRUE(line);
    ScheduleLine expected;
    expected.muid = lineMuid("city", "R2");
    expected.feed = "city";
    expected.routeId = "R2";
    expected.agencyId = "A1";
    expected.shortName = "T2";
    expected.longName = "Hôpital - Université";
    expected.color = "FFB900";
    expected.routeType = 0;
    expected.order = 1;
    expected.knownAt = 1750000000;
    expected.agency = {"A1", "City Lines", "https://city.example/", "Europe/Paris", "fr"};
    EXPECT_EQ(*line, expected);
    EXPECT_EQ(store->lines("city")[1], expected);
    EXPECT_EQ(report.lines, 3U);
    EXPECT_EQ(report.newLines, 3U);
    EXPECT_EQ(report.departedLines, 0U);
    EXPECT_EQ(report.agencies, 2U);
    EXPECT_EQ(report.rows, 5U);
}

TEST_F(ScheduleStoreTest, KnowsNothingOfWhatWasNeverImported) {
    EXPECT_THAT(store->feeds(), IsEmpty());
    EXPECT_THAT(store->lines("city"), IsEmpty());
    EXPECT_FALSE(store->info("city"));
    EXPECT_FALSE(store->line(lineMuid("city", "R1")));
    EXPECT_FALSE(store->lineIndex("city"));
    EXPECT_FALSE(store->removeSchedule("city"));
}

TEST_F(ScheduleStoreTest, KeepsWhatAScheduleSaysOfItself) {
    auto files = testing::smallSchedule();
    files.emplace_back("feed_info.txt",
                       "feed_publisher_name,feed_lang,feed_start_date,feed_end_date,feed_version\n"
                       "City,fr,20250101,20251231,v7\n");
    files.emplace_back("stops.txt", "stop_id\nS1\n");
    ASSERT_EQ(import(files), "");
    const auto info = store->info("city");
    ASSERT_TRUE(info);
    EXPECT_EQ(info->feed, "city");
    EXPECT_EQ(info->publisher, "City");
    EXPECT_EQ(info->version, "v7");
    EXPECT_EQ(info->language, "fr");
    EXPECT_EQ(info->timezone, "Europe/Paris");
    EXPECT_EQ(info->startDate, "2025-01-01");
    EXPECT_EQ(info->endDate, "2025-12-31");
    EXPECT_EQ(info->validUntil, 1767222000);
    EXPECT_EQ(info->importedAt, 1750000000);
    EXPECT_EQ(info->agencies, 2);
    EXPECT_EQ(info->lines, 3);
    EXPECT_EQ(info->stops, 1);
    EXPECT_FALSE(info->knowsStopsOfLines);
    ASSERT_EQ(import(testing::smallSchedule()), "");
    EXPECT_FALSE(store->info("city")->validUntil);
}

TEST_F(ScheduleStoreTest, ALineThatLeavesStaysKnownWithItsAgency) {
    ASSERT_EQ(import(testing::smallSchedule()), "");
    ASSERT_EQ(import({{"agency.txt", "agency_id,agency_name\nA9,Others\n"},
                      {"routes.txt", "route_id,route_short_name\nR1,1bis\nR4,4\n"}}),
              "");
    EXPECT_EQ(report.lines, 2U);
    EXPECT_EQ(report.newLines, 1U);
    EXPECT_EQ(report.departedLines, 2U);
    EXPECT_THAT(routesOf(store->lines("city")), ElementsAre("R1", "R4"));
    const auto departed = store->line(lineMuid("city", "R3"));
    ASSERT_TRUE(departed);
    EXPECT_FALSE(departed->present);
    EXPECT_EQ(departed->longName, "Traversée du port");
    EXPECT_EQ(departed->agency.name, "River Boats");
    EXPECT_EQ(store->line(lineMuid("city", "R1"))->shortName, "1bis");
    EXPECT_EQ(store->line(lineMuid("city", "R1"))->agency.name, "Others");
    ASSERT_EQ(import(testing::smallSchedule()), "");
    EXPECT_EQ(report.newLines, 2U);
    EXPECT_TRUE(store->line(lineMuid("city", "R3"))->present);
}

TEST_F(ScheduleStoreTest, ALineIsKnownSinceTheLastScheduleThatHasIt) {
    const auto knownAt = [this](const char* route) {
        return store->line(lineMuid("city", route))->knownAt;
    };
    ASSERT_EQ(import(testing::smallSchedule()), "");
    clock->advance(100);
    ASSERT_EQ(import({{"routes.txt", "route_id,route_short_name\nR1,1\n"}}), "");
    EXPECT_EQ(knownAt("R1"), 1750000100);
    EXPECT_EQ(knownAt("R3"), 1750000000);
    clock->advance(100);
    EXPECT_FALSE(store->removeSchedule("city"));
    EXPECT_EQ(knownAt("R1"), 1750000100);
}

TEST_F(ScheduleStoreTest, AStoreOfTheFirstVersionIsBroughtUpToDate) {
    ASSERT_EQ(import(testing::smallSchedule()), "");
    ASSERT_EQ(import({{"routes.txt", "route_id,route_short_name\nR1,1\n"}}), "");
    store = nullptr;
    const auto makeOld = [this] {
        const auto old = SQLiteDatabase::open(path(), SQLiteDatabase::Mode::Write, nullptr);
        EXPECT_TRUE(old->execute("ALTER TABLE line DROP COLUMN known_at; PRAGMA user_version = 1"));
    };
    const auto expectUpToDate = [this] {
        store = open();
        EXPECT_EQ(store->line(lineMuid("city", "R1"))->knownAt, 1750000000);
        EXPECT_EQ(store->line(lineMuid("city", "R3"))->knownAt, 0);
        store = nullptr;
    };
    makeOld();
    {
        const auto inMemory = Environment::keepsWritesInMemory().overrideWith(true);
        expectUpToDate();
    }
    expectUpToDate();
    store = open();
    ASSERT_EQ(import(testing::smallSchedule()), "");
    EXPECT_EQ(store->line(lineMuid("city", "R3"))->knownAt, 1750000000);
}

TEST_F(ScheduleStoreTest, RemovingAScheduleKeepsItsLinesKnown) {
    ASSERT_EQ(import(testing::smallSchedule(), "city"), "");
    ASSERT_EQ(import(testing::smallSchedule(), "town"), "");
    EXPECT_FALSE(store->removeSchedule("city"));
    EXPECT_THAT(store->feeds(), ElementsAre("town"));
    EXPECT_THAT(store->lines("city"), IsEmpty());
    EXPECT_FALSE(store->info("city"));
    EXPECT_FALSE(store->lineIndex("city"));
    EXPECT_FALSE(store->line(lineMuid("city", "R1"))->present);
    EXPECT_EQ(store->line(lineMuid("city", "R1"))->agency.name, "City Lines");
    EXPECT_TRUE(store->line(lineMuid("town", "R1"))->present);
    EXPECT_EQ(store->search("gare", 10).size(), 1U);
    ASSERT_EQ(import(testing::smallSchedule(), "city"), "");
    EXPECT_TRUE(store->line(lineMuid("city", "R1"))->present);
}

TEST_F(ScheduleStoreTest, ARefusedImportLeavesTheEarlierSchedule) {
    ASSERT_EQ(import(testing::smallSchedule()), "");
    const auto before = store->lines("city");
    const ImportReport reportBefore = report;
    for (const Files& refused :
         {Files{{"agency.txt", "agency_id\n"}},
          Files{{"routes.txt", "route_id\nR9\n"}, {"stops.txt", "stop_id\nS\xFF\n"}}}) {
        EXPECT_NE(import(refused), "");
        EXPECT_EQ(store->lines("city"), before);
        EXPECT_EQ(report.lines, reportBefore.lines);
    }
    EXPECT_FALSE(store->line(lineMuid("city", "R9")));
}

TEST_F(ScheduleStoreTest, OneLinesNumberCannotBeTakenByAnotherFeed) {
    ASSERT_EQ(import(testing::smallSchedule(), "city"), "");
    ASSERT_EQ(import(testing::smallSchedule(), "town"), "");
    EXPECT_EQ(store->lines("city").size(), 3U);
    EXPECT_EQ(store->lines("town").size(), 3U);
    EXPECT_EQ(store->line(lineMuid("city", "R1"))->feed, "city");
}

TEST_F(ScheduleStoreTest, TellsTheIndexWhatServesAStop) {
    auto files = testing::smallSchedule();
    files.emplace_back("stops.txt", "stop_id,stop_name\nS1,Gare\nS2,\n");
    files.emplace_back("trips.txt", "route_id,trip_id\nR2,T2\nR1,T1\n");
    files.emplace_back("stop_times.txt", "trip_id,stop_id\nT2,S1\nT1,S1\n");
    ASSERT_EQ(import(files), "");
    ASSERT_EQ(import(files, "town"), "");
    EXPECT_TRUE(store->info("city")->knowsStopsOfLines);
    const auto index = store->lineIndex("city");
    ASSERT_TRUE(index);
    EXPECT_EQ(index->feed(), "city");
    EXPECT_EQ(index->language(), "fr");
    EXPECT_EQ(index->timezone(), "Europe/Paris");
    EXPECT_THAT(index->linesServingStop("S1"),
                Optional(ElementsAre(lineMuid("city", "R1"), lineMuid("city", "R2"))));
    EXPECT_THAT(index->linesServingStop("S2"), Optional(IsEmpty()));
    EXPECT_EQ(index->stopName("S1"), "Gare");
    EXPECT_EQ(index->stopName("S2"), "");
    EXPECT_FALSE(index->stopName("S3"));
    EXPECT_THAT(index->linesOfAgency("A2"), ElementsAre(lineMuid("city", "R3")));
    ASSERT_EQ(import(testing::smallSchedule()), "");
    EXPECT_THAT(store->lineIndex("city")->linesServingStop("S1"), Optional(IsEmpty()));
}

TEST_F(ScheduleStoreTest, AFailedQuestionAboutAStopIsNoAnswerThatNothingServesIt) {
    ASSERT_EQ(import(testing::smallSchedule()), "");
    const auto index = store->lineIndex("city");
    EXPECT_THAT(index->linesServingStop("S1"), Optional(IsEmpty()));
    const auto other = SQLiteDatabase::open(path(), SQLiteDatabase::Mode::Write, nullptr);
    ASSERT_TRUE(other->execute("DROP TABLE stop_line"));
    const testing::LogCapture log;
    EXPECT_EQ(index->linesServingStop("S1"), std::nullopt);
    EXPECT_THAT(log.messages(), ElementsAre(HasSubstr(path().string())));
}

TEST_F(ScheduleStoreTest, LinesThatCannotBeReadAreAnErrorAndNotNone) {
    ASSERT_EQ(import(testing::smallSchedule()), "");
    EXPECT_THAT(store->lines("nowhere", &error), IsEmpty());
    EXPECT_FALSE(error);
    const auto other = SQLiteDatabase::open(path(), SQLiteDatabase::Mode::Write, nullptr);
    ASSERT_TRUE(other->execute("DROP TABLE line"));
    const testing::LogCapture log;
    EXPECT_THAT(store->lines("city", &error), IsEmpty());
    ASSERT_TRUE(error);
    EXPECT_THAT(error->localizedDescription(), HasSubstr(path().string()));
    error = nullptr;
    EXPECT_THAT(store->search("gare", 5, &error), IsEmpty());
    EXPECT_TRUE(error);
}

TEST_F(ScheduleStoreTest, NothingThatCannotBeReadIsTakenForNothingThere) {
    ASSERT_EQ(import(testing::smallSchedule()), "");
    const auto muid = lineMuid("city", "R1");
    EXPECT_THAT(store->feeds(&error), ElementsAre("city"));
    EXPECT_TRUE(store->info("city", &error));
    EXPECT_FALSE(store->info("nowhere", &error));
    EXPECT_TRUE(store->line(muid, &error));
    EXPECT_FALSE(store->line(7, &error));
    EXPECT_TRUE(store->lineIndex("city", &error));
    EXPECT_FALSE(store->lineIndex("nowhere", &error));
    EXPECT_THAT(store->linesNamed("T2", &error), SizeIs(1));
    EXPECT_THAT(store->linesNamed("no such name", &error), IsEmpty());
    EXPECT_FALSE(error);
    const auto other = SQLiteDatabase::open(path(), SQLiteDatabase::Mode::Write, nullptr);
    ASSERT_TRUE(other->execute("DROP TABLE feed"));
    const testing::LogCapture log;
    const auto said = [&] {
        const auto given = std::exchange(error, nullptr);
        return given ? given->localizedDescription() : "(null)";
    };
    EXPECT_THAT(store->feeds(&error), IsEmpty());
    EXPECT_THAT(said(), HasSubstr(path().string() + ": "));
    EXPECT_FALSE(store->info("city", &error));
    EXPECT_THAT(said(), HasSubstr(path().string() + ": "));
    EXPECT_FALSE(store->line(muid, &error));
    EXPECT_THAT(said(), HasSubstr(path().string() + ": "));
    EXPECT_FALSE(store->lineIndex("city", &error));
    EXPECT_THAT(said(), HasSubstr(path().string() + ": "));
    EXPECT_THAT(store->linesNamed("T2", &error), IsEmpty());
    EXPECT_THAT(said(), HasSubstr(path().string() + ": "));
    EXPECT_THAT(store->linesNear("hopitl", 5, &error), IsEmpty());
    EXPECT_THAT(said(), HasSubstr(path().string() + ": "));
}

TEST_F(ScheduleStoreTest, AFileThatWasCutIsAnErrorAndNotAnEmptyStore) {
    ASSERT_EQ(import(testing::smallSchedule()), "");
    store = nullptr;
    const auto size = std::filesystem::file_size(path());
    std::filesystem::resize_file(path(), size / 2);
    const testing::LogCapture log;
    const auto cut = ScheduleStore::open(path(), &error);
    EXPECT_THAT(cut ? cut->lines("city", &error) : std::vector<ScheduleLine>(), IsEmpty());
    ASSERT_TRUE(error);
    EXPECT_THAT(error->localizedDescription(), HasSubstr(path().string() + ": "));
    EXPECT_THAT(error->localizedDescription(), HasSubstr("orvo feeds update"));
}

TEST_F(ScheduleStoreTest, AStoreThatIsHiddenIsAnErrorAlsoWhereNothingIsWritten) {
    const auto hidden = path().parent_path() / std::string(300, 'x') / "schedules.sqlite";
    for (const bool inMemory : {false, true}) {
        const auto kept = Environment::keepsWritesInMemory().overrideWith(inMemory);
        error = nullptr;
        EXPECT_EQ(ScheduleStore::open(hidden, &error), nullptr);
        ASSERT_TRUE(error);
        EXPECT_THAT(error->localizedDescription(), HasSubstr("File name too long"));
    }
}

TEST_F(ScheduleStoreTest, AStoreThatAnotherProgramHoldsIsAnErrorThatSaysSo) {
    ASSERT_EQ(import(testing::smallSchedule()), "");
    store = nullptr;
    const auto other = SQLiteDatabase::open(path(), SQLiteDatabase::Mode::Write, nullptr);
    ASSERT_TRUE(other->execute("PRAGMA locking_mode = EXCLUSIVE; BEGIN EXCLUSIVE;"
                               "UPDATE line SET long_name = ''"));
    EXPECT_EQ(ScheduleTables::openForWriting(path(), std::chrono::seconds(0), error), nullptr);
    ASSERT_TRUE(error);
    EXPECT_EQ(error->localizedDescription(),
              path().string() +
                  ": database is locked by another program; try again when that is done");
}

TEST_F(ScheduleStoreTest, NamesThatCouldNotBeTranslatedOnceAreTranslatedLater) {
    auto files = testing::smallSchedule();
    files.emplace_back("translations.txt",
                       "table_name,field_name,language,translation,record_id\n"
                       "routes,route_long_name,nl,Ziekenhuis,R2\n");
    ASSERT_EQ(import(files), "");
    const auto dutch = Text::locale().overrideWith("nl");
    const auto other = SQLiteDatabase::open(path(), SQLiteDatabase::Mode::Write, nullptr);
    ASSERT_TRUE(other->execute("ALTER TABLE translation RENAME TO away"));
    {
        const testing::LogCapture log;
        EXPECT_FALSE(store->line(lineMuid("city", "R2"), &error));
        EXPECT_TRUE(error);
    }
    ASSERT_TRUE(other->execute("ALTER TABLE away RENAME TO translation"));
    EXPECT_EQ(store->line(lineMuid("city", "R2"))->longName, "Ziekenhuis");
}

TEST_F(ScheduleStoreTest, AnswersNamesInThePersonsLanguage) {
    auto files = testing::smallSchedule();
    files.emplace_back("translations.txt",
                       "table_name,field_name,language,translation,record_id\n"
                       "routes,route_long_name,en,Station - Town hall,R1\n"
                       "agency,agency_name,en,City Transit,A1\n");
    ASSERT_EQ(import(files), "");
    EXPECT_EQ(store->lines("city")[0].longName, "Gare - Mairie");
    const auto english = Text::locale().overrideWith("en-GB");
    EXPECT_EQ(store->lines("city")[0].longName, "Station - Town hall");
    EXPECT_EQ(store->line(lineMuid("city", "R2"))->agency.name, "City Transit");
    EXPECT_THAT(routesOf(store->search("town", 5)), ElementsAre("R1"));
    // A sign may show the name that the schedule itself has.
    const auto bySign = store->search("mairie", 5);
    ASSERT_THAT(routesOf(bySign), ElementsAre("R1"));
    EXPECT_EQ(bySign[0].longName, "Station - Town hall");
    EXPECT_THAT(routesOf(store->linesNamed("gare mairie")), ElementsAre("R1"));
    const auto misspelt = store->linesNear("mayrie", 5);
    ASSERT_THAT(routesOf(misspelt), ElementsAre("R1"));
    EXPECT_EQ(misspelt[0].longName, "Station - Town hall");
    EXPECT_THAT(routesOf(store->linesNear("statoin", 5)), ElementsAre("R1"));
    EXPECT_EQ(store->lineIndex("city")->lines()[0].longName, "Gare - Mairie");
    ASSERT_EQ(import(testing::smallSchedule()), "");
    EXPECT_EQ(store->lines("city")[0].longName, "Gare - Mairie");
}

TEST_F(ScheduleStoreTest, SearchesAllFeedsBestFirst) {
    ASSERT_EQ(import(testing::smallSchedule(), "b"), "");
    ASSERT_EQ(import(testing::smallSchedule(), "a"), "");
    const auto found = store->search("HOPITAL", 5);
    ASSERT_EQ(found.size(), 2U);
    EXPECT_EQ(found[0].feed, "a");
    EXPECT_EQ(found[1].feed, "b");
    EXPECT_EQ(store->search("hopital", 1).size(), 1U);
    EXPECT_EQ(store->linesNamed("t2").size(), 2U);
    EXPECT_THAT(store->linesNamed("t"), IsEmpty());
    EXPECT_EQ(store->linesNear("hopitl", 5).size(), 2U);
    EXPECT_EQ(store->linesNear("hopitl", 1).size(), 1U);
}

TEST_F(ScheduleStoreTest, OtherConnectionsSeeAnImportWhole) {
    const auto other = open();
    ASSERT_EQ(import(testing::smallSchedule()), "");
    EXPECT_EQ(other->lines("city").size(), 3U);
    EXPECT_EQ(open()->lines("city").size(), 3U);
}

TEST_F(ScheduleStoreTest, TellsProgressToTheEnd) {
    std::vector<double> fractions;
    ImportOptions options;
    options.progress = [&](const ImportProgress& progress) {
        fractions.push_back(progress.fraction);
        EXPECT_EQ(store->lines("city").size(), progress.fraction < 1 ? 0U : 3U);
    };
    const auto zip = testing::zipOf(testing::smallSchedule());
    EXPECT_FALSE(store->importSchedule(
        "city", ScheduleSource::fromBytes(zip, "city.zip"), options, nullptr));
    ASSERT_FALSE(fractions.empty());
    EXPECT_TRUE(std::ranges::is_sorted(fractions));
    EXPECT_EQ(fractions.back(), 1);
}

TEST_F(ScheduleStoreTest, AScheduleNeedsTheNameOfItsFeed) {
    EXPECT_THROW(import(testing::smallSchedule(), ""), NSInvalidArgumentException);
}

TEST_F(ScheduleStoreTest, ADamagedFileIsRefusedByName) {
    const auto damaged = folder.path() / "damaged.sqlite";
    testing::writeFile(damaged, std::string(5000, 'x'));
    EXPECT_FALSE(ScheduleStore::open(damaged, &error));
    EXPECT_THAT(error->localizedDescription(), HasSubstr(damaged.string() + ": "));
    EXPECT_EQ(error->code(), static_cast<std::int64_t>(ScheduleErrorCode::Store));
    EXPECT_FALSE(ScheduleStore::open(damaged, nullptr));
}

TEST_F(ScheduleStoreTest, AFolderThatCannotBeMadeIsRefusedByName) {
    testing::writeFile(folder.path() / "file", "");
    EXPECT_FALSE(ScheduleStore::open(folder.path() / "file" / "schedules.sqlite", &error));
    EXPECT_THAT(error->localizedDescription(), HasSubstr((folder.path() / "file").string()));
}

TEST_F(ScheduleStoreTest, WhereNothingCanBeMadeAMissingStoreIsEmptyAndStaysSo) {
    if (geteuid() == 0)
        GTEST_SKIP() << "root can write everywhere";
    const auto place = folder.path() / "closed";
    std::filesystem::create_directory(place);
    std::filesystem::permissions(
        place, std::filesystem::perms::owner_read | std::filesystem::perms::owner_exec);
    const auto closed = ScheduleStore::open(place / "data" / "schedules.sqlite", &error);
    ASSERT_TRUE(closed);
    EXPECT_THAT(closed->feeds(), IsEmpty());
    error = closed->removeSchedule("city");
    ASSERT_TRUE(error);
    EXPECT_THAT(error->localizedDescription(), HasSubstr("closed/data"));
}

TEST_F(ScheduleStoreTest, DefaultPathLiesInTheProfileInUse) {
    const testing::TemporaryProfile profile;
    EXPECT_EQ(ScheduleStore::defaultPath(), profile.path() / "data" / "schedules.sqlite");
}

TEST_F(ScheduleStoreTest, KeptInMemoryNothingIsWritten) {
    ASSERT_EQ(import(testing::smallSchedule()), "");
    store = nullptr;
    const auto inMemory = Environment::keepsWritesInMemory().overrideWith(true);
    const auto size = std::filesystem::file_size(path());
    store = open();
    EXPECT_EQ(store->lines("city").size(), 3U);
    ASSERT_EQ(import({{"routes.txt", "route_id\nR7\n"}}), "");
    EXPECT_THAT(routesOf(store->lines("city")), ElementsAre("R7"));
    EXPECT_FALSE(store->line(lineMuid("city", "R1"))->present);
    EXPECT_FALSE(store->removeSchedule("city"));
    EXPECT_THAT(store->feeds(), IsEmpty());
    EXPECT_EQ(open()->lines("city").size(), 3U);
    EXPECT_EQ(std::filesystem::file_size(path()), size);
}

TEST_F(ScheduleStoreTest, KeptInMemoryAMissingFileIsNotMade) {
    const auto inMemory = Environment::keepsWritesInMemory().overrideWith(true);
    const auto missing = folder.path() / "none" / "schedules.sqlite";
    store = ScheduleStore::open(missing, &error);
    ASSERT_TRUE(store);
    ASSERT_EQ(import(testing::smallSchedule()), "");
    EXPECT_EQ(store->lines("city").size(), 3U);
    EXPECT_FALSE(std::filesystem::exists(missing.parent_path()));
}

} // namespace
} // namespace orvo
