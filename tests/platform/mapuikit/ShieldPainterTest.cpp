#include "platform/mapuikit/ShieldPainter.h"

#include "platform/geoservices/TransitArtworkTypes.h"
#include "platform/mapuikit/ArtworkDataSourceCache.h"
#include "platform/mapuikit/SizedTransitArtwork.h"

#include <QGuiApplication>
#include <gtest/gtest.h>

#include <algorithm>
#include <cmath>

namespace orvo {
namespace {

/// Drawing needs a graphical application object. CTest runs each test in a process of its own,
/// where none stands in the way.
class ShieldTest : public ::testing::Test {
protected:
    void SetUp() override {
        if (!QCoreApplication::instance()) {
            static int count = 1;
            static char name[] = "test";
            static char* arguments[] = {name, nullptr};
            // Never destroyed: at the end of the process its platform would be gone before it.
            static auto* const application = new QGuiApplication(count, arguments);
            ASSERT_TRUE(application);
        }
        if (!qobject_cast<QGuiApplication*>(QCoreApplication::instance()))
            GTEST_SKIP()
                << "another test of this process has an application object without a screen";
    }

    static std::shared_ptr<TransitShieldDataSource>
    shield(const char* text,
           TransitShieldType type = TransitShieldType::Bus,
           const char* colours = "DA291C,FFFFFF") {
        return TransitShieldDataSource::initWithFields(
            {.shieldType = static_cast<std::int32_t>(type),
             .shieldText = text,
             .shieldColorString = colours});
    }
    static std::shared_ptr<UIImage> drawn(const std::shared_ptr<TransitShieldDataSource>& shield,
                                          std::int64_t size = 7,
                                          double scale = 2,
                                          bool night = false) {
        return ShieldPainter::draw(*shield, size, scale, night);
    }
    static std::uint32_t pixel(const UIImage& image, double x, double y) {
        const auto columns =
            static_cast<std::size_t>(std::lround(image.size().width * image.scale()));
        const auto column = static_cast<std::size_t>(x * image.scale());
        const auto row = static_cast<std::size_t>(y * image.scale());
        return image.pixels()[row * columns + column];
    }
    static std::shared_ptr<TransitArtworkDataSource> artwork(const char* text) {
        return TransitArtworkDataSource::initWithFields(
            {.artworkSourceType = 1, .shieldDataSource = shield(text)});
    }
    static std::shared_ptr<ArtworkDataSourceCache> cache() {
        return ArtworkDataSourceCache::initWithArtworkManager(
            TransitArtworkManager::initWithIconManager(IconManager::sharedManager()));
    }
};

TEST_F(ShieldTest, HeightGoesByTheSizeAtEveryScale) {
    const std::vector<double> heights = {12, 14, 16, 18, 20, 22, 25, 28};
    for (std::int64_t size = 0; size <= 7; ++size)
        for (const double scale : {1.0, 2.0, 3.0}) {
            const auto image = drawn(shield("1"), size, scale);
            ASSERT_TRUE(image);
            EXPECT_DOUBLE_EQ(image->size().height, heights.at(static_cast<std::size_t>(size)));
            EXPECT_DOUBLE_EQ(image->scale(), scale);
        }
    EXPECT_DOUBLE_EQ(drawn(shield("1"), -1)->size().height, 12);
    EXPECT_DOUBLE_EQ(drawn(shield("1"), 8)->size().height, 28);
}

TEST_F(ShieldTest, IsAtLeastAsWideAsHighAndGrowsWithItsText) {
    EXPECT_DOUBLE_EQ(drawn(shield("1"))->size().width, 28);
    const auto narrow = drawn(shield("Express"))->size().width;
    EXPECT_GT(narrow, 28);
    EXPECT_GT(drawn(shield("Express 42"))->size().width, narrow);
    EXPECT_LT(drawn(shield("Express"), 3)->size().width, narrow);
}

TEST_F(ShieldTest, MetroIsADiscForTwoCharactersAndAPillForMore) {
    EXPECT_DOUBLE_EQ(drawn(shield("U1", TransitShieldType::Metro))->size().width, 28);
    EXPECT_GT(drawn(shield("U10", TransitShieldType::Metro))->size().width, 28);
}

TEST_F(ShieldTest, CornersTellTheMode) {
    // Two points in from the corner: outside a disc, inside what is rounded a little.
    const auto corner = [&](TransitShieldType type) {
        return pixel(*drawn(shield("ABC", type)), 2, 2) >> 24U;
    };
    EXPECT_EQ(corner(TransitShieldType::Metro), 0U);
    EXPECT_EQ(corner(TransitShieldType::Ferry), 0U);
    EXPECT_EQ(corner(TransitShieldType::Cable), 0U);
    EXPECT_EQ(corner(TransitShieldType::Rail), 255U);
    EXPECT_EQ(corner(TransitShieldType::Bus), 255U);
    EXPECT_EQ(corner(TransitShieldType::Tram), 255U);
}

TEST_F(ShieldTest, EdgesLieOnWholePixelsAtEverySizeScaleAndMode) {
    for (const auto type : {TransitShieldType::Metro,
                            TransitShieldType::Tram,
                            TransitShieldType::Bus,
                            TransitShieldType::Rail,
                            TransitShieldType::Ferry,
                            TransitShieldType::Cable})
        for (std::int64_t size = 0; size <= 7; ++size)
            for (const double scale : {1.0, 2.0, 3.0}) {
                const auto image = SizedTransitArtwork::initWithArtwork_shieldSize_artworkCache(
                                       TransitArtworkDataSource::initWithFields(
                                           {.shieldDataSource = shield("Long name", type)}),
                                       size,
                                       cache())
                                       ->imageToDisplayWithScreenScale_nightMode(scale, true);
                ASSERT_TRUE(image);
                const double onePixel = 1 / scale;
                const auto [width, height] = image->size();
                EXPECT_DOUBLE_EQ(width * scale, std::round(width * scale));
                EXPECT_EQ(pixel(*image, width / 2, 0), 0xFFDA291CU) << size << " " << scale;
                EXPECT_EQ(pixel(*image, width / 2, height - onePixel), 0xFFDA291CU);
            }
}

TEST_F(ShieldTest, HasTheLinesColours) {
    EXPECT_EQ(pixel(*drawn(shield("1")), 3, 14), 0xFFDA291CU);
}

TEST_F(ShieldTest, WithoutColoursIsNeutralByDayAndNight) {
    const auto neutral = shield("CT", TransitShieldType::Neutral, "");
    EXPECT_NE(pixel(*drawn(neutral, 7, 2, false), 3, 14),
              pixel(*drawn(neutral, 7, 2, true), 3, 14));
}

TEST_F(ShieldTest, NearlyInvisibleOneGetsAHairline) {
    const auto edge = [&](const char* colours) {
        return pixel(*drawn(shield("1", TransitShieldType::Rail, colours)), 14, 0);
    };
    EXPECT_NE(edge("F0F0F0,000000"), 0xFFF0F0F0U);
    EXPECT_EQ(edge("DA291C,FFFFFF"), 0xFFDA291CU);
}

TEST_F(ShieldTest, NothingToShowIsNil) {
    EXPECT_FALSE(ShieldPainter::draw(*TransitShieldDataSource::initWithFields({}), 7, 2, false));
    EXPECT_FALSE(cache()->imageForArtwork_shieldSize_scale_nightMode(nullptr, 7, 2, false));
    EXPECT_FALSE(
        SizedTransitArtwork::initWithArtwork_shieldSize_artworkCache(artwork("1"), 7, nullptr)
            ->imageToDisplayWithScreenScale_nightMode(2, false));
}

TEST_F(ShieldTest, WithoutATextIsItsLinesColourAlone) {
    const auto image = drawn(TransitShieldDataSource::initWithFields(
        {.shieldType = static_cast<std::int32_t>(TransitShieldType::Metro),
         .shieldColorString = "DA291C,FFFFFF"}));
    ASSERT_TRUE(image);
    EXPECT_DOUBLE_EQ(image->size().width, 28);
    EXPECT_EQ(pixel(*image, 14, 14), 0xFFDA291CU);
    EXPECT_FALSE(drawn(TransitShieldDataSource::initWithFields({.shieldColorString = "red"})));
}

TEST(IconManager, NamesWhatIsDrawn) {
    const auto name = [](std::optional<std::string> text, std::optional<std::string> colours) {
        return IconManager::_nameOfArtwork(*TransitArtworkDataSource::initWithFields(
            {.shieldDataSource = TransitShieldDataSource::initWithFields(
                 {.shieldText = std::move(text), .shieldColorString = std::move(colours)})}));
    };
    EXPECT_EQ(name("M1", "DA291C,FFFFFF"), "[M1]");
    EXPECT_EQ(name("M1", std::nullopt), "[M1]");
    EXPECT_EQ(name(std::nullopt, "DA291C,FFFFFF"), "[]");
    EXPECT_EQ(name(std::nullopt, "red"), "");
    EXPECT_EQ(name("", std::nullopt), "");
    EXPECT_EQ(IconManager::_nameOfArtwork(*TransitArtworkDataSource::initWithFields({})), "");
}

TEST_F(ShieldTest, OfATextThatNoColumnHasRoomForTheBeginningIsDrawn) {
    const std::string forty(40, 'W');
    const auto whole = drawn(shield(forty.c_str()));
    const auto cut = drawn(shield((forty + "W").c_str()));
    EXPECT_GT(cut->size().width, whole->size().width); // an ellipsis follows
    const auto longest = drawn(shield(std::string(100'000, 'W').c_str()));
    EXPECT_EQ(longest->size().width, cut->size().width);
    EXPECT_TRUE(std::ranges::equal(longest->pixels(), cut->pixels()));
}

TEST_F(ShieldTest, ALongTextIsCutBetweenWholeCharacters) {
    const std::string before(39, 'W');
    const std::string flag = "\U0001F1E9\U0001F1EA"; // two code points, four units of UTF-16
    const auto cut = drawn(shield((before + flag + "W").c_str()));
    const auto expected = drawn(shield((before + "…").c_str()));
    EXPECT_TRUE(std::ranges::equal(cut->pixels(), expected->pixels()));
}

TEST_F(ShieldTest, ArtworkWithoutAShieldShowsItsFallbackOrText) {
    const auto fallback =
        TransitArtworkDataSource::initWithFields({.iconFallbackShieldDataSource = shield("F")});
    const auto text = TransitArtworkDataSource::initWithFields(
        {.textDataSource = TransitTextDataSource::initWithFields(
             {.text = ServerFormattedString::initWithFields({.alternativeString = "T"})})});
    EXPECT_TRUE(cache()->imageForArtwork_shieldSize_scale_nightMode(fallback, 7, 2, false));
    EXPECT_TRUE(cache()->imageForArtwork_shieldSize_scale_nightMode(text, 7, 2, false));
    EXPECT_FALSE(cache()->imageForArtwork_shieldSize_scale_nightMode(
        TransitArtworkDataSource::initWithFields({}), 7, 2, false));
}

TEST_F(ShieldTest, CacheDrawsEqualArtworkOnce) {
    const auto kept = cache();
    const auto first = kept->imageForArtwork_shieldSize_scale_nightMode(artwork("1"), 7, 2, false);
    EXPECT_EQ(kept->imageForArtwork_shieldSize_scale_nightMode(artwork("1"), 7, 2, false), first);
    EXPECT_EQ(kept->renderCount(), 1U);
    (void)kept->imageForArtwork_shieldSize_scale_nightMode(artwork("1"), 6, 2, false);
    (void)kept->imageForArtwork_shieldSize_scale_nightMode(artwork("1"), 7, 1, false);
    (void)kept->imageForArtwork_shieldSize_scale_nightMode(artwork("1"), 7, 2, true);
    (void)kept->imageForArtwork_shieldSize_scale_nightMode(artwork("2"), 7, 2, false);
    EXPECT_EQ(kept->renderCount(), 5U);
    kept->purge();
    EXPECT_EQ(kept->bytes(), 0U);
    (void)kept->imageForArtwork_shieldSize_scale_nightMode(artwork("1"), 7, 2, false);
    EXPECT_EQ(kept->renderCount(), 6U);
}

TEST_F(ShieldTest, ArtworkThatShowsNothingIsKeptAndHasItsPrice) {
    const auto kept = cache();
    const auto nothing = TransitArtworkDataSource::initWithFields({});
    for (int i = 0; i < 2; ++i)
        EXPECT_FALSE(kept->imageForArtwork_shieldSize_scale_nightMode(nothing, 7, 2, false));
    EXPECT_EQ(kept->renderCount(), 1U);
    EXPECT_GT(kept->bytes(), 0U);
}

TEST_F(ShieldTest, CacheStaysWithinItsBytesAndLetsTheOldestGo) {
    const auto kept = cache();
    for (int i = 0; i < 400; ++i)
        (void)kept->imageForArtwork_shieldSize_scale_nightMode(
            artwork(("Long name " + std::to_string(i)).c_str()), 7, 3, false);
    EXPECT_LE(kept->bytes(), ArtworkDataSourceCache::MaximumBytes);
    const auto renders = kept->renderCount();
    (void)kept->imageForArtwork_shieldSize_scale_nightMode(artwork("Long name 399"), 7, 3, false);
    EXPECT_EQ(kept->renderCount(), renders);
    (void)kept->imageForArtwork_shieldSize_scale_nightMode(artwork("Long name 0"), 7, 3, false);
    EXPECT_EQ(kept->renderCount(), renders + 1);
}

TEST(SizedTransitArtwork, EqualsByArtworkSizeAndTheSameCache) {
    const auto shieldArtwork = [](const char* text) {
        return TransitArtworkDataSource::initWithFields(
            {.shieldDataSource = TransitShieldDataSource::initWithFields({.shieldText = text})});
    };
    const auto kept = ArtworkDataSourceCache::initWithArtworkManager(nullptr);
    const auto make = [&](const char* text,
                          std::int64_t size,
                          const std::shared_ptr<ArtworkDataSourceCache>& with) {
        return SizedTransitArtwork::initWithArtwork_shieldSize_artworkCache(
            shieldArtwork(text), size, with);
    };
    EXPECT_TRUE(equal(make("1", 7, kept), make("1", 7, kept)));
    EXPECT_EQ(make("1", 7, kept)->hash(), make("1", 7, kept)->hash());
    EXPECT_FALSE(equal(make("1", 7, kept), make("2", 7, kept)));
    EXPECT_FALSE(equal(make("1", 7, kept), make("1", 6, kept)));
    EXPECT_FALSE(equal(make("1", 7, kept),
                       make("1", 7, ArtworkDataSourceCache::initWithArtworkManager(nullptr))));
    EXPECT_TRUE(
        equal(SizedTransitArtwork::initWithArtwork_shieldSize_artworkCache(nullptr, 7, nullptr),
              SizedTransitArtwork::initWithArtwork_shieldSize_artworkCache(nullptr, 7, nullptr)));
}

} // namespace
} // namespace orvo
