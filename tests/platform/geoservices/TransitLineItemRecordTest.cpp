#include "platform/geoservices/TransitLineItemRecord.h"

#include <gtest/gtest.h>

namespace orvo {
namespace {

TEST(TransitLineItemRecord, IsTheLineThatItWasMadeWith) {
    const auto item = TransitLineItemRecord::initWithFields_service({.muid = 7, .name = "A"}, {});
    const std::shared_ptr<TransitLine> line = item;
    EXPECT_EQ(line->muid(), 7U);
    EXPECT_EQ(line->name(), "A");
}

TEST(TransitLineItemRecord, TellsUnaskedIncidentsFromNone) {
    const auto unasked = TransitLineItemRecord::initWithFields_service({}, {});
    EXPECT_FALSE(unasked->hasIncidentComponent());
    EXPECT_EQ(unasked->incidents(), nullptr);
    const auto none = NSArray::array();
    const std::shared_ptr<TransitLineItem> asked = TransitLineItemRecord::initWithFields_service(
        {}, {.incidents = none, .hasIncidentComponent = true});
    EXPECT_TRUE(asked->hasIncidentComponent());
    EXPECT_EQ(asked->incidents(), none);
    EXPECT_FALSE(asked->isIncidentsTTLExpired());
}

TEST(TransitLineItemRecord, KeepsItsIncidentsPastTheirTimeToLive) {
    const auto incidents = NSArray::array();
    const auto item = TransitLineItemRecord::initWithFields_service(
        {}, {.incidents = incidents, .isIncidentsTTLExpired = true});
    EXPECT_TRUE(item->isIncidentsTTLExpired());
    EXPECT_EQ(item->incidents(), incidents);
    EXPECT_FALSE(item->hasIncidentComponent());
}

TEST(TransitLineItemRecord, TellsWhetherItHasFurtherInformationApartFromTheInformation) {
    const auto promised =
        TransitLineItemRecord::initWithFields_service({}, {.hasEncyclopedicInfo = true});
    EXPECT_TRUE(promised->hasEncyclopedicInfo());
    EXPECT_EQ(promised->encyclopedicInfo(), nullptr);
    const auto info = MapItemIdentifier::identifierWithMuid(1);
    const auto given =
        TransitLineItemRecord::initWithFields_service({}, {.encyclopedicInfo = info});
    EXPECT_FALSE(given->hasEncyclopedicInfo());
    EXPECT_EQ(given->encyclopedicInfo(), info);
}

} // namespace
} // namespace orvo
