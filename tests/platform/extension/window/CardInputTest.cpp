#include "platform/extension/window/CardInput.h"

#include "TableWidget.h"

#include <gmock/gmock.h>

namespace orvo {
namespace {

using ::testing::ElementsAre;
using ::testing::IsEmpty;
using testing::TableWorld;

constexpr CGPoint Header{100, 18};
constexpr CGPoint Button{330, 18};
constexpr CGPoint FirstRow{100, 60};
constexpr CGPoint SecondRow{100, 180};

/// A card that is laid out, as large as its host says.
struct CardWorld : TableWorld {
    CardWorld() {
        host->setShown(true);
        fit();
    }
    void fit() {
        card->setFrame({{0, 0}, WidgetCard::sizeForContentSize(host->contentSize())});
        card->update();
        card->layoutIfNeeded();
    }
    void expand() {
        host->setDisplayMode(NCWidgetDisplayMode::Expanded);
        fit();
    }
    void click(CGPoint point) {
        input.pressBegan(point);
        input.pressEnded(point);
    }
    bool isRowLit(std::int64_t row) const {
        return widget->table->cellForRowAtIndexPath(*NSIndexPath::indexPathForRow_inSection(row, 0))
            ->isHighlighted();
    }

    std::shared_ptr<WidgetCard> card = WidgetCard::cardWithHost_offersButton(host, true);
    CardInput input{card, host};
};

TEST(CardInput, KnowsWhatLiesWhere) {
    CardWorld world;
    EXPECT_EQ(world.input.partAt(Header), CardPart::Header);
    EXPECT_EQ(world.input.partAt(Button), CardPart::Button);
    EXPECT_EQ(world.input.partAt(FirstRow), CardPart::Row);
    EXPECT_EQ(world.input.partAt({100, 500}), CardPart::Nothing);
    EXPECT_EQ(world.input.partAt({-1, 60}), CardPart::Nothing);
    world.widget->show({"dead"});
    world.fit();
    EXPECT_EQ(world.input.partAt(FirstRow), CardPart::Content);
    EXPECT_EQ(world.input.partAt(Button), CardPart::Header) << "there is no more to show";
}

TEST(CardInput, PressOnARowLightsItAndOpensItAtItsEnd) {
    CardWorld world;
    world.input.pressBegan(FirstRow);
    EXPECT_TRUE(world.isRowLit(0));
    EXPECT_TRUE(world.input.isPressing());
    EXPECT_THAT(world.widget->pressed, IsEmpty());
    world.input.pressEnded(FirstRow);
    EXPECT_THAT(world.widget->pressed, ElementsAre("red"));
    EXPECT_FALSE(world.isRowLit(0));
    EXPECT_FALSE(world.input.isPressing());
}

TEST(CardInput, PressThatLeavesItsRowDoesNothing) {
    CardWorld world;
    world.expand();
    world.input.pressBegan(FirstRow);
    world.input.pressMoved(SecondRow);
    EXPECT_FALSE(world.isRowLit(0));
    world.input.pressEnded(SecondRow);
    EXPECT_THAT(world.widget->pressed, IsEmpty());
}

TEST(CardInput, ButtonChangesTheModeAtTheEndOfItsPress) {
    CardWorld world;
    world.input.pressBegan(Button);
    EXPECT_EQ(world.host->displayMode(), NCWidgetDisplayMode::Compact);
    world.input.pressMoved(Header);
    world.input.pressEnded(Header);
    EXPECT_EQ(world.host->displayMode(), NCWidgetDisplayMode::Compact) << "it was left";
    world.click(Button);
    EXPECT_EQ(world.host->displayMode(), NCWidgetDisplayMode::Expanded);
    world.fit();
    world.click(Button);
    EXPECT_EQ(world.host->displayMode(), NCWidgetDisplayMode::Compact);
}

TEST(CardInput, FingerThatMovesScrollsInsteadOfPressing) {
    CardWorld world;
    world.expand();
    world.card->setFrame({{0, 0}, {359, 36 + 150}});
    world.card->layoutIfNeeded();
    world.input.touchBegan({100, 150});
    EXPECT_TRUE(world.input.isPressing());
    world.input.touchMoved({100, 145});
    EXPECT_EQ(world.widget->table->contentOffset().y, 0) << "no finger is that still";
    world.input.touchMoved({100, 125});
    world.input.touchMoved({100, 105});
    EXPECT_EQ(world.widget->table->contentOffset().y, 40);
    world.input.touchEnded({100, 105});
    EXPECT_THAT(world.widget->pressed, IsEmpty());
    world.input.touchBegan(FirstRow);
    world.input.touchEnded(FirstRow);
    EXPECT_THAT(world.widget->pressed, ElementsAre("red"));
}

TEST(CardInput, TabGoesFromRowsToButtonAndRound) {
    CardWorld world;
    EXPECT_EQ(world.input.focus(), CardFocus::None);
    EXPECT_TRUE(world.input.pressKey(CardKey::Tab));
    EXPECT_EQ(world.input.focus(), CardFocus::Rows);
    EXPECT_TRUE(world.widget->table->isFirstResponder());
    EXPECT_TRUE(world.input.pressKey(CardKey::Tab));
    EXPECT_EQ(world.input.focus(), CardFocus::Button);
    EXPECT_FALSE(world.widget->table->isFirstResponder());
    EXPECT_TRUE(world.input.pressKey(CardKey::Tab));
    EXPECT_EQ(world.input.focus(), CardFocus::Rows);
    EXPECT_TRUE(world.input.pressKey(CardKey::BackTab));
    EXPECT_EQ(world.input.focus(), CardFocus::Button);
}

TEST(CardInput, TabPassesOverWhatIsNotThere) {
    CardWorld world;
    world.widget->show({"red"});
    world.fit();
    EXPECT_TRUE(world.input.pressKey(CardKey::BackTab));
    EXPECT_EQ(world.input.focus(), CardFocus::Rows);
    EXPECT_FALSE(world.input.pressKey(CardKey::Tab));
    EXPECT_EQ(world.input.focus(), CardFocus::Rows);
    world.widget->show({});
    world.fit();
    EXPECT_EQ(world.input.focus(), CardFocus::None);
    EXPECT_FALSE(world.input.pressKey(CardKey::Return));
    EXPECT_FALSE(world.input.pressKey(CardKey::Down));
}

TEST(CardInput, ArrowsMoveAmongRowsAndReturnOpens) {
    CardWorld world;
    world.expand();
    EXPECT_TRUE(world.input.pressKey(CardKey::Down)) << "shows where the focus is";
    EXPECT_EQ(world.widget->table->focusedIndexPath()->row(), 0);
    EXPECT_TRUE(world.input.pressKey(CardKey::Down));
    EXPECT_TRUE(world.input.pressKey(CardKey::Return));
    EXPECT_TRUE(world.input.pressKey(CardKey::End));
    EXPECT_TRUE(world.input.pressKey(CardKey::Space));
    EXPECT_FALSE(world.input.pressKey(CardKey::Down)) << "it is the last row";
    EXPECT_THAT(world.widget->pressed, ElementsAre("green", "blue"));
}

TEST(CardInput, ReturnPressesTheButton) {
    CardWorld world;
    world.input.setFocus(CardFocus::Button);
    EXPECT_TRUE(world.input.pressKey(CardKey::Return));
    EXPECT_EQ(world.host->displayMode(), NCWidgetDisplayMode::Expanded);
    EXPECT_TRUE(world.input.pressKey(CardKey::Space));
    EXPECT_EQ(world.host->displayMode(), NCWidgetDisplayMode::Compact);
}

TEST(CardInput, EscapeEndsAPressThenShowsLessThenIsPassedOn) {
    CardWorld world;
    int passedOn = 0;
    world.input.setEscape([&] { ++passedOn; });
    world.expand();
    world.input.pressBegan(FirstRow);
    EXPECT_TRUE(world.input.pressKey(CardKey::Escape));
    world.input.pressEnded(FirstRow);
    EXPECT_THAT(world.widget->pressed, IsEmpty());
    EXPECT_EQ(world.host->displayMode(), NCWidgetDisplayMode::Expanded);
    EXPECT_TRUE(world.input.pressKey(CardKey::Escape));
    EXPECT_EQ(world.host->displayMode(), NCWidgetDisplayMode::Compact);
    EXPECT_EQ(passedOn, 0);
    EXPECT_TRUE(world.input.pressKey(CardKey::Escape));
    EXPECT_EQ(passedOn, 1);
}

TEST(CardInput, FocusIsShownOnlyWhileTheWindowIsTypedInto) {
    CardWorld world;
    world.input.pressKey(CardKey::Tab);
    world.input.setActive(false);
    EXPECT_FALSE(world.widget->table->isFirstResponder());
    world.input.setActive(true);
    EXPECT_TRUE(world.widget->table->isFirstResponder());
    world.click(FirstRow);
    EXPECT_FALSE(world.widget->table->isFirstResponder()) << "a pointer was used";
}

} // namespace
} // namespace orvo
