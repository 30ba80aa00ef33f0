#include "orvo/window/private/MarkList.h"

#include "orvo/window/WindowWorld.h"
#include "orvo/window/private/MarkDelegate.h"

namespace orvo {
namespace {

class MarkListTest : public testing::WindowTest {
protected:
    void SetUp() override {
        ASSERT_TRUE(testing::haveWindowApplication());
        delegate.emplace(nullptr);
        list.emplace(&*delegate, "Favorites");
    }

    std::optional<MarkDelegate> delegate;
    std::optional<MarkList> list;
};

TEST_F(MarkListTest, AVoiceSaysTheListAndEachRowWithItsNote) {
    list->addMark({.muid = 1, .name = "M1", .title = "Airport", .detail = "Metro"}, {});
    list->addMark({.muid = 2, .name = "4", .title = "4"}, "Favorite");
    EXPECT_EQ(list->accessibleName(), "Favorites");
    EXPECT_EQ(list->item(0)->data(Qt::AccessibleTextRole).toString(), "M1, Airport, Metro");
    EXPECT_EQ(list->item(1)->data(Qt::AccessibleTextRole).toString(), "4, Favorite");
    EXPECT_EQ(list->item(1)->data(MarkDelegate::NoteRole).toString(), "Favorite");
}

TEST_F(MarkListTest, ARowKnowsItsMark) {
    list->addMark({.muid = 7, .name = "M1", .title = "Airport"}, {});
    const auto mark = MarkList::markOf(*list->item(0));
    EXPECT_EQ(mark.muid, 7U);
    EXPECT_EQ(mark.title, "Airport");
}

TEST_F(MarkListTest, ANameThatLooksLikeMarkupIsShownAsItIs) {
    list->addMark({.name = "<b>1</b>"}, {});
    EXPECT_EQ(list->item(0)->toolTip(), "&lt;b&gt;1&lt;/b&gt;");
}

} // namespace
} // namespace orvo
