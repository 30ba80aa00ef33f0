#include "platform/mapuikit/TransitInfoLabelView.h"

#include "KitViewTest.h"
#include "platform/foundation/Exceptions.h"
#include "platform/uikit/UIColor.h"

namespace orvo {
namespace {

using Strings = std::vector<std::string>;

/// Shields of size 7 are 28 high, and 20 wide for one character; 5 stand between. The text for
/// those left out is at 10 points, 5 for each character.
class TransitInfoLabelViewTest : public testing::KitViewTest {
protected:
    TransitInfoLabelViewTest() {
        view->setArtworkCache(cache);
        view->setFont(UIFont::systemFontOfSize_weight(10, 400));
        view->setTextColor(UIColor::systemGrayColor());
        constrained(view, card, "row");
        place(view, 0, 0);
    }
    static std::shared_ptr<NSArray> lines(std::initializer_list<const char*> texts) {
        std::vector<std::shared_ptr<TransitArtworkDataSource>> artworks;
        for (const auto* text : texts)
            artworks.push_back(testing::shieldArtwork(text));
        return NSArray::arrayOf(artworks);
    }
    void cutTo(CGFloat width) {
        view->setMaxWidth_textForTruncationGenerator(width, [this](std::uint64_t leftOut) {
            generated.push_back(leftOut);
            return "+" + std::to_string(leftOut);
        });
    }
    CGSize sized() {
        card->layoutIfNeeded();
        return view->frame().size;
    }

