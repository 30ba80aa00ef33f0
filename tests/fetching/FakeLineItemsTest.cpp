#include "fetching/DebugTransitLineItem.h"
#include "fetching/FetchingFakes.h"
#include "fetching/OWTransitIncidentFetcher.h"
#include "fetching/OWTransitIncidentUpdater.h"
#include "platform/foundation/Environment.h"
#include "platform/foundation/Exceptions.h"
#include "platform/foundation/NSString.h"
#include "platform/geoservices/TransitIncidentRecord.h"
#include "shared/NSUserDefaults_OrvoGroup.h"
#include "support/TemporaryProfile.h"
#include "support/TestClock.h"

#include <gtest/gtest.h>

#include <deque>
#include <vector>

namespace orvo {
namespace {

using testing::makeItem;
using testing::StoppedClock;
using testing::TemporaryProfile;

/// Draws the numbers that the test gives, in order; to draw more is a failure.
class FakeLineItems : public ::testing::Test {
protected:
    void draw(std::initializer_list<std::uint32_t> numbers) { _draws = numbers; }
    [[nodiscard]] std::size_t drawsLeft() const { return _draws.size(); }
    static void setRandomNumberOfIncidents(bool random) {
        OrvoGroup::__orvo_groupUserDefaults()->setBool_forKey(
            random, "Orvo.TransitWidget.internal.randomNumberIncidents");
    }
    static std::vector<std::shared_ptr<TransitLineItem>>
    fake(const std::vector<std::shared_ptr<TransitLineItem>>& items) {
        return typed<TransitLineItem>(
            OWTransitIncidentFetcher::init()->_fakeLineItemsFromItems(NSArray::arrayOf(items)));
    }
    static std::shared_ptr<TransitLineItem> fake(const std::shared_ptr<TransitLineItem>& item) {
        return fake(std::vector<std::shared_ptr<TransitLineItem>>{item}).at(0);
    }
    static bool isDebugItem(const std::shared_ptr<TransitLineItem>& item) {
        return std::dynamic_pointer_cast<DebugTransitLineItem>(item) != nullptr;
    }

private:
    std::uint32_t next() {
        if (_draws.empty()) {
            ADD_FAILURE() << "more random numbers were drawn than the test gives";
            return 0;
        }
        const std::uint32_t number = _draws.front();
        _draws.pop_front();
        return number;
    }

