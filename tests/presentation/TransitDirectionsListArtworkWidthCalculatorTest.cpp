#include "presentation/TransitDirectionsListArtworkWidthCalculator.h"

#include "platform/uikit/UITraitCollection.h"
#include "presentation/ArtworkColumn.h"

#include <gtest/gtest.h>

#include <initializer_list>
#include <set>
#include <string>
#include <vector>

namespace orvo {
namespace {

using testing::sizedArtwork;
using testing::WidthsCache;
using Calculator = TransitDirectionsListArtworkWidthCalculator;

ArtworkWidthCalculatorSizeParameter limits(double least, double most, UIEdgeInsets insets = {}) {
    return {least, most, insets};
}

class TransitDirectionsListArtworkWidthCalculatorTest : public ::testing::Test {
protected:
    using Artwork = std::shared_ptr<SizedTransitArtwork>;

    Artwork artwork(const char* text, std::int64_t size = 7) {
        return sizedArtwork(text, size, cache);
    }
    /// Says the widths of a shield from size 0 on.
    void say(const char* text, std::initializer_list<double> widths) {
        std::int64_t size = 0;
        for (const double width : widths)
            cache->widths[{text, size++}] = width;
    }
    double width(std::vector<Artwork> artworks, ArtworkWidthCalculatorSizeParameter parameter) {
        double found = -1;
        replacements =
            Calculator::initWithSizedArtworks_sizeParameter(NSArray::arrayOf(artworks), parameter)
                ->calculateArtworkViewWidthAndArtworkSizes(&found);
        return found;
    }
    /// The size of the smaller form; -1 where there is none.
    std::int64_t sizeOf(const Artwork& initial) const {
        const auto form =
            std::dynamic_pointer_cast<SizedTransitArtwork>(replacements->objectForKey(initial));
        return form ? form->shieldSize() : -1;
    }
    /// The smaller forms in the order in which they were tried.
    std::vector<std::string> shrinking() const {
        auto forms = cache->forms;
        std::erase_if(forms, [](const std::string& form) { return form.ends_with('7'); });
        return forms;
    }
    static ArtworkWidthCalculatorSizeParameter normalised(double least, double most) {
        return Calculator::initWithSizedArtworks_sizeParameter(NSArray::array(),
                                                               limits(least, most))
            ->sizeParameter();
    }

