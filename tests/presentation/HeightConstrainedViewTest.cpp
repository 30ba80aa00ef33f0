#include "presentation/HeightConstrainedView.h"

#include <gtest/gtest.h>

namespace orvo {
namespace {

TEST(HeightConstrainedView, ItsConstraintAsksForNoHeight) {
    const auto view = HeightConstrainedView::initWithFrame({{0, 0}, {30, 40}});
    view->setIdentifier("view");
    const auto& constraint = view->heightConstraint();
    EXPECT_EQ(constraint->firstItem(), view);
    EXPECT_EQ(constraint->description(), "view.height == 0");
}

TEST(HeightConstrainedView, ItsConstraintIsMadeOnceAndLeftInactive) {
    const auto view = HeightConstrainedView::init();
    const auto constraint = view->heightConstraint();
    EXPECT_FALSE(constraint->isActive());
    constraint->setConstant(12);
    EXPECT_EQ(view->heightConstraint(), constraint);
    EXPECT_FALSE(constraint->isActive());
    EXPECT_TRUE(view->constraints().empty());
}

TEST(HeightConstrainedView, TakesTheHeightOnceTheConstraintIsActive) {
    const auto root = UIView::initWithFrame({{0, 0}, {100, 100}});
    const auto view = HeightConstrainedView::init();
    view->setTranslatesAutoresizingMaskIntoConstraints(false);
    root->addSubview(view);
    NSLayoutConstraint::activateConstraints({
        view->topAnchor().constraintEqualToAnchor(root->topAnchor()),
        view->leadingAnchor().constraintEqualToAnchor(root->leadingAnchor()),
        view->trailingAnchor().constraintEqualToAnchor(root->trailingAnchor()),
        view->heightConstraint(),
    });
    view->heightConstraint()->setConstant(25);
    root->layoutIfNeeded();
    EXPECT_EQ(view->frame(), (CGRect{{0, 0}, {100, 25}}));
}

} // namespace
} // namespace orvo
