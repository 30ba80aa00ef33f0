#include "platform/geoservices/TransitLineRecord.h"

#include "platform/geoservices/TransitSystemRecord.h"

#include <gtest/gtest.h>

namespace orvo {
namespace {

TEST(TransitLineRecord, TellsNoTextFromAnEmptyOne) {
    const auto untold = TransitLineRecord::initWithFields({.muid = 7});
    EXPECT_EQ(untold->name(), std::nullopt);
    EXPECT_EQ(untold->lineColorString(), std::nullopt);
    const auto empty = TransitLineRecord::initWithFields({.name = "", .lineColorString = ""});
    EXPECT_EQ(empty->name(), "");
    EXPECT_EQ(empty->lineColorString(), "");
}

TEST(TransitLineRecord, GivesEachOfItsThreeArtworksInItsOwnPlace) {
    const auto map = TransitArtworkDataSource::initWithFields({});
    const auto mode = TransitArtworkDataSource::initWithFields({});
    const auto shield = TransitArtworkDataSource::initWithFields({});
    const std::shared_ptr<TransitLine> line = TransitLineRecord::initWithFields(
        {.artwork = map, .modeArtwork = mode, .alternateArtwork = shield});
    EXPECT_EQ(line->artwork(), map);
    EXPECT_EQ(line->modeArtwork(), mode);
    EXPECT_EQ(line->alternateArtwork(), shield);
}

TEST(TransitLineRecord, GivesTheVeryIdentifierAndSystemThatItWasMadeWith) {
    const auto identifier = MapItemIdentifier::identifierWithMuid(7);
    const auto system = TransitSystemRecord::initWithFields({});
    const auto line =
        TransitLineRecord::initWithFields({.muid = 8, .identifier = identifier, .system = system});
    EXPECT_EQ(line->identifier(), identifier);
    EXPECT_EQ(line->system(), system);
    EXPECT_EQ(line->muid(), 8U);
}

TEST(TransitLineRecord, AnswersEachYesAndNoByItself) {
    const auto bus = TransitLineRecord::initWithFields({.isBus = true});
    EXPECT_TRUE(bus->isBus());
    EXPECT_FALSE(bus->departuresAreVehicleSpecific() || bus->hasLineColorString() ||
                 bus->showVehicleNumber());
    const auto specific = TransitLineRecord::initWithFields({.departuresAreVehicleSpecific = true});
    EXPECT_TRUE(specific->departuresAreVehicleSpecific());
    EXPECT_FALSE(specific->isBus() || specific->showVehicleNumber());
    const auto numbered = TransitLineRecord::initWithFields({.showVehicleNumber = true});
    EXPECT_TRUE(numbered->showVehicleNumber());
    EXPECT_FALSE(numbered->isBus() || numbered->departuresAreVehicleSpecific());
}

TEST(TransitLineRecord, TellsWhetherThereIsAColorApartFromTheColor) {
    const auto line = TransitLineRecord::initWithFields({.hasLineColorString = true});
    EXPECT_TRUE(line->hasLineColorString());
    EXPECT_EQ(line->lineColorString(), std::nullopt);
    EXPECT_EQ(
        TransitLineRecord::initWithFields({.lineColorString = "00AAFF"})->hasLineColorString(),
        false);
}

} // namespace
} // namespace orvo
