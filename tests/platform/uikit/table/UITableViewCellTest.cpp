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
    EXPECT_EQ(ground(), (std::vector<std::string>{"fill 17171A14 radius 8 at -8 0 116 10"}));
    row->setTraitCollection(UITraitCollection{.userInterfaceStyle = UIUserInterfaceStyle::Dark});
    EXPECT_EQ(ground(), (std::vector<std::string>{"fill F5F5F714 radius 8 at -8 0 116 10"}));
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

/// A table with three rows, in each of which a mark stands beside the text.
class TableCellRowTest : public testing::TableTest {
protected:
    TableCellRowTest() {
        source->sections = {rows(3)};
        card->layoutIfNeeded();
        cell = std::dynamic_pointer_cast<testing::TextCell>(table->visibleCells().at(1));
        mark = std::make_shared<CountedView>();
        constrained(mark, cell->contentView(), "mark");
        size(mark, 5, 5);
        near = with(leading(10), UILayoutPriorityDefaultHigh);
        far = with(leading(30), UILayoutPriorityDefaultLow);
        activate({mark->topAnchor().constraintEqualToAnchor(cell->contentView()->topAnchor()),
                  near,
                  far});
        for (const auto& other : table->visibleCells()) {
            const auto counted = std::make_shared<CountedView>();
            counted->setFrame({{0, 0}, {1, 1}});
            other->contentView()->addSubview(counted);
            counters.push_back(counted);
        }
        layOut();
        source->asked.clear();
    }

    struct CountedView final : UIView {
        void layoutSubviews() override {
            UIView::layoutSubviews();
            ++layouts;
        }
        int layouts = 0;
    };

    std::shared_ptr<NSLayoutConstraint> leading(CGFloat distance) const {
        return mark->leadingAnchor().constraintEqualToAnchor_constant(
            cell->contentView()->leadingAnchor(), distance);
    }
    /// As a window does before it draws. Answers where the mark then stands.
    CGFloat layOut() {
        card->layoutIfNeeded();
        return mark->frame().origin.x;
    }

    std::shared_ptr<testing::TextCell> cell;
    std::shared_ptr<CountedView> mark;
    std::shared_ptr<NSLayoutConstraint> near;
    std::shared_ptr<NSLayoutConstraint> far;
    std::vector<std::shared_ptr<CountedView>> counters; ///< one in each row
};

TEST_F(TableCellRowTest, ConstantThatChangesMovesWhatItPlacesWithoutAnythingElse) {
    EXPECT_EQ(layOut(), 10);
    near->setConstant(17);
    EXPECT_EQ(layOut(), 17);
}

TEST_F(TableCellRowTest, PriorityThatChangesMovesWhatItPlaces) {
    far->setPriority(UILayoutPriorityRequired);
    EXPECT_EQ(layOut(), 30);
}

TEST_F(TableCellRowTest, ConstraintThatGoesOrComesMovesWhatItPlaces) {
    near->setActive(false);
    EXPECT_EQ(layOut(), 30);
    near->setActive(true);
    EXPECT_EQ(layOut(), 10);
}

TEST_F(TableCellRowTest, TextThatChangesIsLaidOut) {
    const auto note = label(cell->contentView(), "note", "ab");
    place(note, 0, 0);
    layOut();
    EXPECT_EQ(note->frame().size.width, 10);
    note->setText("abcd");
    layOut();
    EXPECT_EQ(note->frame().size.width, 20);
}

TEST_F(TableCellRowTest, MoveInsideOneRowLaysOutNothingElse) {
    const auto measured = measurer->measured;
    near->setConstant(17);
    layOut();
    near->setConstant(17);
    layOut();
    for (const auto& counted : counters)
        EXPECT_EQ(counted->layouts, 1);
    EXPECT_EQ(mark->layouts, 1);
    EXPECT_TRUE(source->asked.empty());
    EXPECT_EQ(measurer->measured, measured);
    EXPECT_FALSE(table->needsLayout());
}

} // namespace
} // namespace orvo
