#include "platform/geoservices/FeedTransitIncident.h"

#include <gtest/gtest.h>

namespace orvo::testing {

TEST(FeedTransitIncident, WhereThereIsNoMessageItIsTheTitle) {
    const auto incident =
        FeedTransitIncident::initWithFields_details({.title = "Closed", .summary = "s"}, {});
    EXPECT_EQ(incident->messageForRoutePlanning(), "Closed");
    EXPECT_EQ(incident->messageForRouteStepping(), "Closed");
    EXPECT_EQ(incident->messageForNonRoutable(), "Closed");
    EXPECT_EQ(FeedTransitIncident::initWithFields_details({}, {})->messageForRouteStepping(),
              std::nullopt);
}

TEST(FeedTransitIncident, AMessageOfItsOwnIsTold) {
    const auto incident =
        FeedTransitIncident::initWithFields_details({.title = "Closed",
                                                     .messageForRoutePlanning = "planning",
                                                     .messageForRouteStepping = "stepping",
                                                     .messageForNonRoutable = "none"},
                                                    {});
    EXPECT_EQ(incident->messageForRoutePlanning(), "planning");
    EXPECT_EQ(incident->messageForRouteStepping(), "stepping");
    EXPECT_EQ(incident->messageForNonRoutable(), "none");
}

TEST(FeedTransitIncident, ASummaryThatIsTheWholeDescriptionIsBoth) {
    const auto incident = FeedTransitIncident::initWithFields_details({.summary = "A fire."},
                                                                      {.isSummaryWhole = true});
    EXPECT_EQ(incident->summary(), "A fire.");
    EXPECT_EQ(incident->fullDescription(), "A fire.");
    EXPECT_EQ(
        FeedTransitIncident::initWithFields_details({.summary = "A fire."}, {})->fullDescription(),
        std::nullopt);
}

TEST(FeedTransitIncident, ObjectsOfOneIncidentDifferOnlyInTheirOccurrence) {
    const auto date = [](double seconds) {
        return NSDate::dateWithTimeIntervalSince1970(seconds);
    };
    const auto common = std::make_shared<const FeedTransitIncident::Common>(
        FeedTransitIncident::Common{{.muid = 7,
                                     .startDate = date(1),
                                     .endDate = date(2),
                                     .isBlockingIncident = true,
                                     .title = "Closed",
                                     .summary = "A fire.",
                                     .iconType = 4,
                                     .creationDate = date(3),
                                     .lastUpdated = date(4)},
                                    {.feed = "town",
                                     .severity = IncidentSeverity::Severe,
                                     .effect = IncidentEffect::Detour,
                                     .isPartOfLine = true,
                                     .timeZone = "Asia/Tokyo"}});
    const auto incident = FeedTransitIncident::initWithCommon_occurrence(
        common, {date(5), nullptr, false, false, "Europe/Paris"});
    EXPECT_EQ(incident->startDate()->timeIntervalSince1970(), 5);
    EXPECT_EQ(incident->endDate(), nullptr);
    EXPECT_FALSE(incident->isBlockingIncident());
    EXPECT_FALSE(incident->details().isPartOfLine);
    EXPECT_EQ(incident->details().timeZone, "Europe/Paris");
    EXPECT_EQ(incident->muid(), 7U);
    EXPECT_EQ(incident->title(), "Closed");
    EXPECT_EQ(incident->summary(), "A fire.");
    EXPECT_EQ(incident->iconType(), 4);
    EXPECT_EQ(incident->creationDate()->timeIntervalSince1970(), 3);
    EXPECT_EQ(incident->lastUpdated()->timeIntervalSince1970(), 4);
    EXPECT_EQ(incident->details().feed, "town");
    EXPECT_EQ(incident->severity(), IncidentSeverity::Severe);
    EXPECT_EQ(incident->effect(), IncidentEffect::Detour);
}

TEST(FeedTransitIncident, FromFieldsAndDetailsItHasThatOccurrence) {
    const auto start = NSDate::dateWithTimeIntervalSince1970(1);
    const auto end = NSDate::dateWithTimeIntervalSince1970(2);
    const auto incident = FeedTransitIncident::initWithFields_details(
        {.startDate = start, .endDate = end, .isBlockingIncident = true},
        {.isPartOfLine = true, .timeZone = "Asia/Tokyo"});
    EXPECT_EQ(incident->startDate(), start);
    EXPECT_EQ(incident->endDate(), end);
    EXPECT_TRUE(incident->isBlockingIncident());
    EXPECT_TRUE(incident->details().isPartOfLine);
    EXPECT_EQ(incident->details().timeZone, "Asia/Tokyo");
}

TEST(FeedTransitIncident, NamesAreThoseOfTheFormat) {
    EXPECT_EQ(nameOf(IncidentSeverity::Severe), "SEVERE");
    EXPECT_EQ(nameOf(IncidentEffect::NoService), "NO_SERVICE");
    EXPECT_EQ(nameOf(IncidentCause::MedicalEmergency), "MEDICAL_EMERGENCY");
    EXPECT_EQ(nameOf(static_cast<IncidentEffect>(99)), "99");
}

} // namespace orvo::testing
