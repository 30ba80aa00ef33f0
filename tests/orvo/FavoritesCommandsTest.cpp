#include "CommandTest.h"

#include <gmock/gmock.h>

namespace orvo {
namespace {

using ::testing::HasSubstr;

class FavoritesCommandsTest : public testing::CommandTest {
protected:
    void SetUp() override { addCity(); }
};

TEST_F(FavoritesCommandsTest, AddsLinesByRouteAndByNameInTheOrderGiven) {
    answered({"favorites", "add", "city:T4", "m2", "Skyline Cable Car"});
    EXPECT_EQ(answered({"favorites", "list"}),
              "1\tcity:T4\t4\tMarrow Bay Transit\n"
              "2\tcity:M2\tM2\tMarrow Bay Transit\n"
              "3\tcity:SKY\tSkyline Cable Car\tHarbour and Hills Railway\n");
}

TEST_F(FavoritesCommandsTest, AddsNothingWhenOneLineIsNotFound) {
    EXPECT_THAT(refused({"favorites", "add", "city:M1", "city:M9"}),
                HasSubstr("the schedule of city has no line M9"));
    EXPECT_EQ(answered({"favorites", "list"}), "");
    EXPECT_THAT(refused({"favorites", "add", "Nowhere"}), HasSubstr("no line is called Nowhere"));
    EXPECT_THAT(refused({"favorites", "add", "town:M1"}), HasSubstr("Nor is there a feed town"));
}

TEST_F(FavoritesCommandsTest, ANameOfSeveralLinesIsRefusedWithTheChoice) {
    answered({"feeds", "add", "town", "--static", writeSchedule(), "--alerts", writeAlerts({})});
    EXPECT_THAT(refused({"favorites", "add", "M1"}), HasSubstr("Choose one of city:M1, town:M1."));
}

TEST_F(FavoritesCommandsTest, AMisspeltLineIsAskedFor) {
    EXPECT_EQ(refused({"favorites", "add", "Skylin Cabel Car"}),
              "orvo: no line is called Skylin Cabel Car\n"
              "Did you mean city:SKY (Skyline Cable Car)?\n");
    EXPECT_THAT(refused({"favorites", "add", "Exprss"}),
                HasSubstr("\nDid you mean one of city:CE (Coastal Express), city:X90 (Airport "
                          "Express)?\n"));
    // There are four of them: the best three.
    EXPECT_THAT(refused({"favorites", "add", "Centrel"}),
                HasSubstr("\nDid you mean one of city:T7 (Central Station – Hillside), city:S1 "
                          "(Central Station – Northern Coast), city:N3 (Night bus Central Station "
                          "– Old Harbour)?\n"));
}

TEST_F(FavoritesCommandsTest, APartOfANameIsAskedForWhereFewLinesHaveIt) {
    EXPECT_THAT(refused({"favorites", "add", "Express"}),
                HasSubstr("\nDid you mean one of city:CE (Coastal Express), city:X90 (Airport "
                          "Express)?\n"));
    EXPECT_THAT(refused({"favorites", "add", "Harbour"}),
                HasSubstr("\nLook for it with: orvo lines \"Harbour\"\n"));
}

TEST_F(FavoritesCommandsTest, ALineOfAFeedIsAskedForByNumberInAnyCaseAndByName) {
    EXPECT_EQ(refused({"favorites", "add", "city:m1"}),
              "orvo: the schedule of city has no line m1\n"
              "Did you mean city:M1 (Airport – Old Harbour)?\n");
    EXPECT_THAT(refused({"favorites", "add", "city:Skylyne"}),
                HasSubstr("\nDid you mean city:SKY (Skyline Cable Car)?\n"));
    EXPECT_THAT(refused({"favorites", "add", "city:M9"}),
                HasSubstr("\nFind its lines with: orvo lines city\n"));
}

TEST_F(FavoritesCommandsTest, NoOtherNumberIsAskedForAndNothingThatIsFar) {
    for (const char* name : {"M3", "9", "X91", "B4", "Tramway", "zzzzzz", "?"})
        EXPECT_THAT(refused({"favorites", "add", name}),
                    HasSubstr("\nLook for it with: orvo lines"))
            << name;
}

TEST_F(FavoritesCommandsTest, ListAndIncidentsNameALineInThePersonsLanguage) {
    answered({"favorites", "add", "city:SKY"});
    EXPECT_EQ(answered({"favorites", "list", "--language", "de"}),
              "1\tcity:SKY\tPanorama-Seilbahn\tHarbour and Hills Railway\n");
    EXPECT_THAT(answered({"favorites", "list", "--json", "--language", "de"}),
                HasSubstr("\"name\": \"Panorama-Seilbahn\""));
    EXPECT_THAT(answered({"incidents", "--language", "de"}), HasSubstr("Panorama-Seilbahn"));
    EXPECT_EQ(answered({"favorites", "list"}),
              "1\tcity:SKY\tSkyline Cable Car\tHarbour and Hills Railway\n");
}

TEST_F(FavoritesCommandsTest, ALineIsMovedAndRemovedByItsShownAndByItsKeptName) {
    for (const char* name : {"Panorama-Seilbahn", "panorama-seilbahn", "Skyline Cable Car"}) {
        answered({"favorites", "add", "M1", "city:SKY"});
        EXPECT_EQ(answered({"favorites", "move", name, "1", "--language", "de"}),
                  "Panorama-Seilbahn is number 1 now\n");
        EXPECT_EQ(answered({"favorites", "remove", name, "M1", "--language", "de"}),
                  "Removed Panorama-Seilbahn\nRemoved M1\n");
    }
    answered({"favorites", "add", "city:SKY"});
    EXPECT_THAT(refused({"favorites", "remove", "Panorama-Seilbahn"}), // English
                HasSubstr("there is no favourite Panorama-Seilbahn"));
}

TEST_F(FavoritesCommandsTest, ANameThatOneLineShowsAndAnotherWasKeptByIsOfSeveral) {
    answered({"favorites", "add", "city:SKY"});
    answered({"favorites", "add", "--place", "Panorama-Seilbahn", "--location", "1,2"});
    EXPECT_EQ(refused({"favorites", "remove", "Panorama-Seilbahn", "--language", "de"}),
              "orvo: several favourites are called Panorama-Seilbahn\nSee: orvo favorites list\n");
    EXPECT_EQ(answered({"favorites", "remove", "Panorama-Seilbahn"}),
              "Removed Panorama-Seilbahn\n");
    EXPECT_THAT(answered({"favorites", "list"}), HasSubstr("city:SKY"));
}

TEST_F(FavoritesCommandsTest, WithoutSchedulesALineHasTheNameThatItWasKeptBy) {
    answered({"favorites", "add", "city:SKY"});
    write("data/schedules.sqlite", "no database at all, though long enough for a header of one");
    EXPECT_EQ(answered({"favorites", "list", "--language", "de"}),
              "1\tcity:SKY\tSkyline Cable Car\tHarbour and Hills Railway\n");
    answered({"favorites", "move", "Skyline Cable Car", "1"});
    EXPECT_EQ(answered({"favorites", "remove", "Skyline Cable Car"}),
              "Removed Skyline Cable Car\n");
}

TEST_F(FavoritesCommandsTest, AMisspeltFavouriteIsAskedFor) {
    answered({"favorites", "add", "M1", "M2", "city:SKY"});
    answered({"favorites", "add", "--place", "Kindergarten", "--location", "1,2"});
    EXPECT_EQ(refused({"favorites", "remove", "Skylin Cabel Car"}),
              "orvo: there is no favourite Skylin Cabel Car\n"
              "Did you mean city:SKY (Skyline Cable Car)?\n");
    EXPECT_THAT(refused({"favorites", "move", "Kindergarden", "1"}),
                HasSubstr("\nDid you mean Kindergarten?\n"));
    EXPECT_THAT(refused({"favorites", "remove", "M3"}), HasSubstr("\nSee: orvo favorites list\n"));
}

TEST_F(FavoritesCommandsTest, AddingAgainSaysSo) {
    answered({"favorites", "add", "M1"});
    EXPECT_THAT(answered({"favorites", "add", "M1"}), HasSubstr("Already a favourite"));
}

TEST_F(FavoritesCommandsTest, KeepsPlacesBesideLines) {
    answered({"favorites", "add", "--place", "Home", "--location", "54.3821,10.1401"});
    answered({"favorites", "add", "M1"});
    EXPECT_EQ(answered({"favorites", "list"}),
              "1\t(place)\tHome\t54.382, 10.14\n"
              "2\tcity:M1\tM1\tMarrow Bay Transit\n");
    EXPECT_THAT(answered({"favorites", "list", "--json"}),
                HasSubstr("\"kind\": \"place\",\n      \"name\": \"Home\",\n      \"latitude\": "
                          "54.3821,\n      \"longitude\": 10.1401\n"));
}

TEST_F(FavoritesCommandsTest, APlaceNeedsALocationThatExists) {
    for (const char* location : {"here", "91,0", "0,181", "1", "1,2,3", ""})
        refused({"favorites", "add", "--place", "Home", std::string("--location=") + location},
                ExitCode::WrongUsage);
    refused({"favorites", "add", "--place", "Home"}, ExitCode::WrongUsage);
    refused({"favorites", "add", "M1", "--location", "1,2"}, ExitCode::WrongUsage);
    refused({"favorites", "add"}, ExitCode::WrongUsage);
}

TEST_F(FavoritesCommandsTest, MovesByNumberRouteAndName) {
    answered({"favorites", "add", "M1", "M2", "S1"});
    answered({"favorites", "move", "3", "1"});
    EXPECT_THAT(answered({"favorites", "list"}), HasSubstr("1\tcity:S1"));
    EXPECT_EQ(answered({"favorites", "move", "city:S1", "99"}), "S1 is number 3 now\n");
    EXPECT_THAT(answered({"favorites", "list"}), HasSubstr("3\tcity:S1"));
    answered({"favorites", "move", "m2", "1"});
    EXPECT_THAT(answered({"favorites", "list"}), HasSubstr("1\tcity:M2"));
    refused({"favorites", "move", "M1", "0"}, ExitCode::WrongUsage);
    EXPECT_THAT(refused({"favorites", "move", "T4", "1"}), HasSubstr("there is no favourite T4"));
}

TEST_F(FavoritesCommandsTest, RemovesAllThatAreNamedOrNone) {
    answered({"favorites", "add", "M1", "M2", "S1"});
    refused({"favorites", "remove", "M1", "T4"});
    EXPECT_THAT(answered({"favorites", "list"}), HasSubstr("city:M1"));
    answered({"favorites", "remove", "M1", "3", "S1"});
    EXPECT_EQ(answered({"favorites", "list"}), "1\tcity:M2\tM2\tMarrow Bay Transit\n");
}

TEST_F(FavoritesCommandsTest, AFavouriteOutlivesItsFeed) {
    answered({"favorites", "add", "M1"});
    answered({"feeds", "remove", "city"});
    EXPECT_EQ(answered({"favorites", "list"}), "1\tcity:M1\tM1\tMarrow Bay Transit\n");
}

TEST_F(FavoritesCommandsTest, ADamagedFileIsToldAndIsNotLikeNone) {
    for (const auto& words : std::vector<std::vector<std::string>>{
             {"favorites", "list"}, {"incidents"}, {"favorites", "add", "city:M1"}}) {
        write("data/favorites.sqlite",
              "no database at all, though long enough for a header of one");
        const auto error = refused(words);
        EXPECT_THAT(error, HasSubstr("favorites.sqlite is damaged and was set aside as "));
        EXPECT_THAT(error, HasSubstr("\nPut a good copy in its place, or add your favourites"));
    }
    EXPECT_TRUE(std::filesystem::exists(profile.path() / "data/favorites.sqlite.damaged-3"));
    EXPECT_EQ(answered({"favorites", "list"}), "");
}

TEST_F(FavoritesCommandsTest, FavouritesThatAreHiddenAreNotLikeNone) {
    const auto path = profile.path() / "data" / "favorites.sqlite";
    std::filesystem::create_directories(path.parent_path());
    std::filesystem::create_symlink(path.filename(), path); // a loop, which root cannot read either
    for (const auto& words : std::vector<std::vector<std::string>>{
             {"favorites", "list"}, {"incidents"}, {"incidents", "--json"}}) {
        const auto error = refused(words);
        EXPECT_THAT(error, HasSubstr("favorites.sqlite: the favorites cannot be opened: "));
        EXPECT_THAT(error, HasSubstr("Too many levels of symbolic links\nMake it readable"));
    }
}

TEST_F(FavoritesCommandsTest, ADamagedFileThatStaysIsAFailureWithTheCure) {
    write("data/favorites.sqlite", "no database at all, though long enough for a header of one");
    const auto error = refused({"favorites", "list", "--at", "2024-07-24T01:28:40Z"});
    EXPECT_THAT(error, HasSubstr("favorites.sqlite: the favorites cannot be opened: "));
    EXPECT_THAT(error, HasSubstr("\nMake it readable or put a good copy in its place"));
    EXPECT_FALSE(std::filesystem::exists(profile.path() / "data/favorites.sqlite.damaged-1"));
}

} // namespace
} // namespace orvo