    std::shared_ptr<WidthsCache> cache = std::make_shared<WidthsCache>();
    std::shared_ptr<NSMapTable> replacements;
};

TEST_F(TransitDirectionsListArtworkWidthCalculatorTest, LimitsInOrderAreKept) {
    EXPECT_EQ(normalised(20, 60), limits(20, 60));
    EXPECT_EQ(normalised(20, 20), limits(20, 20));
}

TEST_F(TransitDirectionsListArtworkWidthCalculatorTest, ANegativeDefaultBecomesFifty) {
    EXPECT_EQ(normalised(-1, 10), limits(50, 50));
    EXPECT_EQ(normalised(-1, 60), limits(50, 60));
}

TEST_F(TransitDirectionsListArtworkWidthCalculatorTest, ADefaultOfZeroStays) {
    EXPECT_EQ(normalised(0, -5), limits(0, 0));
    EXPECT_EQ(normalised(0, 5), limits(0, 5));
}

TEST_F(TransitDirectionsListArtworkWidthCalculatorTest, AMaximumBelowTheDefaultIsRaised) {
    EXPECT_EQ(normalised(70, 60), limits(70, 70));
}

TEST_F(TransitDirectionsListArtworkWidthCalculatorTest, WithoutArtworksTheWidthIsTheDefault) {
    EXPECT_EQ(width({}, limits(73, 100)), 73);
    EXPECT_EQ(replacements->count(), 0U);
}

TEST_F(TransitDirectionsListArtworkWidthCalculatorTest, TheWidestWithItsInsetsIsTheWidth) {
    say("a", {0, 0, 0, 0, 0, 0, 0, 30});
    const UIEdgeInsets insets{100, 4, 100, 4};
    EXPECT_EQ(width({artwork("a")}, limits(20, 60, insets)), 38);
    EXPECT_EQ(width({artwork("a")}, limits(40, 60, insets)), 40);
    EXPECT_EQ(width({artwork("a")}, limits(38, 60, insets)), 38);
    EXPECT_EQ(replacements->count(), 0U);
    EXPECT_FALSE(cache->askedForNight);
}

TEST_F(TransitDirectionsListArtworkWidthCalculatorTest, ShieldsAreMeasuredForTheMainScreenByDay) {
    const auto traits = UITraitCollection::system().overrideWith(
        {.userInterfaceStyle = UIUserInterfaceStyle::Dark, .displayScale = 3});
    (void)width({artwork("a")}, limits(20, 60));
    EXPECT_EQ(cache->scales, std::set<double>{3});
    EXPECT_FALSE(cache->askedForNight);
}

TEST_F(TransitDirectionsListArtworkWidthCalculatorTest, InsetsDoNotCountForWhichIsWidest) {
    say("a", {0, 0, 0, 0, 0, 0, 0, 30});
    say("b", {0, 0, 0, 0, 0, 0, 0, 20});
    EXPECT_EQ(width({artwork("a"), artwork("b")}, limits(5, 60, {0, -10, 0, -10})), 10);
    EXPECT_EQ(replacements->count(), 0U);
}

TEST_F(TransitDirectionsListArtworkWidthCalculatorTest, OfEquallyWideShieldsTheLaterShrinksFirst) {
    say("a", {10, 10, 10, 10, 10, 10, 60, 80});
    say("b", {10, 10, 10, 10, 10, 10, 75, 80});
    const auto a = artwork("a");
    const auto b = artwork("b");
    EXPECT_EQ(width({a, b}, limits(20, 70)), 60);
    EXPECT_EQ(shrinking(), (std::vector<std::string>{"b6", "a6", "b5"}));
}

TEST_F(TransitDirectionsListArtworkWidthCalculatorTest,
       OfManyEquallyWideShieldsTheLastShrinksFirst) {
    std::vector<Artwork> artworks;
    std::vector<std::string> fromTheLast;
    for (int number = 10; number < 40; ++number) {
        const auto text = "s" + std::to_string(number);
        cache->widths[{text, 7}] = 80;
        cache->widths[{text, 6}] = 60;
        artworks.push_back(artwork(text.c_str()));
        fromTheLast.insert(fromTheLast.begin(), text + "6");
    }
    EXPECT_EQ(width(artworks, limits(20, 70)), 60);
    EXPECT_EQ(shrinking(), fromTheLast);
}

TEST_F(TransitDirectionsListArtworkWidthCalculatorTest, ATooWideShieldShrinksSizeBySize) {
    const auto a = artwork("a"); // 70 points at size 7
    EXPECT_EQ(width({a}, limits(20, 45)), 40);
    EXPECT_EQ(sizeOf(a), 4);
    const auto form = std::dynamic_pointer_cast<SizedTransitArtwork>(replacements->objectForKey(a));
    EXPECT_EQ(form->artwork(), a->artwork());
    EXPECT_EQ(form->artworkCache(), a->artworkCache());
    EXPECT_EQ(a->shieldSize(), 7);
}

TEST_F(TransitDirectionsListArtworkWidthCalculatorTest, EachStepTakesWhatIsWidestNow) {
    say("a", {10, 10, 10, 10, 10, 60, 80, 90});
    say("b", {10, 10, 10, 10, 10, 50, 70, 85});
    const auto a = artwork("a");
    const auto b = artwork("b");
    EXPECT_EQ(width({a, b}, limits(20, 75)), 70); // a: 90, 80, 60; b: 85, 70
    EXPECT_EQ(shrinking(), (std::vector<std::string>{"a6", "b6", "a5"}));
    EXPECT_EQ(sizeOf(a), 5);
    EXPECT_EQ(sizeOf(b), 6);
}

TEST_F(TransitDirectionsListArtworkWidthCalculatorTest, OnlyShrunkenArtworksAreInTheMap) {
    const auto narrow = artwork("n", 2);
    const auto wide = artwork("w");
    EXPECT_EQ(width({wide, narrow}, limits(5, 60)), 60);
    EXPECT_EQ(replacements->count(), 1U);
    EXPECT_EQ(sizeOf(narrow), -1);
    EXPECT_EQ(replacements->allKeys()->objectAtIndex(0), wide);
}

TEST_F(TransitDirectionsListArtworkWidthCalculatorTest, SizeOneStillShrinksToZero) {
    say("a", {12, 90});
    const auto a = artwork("a", 1);
    EXPECT_EQ(width({a}, limits(5, 20)), 12);
    EXPECT_EQ(sizeOf(a), 0);
}

TEST_F(TransitDirectionsListArtworkWidthCalculatorTest, WhatIsTooWideAtSizeZeroDoesNotCount) {
    say("huge", {500});
    const auto huge = artwork("huge", 0);
    EXPECT_EQ(width({artwork("a", 3), huge}, limits(5, 60)), 30);
    EXPECT_EQ(sizeOf(huge), -1);
}

TEST_F(TransitDirectionsListArtworkWidthCalculatorTest,
       AShieldTooWideInEverySizeKeepsItsSmallestForm) {
    say("huge", {500, 600, 700});
    const auto huge = artwork("huge", 2);
    EXPECT_EQ(width({artwork("a", 3), huge}, limits(5, 60)), 30);
    EXPECT_EQ(sizeOf(huge), 0);
}

TEST_F(TransitDirectionsListArtworkWidthCalculatorTest, WhenNoneFitsTheWidthIsTheDefault) {
    say("huge", {500});
    EXPECT_EQ(width({artwork("huge", 0)}, limits(7, 60)), 7);
}

TEST_F(TransitDirectionsListArtworkWidthCalculatorTest, TheWidthNeedNotBeAskedFor) {
    EXPECT_EQ(Calculator::initWithSizedArtworks_sizeParameter(NSArray::arrayOf({artwork("a")}),
                                                              limits(5, 60))
                  ->calculateArtworkViewWidthAndArtworkSizes(nullptr)
                  ->count(),
              1U);
}

} // namespace
} // namespace orvo
