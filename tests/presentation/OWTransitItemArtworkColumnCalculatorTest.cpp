#include "presentation/OWTransitItemArtworkColumnCalculator.h"

#include "presentation/ArtworkColumn.h"

#include <gtest/gtest.h>

#include <string>
#include <vector>

namespace orvo {
namespace {

using testing::sizedArtwork;
using testing::WidthsCache;

std::shared_ptr<OWTransitItem>
item(const std::string& text, const std::shared_ptr<ArtworkImageSource>& source, double alpha = 1) {
    return OWTransitItem::initWithPrimaryText_secondaryText_artwork_artworkHidden_openable(
        text,
        std::nullopt,
        source ? OWConfiguredArtwork::initWithArtworkSource_alpha(source, alpha) : nullptr,
        false,
        nullptr);
}

class OWTransitItemArtworkColumnCalculatorTest : public ::testing::Test {
protected:
    std::shared_ptr<ArtworkImageSource> shield(const char* text, std::int64_t size = 7) {
        return sizedArtwork(text, size, cache);
    }
    std::shared_ptr<NSArray> adjusted(const std::shared_ptr<NSArray>& items,
                                      bool withBlock = true) {
        const auto block = [this](const auto& old, const auto& artwork) {
            called.push_back(*old->primaryText());
            return keepsItems ? nullptr : item(*old->primaryText() + "'", artwork);
        };
        return calculator->itemsFromItems_sizeParameter_outArtworkColumnWidth_downSizingBlock(
            items,
            {5, 60, {}},
            &width,
            withBlock ? OWTransitItemArtworkColumnCalculator::DownSizingBlock(block) : nullptr);
    }
    static std::vector<std::string> texts(const std::shared_ptr<NSArray>& items) {
        std::vector<std::string> texts;
        for (const auto& one : typed<OWTransitItem>(items))
            texts.push_back(*one->primaryText());
        return texts;
    }
    using Texts = std::vector<std::string>;

