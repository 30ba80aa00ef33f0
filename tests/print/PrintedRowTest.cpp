#include "print/PrintedRow.h"

#include "platform/foundation/Exceptions.h"
#include "platform/foundation/NSString.h"
#include "platform/mapuikit/SizedTransitArtwork.h"
#include "platform/uikit/UIImage.h"
#include "print/PrintWorld.h"
#include "viewmodel/OWTransitItem.h"
#include "viewmodel/OWTransitSummaryItem.h"

#include <gtest/gtest.h>

namespace orvo {
namespace {

using testing::shield;

std::shared_ptr<OWTransitItem> item(std::shared_ptr<ArtworkImageSource> source, double alpha = 1) {
    return OWTransitItem::initWithPrimaryText_secondaryText_artwork_artworkHidden_openable(
        "Title",
        "Second",
        OWConfiguredArtwork::initWithArtworkSource_alpha(std::move(source), alpha),
        false,
        nullptr);
}

std::vector<PrintedShield>
shieldsOf(const std::vector<std::shared_ptr<TransitArtworkDataSource>>& artworks) {
    return PrintedRow::of(OWTransitSummaryItem::initWithText_artworks_userActivityData(
                              "2", NSArray::arrayOf(artworks), nullptr))
        .artwork->shields;
}

PrintedShield shieldOf(const std::shared_ptr<TransitArtworkDataSource>& artwork) {
    return shieldsOf({artwork}).at(0);
}

TEST(PrintedRow, OfAnItemHasItsTextsAndItsImage) {
    const auto row = PrintedRow::of(item(UIImage::imageNamed("good-alt-v2"), 0.3));
    EXPECT_EQ(row.kind, PrintedRow::Kind::Item);
    EXPECT_EQ(row.primaryText, "Title");
    EXPECT_EQ(row.secondaryText, "Second");
    EXPECT_EQ(row.artwork->image, "good-alt-v2");
    EXPECT_EQ(row.artwork->alpha, 0.3);
    EXPECT_FALSE(row.artworkHidden);
    EXPECT_FALSE(row.opens);
}

TEST(PrintedRow, OfAnItemHasItsShield) {
    const auto row = PrintedRow::of(item(
        SizedTransitArtwork::initWithArtwork_shieldSize_artworkCache(shield("U1"), 7, nullptr)));
    EXPECT_FALSE(row.artwork->image);
    ASSERT_EQ(row.artwork->shields.size(), 1U);
    EXPECT_EQ(row.artwork->shields[0].text, "U1");
}

TEST(PrintedRow, ASizedArtworkWithoutAnyShowsNoShield) {
    const auto row = PrintedRow::of(
        item(SizedTransitArtwork::initWithArtwork_shieldSize_artworkCache(nullptr, 7, nullptr)));
    ASSERT_TRUE(row.artwork);
    EXPECT_TRUE(row.artwork->shields.empty());
}

TEST(PrintedRow, NilsStayNil) {
    const auto row = PrintedRow::of(
        OWTransitItem::initWithPrimaryText_secondaryText_artwork_artworkHidden_openable(
            std::nullopt, std::nullopt, nullptr, true, nullptr));
    EXPECT_FALSE(row.primaryText);
    EXPECT_FALSE(row.secondaryText);
    EXPECT_FALSE(row.artwork);
    EXPECT_TRUE(row.artworkHidden);
}

TEST(PrintedRow, OfASummaryHasAllShieldsInOrderAndNoSecondLine) {
    const auto row = PrintedRow::of(OWTransitSummaryItem::initWithText_artworks_userActivityData(
        "2 advisories",
        NSArray::arrayOf(std::vector{shield("U2"), shield("U1")}),
        OWUserActivityData::initWithActivityType_userInfo("a.b", nullptr)));
    EXPECT_EQ(row.kind, PrintedRow::Kind::Summary);
    EXPECT_EQ(row.primaryText, "2 advisories");
    EXPECT_FALSE(row.secondaryText);
    ASSERT_EQ(row.artwork->shields.size(), 2U);
    EXPECT_EQ(row.artwork->shields[0].text, "U2");
    EXPECT_EQ(row.artwork->shields[1].text, "U1");
    EXPECT_EQ(row.opens->activityType, "a.b");
}

TEST(PrintedRow, ShieldsHaveTheColoursOfTheirLines) {
    EXPECT_EQ(shieldOf(shield("1", "00843D,FFEE00")).background, "00843D");
    EXPECT_EQ(shieldOf(shield("1", "00843D,FFEE00")).foreground, "FFEE00");
    EXPECT_EQ(shieldOf(shield("1", "00843D")).foreground, "FFFFFF");
    EXPECT_EQ(shieldOf(shield("1", "FFEE00")).foreground, "000000");
    EXPECT_FALSE(shieldOf(shield("1")).background);
}

TEST(PrintedRow, AColourThatIsNoneMakesANeutralShield) {
    for (const char* colours : {"", "red", "12345", "1234567", "+12345", "12 456", "GG0000", ","})
        EXPECT_FALSE(shieldOf(shield("1", colours)).background) << colours;
    EXPECT_EQ(shieldOf(shield("1", "000000,pink")).foreground, "FFFFFF");
}

TEST(PrintedRow, AnArtworkWithoutAShieldShowsItsFallbackOrNothing) {
    const auto fallback = TransitArtworkDataSource::initWithFields(
        {.artworkSourceType = 2,
         .iconFallbackShieldDataSource =
             TransitShieldDataSource::initWithFields({.shieldText = "MBT"})});
    EXPECT_EQ(shieldOf(fallback).text, "MBT");
    EXPECT_TRUE(shieldsOf({TransitArtworkDataSource::initWithFields({})}).empty());
    EXPECT_TRUE(shieldsOf({shield("")}).empty());
}

TEST(PrintedRow, AColourAloneIsPrintedByItsLinesName) {
    const auto colour = TransitArtworkDataSource::initWithFields(
        {.artworkSourceType = 1,
         .shieldDataSource =
             TransitShieldDataSource::initWithFields({.shieldColorString = "DA291C,FFFFFF"}),
         .accessibilityText = "Red Line"});
    EXPECT_EQ(shieldOf(colour).text, "Red Line");
    EXPECT_EQ(shieldOf(colour).background, "DA291C");
    const auto nameless = TransitArtworkDataSource::initWithFields(
        {.artworkSourceType = 1,
         .shieldDataSource =
             TransitShieldDataSource::initWithFields({.shieldColorString = "DA291C,FFFFFF"})});
    EXPECT_TRUE(shieldsOf({nameless}).empty());
}

TEST(PrintedRow, OfAnythingElseIsAProgrammingError) {
    EXPECT_THROW((void)PrintedRow::of(NSString::string("x")), NSInvalidArgumentException);
    EXPECT_THROW((void)PrintedRow::of(nullptr), NSInvalidArgumentException);
    EXPECT_THROW((void)openableOfItem(NSString::string("x")), NSInvalidArgumentException);
}

} // namespace
} // namespace orvo
