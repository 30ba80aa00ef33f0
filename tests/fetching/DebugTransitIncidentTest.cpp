#include "fetching/DebugTransitIncident.h"

#include "fetching/DebugAffectedEntities.h"
#include "fetching/FetchingFakes.h"
#include "support/TestClock.h"

#include <gtest/gtest.h>

#include <limits>

namespace orvo {
namespace {

using testing::makeLine;
using testing::StoppedClock;

constexpr double now = 1750000000;

class FakeIncident : public ::testing::Test {
protected:
    static std::shared_ptr<DebugTransitIncident> fakeFor(const std::shared_ptr<TransitLine>& line) {
        return DebugTransitIncident::__debug_fakeIncidentAffectingLine(line);
    }

    StoppedClock clock{now};
    std::shared_ptr<DebugTransitIncident> incident = fakeFor(makeLine(41, "Linie 5"));
};

TEST_F(FakeIncident, HasTheNumberAfterItsLines) {
    EXPECT_EQ(incident->muid(), 42U);
    EXPECT_EQ(fakeFor(makeLine(std::numeric_limits<std::uint64_t>::max()))->muid(), 0U);
}

TEST_F(FakeIncident, HasItsTextsByteForByte) {
    EXPECT_EQ(incident->title(), "Something Bad\xE2\x84\xA2");
    EXPECT_EQ(incident->summary(), "Linie 5 \xC2\xB7 Possible delays due to strike");
    EXPECT_EQ(incident->fullDescription(),
              "Only one train out of three is working due to national strike of public transit "
              "workers.");
    EXPECT_EQ(incident->messageForRoutePlanning(), "Something Bad\xE2\x84\xA2 happened");
    EXPECT_EQ(incident->messageForRouteStepping(), "Something Bad\xE2\x84\xA2 happened");
    EXPECT_EQ(incident->messageForNonRoutable(), "Something Bad\xE2\x84\xA2 happened");
}

TEST_F(FakeIncident, OfALineWithoutANameSaysSo) {
    const auto nameless = TransitLineRecord::initWithFields({});
    EXPECT_EQ(fakeFor(nameless)->summary(), "(null) \xC2\xB7 Possible delays due to strike");
}

TEST_F(FakeIncident, LastsFromADayAgoToADayAhead) {
    EXPECT_EQ(incident->startDate()->timeIntervalSince1970(), now - 86400);
    EXPECT_EQ(incident->endDate()->timeIntervalSince1970(), now + 86400);
}

TEST_F(FakeIncident, WasCreatedAtItsStartAndUpdatedNow) {
    EXPECT_EQ(incident->creationDate()->timeIntervalSince1970(), now - 86400);
    EXPECT_EQ(incident->lastUpdated()->timeIntervalSince1970(), now);
}

TEST_F(FakeIncident, TakesItsDatesWhenItIsMade) {
    clock->advance(100);
    const auto later = fakeFor(makeLine(41, "Linie 5"));
    EXPECT_EQ(later->endDate()->timeIntervalSinceDate(*incident->endDate()), 100);
    EXPECT_EQ(later->lastUpdated()->timeIntervalSinceDate(*incident->lastUpdated()), 100);
    EXPECT_EQ(later->muid(), incident->muid());
    EXPECT_EQ(later->summary(), incident->summary());
}

TEST_F(FakeIncident, IsABlockingOneWithIconOne) {
    EXPECT_EQ(incident->iconType(), 1);
    EXPECT_TRUE(incident->isBlockingIncident());
}

TEST_F(FakeIncident, ConcernsTheWholeLine) {
    const auto entities = typed<DebugAffectedEntities>(incident->affectedEntities());
    ASSERT_EQ(entities.size(), 1U);
    EXPECT_EQ(entities[0]->muid(), 41U);
}

TEST(DebugTransitIncident, IsEmptyAtFirst) {
    const auto incident = DebugTransitIncident::init();
    EXPECT_EQ(incident->muid(), 0U);
    EXPECT_EQ(incident->startDate(), nullptr);
    EXPECT_EQ(incident->endDate(), nullptr);
    EXPECT_FALSE(incident->isBlockingIncident());
    EXPECT_EQ(incident->title(), std::nullopt);
    EXPECT_EQ(incident->iconType(), 0);
    EXPECT_EQ(incident->affectedEntities(), nullptr);
}

TEST(DebugTransitIncident, EveryPropertyCanBeWritten) {
    const auto incident = DebugTransitIncident::init();
    const auto date = [](double seconds) {
        return NSDate::dateWithTimeIntervalSince1970(seconds);
    };
    const auto entities = NSArray::arrayOf({DebugAffectedEntities::initWithMuid(9)});
    incident->setMuid(1);
    incident->setStartDate(date(2));
    incident->setEndDate(date(3));
    incident->setBlockingIncident(true);
    incident->setTitle("title");
    incident->setSummary("summary");
    incident->setFullDescription("description");
    incident->setMessageForRoutePlanning("planning");
    incident->setMessageForRouteStepping("stepping");
    incident->setMessageForNonRoutable("none");
    incident->setIconType(-4);
    incident->setCreationDate(date(5));
    incident->setLastUpdated(date(6));
    incident->setAffectedEntities(entities);

    const TransitIncident& record = *incident;
    EXPECT_EQ(record.muid(), 1U);
    EXPECT_TRUE(equal(record.startDate(), date(2)));
    EXPECT_TRUE(equal(record.endDate(), date(3)));
    EXPECT_TRUE(record.isBlockingIncident());
    EXPECT_EQ(record.title(), "title");
    EXPECT_EQ(record.summary(), "summary");
    EXPECT_EQ(record.fullDescription(), "description");
    EXPECT_EQ(record.messageForRoutePlanning(), "planning");
    EXPECT_EQ(record.messageForRouteStepping(), "stepping");
    EXPECT_EQ(record.messageForNonRoutable(), "none");
    EXPECT_EQ(record.iconType(), -4);
    EXPECT_TRUE(equal(record.creationDate(), date(5)));
    EXPECT_TRUE(equal(record.lastUpdated(), date(6)));
    EXPECT_EQ(record.affectedEntities(), entities);
}

} // namespace
} // namespace orvo