    std::shared_ptr<WidthsCache> cache = std::make_shared<WidthsCache>();
    std::shared_ptr<OWTransitItemArtworkColumnCalculator> calculator =
        OWTransitItemArtworkColumnCalculator::init();
    double width = -1;
    bool keepsItems = false;
    Texts called;
};

TEST_F(OWTransitItemArtworkColumnCalculatorTest, NoItemsGiveTheDefaultWidth) {
    const auto items = NSArray::array();
    EXPECT_EQ(adjusted(items), items);
    EXPECT_EQ(width, 5);
}

TEST_F(OWTransitItemArtworkColumnCalculatorTest, RowsWithoutAShieldStayAsTheyAre) {
    const auto items =
        NSArray::arrayOf({item("image", UIImage::imageNamed("good-v2")), item("none", nullptr)});
    EXPECT_EQ(adjusted(items), items);
    EXPECT_EQ(width, 5);
    EXPECT_EQ(cache->images, 0);
}

TEST_F(OWTransitItemArtworkColumnCalculatorTest, WithoutReplacementsTheInputItselfComesBack) {
    const auto items = NSArray::arrayOf({item("a", shield("a", 3)), item("b", shield("b", 4))});
    EXPECT_EQ(adjusted(items), items);
    EXPECT_EQ(width, 40);
    EXPECT_EQ(called, Texts{});
}

TEST_F(OWTransitItemArtworkColumnCalculatorTest, OnlyTooWideRowsAreMadeAgainInTheirPlaces) {
    const auto items = NSArray::arrayOf({item("a", shield("a", 3)),
                                         item("image", UIImage::imageNamed("good-v2")),
                                         item("b", shield("b")),
                                         item("c", shield("c", 6)),
                                         item("d", shield("d"))});
    const auto result = adjusted(items);
    EXPECT_EQ(texts(result), (Texts{"a", "image", "b'", "c", "d'"}));
    EXPECT_EQ(width, 60);
    const auto artwork = std::dynamic_pointer_cast<SizedTransitArtwork>(
        typed<OWTransitItem>(result)[2]->artwork()->artworkSource());
    EXPECT_EQ(artwork->shieldSize(), 6);
}

TEST_F(OWTransitItemArtworkColumnCalculatorTest, ANilAnswerKeepsTheItem) {
    keepsItems = true;
    EXPECT_EQ(texts(adjusted(NSArray::arrayOf({item("a", shield("a"))}))), Texts{"a"});
    EXPECT_EQ(called, Texts{"a"});
    EXPECT_EQ(width, 60);
}

TEST_F(OWTransitItemArtworkColumnCalculatorTest, WithoutABlockItemsAreKept) {
    EXPECT_EQ(texts(adjusted(NSArray::arrayOf({item("a", shield("a"))}), false)), Texts{"a"});
    EXPECT_EQ(width, 60);
}

TEST_F(OWTransitItemArtworkColumnCalculatorTest, OfTwoEqualArtworksOnlyTheLaterRowIsReplaced) {
    const auto items = NSArray::arrayOf({item("first", shield("a")), item("second", shield("a"))});
    EXPECT_EQ(texts(adjusted(items)), (Texts{"first", "second'"}));
}

TEST_F(OWTransitItemArtworkColumnCalculatorTest,
       ARowWhoseShieldNeverFitsIsStillThereInItsSmallestForm) {
    for (std::int64_t size = 0; size <= 7; ++size)
        cache->widths[{"huge", size}] = 500;
    const auto result =
        adjusted(NSArray::arrayOf({item("huge", shield("huge")), item("a", shield("a", 2))}));
    EXPECT_EQ(texts(result), (Texts{"huge'", "a"}));
    EXPECT_EQ(width, 20);
}

TEST_F(OWTransitItemArtworkColumnCalculatorTest, EqualItemsAreNotLookedAtAgain) {
    const auto first = adjusted(NSArray::arrayOf({item("a", shield("a"))}));
    const int images = cache->images;
    width = -1;
    EXPECT_EQ(adjusted(NSArray::arrayOf({item("a", shield("a"))})), first);
    EXPECT_EQ(width, 60);
    EXPECT_EQ(called, Texts{"a"});
    EXPECT_EQ(cache->images, images);
}

TEST_F(OWTransitItemArtworkColumnCalculatorTest, TheParameterIsComparedAsItWasGiven) {
    const auto items = NSArray::arrayOf({item("a", shield("a"))});
    const auto calls = [&](ArtworkWidthCalculatorSizeParameter parameter) {
        int count = 0;
        (void)calculator->itemsFromItems_sizeParameter_outArtworkColumnWidth_downSizingBlock(
            items, parameter, nullptr, [&](const auto&, const auto&) {
                ++count;
                return nullptr;
            });
        return count;
    };
    EXPECT_EQ(calls({-1, 10, {}}), 1);
    EXPECT_EQ(calls({-1, 10, {}}), 0);
    EXPECT_EQ(calls({50, 50, {}}), 1); // what it was normalised to
    EXPECT_EQ(calls({50, 50, {1, 0, 0, 0}}), 1);
}

TEST_F(OWTransitItemArtworkColumnCalculatorTest, EachNumberOfTheParameterCounts) {
    const auto items = NSArray::arrayOf({item("a", shield("a"))});
    const ArtworkWidthCalculatorSizeParameter usual{5, 60, {1, 2, 3, 4}};
    const auto looks = [&](const ArtworkWidthCalculatorSizeParameter& parameter) {
        const int before = cache->images;
        (void)calculator->itemsFromItems_sizeParameter_outArtworkColumnWidth_downSizingBlock(
            items, parameter, nullptr, nullptr);
        return cache->images > before;
    };
    using Parameter = ArtworkWidthCalculatorSizeParameter;
    for (const auto& other : {Parameter{5.5, 60, {1, 2, 3, 4}},
                              Parameter{5, 60.5, {1, 2, 3, 4}},
                              Parameter{5, 60, {1.5, 2, 3, 4}},
                              Parameter{5, 60, {1, 2.5, 3, 4}},
                              Parameter{5, 60, {1, 2, 3.5, 4}},
                              Parameter{5, 60, {1, 2, 3, 4.5}}}) {
        EXPECT_TRUE(looks(usual));
        EXPECT_FALSE(looks(usual));
        EXPECT_TRUE(looks(other));
    }
}

TEST_F(OWTransitItemArtworkColumnCalculatorTest, AFreshCalculatorAlwaysCalculates) {
    width = -1;
    const auto items = NSArray::array();
    EXPECT_EQ(calculator->itemsFromItems_sizeParameter_outArtworkColumnWidth_downSizingBlock(
                  items, {}, &width, nullptr),
              items);
    EXPECT_EQ(width, 0);
    EXPECT_EQ(calculator->cachedOriginalItems(), items);
}

TEST_F(OWTransitItemArtworkColumnCalculatorTest, OnlyTheLastAnswerIsKept) {
    const auto a = NSArray::arrayOf({item("a", shield("a"))});
    const auto b = NSArray::arrayOf({item("b", shield("b"))});
    (void)adjusted(a);
    (void)adjusted(b);
    (void)adjusted(a);
    EXPECT_EQ(called, (Texts{"a", "b", "a"}));
}

} // namespace
} // namespace orvo