    std::shared_ptr<UIView> card = root(300, 100);
    std::shared_ptr<TransitInfoLabelView> view =
        TransitInfoLabelView::initWithLabelItems_iconSize_shieldSize_spaceBetweenShields_maxWidth(
            nullptr, 7, 7, 5, TransitInfoLabelViewNoMaximumWidth);
    std::vector<std::uint64_t> generated;
};

TEST_F(TransitInfoLabelViewTest, StartsWithoutShieldsOnOneLineOfAnyWidth) {
    EXPECT_EQ(view->labelItems(), nullptr);
    EXPECT_EQ(view->iconSize(), 7);
    EXPECT_EQ(view->shieldSize(), 7);
    EXPECT_EQ(view->spaceBetweenShields(), 5);
    EXPECT_EQ(view->maxWidth(), TransitInfoLabelViewNoMaximumWidth);
    EXPECT_EQ(view->numberOfLines(), 1);
    EXPECT_EQ(sized(), (CGSize{0, 28}));
    EXPECT_TRUE(draw(card).empty());
}

TEST_F(TransitInfoLabelViewTest, ShieldsStandInOrderAsFarApartAsWasSaid) {
    view->setLabelItems(lines({"1", "22", "3"}));
    EXPECT_EQ(sized(), (CGSize{80, 28}));
    EXPECT_EQ(draw(card),
              (Strings{"pixels 20x28 at 0 0 20 28",
                       "pixels 30x28 at 25 0 30 28",
                       "pixels 20x28 at 60 0 20 28"}));
}

TEST_F(TransitInfoLabelViewTest, DumpsNameTheShieldsAndTheTextForTheRest) {
    EXPECT_EQ(dumpViews(*card), "UIView1 0 0 300 100\n  row 0 0 0 0\n");
    view->setLabelItems(lines({"1", "22", "3"}));
    card->layoutIfNeeded();
    EXPECT_EQ(dumpViews(*card), "UIView1 0 0 300 100\n  row 0 0 80 28 [1] [22] [3]\n");
    cutTo(70);
    card->layoutIfNeeded();
    EXPECT_EQ(dumpViews(*card), "UIView1 0 0 300 100\n  row 0 0 70 28 [1] [22] \"+1\"\n");
}

TEST_F(TransitInfoLabelViewTest, IconsHaveASizeOfTheirOwn) {
    const auto row =
        TransitInfoLabelView::initWithLabelItems_iconSize_shieldSize_spaceBetweenShields_maxWidth(
            NSArray::arrayOf({testing::shieldArtwork("1"),
                              testing::shieldArtwork("2", TransitArtworkSourceType::Icon)}),
            4,
            7,
            5,
            TransitInfoLabelViewNoMaximumWidth);
    row->setArtworkCache(cache);
    std::ignore = row->intrinsicContentSize();
    EXPECT_EQ(cache->asked, (Strings{"1 7", "2 4"}));
}

TEST_F(TransitInfoLabelViewTest, IsCutToTheWidthWithATextForTheOthers) {
    view->setLabelItems(lines({"1", "2", "3", "4"}));
    struct Case {
        CGFloat width;
        std::size_t shown;
        std::optional<std::string> text;
        CGFloat wide;
    };
    for (const auto& [width, shown, text, wide] : {Case{200, 4, std::nullopt, 95},
                                                   Case{95, 4, std::nullopt, 95},
                                                   Case{94, 3, "+1", 85},
                                                   Case{85, 3, "+1", 85},
                                                   Case{84, 2, "+2", 60},
                                                   Case{59, 1, "+3", 35},
                                                   Case{34, 0, "+4", 10},
                                                   Case{7, 0, "+4", 7},
                                                   Case{0, 0, std::nullopt, 0}}) {
        cutTo(width);
        EXPECT_EQ(view->_shownShields(), shown) << width;
        if (width > 0) {
            EXPECT_EQ(view->_truncationText(), text) << width;
        }
        EXPECT_EQ(sized(), (CGSize{wide, 28})) << width;
    }
}

TEST_F(TransitInfoLabelViewTest, GeneratorIsAskedOnlyWhereSomethingIsLeftOut) {
    view->setLabelItems(lines({"1", "2"}));
    cutTo(45);
    sized();
    EXPECT_TRUE(generated.empty());
    cutTo(44);
    EXPECT_EQ(generated, (std::vector<std::uint64_t>{1}));
}

TEST_F(TransitInfoLabelViewTest, TextIsDrawnInItsColourOnTheBaselineOfTheRow) {
    view->setLabelItems(lines({"1", "2"}));
    cutTo(44);
    // Capitals are 7 high: their middle is that of the shields.
    EXPECT_EQ(draw(card),
              (Strings{"pixels 20x28 at 0 0 20 28", "text \"+1\" 5B5B63 at 25 17.5 10 0"}));
    EXPECT_EQ(view->_firstBaselineFromTop(), 17.5);
    EXPECT_EQ(view->_lastBaselineFromBottom(), 10.5);
}

TEST_F(TransitInfoLabelViewTest, BaselineIsTheSameWithoutAText) {
    const auto before = view->_firstBaselineFromTop();
    view->setLabelItems(lines({"1"}));
    EXPECT_EQ(view->_firstBaselineFromTop(), before);
}

TEST_F(TransitInfoLabelViewTest, TextIsNeverTallerThanTheShields) {
    view->setFont(UIFont::systemFontOfSize_weight(53, 400));
    EXPECT_EQ(view->_textFont()->lineHeight(), 28);
    view->setLabelItems(lines({"1", "2", "3"}));
    cutTo(69);
    EXPECT_EQ(sized().height, 28);
    EXPECT_EQ(view->_firstBaselineFromTop(), (28 + 0.7 * 28) / 2);
    view->setFont(UIFont::systemFontOfSize_weight(20, 400));
    EXPECT_EQ(view->_textFont()->pointSize(), 20);
}

TEST_F(TransitInfoLabelViewTest, ReadFromRightToLeftItStartsAtTheRight) {
    card->setTraitCollection(
        UITraitCollection{.layoutDirection = UIUserInterfaceLayoutDirection::RightToLeft});
    view->setLabelItems(lines({"1", "2"}));
    cutTo(44);
    EXPECT_EQ(draw(card),
              (Strings{"pixels 20x28 at 280 0 20 28", "text \"+1\" 5B5B63 at 265 17.5 10 0"}));
}

TEST_F(TransitInfoLabelViewTest, ShieldsStandOnWholeDevicePixels) {
    const auto row = constrained(
        TransitInfoLabelView::initWithLabelItems_iconSize_shieldSize_spaceBetweenShields_maxWidth(
            lines({"1", "2"}), 7, 7, 5.3, TransitInfoLabelViewNoMaximumWidth),
        card,
        "other");
    row->setArtworkCache(cache);
    place(row, 0, 0);
    EXPECT_EQ(draw(card).back(), "pixels 20x28 at 25 0 20 28");
    card->setTraitCollection(UITraitCollection{.displayScale = 2});
    EXPECT_EQ(draw(card, 2).back(), "pixels 40x56 at 25.5 0 20 28");
}

TEST_F(TransitInfoLabelViewTest, WiderThanItsShieldsItStillStartsWhereReadingStarts) {
    view->widthAnchor().constraintEqualToConstant(200)->setActive(true);
    view->setLabelItems(lines({"1"}));
    EXPECT_EQ(draw(card), (Strings{"pixels 20x28 at 0 0 20 28"}));
    card->setTraitCollection(
        UITraitCollection{.layoutDirection = UIUserInterfaceLayoutDirection::RightToLeft});
    EXPECT_EQ(draw(card), (Strings{"pixels 20x28 at 280 0 20 28"}));
}

TEST_F(TransitInfoLabelViewTest, WithoutAGeneratorTheOthersAreLeftOutSilently) {
    view->setLabelItems(lines({"1", "2", "3"}));
    view->setMaxWidth_textForTruncationGenerator(50, nullptr);
    EXPECT_EQ(sized(), (CGSize{45, 28}));
    EXPECT_EQ(view->_truncationText(), std::nullopt);
}

TEST_F(TransitInfoLabelViewTest, MoreLinesShowMoreShields) {
    view->setNumberOfLines(2);
    view->setLabelItems(lines({"1", "2", "3", "4"}));
    cutTo(45);
    EXPECT_EQ(view->_shownShields(), 4U);
    EXPECT_EQ(sized(), (CGSize{45, 61}));
    EXPECT_EQ(view->_lastBaselineFromBottom(), 10.5);
}

TEST_F(TransitInfoLabelViewTest, WithoutACacheThereIsNothingToShow) {
    view->setLabelItems(lines({"1"}));
    view->setArtworkCache(nullptr);
    EXPECT_EQ(sized(), (CGSize{0, 28}));
    EXPECT_TRUE(draw(card).empty());
}

TEST_F(TransitInfoLabelViewTest, SameRowAgainCostsNothing) {
    view->setLabelItems(lines({"1", "2", "3"}));
    cutTo(60);
    draw(card);
    const auto asked = cache->asked.size();
    const auto measured = measurer->measured;
    cutTo(60);
    view->setLabelItems(lines({"1", "2", "3"}));
    card->layoutIfNeeded();
    EXPECT_FALSE(card->_needsDisplay());
    EXPECT_FALSE(card->needsLayout());
    EXPECT_EQ(cache->asked.size(), asked);
    EXPECT_EQ(measurer->measured, measured);
}

TEST_F(TransitInfoLabelViewTest, AnotherTextForTheSameShieldsIsShown) {
    view->setLabelItems(lines({"1", "2"}));
    cutTo(44);
    draw(card);
    view->setMaxWidth_textForTruncationGenerator(44, [](std::uint64_t) { return "&1"; });
    EXPECT_EQ(view->_truncationText(), "&1");
    EXPECT_TRUE(card->_needsDisplay());
}

TEST_F(TransitInfoLabelViewTest, ShieldsOutOfSightAreNotDrawnForTheirSize) {
    std::vector<std::shared_ptr<TransitArtworkDataSource>> many;
    for (int i = 0; i < 100; ++i)
        many.push_back(testing::shieldArtwork(std::to_string(i % 10)));
    cutTo(100);
    cache->asked.clear();
    view->setLabelItems(NSArray::arrayOf(many));
    sized();
    EXPECT_LE(cache->asked.size(), 5U);
}

TEST_F(TransitInfoLabelViewTest, ItemsOfAnotherClassAreAnError) {
    EXPECT_THROW(view->setLabelItems(NSArray::arrayWithObjects({UIView::init()})),
                 NSInvalidArgumentException);
    EXPECT_EQ(view->labelItems(), nullptr);
}

TEST_F(TransitInfoLabelViewTest, IsSpokenAsTheShieldsShownAndTheText) {
    EXPECT_EQ(view->accessibilityLabel(), std::nullopt);
    const auto spoken = TransitArtworkDataSource::initWithFields(
        {.shieldDataSource = TransitShieldDataSource::initWithFields({.shieldText = "U1"}),
         .accessibilityText = "Underground 1"});
    view->setLabelItems(
        NSArray::arrayOf({spoken, testing::shieldArtwork("2"), testing::shieldArtwork("3")}));
    cutTo(75);
    EXPECT_EQ(view->accessibilityLabel(), "Underground 1, 2, +1");
}

} // namespace
} // namespace orvo
