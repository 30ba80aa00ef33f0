#include "shared/NSObject_OrvoSharedExtras.h"

#include "platform/foundation/NSString.h"
#include "platform/foundation/RunLoop.h"

#include <gtest/gtest.h>

#include <functional>
#include <map>
#include <string>
#include <thread>
#include <vector>

namespace orvo {
namespace {

using OrvoSharedExtras::_orvo_needsUpdateWithSelector;
using OrvoSharedExtras::_orvo_objectPassingTest_nextObject;
using OrvoSharedExtras::_orvo_setNeedsUpdate_withSelector;
using OrvoSharedExtras::_orvo_setNeedsUpdateWithSelector;

const Selector layOut("layOut");
const Selector redraw("redraw");

/// Has the two methods; each is counted and then does what the test says.
class Screen final : public virtual NSObject {
public:
    Method methodForSelector(const Selector& selector) override {
        if (selector != layOut && selector != redraw)
            return NSObject::methodForSelector(selector);
        return [this, name = selector.name()](const auto&) -> std::shared_ptr<NSObject> {
            ++counts[name];
            thread = std::this_thread::get_id();
            if (whenPerformed)
                whenPerformed(name);
            return nullptr;
        };
    }

    int count(const Selector& selector) { return counts[selector.name()]; }

    std::map<std::string, int> counts;
    std::thread::id thread;
    std::function<void(const std::string& name)> whenPerformed;
};

class NeedsUpdate : public ::testing::Test {
protected:
    /// Runs what the main queue holds now.
    static void runMainQueue() { RunLoop::main().runOnce(); }

