#include "orvo/window/FavoritesEditor.h"

#include "orvo/window/WindowWorld.h"
#include "platform/feeds/schedule/LineMaker.h"
#include "platform/foundation/Exceptions.h"

namespace orvo {
namespace {

class FavoritesEditorTest : public testing::WindowTest {
protected:
    static std::shared_ptr<FavoritesStore> openStore(FavoritesStore::Access access,
                                                     std::shared_ptr<NSError>& error) {
        return FavoritesStore::open(FavoritesStore::standardPath(), access, &error);
    }

    void SetUp() override {
        importCity();
        EXPECT_FALSE(editor.reload());
    }

    void add(const std::vector<const char*>& routes) {
        for (const char* route : routes)
            EXPECT_FALSE(editor.add(lineMuid("city", route)));
    }

    std::string names() const { return namesOf(editor); }
    static std::string namesOf(const FavoritesEditor& editor) {
        std::string names;
        for (const auto& mark : editor.favorites())
            names += (names.empty() ? "" : " ") + mark.name;
        return names;
    }

    FavoritesEditor editor{openStore};
};

TEST_F(FavoritesEditorTest, AddsAtTheEndAndKeepsItAtOnce) {
    EXPECT_EQ(names(), "");
    add({"M1", "T4"});
    EXPECT_EQ(names(), "M1 4");
    EXPECT_NE(editor.favorites()[0].title, "M1"); // the long name
    FavoritesEditor another(openStore);
    EXPECT_FALSE(another.reload());
    EXPECT_EQ(namesOf(another), "M1 4");
}

TEST_F(FavoritesEditorTest, ALineIsAFavoriteOnce) {
    add({"M1", "T4", "M1"});
    EXPECT_EQ(names(), "M1 4");
}

TEST_F(FavoritesEditorTest, ALineOfNoScheduleIsRefused) {
    const auto error = editor.add(4711);
    ASSERT_TRUE(error);
    EXPECT_EQ(error->localizedDescription(), "No schedule has that line any more.");
    EXPECT_EQ(names(), "");
}

TEST_F(FavoritesEditorTest, MovesToTheIndexThatItHasAfterwards) {
    add({"M1", "T4", "S1"});
    EXPECT_FALSE(editor.move(2, 0));
    EXPECT_EQ(names(), "S1 M1 4");
    EXPECT_FALSE(editor.move(0, 1));
    EXPECT_EQ(names(), "M1 S1 4");
    EXPECT_FALSE(editor.move(0, 99));
    EXPECT_EQ(names(), "S1 4 M1");
    EXPECT_FALSE(editor.move(7, 0));
    EXPECT_EQ(names(), "S1 4 M1");
}

TEST_F(FavoritesEditorTest, WhatWasRemovedComesBackToItsPlaceTheLatestFirst) {
    add({"M1", "T4", "S1"});
    EXPECT_FALSE(editor.canUndoRemoval());
    EXPECT_FALSE(editor.remove(1));
    EXPECT_FALSE(editor.remove(0));
    EXPECT_EQ(names(), "S1");
    EXPECT_FALSE(editor.undoRemoval());
    EXPECT_EQ(names(), "M1 S1");
    EXPECT_FALSE(editor.undoRemoval());
    EXPECT_EQ(names(), "M1 4 S1");
    EXPECT_FALSE(editor.canUndoRemoval());
}

TEST_F(FavoritesEditorTest, APlaceIsShownRemovedAndBroughtBack) {
    std::shared_ptr<NSError> error;
    EXPECT_FALSE(openStore(FavoritesStore::Access::Write, error)
                     ->addPlace(*FavoritePlace::initWithName_latitude_longitude("Home", 54.3, 10)));
    add({"M1"});
    EXPECT_EQ(names(), "Home M1");
    EXPECT_EQ(editor.favorites()[0].detail, "54.3, 10");
    EXPECT_FALSE(editor.remove(0));
    EXPECT_EQ(names(), "M1");
    EXPECT_FALSE(editor.undoRemoval());
    EXPECT_EQ(names(), "Home M1");
}

TEST_F(FavoritesEditorTest, SearchesNamesAndKnowsWhatIsAFavorite) {
    add({"M1"});
    const auto found = editor.search(" m1 ");
    ASSERT_FALSE(found.lines.empty());
    EXPECT_EQ(found.lines[0].line.name, "M1");
    EXPECT_TRUE(found.lines[0].isFavorite);
    EXPECT_FALSE(found.error);
    EXPECT_TRUE(editor.search("no such line").lines.empty());
    EXPECT_TRUE(editor.search("  ").lines.empty());
}

TEST_F(FavoritesEditorTest, TheNameOfAFeedFindsAllItsLines) {
    EXPECT_EQ(editor.search("city").lines.size(), schedules()->lines("city").size());
}

TEST_F(FavoritesEditorTest, WithoutSchedulesThereIsNothingToSearch) {
    const testing::TemporaryProfile empty;
    FavoritesEditor beginner(openStore);
    EXPECT_FALSE(beginner.search("m1").hasSchedules);
    EXPECT_TRUE(editor.search("m1").hasSchedules);
}

TEST_F(FavoritesEditorTest, KeepsToTheProfileThatItWasMadeIn) {
    const testing::TemporaryProfile other;
    add({"M1"});
    FavoritesEditor inOther(openStore);
    EXPECT_FALSE(inOther.reload());
    EXPECT_EQ(namesOf(inOther), "");
    EXPECT_EQ(names(), "M1");
}

TEST_F(FavoritesEditorTest, WhatCannotBeKeptIsAnErrorAndNothingChanges) {
    add({"M1"});
    FavoritesEditor locked([](FavoritesStore::Access access, std::shared_ptr<NSError>& error) {
        if (access == FavoritesStore::Access::Read)
            return openStore(access, error);
        error = favoritesError(FavoritesError::CannotWrite, "The disk is full.");
        return std::shared_ptr<FavoritesStore>();
    });
    EXPECT_FALSE(locked.reload());
    for (const auto& error :
         {locked.remove(0), locked.add(lineMuid("city", "T4")), locked.move(0, 0)}) {
        ASSERT_TRUE(error);
        EXPECT_EQ(error->localizedDescription(), "The disk is full.");
    }
    EXPECT_EQ(namesOf(locked), "M1");
    EXPECT_FALSE(locked.canUndoRemoval());
}

TEST_F(FavoritesEditorTest, NeedsAWayToOpenThem) {
    EXPECT_THROW(FavoritesEditor({}), NSInvalidArgumentException);
}

} // namespace
} // namespace orvo
