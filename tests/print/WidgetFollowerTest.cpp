#include "print/WidgetFollower.h"

#include "platform/foundation/RunLoop.h"
#include "print/SceneWorld.h"

#include <gtest/gtest.h>

namespace orvo {
namespace {

constexpr double Interval = 60;

class WidgetFollowerTest : public ::testing::Test, protected testing::SceneWorld {
protected:
    void follow() {
        scene.appear();
        follower.emplace(
            scene,
            Interval,
            [this] { askedBefore.push_back(lookup->asked().size()); },
            [this](const PrintedWidget& widget) {
                if (states.empty() || states.back() != widget.state)
                    states.push_back(widget.state);
            });
    }
    /// Turns the loop until those different states have been told, and so many lookups asked.
    bool comesTo(std::size_t lookups, const std::vector<ServiceState>& told) {
        constexpr double Patience = 30;
        return loop.runUntil(
                   [&] {
                       return lookup->asked().size() >= lookups && states.size() >= told.size();
                   },
                   Patience) &&
               lookup->asked().size() == lookups && states == told;
    }
    void advance(double seconds) {
        world.clock->advance(seconds);
        loop.checkTimers();
    }
    void answerWithIncidentIn(double seconds) {
        answerWith({testing::line(1,
                                  "U1",
                                  {TransitIncidentRecord::initWithFields(
                                      {.muid = 1,
                                       .startDate = NSDate::dateWithTimeIntervalSinceNow(seconds),
                                       .title = "Coming"})})});
    }

    static constexpr auto Good = ServiceState::Good;
    static constexpr auto Advisories = ServiceState::Advisories;
    static constexpr auto Unavailable = ServiceState::Unavailable;

    RunLoop& loop = RunLoop::main();
    WidgetScene scene{extension(), {.mode = NCWidgetDisplayMode::Compact}};
    std::vector<ServiceState> states;
    std::vector<std::size_t> askedBefore;
    std::optional<WidgetFollower> follower;
};

TEST_F(WidgetFollowerTest, TellsWhatTheFirstFetchBroughtAndNothingKept) {
    answerWithIncidentIn(1000);
    follow();
    EXPECT_TRUE(comesTo(1, {Good}));
}

TEST_F(WidgetFollowerTest, TellsAnIncidentsBeginningWhenItBeginsAndAsksAgain) {
    answerWithIncidentIn(10);
    follow();
    ASSERT_TRUE(comesTo(1, {Good}));
    advance(9);
    loop.runOnce();
    EXPECT_EQ(states.size(), 1U);
    advance(1.1);
    EXPECT_TRUE(comesTo(2, {Good, Advisories}));
}

TEST_F(WidgetFollowerTest, AsksAgainAfterTheIntervalAndSaysSoBefore) {
    answerWithIncidentIn(1000);
    answerWithIncidentIn(0);
    follow();
    ASSERT_TRUE(comesTo(1, {Good}));
    advance(Interval + 1);
    EXPECT_TRUE(comesTo(2, {Good, Advisories}));
    EXPECT_EQ(askedBefore.size(), 2U);
    EXPECT_EQ(askedBefore[1], 1U);
}

TEST_F(WidgetFollowerTest, AFailedFetchIsToldAndTriedAgain) {
    fail();
    answerWithIncidentIn(1000);
    follow();
    ASSERT_TRUE(comesTo(1, {Unavailable}));
    advance(Interval + 1);
    EXPECT_TRUE(comesTo(2, {Unavailable, Good}));
}

TEST_F(WidgetFollowerTest, EndedItTellsNothingMore) {
    answerWithIncidentIn(10);
    follow();
    ASSERT_TRUE(comesTo(1, {Good}));
    follower.reset();
    advance(20);
    loop.runOnce();
    EXPECT_EQ(states.size(), 1U);
}

} // namespace
} // namespace orvo