    // The thread of the tests is the main thread.
    RunLoop& _loop = RunLoop::main();
    std::shared_ptr<Screen> screen = std::make_shared<Screen>();
};

// Chains

class Link final : public virtual NSObject {
public:
    explicit Link(int ownNumber, std::shared_ptr<Link> following = nullptr)
        : number(ownNumber)
        , next(std::move(following)) {}
    int number;
    std::shared_ptr<Link> next;
};

std::shared_ptr<NSObject> nextLink(const std::shared_ptr<NSObject>& link) {
    return std::dynamic_pointer_cast<Link>(link)->next;
}

std::function<bool(const std::shared_ptr<NSObject>&)> hasNumber(int number,
                                                                std::vector<int>* tested) {
    return [number, tested](const auto& link) {
        const int own = std::dynamic_pointer_cast<Link>(link)->number;
        tested->push_back(own);
        return own == number;
    };
}

TEST(ObjectPassingTest, TestsTheReceiverFirstAndThenEachNextObject) {
    const auto third = std::make_shared<Link>(3);
    const auto second = std::make_shared<Link>(2, third);
    const auto first = std::make_shared<Link>(1, second);
    std::vector<int> tested;
    EXPECT_EQ(_orvo_objectPassingTest_nextObject(first, hasNumber(1, &tested), nextLink), first);
    EXPECT_EQ(tested, (std::vector<int>{1}));
    tested.clear();
    EXPECT_EQ(_orvo_objectPassingTest_nextObject(first, hasNumber(3, &tested), nextLink), third);
    EXPECT_EQ(tested, (std::vector<int>{1, 2, 3}));
}

TEST(ObjectPassingTest, IsNilWhereTheChainEnds) {
    const auto first = std::make_shared<Link>(1, std::make_shared<Link>(2));
    std::vector<int> tested;
    EXPECT_EQ(_orvo_objectPassingTest_nextObject(first, hasNumber(9, &tested), nextLink), nullptr);
    EXPECT_EQ(tested, (std::vector<int>{1, 2}));
    EXPECT_EQ(_orvo_objectPassingTest_nextObject(nullptr, hasNumber(9, &tested), nextLink),
              nullptr);
}

TEST(ObjectPassingTest, GoesRoundACircleAsLongAsNothingPasses) {
    const auto first = std::make_shared<Link>(1);
    first->next = first;
    int tests = 0;
    const auto passesLate = [&](const auto&) {
        return ++tests == 1000;
    };
    EXPECT_EQ(_orvo_objectPassingTest_nextObject(first, passesLate, nextLink), first);
    EXPECT_EQ(tests, 1000);
    first->next = nullptr;
}

// Updates

TEST_F(NeedsUpdate, PerformsLaterAndNotInsideTheCall) {
    _orvo_setNeedsUpdateWithSelector(screen, layOut);
    EXPECT_EQ(screen->count(layOut), 0);
    runMainQueue();
    EXPECT_EQ(screen->count(layOut), 1);
}

TEST_F(NeedsUpdate, WithSelectorIsTheSameAsYesWithSelector) {
    _orvo_setNeedsUpdate_withSelector(screen, true, layOut);
    EXPECT_TRUE(_orvo_needsUpdateWithSelector(screen, layOut));
    runMainQueue();
    EXPECT_EQ(screen->count(layOut), 1);
}

TEST_F(NeedsUpdate, TwoRequestsForOneSelectorPerformItOnce) {
    _orvo_setNeedsUpdateWithSelector(screen, layOut);
    _orvo_setNeedsUpdateWithSelector(screen, layOut);
    runMainQueue();
    runMainQueue();
    EXPECT_EQ(screen->count(layOut), 1);
}

TEST_F(NeedsUpdate, LaterRequestsJoinTheBatchAlreadyScheduled) {
    const long before = screen.use_count();
    _orvo_setNeedsUpdateWithSelector(screen, layOut);
    const long withOneBlock = screen.use_count();
    _orvo_setNeedsUpdateWithSelector(screen, redraw);
    _orvo_setNeedsUpdateWithSelector(screen, layOut);
    EXPECT_EQ(withOneBlock, before + 1);
    EXPECT_EQ(screen.use_count(), withOneBlock); // each submitted block would hold it once more
    runMainQueue();
    EXPECT_EQ(screen->count(layOut), 1);
    EXPECT_EQ(screen->count(redraw), 1);
    EXPECT_EQ(screen.use_count(), before);
}

TEST_F(NeedsUpdate, ARequestThatIsWithdrawnPerformsNothing) {
    _orvo_setNeedsUpdateWithSelector(screen, layOut);
    _orvo_setNeedsUpdate_withSelector(screen, false, layOut);
    EXPECT_FALSE(_orvo_needsUpdateWithSelector(screen, layOut));
    runMainQueue();
    EXPECT_EQ(screen->count(layOut), 0);
}

TEST_F(NeedsUpdate, CanBeRequestedAgainAfterABatchWhoseOnlyRequestWasWithdrawn) {
    const long before = screen.use_count();
    _orvo_setNeedsUpdateWithSelector(screen, layOut);
    _orvo_setNeedsUpdate_withSelector(screen, false, layOut);
    runMainQueue();
    EXPECT_EQ(screen.use_count(), before); // the batch has run, though it had nothing to perform
    _orvo_setNeedsUpdateWithSelector(screen, layOut);
    EXPECT_EQ(screen.use_count(), before + 1); // and the request schedules another
    runMainQueue();
    EXPECT_EQ(screen->count(layOut), 1);
}

TEST_F(NeedsUpdate, WithdrawingLeavesTheBatchScheduledForTheOthers) {
    _orvo_setNeedsUpdateWithSelector(screen, layOut);
    const long withOneBlock = screen.use_count();
    _orvo_setNeedsUpdate_withSelector(screen, false, layOut);
    _orvo_setNeedsUpdateWithSelector(screen, redraw);
    EXPECT_EQ(screen.use_count(), withOneBlock);
    runMainQueue();
    EXPECT_EQ(screen->count(layOut), 0);
    EXPECT_EQ(screen->count(redraw), 1);
}

TEST_F(NeedsUpdate, WithdrawingWithoutAnyRequestDoesNothing) {
    const long before = screen.use_count();
    _orvo_setNeedsUpdate_withSelector(screen, false, layOut);
    EXPECT_EQ(screen.use_count(), before);
    EXPECT_FALSE(_orvo_needsUpdateWithSelector(screen, layOut));
}

TEST_F(NeedsUpdate, IsTrueFromTheRequestUntilTheBatchHasRun) {
    EXPECT_FALSE(_orvo_needsUpdateWithSelector(screen, layOut));
    _orvo_setNeedsUpdateWithSelector(screen, layOut);
    EXPECT_TRUE(_orvo_needsUpdateWithSelector(screen, layOut));
    EXPECT_FALSE(_orvo_needsUpdateWithSelector(screen, redraw));
    runMainQueue();
    EXPECT_FALSE(_orvo_needsUpdateWithSelector(screen, layOut));
}

TEST_F(NeedsUpdate, IsStillTrueInsideAPerformedMethod) {
    std::map<std::string, bool> needed;
    screen->whenPerformed = [&](const std::string&) {
        needed["layOut"] = _orvo_needsUpdateWithSelector(screen, layOut);
        needed["redraw"] = _orvo_needsUpdateWithSelector(screen, redraw);
    };
    _orvo_setNeedsUpdateWithSelector(screen, layOut);
    _orvo_setNeedsUpdateWithSelector(screen, redraw);
    runMainQueue();
    EXPECT_TRUE(needed["layOut"]);
    EXPECT_TRUE(needed["redraw"]);
}

TEST_F(NeedsUpdate, ARequestFromInsideAPerformedMethodIsDropped) {
    screen->whenPerformed = [&](const std::string& name) {
        const long before = screen.use_count();
        _orvo_setNeedsUpdateWithSelector(screen, redraw);
        _orvo_setNeedsUpdateWithSelector(screen, Selector(name));
        EXPECT_EQ(screen.use_count(), before); // nothing was submitted
    };
    _orvo_setNeedsUpdateWithSelector(screen, layOut);
    runMainQueue();
    runMainQueue();
    EXPECT_EQ(screen->count(layOut), 1);
    EXPECT_EQ(screen->count(redraw), 0);
    EXPECT_FALSE(_orvo_needsUpdateWithSelector(screen, redraw));
}

TEST_F(NeedsUpdate, CanBeRequestedAgainAfterTheBatch) {
    _orvo_setNeedsUpdateWithSelector(screen, layOut);
    runMainQueue();
    _orvo_setNeedsUpdateWithSelector(screen, layOut);
    runMainQueue();
    EXPECT_EQ(screen->count(layOut), 2);
}

TEST_F(NeedsUpdate, WithdrawingInsideTheBatchDoesNotStopTheOther) {
    screen->whenPerformed = [&](const std::string& name) {
        _orvo_setNeedsUpdate_withSelector(screen, false, name == "layOut" ? redraw : layOut);
    };
    _orvo_setNeedsUpdateWithSelector(screen, layOut);
    _orvo_setNeedsUpdateWithSelector(screen, redraw);
    runMainQueue();
    EXPECT_EQ(screen->count(layOut), 1);
    EXPECT_EQ(screen->count(redraw), 1);
}

TEST_F(NeedsUpdate, KeepsTheReceiverUntilTheBatchHasRun) {
    int performed = 0;
    screen->whenPerformed = [&](const std::string&) {
        ++performed;
    };
    const std::weak_ptr<Screen> watch = screen;
    _orvo_setNeedsUpdateWithSelector(screen, layOut);
    screen.reset();
    EXPECT_FALSE(watch.expired());
    runMainQueue();
    EXPECT_EQ(performed, 1);
    EXPECT_TRUE(watch.expired());
}

TEST_F(NeedsUpdate, ReceiversHaveBatchesOfTheirOwn) {
    const auto other = std::make_shared<Screen>();
    _orvo_setNeedsUpdateWithSelector(screen, layOut);
    EXPECT_FALSE(_orvo_needsUpdateWithSelector(other, layOut));
    _orvo_setNeedsUpdateWithSelector(other, redraw);
    runMainQueue();
    EXPECT_EQ(screen->counts, (std::map<std::string, int>{{"layOut", 1}}));
    EXPECT_EQ(other->counts, (std::map<std::string, int>{{"redraw", 1}}));
}

TEST_F(NeedsUpdate, RequestedOnAnotherThreadRunsOnTheMainThread) {
    std::thread([&] { _orvo_setNeedsUpdateWithSelector(screen, layOut); }).join();
    runMainQueue();
    EXPECT_EQ(screen->count(layOut), 1);
    EXPECT_EQ(screen->thread, std::this_thread::get_id());
}

TEST_F(NeedsUpdate, OfNilIsNothing) {
    _orvo_setNeedsUpdateWithSelector(nullptr, layOut);
    _orvo_setNeedsUpdate_withSelector(nullptr, false, layOut);
    EXPECT_FALSE(_orvo_needsUpdateWithSelector(nullptr, layOut));
}

} // namespace
} // namespace orvo
