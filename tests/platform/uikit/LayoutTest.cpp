#include "ViewTest.h"
#include "platform/foundation/Exceptions.h"
#include "platform/uikit/_LayoutEngine.h"

#include <cmath>

namespace orvo {
namespace {

using LayoutTest = testing::ViewTest;

TEST_F(LayoutTest, ConstraintsPlaceAViewInItsSuperview) {
    const auto card = root(200, 100);
    const auto box = child(card, "box");
    place(box, 16, 8);
    size(box, 40, 20);
    EXPECT_EQ(layout(card), R"(
UIView1 0 0 200 100
  box 16 8 40 20
)");
}

TEST_F(LayoutTest, ViewsFarApartInTheTreeAreRelated) {
    const auto card = root(200, 100);
    const auto left = child(card, "left");
    place(left, 10, 10);
    size(left, 50, 50);
    const auto inner = child(left, "inner");
    place(inner, 5, 5);
    size(inner, 10, 10);
    const auto right = child(card, "right");
    activate({right->leadingAnchor().constraintEqualToAnchor_constant(inner->trailingAnchor(), 8),
              right->topAnchor().constraintEqualToAnchor(inner->bottomAnchor())});
    size(right, 10, 10);
    EXPECT_EQ(layout(card), R"(
UIView1 0 0 200 100
  left 10 10 50 50
    inner 15 15 10 10
  right 33 25 10 10
)");
}

TEST_F(LayoutTest, GuidesTakePartAndShowTheirFrame) {
    const auto card = root(200, 100);
    const auto guide = UILayoutGuide::init();
    guide->setIdentifier("guide");
    card->addLayoutGuide(guide);
    const auto box = child(card, "box");
    activate({guide->leadingAnchor().constraintEqualToAnchor_constant(card->leadingAnchor(), 20),
              guide->widthAnchor().constraintEqualToConstant(60),
              guide->centerYAnchor().constraintEqualToAnchor(card->centerYAnchor()),
              guide->heightAnchor().constraintEqualToConstant(40),
              box->centerXAnchor().constraintEqualToAnchor(guide->centerXAnchor()),
              box->bottomAnchor().constraintEqualToAnchor(guide->bottomAnchor())});
    size(box, 10, 10);
    EXPECT_EQ(layout(card), R"(
UIView1 0 0 200 100
  (guide 20 30 60 40)
  box 45 60 10 10
)");
    EXPECT_EQ(guide->layoutFrame(), (CGRect{{20, 30}, {60, 40}}));
}

TEST_F(LayoutTest, MultipliersOfLengthsAndOfPositionsAreWithinTheCommonView) {
    const auto card = root(200, 100);
    const auto panel = child(card, "panel");
    place(panel, 50, 0);
    size(panel, 100, 100);
    const auto box = child(panel, "box");
    activate({box->widthAnchor().constraintEqualToAnchor_multiplier(panel->widthAnchor(), 0.25),
              box->heightAnchor().constraintEqualToConstant(10),
              box->topAnchor().constraintEqualToAnchor(panel->topAnchor()),
              NSLayoutConstraint::
                  constraintWithItem_attribute_relatedBy_toItem_attribute_multiplier_constant(
                      box,
                      NSLayoutAttribute::CenterX,
                      NSLayoutRelation::Equal,
                      panel,
                      NSLayoutAttribute::Trailing,
                      0.5,
                      0)});
    layout(card);
    // The middle of the panel, 12.5 to each side.
    EXPECT_EQ(card->_layoutEngine().solvedFrame(*box), (CGRect{{87.5, 0}, {25, 10}}));
}

TEST_F(LayoutTest, ConstantChangesWithoutARebuild) {
    const auto card = root(200, 100);
    const auto box = child(card, "box");
    place(box, 0, 0);
    const auto width = box->widthAnchor().constraintEqualToConstant(40);
    activate({width, box->heightAnchor().constraintEqualToConstant(10)});
    layout(card);
    width->setConstant(60);
    EXPECT_TRUE(card->_layoutEngine().solvedFrame(*box).has_value());
    layout(card);
    EXPECT_EQ(frameOf(box).size.width, 60);
}

TEST_F(LayoutTest, PriorityChangesDecideAnew) {
    const auto card = root(200, 100);
    const auto box = child(card, "box");
    place(box, 0, 0);
    const auto narrow = with(box->widthAnchor().constraintEqualToConstant(40), 500);
    const auto wide = with(box->widthAnchor().constraintEqualToConstant(80), 400);
    activate({narrow, wide});
    layout(card);
    EXPECT_EQ(frameOf(box).size.width, 40);
    wide->setPriority(600);
    layout(card);
    EXPECT_EQ(frameOf(box).size.width, 80);
}

TEST_F(LayoutTest, ManyWeakConstraintsNeverBeatAStrongOne) {
    const auto card = root(200, 100);
    const auto box = child(card, "box");
    place(box, 0, 0);
    activate({with(box->widthAnchor().constraintEqualToConstant(40), 500)});
    for (int i = 0; i < 50; ++i)
        activate({with(box->widthAnchor().constraintEqualToConstant(180), 499)});
    layout(card);
    EXPECT_EQ(frameOf(box).size.width, 40);
}

TEST_F(LayoutTest, ExclusiveConstraintsMaySwitchInAnyOrderBetweenTwoPasses) {
    const auto card = root(200, 100);
    const auto box = child(card, "box");
    place(box, 0, 0);
    const auto narrow = box->widthAnchor().constraintEqualToConstant(40);
    const auto wide = box->widthAnchor().constraintEqualToConstant(80);
    activate({narrow});
    layout(card);
    wide->setActive(true);
    narrow->setActive(false);
    layout(card);
    EXPECT_EQ(frameOf(box).size.width, 80);
    EXPECT_TRUE(log.messages().empty());
}

TEST_F(LayoutTest, ConflictIsToldWithTheNamesOfAllItsConstraints) {
    const auto card = root(200, 100);
    const auto box = child(card, "box");
    place(box, 0, 0);
    const auto narrow = box->widthAnchor().constraintEqualToConstant(40);
    const auto wide = box->widthAnchor().constraintEqualToConstant(80);
    wide->setIdentifier("wide");
    activate({narrow, wide});
    layout(card);
    ASSERT_EQ(log.messages().size(), 1U);
    const auto message = log.messages()[0];
    EXPECT_NE(message.find("box.width == 40"), std::string::npos) << message;
    EXPECT_NE(message.find("Leaving out: wide: box.width == 80"), std::string::npos) << message;
    EXPECT_EQ(frameOf(box).size.width, 40);
    layout(card);
    EXPECT_EQ(log.messages().size(), 1U);
}

TEST_F(LayoutTest, ViewsWithAGivenFrameKeepItAndCarryWhatTheyHold) {
    const auto card = root(200, 100);
    const auto panel = UIView::initWithFrame({{30, 20}, {100, 50}});
    card->addSubview(panel);
    const auto box = child(panel, "box");
    pin(box, panel);
    EXPECT_EQ(layout(card), R"(
UIView1 0 0 200 100
  UIView2 30 20 100 50
    box 30 20 100 50
)");
    panel->setFrame({{0, 0}, {70, 40}});
    EXPECT_EQ(layout(card), R"(
UIView1 0 0 200 100
  UIView2 0 0 70 40
    box 0 0 70 40
)");
}

TEST_F(LayoutTest, GivenFrameIsRelativeToTheViewThatItIsInNow) {
    const auto card = root(200, 100);
    const auto left = UIView::initWithFrame({{10, 0}, {50, 50}});
    const auto right = UIView::initWithFrame({{100, 0}, {50, 50}});
    card->addSubview(left);
    card->addSubview(right);
    const auto panel = UIView::initWithFrame({{5, 5}, {20, 20}});
    left->addSubview(panel);
    const auto box = child(panel, "box");
    pin(box, panel);
    layout(card);
    EXPECT_EQ(card->_layoutEngine().solvedFrame(*box), (CGRect{{15, 5}, {20, 20}}));
    right->addSubview(panel);
    layout(card);
    EXPECT_EQ(card->_layoutEngine().solvedFrame(*box), (CGRect{{105, 5}, {20, 20}}));
}

TEST_F(LayoutTest, RootOfAnotherSizeMovesWhatIsPinnedToIt) {
    const auto card = root(200, 100);
    const auto box = child(card, "box");
    pin(box, card);
    layout(card);
    card->setFrame({{0, 0}, {320, 120}});
    layout(card);
    EXPECT_EQ(frameOf(box), (CGRect{{0, 0}, {320, 120}}));
}

TEST_F(LayoutTest, MarginsGuideFollowsTheMargins) {
    const auto card = root(359, 110);
    card->setDirectionalLayoutMargins({0, 16, 0, 16});
    const auto box = child(card, "box");
    const auto margins = card->layoutMarginsGuide();
    activate({box->leadingAnchor().constraintEqualToAnchor(margins->leadingAnchor()),
              box->trailingAnchor().constraintEqualToAnchor(margins->trailingAnchor()),
              box->topAnchor().constraintEqualToAnchor(margins->topAnchor()),
              box->bottomAnchor().constraintEqualToAnchor(margins->bottomAnchor())});
    layout(card);
    EXPECT_EQ(frameOf(box), (CGRect{{16, 0}, {327, 110}}));
    card->setDirectionalLayoutMargins({4, 20, 6, 10});
    layout(card);
    EXPECT_EQ(frameOf(box), (CGRect{{20, 4}, {329, 100}}));
}

TEST_F(LayoutTest, EdgesGoToDevicePixelsAndWhatTouchedStillTouches) {
    for (const double scale : {1.0, 2.0, 3.0}) {
        const auto card = root(100, 10);
        card->setTraitCollection(UITraitCollection{.displayScale = scale});
        const auto left = child(card, "left");
        const auto right = child(card, "right");
        place(left, 0.4, 0);
        activate({left->widthAnchor().constraintEqualToConstant(33.37),
                  left->heightAnchor().constraintEqualToConstant(10),
                  right->leadingAnchor().constraintEqualToAnchor(left->trailingAnchor()),
                  right->topAnchor().constraintEqualToAnchor(left->topAnchor()),
                  right->widthAnchor().constraintEqualToConstant(20.26),
                  right->heightAnchor().constraintEqualToConstant(10)});
        layout(card);
        const auto leftFrame = frameOf(left);
        const auto rightFrame = frameOf(right);
        EXPECT_EQ(leftFrame.origin.x + leftFrame.size.width, rightFrame.origin.x);
        EXPECT_EQ(rightFrame.origin.x, std::round(33.77 * scale) / scale);
        EXPECT_EQ(rightFrame.origin.x + rightFrame.size.width, std::round(54.03 * scale) / scale);
    }
}

TEST_F(LayoutTest, RoundingComesLastSoThatItDoesNotAddUp) {
    const auto card = root(100, 10);
    auto before = child(card, "first");
    place(before, 0, 0);
    size(before, 10.4, 10);
    for (int i = 0; i < 4; ++i) {
        const auto next = child(card, "next");
        activate({next->leadingAnchor().constraintEqualToAnchor(before->trailingAnchor()),
                  next->topAnchor().constraintEqualToAnchor(card->topAnchor())});
        size(next, 10.4, 10);
        before = next;
    }
    layout(card);
    EXPECT_EQ(frameOf(before).origin.x, 42); // 41.6, not 4 times 10
}

TEST_F(LayoutTest, ReadingFromRightToLeftMirrorsLeadingAndTrailingOnly) {
    const auto card = root(200, 100);
    card->setTraitCollection(
        UITraitCollection{.layoutDirection = UIUserInterfaceLayoutDirection::RightToLeft});
    const auto box = child(card, "box");
    place(box, 16, 8);
    size(box, 40, 20);
    const auto after = child(card, "after");
    activate({after->leadingAnchor().constraintGreaterThanOrEqualToAnchor_constant(
                  box->trailingAnchor(), 10),
              after->topAnchor().constraintEqualToAnchor(box->topAnchor()),
              with(after->leadingAnchor().constraintEqualToAnchor(card->leadingAnchor()), 10)});
    size(after, 30, 10);
    const auto left = child(card, "left");
    activate({left->leftAnchor().constraintEqualToAnchor_constant(card->leftAnchor(), 3),
              left->topAnchor().constraintEqualToAnchor(card->topAnchor())});
    size(left, 5, 5);
    EXPECT_EQ(layout(card), R"(
UIView1 0 0 200 100
  box 144 8 40 20
  after 104 8 30 10
  left 3 0 5 5
)");
}

TEST_F(LayoutTest, ForcedDirectionStaysAsItIs) {
    const auto card = root(200, 100);
    card->setTraitCollection(
        UITraitCollection{.layoutDirection = UIUserInterfaceLayoutDirection::RightToLeft});
    const auto box = child(card, "box");
    box->setSemanticContentAttribute(UISemanticContentAttribute::ForceLeftToRight);
    place(box, 16, 8);
    size(box, 40, 20);
    layout(card);
    EXPECT_EQ(frameOf(box).origin.x, 16);
}

TEST_F(LayoutTest, DirectionThatChangesMovesEverything) {
    const auto card = root(200, 100);
    const auto box = child(card, "box");
    place(box, 16, 8);
    size(box, 40, 20);
    layout(card);
    card->setTraitCollection(
        UITraitCollection{.layoutDirection = UIUserInterfaceLayoutDirection::RightToLeft});
    layout(card);
    EXPECT_EQ(frameOf(box).origin.x, 144);
}

TEST_F(LayoutTest, RemovedViewTakesItsOuterConstraintsAlong) {
    const auto card = root(200, 100);
    const auto box = child(card, "box");
    const auto leading = box->leadingAnchor().constraintEqualToAnchor(card->leadingAnchor());
    const auto width = box->widthAnchor().constraintEqualToConstant(10);
    activate({leading, width});
    layout(card);
    box->removeFromSuperview();
    EXPECT_FALSE(leading->isActive());
    EXPECT_TRUE(width->isActive());
    EXPECT_TRUE(card->constraints().empty());
    layout(card);
    EXPECT_EQ(dumpConstraints(*card), "");
}

TEST_F(LayoutTest, ConstraintWhoseViewHasGoneHoldsNothing) {
    const auto card = root(200, 100);
    std::shared_ptr<NSLayoutConstraint> width;
    {
        const auto box = child(card, "box");
        width = box->widthAnchor().constraintEqualToConstant(10);
        activate({width});
        box->removeFromSuperview();
    }
    EXPECT_FALSE(width->isActive());
    EXPECT_EQ(width->firstItem(), nullptr);
    EXPECT_EQ(width->description(), "(gone).width == 10");
}

TEST_F(LayoutTest, ItemsWithoutACommonViewCannotBeConstrained) {
    const auto here = root(10, 10);
    const auto there = root(10, 10);
    const auto constraint = here->widthAnchor().constraintEqualToAnchor(there->widthAnchor());
    EXPECT_THROW(constraint->setActive(true), NSInvalidArgumentException);
    EXPECT_FALSE(constraint->isActive());
}

TEST_F(LayoutTest, ConstraintsArePrintedInOrderWithEveryPart) {
    const auto card = root(200, 100);
    card->setIdentifier("card");
    const auto box = child(card, "box");
    activate(
        {box->leadingAnchor().constraintEqualToAnchor_constant(card->leadingAnchor(), 8),
         box->bottomAnchor().constraintLessThanOrEqualToAnchor_constant(card->bottomAnchor(), -8),
         with(box->widthAnchor().constraintEqualToAnchor_multiplier_constant(
                  card->widthAnchor(), 0.5, 2),
              750),
         box->heightAnchor().constraintGreaterThanOrEqualToConstant(12.5)});
    EXPECT_EQ(dumpConstraints(*card), R"(box.leading == card.leading + 8
box.bottom <= card.bottom - 8
box.width == card.width * 0.5 + 2 @750
box.height >= 12.5
)");
}

TEST_F(LayoutTest, FittingSizeIsTheSmallestThatTheConstraintsAllow) {
    const auto card = root(0, 0);
    const auto box = child(card, "box");
    pin(box, card);
    activate({box->widthAnchor().constraintGreaterThanOrEqualToConstant(30),
              box->heightAnchor().constraintEqualToConstant(12.2)});
    EXPECT_EQ(card->systemLayoutSizeFittingSize(UILayoutFittingCompressedSize), (CGSize{30, 13}));
    EXPECT_EQ(
        card->systemLayoutSizeFittingSize_withHorizontalFittingPriority_verticalFittingPriority(
            {200, 0}, UILayoutPriorityRequired, UILayoutPriorityFittingSizeLevel),
        (CGSize{200, 13}));
    EXPECT_TRUE(log.messages().empty());
    card->setFrame({{0, 0}, {50, 12.2}});
    layout(card);
    EXPECT_EQ(frameOf(box).size.width, 50);
}

TEST_F(LayoutTest, LayoutRootInsideIsLaidOutByItself) {
    class Row : public UIView {
    public:
        bool _isLayoutRoot() const override { return true; }
    };
    const auto table = root(100, 100);
    const auto row = std::make_shared<Row>();
    row->setFrame({{0, 30}, {100, 20}});
    table->addSubview(row);
    const auto box = child(row, "box");
    pin(box, row);
    EXPECT_EQ(layout(table), R"(
UIView1 0 0 100 100
  UIView2 0 30 100 20
    box 0 30 100 20
)");
    row->setFrame({{0, 50}, {100, 40}});
    layout(table);
    EXPECT_EQ(frameOf(box), (CGRect{{0, 0}, {100, 40}}));
}

TEST_F(LayoutTest, UnchangedLayoutIsNotSolvedAgain) {
    const auto card = root(200, 100);
    const auto text = label(card, "text", "one two three");
    text->setNumberOfLines(0);
    pin(text, card);
    layout(card);
    const auto pivots = card->_layoutEngine().solver().pivotCount();
    const auto measured = measurer->measured;
    layout(card);
    card->setNeedsLayout();
    layout(card);
    EXPECT_EQ(card->_layoutEngine().solver().pivotCount(), pivots);
    EXPECT_EQ(measurer->measured, measured);
}

} // namespace
} // namespace orvo
