#include "platform/geoservices/TransitIncidentRecord.h"

#include <gtest/gtest.h>

namespace orvo {
namespace {

TEST(TransitIncidentRecord, LeavesItsPeriodOpenOnTheSideWithoutADate) {
    const auto end = NSDate::dateWithTimeIntervalSinceReferenceDate(60);
    const auto incident = TransitIncidentRecord::initWithFields({.endDate = end});
    EXPECT_EQ(incident->startDate(), nullptr);
    EXPECT_EQ(incident->endDate(), end);
}

TEST(TransitIncidentRecord, KeepsItsFourDatesApart) {
    const auto at = [](double seconds) {
        return NSDate::dateWithTimeIntervalSinceReferenceDate(seconds);
    };
    const std::shared_ptr<TransitIncident> incident = TransitIncidentRecord::initWithFields(
        {.startDate = at(1), .endDate = at(2), .creationDate = at(3), .lastUpdated = at(4)});
    EXPECT_EQ(incident->startDate()->timeIntervalSinceReferenceDate(), 1);
    EXPECT_EQ(incident->endDate()->timeIntervalSinceReferenceDate(), 2);
    EXPECT_EQ(incident->creationDate()->timeIntervalSinceReferenceDate(), 3);
    EXPECT_EQ(incident->lastUpdated()->timeIntervalSinceReferenceDate(), 4);
}

TEST(TransitIncidentRecord, KeepsItsSixTextsApart) {
    const std::shared_ptr<TransitIncident> incident =
        TransitIncidentRecord::initWithFields({.title = "title",
                                               .summary = "summary",
                                               .fullDescription = "description",
                                               .messageForRoutePlanning = "planning",
                                               .messageForRouteStepping = "stepping",
                                               .messageForNonRoutable = "non-routable"});
    EXPECT_EQ(incident->title(), "title");
    EXPECT_EQ(incident->summary(), "summary");
    EXPECT_EQ(incident->fullDescription(), "description");
    EXPECT_EQ(incident->messageForRoutePlanning(), "planning");
    EXPECT_EQ(incident->messageForRouteStepping(), "stepping");
    EXPECT_EQ(incident->messageForNonRoutable(), "non-routable");
}

TEST(TransitIncidentRecord, TellsNoTextFromAnEmptyOne) {
    EXPECT_EQ(TransitIncidentRecord::initWithFields({})->summary(), std::nullopt);
    EXPECT_EQ(TransitIncidentRecord::initWithFields({.summary = ""})->summary(), "");
}

TEST(TransitIncidentRecord, DoesNotBlockUnlessItIsToldTo) {
    EXPECT_FALSE(TransitIncidentRecord::initWithFields({})->isBlockingIncident());
    EXPECT_TRUE(
        TransitIncidentRecord::initWithFields({.isBlockingIncident = true})->isBlockingIncident());
}

TEST(TransitIncidentRecord, TellsNoAffectedEntitiesFromAnEmptyList) {
    EXPECT_EQ(TransitIncidentRecord::initWithFields({})->affectedEntities(), nullptr);
    const auto none = NSArray::array();
    EXPECT_EQ(TransitIncidentRecord::initWithFields({.affectedEntities = none})->affectedEntities(),
              none);
}

} // namespace
} // namespace orvo
