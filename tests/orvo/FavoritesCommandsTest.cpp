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
