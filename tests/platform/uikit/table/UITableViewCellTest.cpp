#include "TableTest.h"

namespace orvo {
namespace {

using TableCellTest = testing::ViewTest;

std::shared_ptr<UITableViewCell> cell() {
    return UITableViewCell::initWithStyle_reuseIdentifier(UITableViewCellStyle::Default, "cell");
}

TEST_F(TableCellTest, ContentFillsTheCell) {
    const auto row = cell();
    row->setFrame({{0, 7}, {100, 30}});
    row->layoutIfNeeded();
    EXPECT_EQ(row->contentView()->frame(), (CGRect{{0, 0}, {100, 30}}));
    EXPECT_EQ(row->reuseIdentifier(), "cell");
    EXPECT_EQ(row->style(), UITableViewCellStyle::Default);
    EXPECT_EQ(row->separatorStyleOverride(), std::nullopt);
}

TEST_F(TableCellTest, ContentIsNamedInDumps) {
    EXPECT_EQ(dumpViews(*cell()), "UITableViewCell1 0 0 0 0\n  contentView 0 0 0 0\n");
}

TEST_F(TableCellTest, HeightThatTheContentSaysWinsWithoutAConflict) {
    const auto row = cell();
    row->setFrame({{0, 0}, {100, 5}});
    row->contentView()->heightAnchor().constraintEqualToConstant(110)->setActive(true);
    EXPECT_EQ(
        row->systemLayoutSizeFittingSize_withHorizontalFittingPriority_verticalFittingPriority(
            {100, 0}, UILayoutPriorityRequired, UILayoutPriorityFittingSizeLevel),
        (CGSize{100, 110}));
    row->layoutIfNeeded();
    EXPECT_TRUE(log.messages().empty());
}

TEST_F(TableCellTest, IsLaidOutByItself) {
    const auto card = root(100, 100);
    const auto row = cell();
    card->addSubview(row);
    EXPECT_NE(&row->_layoutEngine(), &card->_layoutEngine());
}

TEST_F(TableCellTest, ReuseEndsHighlightSelectionAndFocus) {
    const auto row = cell();
    row->setHighlighted(true);
    row->setSelected(true);
    row->_setFocused(true);
    EXPECT_EQ(row->_highlightLevel(), 1);
    row->prepareForReuse();
    EXPECT_FALSE(row->isHighlighted());
    EXPECT_FALSE(row->isSelected());
    EXPECT_FALSE(row->isFocused());
    EXPECT_EQ(row->_highlightLevel(), 0);
}

TEST_F(TableCellTest, GroundIsDarkerInLightAndLighterInTheDark) {
    const auto row = cell();
    row->setFrame({{0, 0}, {100, 10}});
    row->setHighlighted(true);
    const auto ground = [&row] {
        testing::RecordingCanvas canvas;
        drawViewHierarchy(*row, canvas);
        return canvas.drawn;
    };
    EXPECT_EQ(ground(), (std::vector<std::string>{"fill 17171A14 at -8 0 116 10"}));
    row->setTraitCollection(UITraitCollection{.userInterfaceStyle = UIUserInterfaceStyle::Dark});
    EXPECT_EQ(ground(), (std::vector<std::string>{"fill F5F5F714 at -8 0 116 10"}));
}

TEST_F(TableCellTest, IsSpokenAsWhatItShowsFromTopToBottom) {
    const auto row = cell();
    EXPECT_EQ(row->accessibilityLabel(), std::nullopt);
    label(row->contentView(), "title", "Line 1");
    label(row->contentView(), "hidden", "not this")->setHidden(true);
    label(row->contentView(), "status", "Delays");
    EXPECT_EQ(row->accessibilityLabel(), "Line 1, Delays");
    row->setAccessibilityLabel("One");
    EXPECT_EQ(row->accessibilityLabel(), "One");
}

} // namespace
} // namespace orvo
