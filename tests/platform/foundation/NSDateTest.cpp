#include "platform/foundation/NSDate.h"

#include "platform/foundation/NSNumber.h"
#include "support/TestClock.h"

#include <gtest/gtest.h>

#include <limits>

namespace orvo {
namespace {

TEST(NSDate, CountsFromBothEpochs) {
    const auto date = NSDate::dateWithTimeIntervalSince1970(1721784520);
    EXPECT_EQ(date->timeIntervalSince1970(), 1721784520);
    EXPECT_EQ(date->timeIntervalSinceReferenceDate(), 1721784520 - 978307200);
}

TEST(NSDate, TakesNowFromTheEnvironmentsClock) {
    const testing::StoppedClock clock(1000);
    EXPECT_EQ(NSDate::date()->timeIntervalSince1970(), 1000);
    const auto later = NSDate::dateWithTimeIntervalSinceNow(50);
    EXPECT_EQ(later->timeIntervalSince1970(), 1050);
    EXPECT_EQ(later->timeIntervalSinceNow(), 50);
    clock->advance(60);
    EXPECT_EQ(later->timeIntervalSinceNow(), -10);
}

TEST(NSDate, IsPositivelyApartFromAnEarlierOne) {
    const auto early = NSDate::dateWithTimeIntervalSince1970(10);
    const auto late = NSDate::dateWithTimeIntervalSince1970(25);
    EXPECT_EQ(late->timeIntervalSinceDate(*early), 15);
    EXPECT_EQ(early->timeIntervalSinceDate(*late), -15);
}

TEST(NSDate, IsEqualToTheSameMomentAloneAndHashesLikeIt) {
    const auto a = NSDate::dateWithTimeIntervalSince1970(10);
    const auto b = NSDate::dateWithTimeIntervalSince1970(10);
    const auto c = NSDate::dateWithTimeIntervalSince1970(10.5);
    EXPECT_TRUE(a->isEqual(b.get()));
    EXPECT_TRUE(b->isEqual(a.get()));
    EXPECT_EQ(a->hash(), b->hash());
    EXPECT_FALSE(a->isEqual(c.get()));
    EXPECT_FALSE(c->isEqual(a.get()));
    EXPECT_FALSE(a->isEqual(nullptr));
    EXPECT_FALSE(a->isEqual(NSNumber::numberWithDouble(10).get()));
}

TEST(NSDate, HashesZeroOfEitherSignAlike) {
    const auto positive = NSDate::dateWithTimeIntervalSinceReferenceDate(0.0);
    const auto negative = NSDate::dateWithTimeIntervalSinceReferenceDate(-0.0);
    EXPECT_TRUE(positive->isEqual(negative.get()));
    EXPECT_EQ(positive->hash(), negative->hash());
}

TEST(NSDate, DescribesItselfInUTC) {
    EXPECT_EQ(NSDate::dateWithTimeIntervalSince1970(1721784520.9)->description(),
              "2024-07-24 01:28:40 +0000");
    EXPECT_EQ(
        NSDate::dateWithTimeIntervalSinceReferenceDate(std::numeric_limits<double>::infinity())
            ->description(),
        "inf");
}

TEST(NSDate, IsItsOwnCopy) {
    const auto date = NSDate::dateWithTimeIntervalSince1970(10);
    EXPECT_EQ(date->copy(), date);
}

} // namespace
} // namespace orvo
