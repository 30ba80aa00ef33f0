#include "fetching/DebugTransitLineItem.h"

#include "fetching/DebugTransitIncident.h"
#include "platform/foundation/NSString.h"
#include "platform/geoservices/TransitLineItemRecord.h"
#include "platform/geoservices/TransitSystemRecord.h"

#include <gtest/gtest.h>

namespace orvo {
namespace {

/// A line item in which every property has a value that is neither nil nor 0 nor false.
std::shared_ptr<TransitLineItemRecord> fullItem() {
    TransitLineRecord::Fields line;
    line.muid = 7;
    line.name = "Linie 5";
    line.identifier = MapItemIdentifier::identifierWithMuid(7);
    line.system = TransitSystemRecord::initWithFields({});
    line.departureTimeDisplayStyle = 2;
    line.departuresAreVehicleSpecific = true;
    line.isBus = true;
    line.artwork = TransitArtworkDataSource::initWithFields({});
    line.modeArtwork = TransitArtworkDataSource::initWithFields({});
    line.alternateArtwork = TransitArtworkDataSource::initWithFields({});
    line.hasLineColorString = true;
    line.lineColorString = "FF0000";
    line.showVehicleNumber = true;
    line.operatingHours = NSArray::array();
    line.labelItems = NSArray::array();
    line.attribution = NSString::string("attribution");
    line.mapRegion = NSString::string("region");
    return TransitLineItemRecord::initWithFields_service(
        std::move(line), {NSArray::array(), true, true, true, NSString::string("info")});
}

class DebugLineItem : public ::testing::Test {
protected:
    std::shared_ptr<TransitLineItemRecord> wrapped = fullItem();
    std::shared_ptr<NSArray> incidents = NSArray::arrayOf({DebugTransitIncident::init()});
    std::shared_ptr<DebugTransitLineItem> debug =
        DebugTransitLineItem::initWithLine_incidents(wrapped, incidents);
};

TEST_F(DebugLineItem, HasTheGivenIncidentsAndNotItsLines) {
    EXPECT_EQ(debug->incidents(), incidents);
    EXPECT_NE(debug->incidents(), wrapped->incidents());
    EXPECT_EQ(debug->wrappedLine(), wrapped);
}

TEST_F(DebugLineItem, IsTheWrappedLineInWhatMakesItRecognisable) {
    const TransitLine& line = *debug;
    EXPECT_EQ(line.muid(), 7U);
    EXPECT_EQ(line.identifier(), wrapped->identifier());
    EXPECT_EQ(line.name(), "Linie 5");
    EXPECT_EQ(line.system(), wrapped->system());
    EXPECT_EQ(line.departureTimeDisplayStyle(), 2U);
    EXPECT_TRUE(line.departuresAreVehicleSpecific());
    EXPECT_TRUE(line.isBus());
    EXPECT_EQ(line.artwork(), wrapped->artwork());
    EXPECT_EQ(line.modeArtwork(), wrapped->modeArtwork());
    EXPECT_EQ(line.alternateArtwork(), wrapped->alternateArtwork());
    EXPECT_TRUE(line.hasLineColorString());
    EXPECT_EQ(line.lineColorString(), "FF0000");
    EXPECT_TRUE(line.showVehicleNumber());
    EXPECT_EQ(line.operatingHours(), wrapped->operatingHours());
}

TEST_F(DebugLineItem, AnswersNilForTheRestAlthoughTheWrappedLineHasIt) {
    EXPECT_NE(wrapped->labelItems(), nullptr);
    EXPECT_EQ(debug->labelItems(), nullptr);
    EXPECT_NE(wrapped->attribution(), nullptr);
    EXPECT_EQ(debug->attribution(), nullptr);
    EXPECT_NE(wrapped->mapRegion(), nullptr);
    EXPECT_EQ(debug->mapRegion(), nullptr);
    EXPECT_NE(wrapped->encyclopedicInfo(), nullptr);
    EXPECT_EQ(debug->encyclopedicInfo(), nullptr);
}

TEST_F(DebugLineItem, AnswersFalseForTheServiceAlthoughTheWrappedLineSaysTrue) {
    EXPECT_TRUE(wrapped->isIncidentsTTLExpired());
    EXPECT_FALSE(debug->isIncidentsTTLExpired());
    EXPECT_TRUE(wrapped->hasIncidentComponent());
    EXPECT_FALSE(debug->hasIncidentComponent());
    EXPECT_TRUE(wrapped->hasEncyclopedicInfo());
    EXPECT_FALSE(debug->hasEncyclopedicInfo());
}

TEST_F(DebugLineItem, CanBeGivenOtherIncidentsAndAnotherLine) {
    debug->setIncidents(NSArray::array());
    EXPECT_EQ(debug->incidents()->count(), 0U);
    TransitLineRecord::Fields other;
    other.muid = 8;
    debug->setWrappedLine(TransitLineItemRecord::initWithFields_service(std::move(other), {}));
    EXPECT_EQ(debug->muid(), 8U);
    EXPECT_EQ(debug->name(), std::nullopt);
}

TEST_F(DebugLineItem, WithoutAWrappedLineIsNilZeroAndFalse) {
    debug->setWrappedLine(nullptr);
    EXPECT_EQ(debug->muid(), 0U);
    EXPECT_EQ(debug->name(), std::nullopt);
    EXPECT_EQ(debug->system(), nullptr);
    EXPECT_FALSE(debug->isBus());
}

} // namespace
} // namespace orvo
