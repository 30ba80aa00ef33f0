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

TEST(FeedTransitIncident, NamesAreThoseOfTheFormat) {
    EXPECT_EQ(nameOf(IncidentSeverity::Severe), "SEVERE");
    EXPECT_EQ(nameOf(IncidentEffect::NoService), "NO_SERVICE");
    EXPECT_EQ(nameOf(IncidentCause::MedicalEmergency), "MEDICAL_EMERGENCY");
    EXPECT_EQ(nameOf(static_cast<IncidentEffect>(99)), "99");
}

} // namespace orvo::testing
