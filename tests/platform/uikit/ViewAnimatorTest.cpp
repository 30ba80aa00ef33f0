#include "platform/uikit/ViewAnimator.h"

#include "ViewTest.h"
#include "platform/foundation/Environment.h"
#include "support/TestClock.h"

namespace orvo {
namespace {

class ViewAnimatorTest : public testing::ViewTest {
protected:
    void withFrames() {
        animator.setFrameRequest([this] { ++requests; });
    }
    void begin(double delay = 0, const std::string& name = "move") {
        animator.animate(
            *view, name, delay, 1, [this](double progress) { seen.push_back(progress); });
    }
    void at(double seconds) {
        clock->advance(seconds);
        animator.advance();
    }

    std::shared_ptr<testing::ManualMonotonicClock> clock =
        std::make_shared<testing::ManualMonotonicClock>();
    EnvironmentSlot<std::shared_ptr<MonotonicClock>>::Override monotonic =
        Environment::monotonicClock().overrideWith(clock);
    ViewAnimator animator;
    std::shared_ptr<UIView> view = UIView::init();
    std::vector<double> seen;
    int requests = 0;
};

TEST_F(ViewAnimatorTest, ChangeHappensAtOnceWhereNobodyDrawsFrames) {
    begin();
    EXPECT_EQ(seen, (std::vector<double>{1}));
    EXPECT_FALSE(animator.isRunning());
}

TEST_F(ViewAnimatorTest, ChangeHappensAtOnceForWhoWantsLessMotion) {
    withFrames();
    view->setTraitCollection(UITraitCollection{.reducesMotion = true});
    begin();
    EXPECT_EQ(seen, (std::vector<double>{1}));
    EXPECT_EQ(requests, 0);
}

TEST_F(ViewAnimatorTest, ChangeGoesFromNothingToAllSlowlyAtBothEnds) {
    withFrames();
    begin();
    at(0.25);
    at(0.25);
    at(0.25);
    at(0.25);
    EXPECT_EQ(seen, (std::vector<double>{0, 0.15625, 0.5, 0.84375, 1}));
    EXPECT_FALSE(animator.isRunning());
    at(1);
    EXPECT_EQ(seen.size(), 5U);
}

TEST_F(ViewAnimatorTest, LateFrameShowsTheEndOnce) {
    withFrames();
    begin();
    at(7);
    EXPECT_EQ(seen, (std::vector<double>{0, 1}));
}

TEST_F(ViewAnimatorTest, DelayedChangeShowsItsBeginningUntilThen) {
    withFrames();
    begin(0.5);
    at(0.25);
    EXPECT_EQ(seen, (std::vector<double>{0}));
    EXPECT_TRUE(animator.isRunning());
    at(0.75);
    EXPECT_EQ(seen, (std::vector<double>{0, 0.5}));
}

TEST_F(ViewAnimatorTest, FramesAreRequestedOnceUntilAllHasEnded) {
    withFrames();
    begin();
    begin(0, "other");
    EXPECT_EQ(requests, 1);
    at(2);
    begin();
    EXPECT_EQ(requests, 2);
}

TEST_F(ViewAnimatorTest, ChangeOfTheSameNameTakesThePlaceOfTheEarlierOne) {
    withFrames();
    begin();
    at(0.5);
    begin();
    at(0.75);
    EXPECT_EQ(seen, (std::vector<double>{0, 0.5, 0, 0.84375}));
}

TEST_F(ViewAnimatorTest, CancelledChangeStopsWhereItIs) {
    withFrames();
    begin();
    at(0.5);
    animator.cancel(*view, "move");
    at(1);
    EXPECT_EQ(seen, (std::vector<double>{0, 0.5}));
    EXPECT_FALSE(animator.isRunning());
}

TEST_F(ViewAnimatorTest, ViewThatGoesTakesItsChangeAlong) {
    withFrames();
    begin();
    view.reset();
    at(0.5);
    EXPECT_EQ(seen, (std::vector<double>{0}));
    EXPECT_FALSE(animator.isRunning());
}

TEST_F(ViewAnimatorTest, WithoutFramesWhatRunsEndsAtOnce) {
    withFrames();
    begin();
    animator.setFrameRequest(nullptr);
    EXPECT_EQ(seen, (std::vector<double>{0, 1}));
    EXPECT_FALSE(animator.isRunning());
}

TEST_F(ViewAnimatorTest, StepMayBeginAnotherChange) {
    withFrames();
    animator.animate(*view, "first", 0, 1, [this](double progress) {
        if (progress == 1)
            begin();
    });
    at(1);
    EXPECT_TRUE(animator.isRunning());
    at(1);
    EXPECT_EQ(seen, (std::vector<double>{0, 1}));
}

} // namespace
} // namespace orvo
