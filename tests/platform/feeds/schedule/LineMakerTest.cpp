#include "platform/feeds/schedule/LineMaker.h"

#include "platform/geoservices/TransitArtworkTypes.h"

#include <gtest/gtest.h>

namespace orvo {
namespace {

ScheduleLine busLine() {
    ScheduleLine line;
    line.feed = "city";
    line.routeId = "R1";
    line.muid = lineMuid("city", "R1");
    line.shortName = "10";
    line.longName = "Gare - Mairie";
    line.color = "005CA9";
    line.textColor = "FFFFFF";
    line.routeType = 3;
    line.agencyId = "A1";
    line.agency = {"A1", "City Lines", "", "Europe/Paris", "fr"};
    return line;
}

const TransitShieldDataSource& shieldOf(const std::shared_ptr<TransitArtworkDataSource>& artwork) {
    return *artwork->shieldDataSource();
}

TEST(LineMaker, CarriesNumberNamesAndOrigin) {
    const auto line = makeTransitLine(busLine());
    EXPECT_EQ(line->muid(), lineMuid("city", "R1"));
    EXPECT_EQ(line->identifier()->muid(), line->muid());
    EXPECT_EQ(line->name(), "10");
    EXPECT_EQ(line->system()->name(), "City Lines");
    EXPECT_EQ(line->origin(), (FeedLineOrigin{"city", "R1"}));
    EXPECT_TRUE(line->isBus());
    EXPECT_TRUE(line->hasLineColorString());
    EXPECT_EQ(line->lineColorString(), "005CA9");
}

TEST(LineMaker, TheLinesOwnShieldHasItsShortNameInItsColors) {
    const auto line = makeTransitLine(busLine());
    ASSERT_TRUE(line->alternateArtwork());
    EXPECT_EQ(line->alternateArtwork()->artworkSourceType(),
              static_cast<int>(TransitArtworkSourceType::Shield));
    EXPECT_EQ(shieldOf(line->alternateArtwork()).shieldText(), "10");
    EXPECT_EQ(shieldOf(line->alternateArtwork()).shieldColorString(), "005CA9,FFFFFF");
    EXPECT_EQ(shieldOf(line->alternateArtwork()).shieldType(),
              static_cast<int>(TransitShieldType::Bus));
    EXPECT_EQ(line->artwork(), line->alternateArtwork());
}

TEST(LineMaker, MendsColorsThatCannotBeRead) {
    ScheduleLine yellow = busLine();
    yellow.color = "FFB900";
    EXPECT_EQ(shieldOf(makeTransitLine(yellow)->alternateArtwork()).shieldColorString(),
              "FFB900,000000");
}

TEST(LineMaker, AColorAloneMakesAShieldWithoutText) {
    ScheduleLine red = busLine();
    red.shortName.clear();
    const auto line = makeTransitLine(red);
    EXPECT_EQ(line->name(), "Gare - Mairie");
    ASSERT_TRUE(line->alternateArtwork());
    EXPECT_FALSE(shieldOf(line->alternateArtwork()).shieldText());
    EXPECT_EQ(line->alternateArtwork()->accessibilityText(), "Gare - Mairie");
}

TEST(LineMaker, AShortNameAloneMakesAShield) {
    ScheduleLine plain = busLine();
    plain.color.clear();
    plain.textColor.clear();
    const auto line = makeTransitLine(plain);
    ASSERT_TRUE(line->alternateArtwork());
    EXPECT_EQ(shieldOf(line->alternateArtwork()).shieldText(), "10");
    EXPECT_FALSE(line->hasLineColorString());
    EXPECT_FALSE(line->lineColorString());
}

TEST(LineMaker, WithoutShortNameAndColorTheLineHasNoShieldOfItsOwn) {
    ScheduleLine bare = busLine();
    bare.shortName.clear();
    bare.color.clear();
    const auto line = makeTransitLine(bare);
    EXPECT_FALSE(line->alternateArtwork());
    EXPECT_TRUE(equal(line->artwork(), line->modeArtwork()));
}

TEST(LineMaker, LinesOfOneAgencyShareTheirSystemsArtwork) {
    ScheduleLine other = busLine();
    other.routeId = "R2";
    other.shortName = "T2";
    other.routeType = 0;
    const auto a = makeTransitLine(busLine());
    const auto b = makeTransitLine(other);
    EXPECT_TRUE(equal(a->system()->artwork(), b->system()->artwork()));
    EXPECT_EQ(hashOf(a->system()->artwork()), hashOf(b->system()->artwork()));
    other.agency.name = "Country Lines";
    EXPECT_FALSE(equal(a->system()->artwork(), makeTransitLine(other)->system()->artwork()));
}

TEST(LineMaker, TheSystemsMarkIsItsInitialsInANeutralShield) {
    const auto artwork = makeTransitLine(busLine())->system()->artwork();
    EXPECT_EQ(shieldOf(artwork).shieldText(), "CL");
    EXPECT_EQ(shieldOf(artwork).shieldType(), static_cast<int>(TransitShieldType::Neutral));
    EXPECT_EQ(artwork->accessibilityText(), "City Lines");
}

TEST(LineMaker, ALineWithoutAgencyBelongsToItsFeed) {
    ScheduleLine line = busLine();
    line.agency = {};
    EXPECT_EQ(makeTransitLine(line)->system()->name(), "city");
}

TEST(LineMaker, TheModeGivesShapeAndIcon) {
    const std::pair<int, TransitShieldType> modes[] = {{0, TransitShieldType::Tram},
                                                       {1, TransitShieldType::Metro},
                                                       {2, TransitShieldType::Rail},
                                                       {109, TransitShieldType::Rail},
                                                       {3, TransitShieldType::Bus},
                                                       {4, TransitShieldType::Ferry},
                                                       {5, TransitShieldType::Cable},
                                                       {6, TransitShieldType::Cable},
                                                       {7, TransitShieldType::Cable},
                                                       {11, TransitShieldType::Bus},
                                                       {12, TransitShieldType::Metro},
                                                       {1700, TransitShieldType::Neutral}};
    for (const auto& [type, shape] : modes) {
        ScheduleLine line = busLine();
        line.routeType = type;
        const auto made = makeTransitLine(line);
        EXPECT_EQ(shieldOf(made->alternateArtwork()).shieldType(), static_cast<int>(shape)) << type;
        EXPECT_EQ(made->modeArtwork()->artworkSourceType(),
                  static_cast<int>(TransitArtworkSourceType::Icon));
        EXPECT_EQ(made->modeArtwork()->iconDataSource()->defaultTransitType(),
                  static_cast<unsigned>(shape));
        EXPECT_EQ(made->isBus(), type == 3 || type == 11);
    }
}

} // namespace
} // namespace orvo