    TemporaryProfile _profile;
    std::deque<std::uint32_t> _draws;
    EnvironmentSlot<RandomSource>::Override _random =
        Environment::random().overrideWith([this] { return next(); });
};

std::shared_ptr<NSArray> realIncidents() {
    return NSArray::arrayOf({TransitIncidentRecord::initWithFields({})});
}

TEST_F(FakeLineItems, KeepLengthAndOrder) {
    draw({1, 0, 2, 3, 1});
    const std::vector<std::shared_ptr<TransitLineItem>> items = {
        makeItem(10), makeItem(11), makeItem(12), makeItem(13), makeItem(14)};
    const auto fakes = fake(items);
    ASSERT_EQ(fakes.size(), 5U);
    for (std::size_t i = 0; i < fakes.size(); ++i)
        EXPECT_EQ(fakes[i]->muid(), items[i]->muid());
    EXPECT_TRUE(isDebugItem(fakes[0]));
    EXPECT_EQ(fakes[1], items[1]);
    EXPECT_TRUE(isDebugItem(fakes[2]));
    EXPECT_EQ(fakes[3], items[3]);
    EXPECT_TRUE(isDebugItem(fakes[4]));
}

TEST_F(FakeLineItems, OfNothingAreNothing) {
    EXPECT_TRUE(fake(std::vector<std::shared_ptr<TransitLineItem>>{}).empty());
    EXPECT_EQ(OWTransitIncidentFetcher::init()->_fakeLineItemsFromItems(nullptr), nullptr);
}

TEST_F(FakeLineItems, AnItemWithRealIncidentsStaysAndDrawsNothing) {
    draw({1});
    const auto real = makeItem(10, realIncidents());
    const auto fakes = fake({real, makeItem(11)});
    EXPECT_EQ(fakes[0], real);
    EXPECT_TRUE(isDebugItem(fakes[1]));
    EXPECT_EQ(drawsLeft(), 0U);
}

TEST_F(FakeLineItems, AnItemWhoseIncidentsAreNilHasNone) {
    draw({1});
    EXPECT_TRUE(isDebugItem(fake(makeItem(10, nullptr))));
}

TEST_F(FakeLineItems, ADrawDivisibleByThreeKeepsTheItem) {
    for (const std::uint32_t number : {0U, 3U, 4294967295U}) {
        draw({number});
        const auto item = makeItem(10);
        EXPECT_EQ(fake(item), item) << number;
    }
    for (const std::uint32_t number : {1U, 2U, 4294967294U}) {
        draw({number});
        EXPECT_TRUE(isDebugItem(fake(makeItem(10)))) << number;
    }
}

TEST_F(FakeLineItems, HaveOneIncidentWithoutASecondDraw) {
    draw({2, 0});
    EXPECT_EQ(fake(makeItem(10))->incidents()->count(), 1U);
    EXPECT_EQ(drawsLeft(), 1U);
}

TEST_F(FakeLineItems, HaveTheSecondDrawModuloThreeIncidentsWhenTheNumberIsRandom) {
    setRandomNumberOfIncidents(true);
    for (const std::uint32_t number : {0U, 1U, 2U, 3U, 4U, 5U, 4294967295U}) {
        draw({1, number});
        EXPECT_EQ(fake(makeItem(10))->incidents()->count(), number % 3) << number;
        EXPECT_EQ(drawsLeft(), 0U);
    }
}

TEST_F(FakeLineItems, WithZeroIncidentsAreStillDebugItems) {
    setRandomNumberOfIncidents(true);
    draw({1, 0});
    const auto item = makeItem(10);
    const auto debug = std::dynamic_pointer_cast<DebugTransitLineItem>(fake(item));
    ASSERT_TRUE(debug);
    EXPECT_EQ(debug->wrappedLine(), item);
    ASSERT_TRUE(debug->incidents());
    EXPECT_EQ(debug->incidents()->count(), 0U);
}

TEST_F(FakeLineItems, DrawWhetherToReplaceBeforeHowManyItemByItem) {
    setRandomNumberOfIncidents(true);
    draw({1, 2, 3, 2, 1});
    const auto kept = makeItem(11);
    const auto fakes = fake({makeItem(10), kept, makeItem(12)});
    EXPECT_EQ(fakes[0]->incidents()->count(), 2U);
    EXPECT_EQ(fakes[1], kept);
    EXPECT_EQ(fakes[2]->incidents()->count(), 1U);
}

TEST_F(FakeLineItems, ReadTheNumberSwitchEachTime) {
    for (const bool random : {false, true, false}) {
        setRandomNumberOfIncidents(random);
        draw({1, 2});
        EXPECT_EQ(fake(makeItem(10))->incidents()->count(), random ? 2U : 1U);
        EXPECT_EQ(drawsLeft(), random ? 0U : 1U);
    }
}

TEST_F(FakeLineItems, ConcernTheItemsOwnLine) {
    setRandomNumberOfIncidents(true);
    draw({1, 2});
    const auto item = makeItem(41);
    const auto incidents = typed<TransitIncident>(fake(item)->incidents());
    ASSERT_EQ(incidents.size(), 2U);
    EXPECT_NE(incidents[0], incidents[1]);
    EXPECT_EQ(incidents[0]->muid(), 42U);
    EXPECT_EQ(incidents[1]->muid(), 42U);
}

TEST_F(FakeLineItems, AreCurrentSoTheUpdaterSeesOnlyTheirEndADayAhead) {
    constexpr double now = 1750000000;
    const StoppedClock clock(now);
    draw({1, 2});
    const auto items = NSArray::arrayOf(fake({makeItem(10), makeItem(11)}));
    const auto updater =
        OWTransitIncidentUpdater::initWithTransitLineItems_refreshInterval(items, 1800);
    updater->invalidate();
    const auto dates = updater->updateDates();
    ASSERT_EQ(dates->count(), 1U);
    EXPECT_TRUE(equal(dates->elements()[0], NSDate::dateWithTimeIntervalSince1970(now + 86400)));
}

TEST_F(FakeLineItems, RaiseForAnObjectThatIsNoLineItem) {
    EXPECT_THROW((void)OWTransitIncidentFetcher::init()->_fakeLineItemsFromItems(
                     NSArray::arrayOf({NSString::string("x")})),
                 NSInvalidArgumentException);
}

} // namespace
} // namespace orvo
