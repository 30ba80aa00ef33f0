#include "platform/mapuikit/ArtworkImageView.h"

#include "KitViewTest.h"
#include "platform/mapuikit/SizedTransitArtwork.h"
#include "platform/uikit/UIVisualEffectView.h"

namespace orvo {
namespace {

using Strings = std::vector<std::string>;

class ArtworkImageViewTest : public testing::KitViewTest {
protected:
    ArtworkImageViewTest() {
        constrained(view, card, "artwork");
        place(view, 10, 10);
    }
    std::shared_ptr<SizedTransitArtwork> artwork(const std::string& text, std::int64_t size = 3) {
        return SizedTransitArtwork::initWithArtwork_shieldSize_artworkCache(
            testing::shieldArtwork(text), size, cache);
    }

    std::shared_ptr<UIView> card = root(100, 60);
    std::shared_ptr<ArtworkImageView> view = ArtworkImageView::init();
};

TEST_F(ArtworkImageViewTest, IsAsLargeAsItsArtwork) {
    view->setImageSource(artwork("12"));
    card->layoutIfNeeded();
    EXPECT_EQ(view->frame(), (CGRect{{10, 10}, {30, 20}}));
    view->setImageSource(artwork("1", 0));
    card->layoutIfNeeded();
    EXPECT_EQ(view->frame().size, (CGSize{20, 14}));
}

TEST_F(ArtworkImageViewTest, DumpsNameWhatItShows) {
    const auto dumped = [this](const std::shared_ptr<ArtworkImageSource>& source) {
        view->setImageSource(source);
        card->layoutIfNeeded();
        const auto tree = dumpViews(*card);
        return tree.substr(tree.find("artwork"));
    };
    EXPECT_EQ(dumped(artwork("12")), "artwork 10 10 30 20 [12]\n");
    EXPECT_EQ(dumped(UIImage::imageNamed("good-v2")), "artwork 10 10 24 24 good-v2\n");
    EXPECT_EQ(
        dumped(SizedTransitArtwork::initWithArtwork_shieldSize_artworkCache(nullptr, 3, nullptr)),
        "artwork 10 10 0 0\n");
}

TEST_F(ArtworkImageViewTest, WithoutASourceShowsNothing) {
    EXPECT_EQ(view->intrinsicContentSize(),
              (CGSize{UIViewNoIntrinsicMetric, UIViewNoIntrinsicMetric}));
    EXPECT_TRUE(draw(card).empty());
    view->setImageSource(artwork("1"));
    draw(card);
    view->setImageSource(nullptr);
    EXPECT_EQ(view->imageSource(), nullptr);
    EXPECT_TRUE(draw(card).empty());
}

TEST_F(ArtworkImageViewTest, DrawsThePictureForItsScaleAndTimeOfDay) {
    card->setTraitCollection(
        UITraitCollection{.userInterfaceStyle = UIUserInterfaceStyle::Dark, .displayScale = 2});
    view->setImageSource(artwork("1"));
    EXPECT_EQ(draw(card, 2), (Strings{"pixels 40x40 at 10 10 20 20"}));
    EXPECT_EQ(cache->asked.back(), "1 3 night");
}

TEST_F(ArtworkImageViewTest, AlphaFadesIt) {
    view->setImageSource(artwork("1"));
    view->setAlpha(0.5);
    EXPECT_EQ(draw(card), (Strings{"fade 0.5", "pixels 20x20 at 10 10 20 20"}));
    view->setAlpha(0);
    EXPECT_TRUE(draw(card).empty());
}

TEST_F(ArtworkImageViewTest, InsideVibrancyItTakesThatColour) {
    const auto effect =
        UIVisualEffectView::initWithEffect(UIVibrancyEffect::widgetEffectForVibrancyStyle(102));
    constrained(effect, card, "effect");
    place(effect, 0, 0);
    size(effect, 50, 50);
    view->removeFromSuperview();
    effect->contentView()->addSubview(view);
    place(view, 0, 0);
    view->setImageSource(artwork("1"));
    EXPECT_EQ(draw(card), (Strings{"pixels 20x20 5B5B63 at 0 0 20 20"}));
}

TEST_F(ArtworkImageViewTest, FixedImagesAreSourcesToo) {
    view->setImageSource(UIImage::imageNamed("WidgetGenericTransit"));
    EXPECT_EQ(draw(card), (Strings{"image WidgetGenericTransit 17171A at 10 10 24 24"}));
}

TEST_F(ArtworkImageViewTest, EqualSourceChangesNothing) {
    view->setImageSource(artwork("1"));
    draw(card);
    const auto renders = view->_renders();
    const auto same = artwork("1");
    view->setImageSource(same);
    card->layoutIfNeeded();
    EXPECT_FALSE(card->_needsDisplay());
    EXPECT_EQ(view->_renders(), renders);
    EXPECT_EQ(view->imageSource(), same);
}

TEST_F(ArtworkImageViewTest, UnchangedItIsMeasuredOnceAndKeepsNoPicture) {
    view->setImageSource(artwork("1"));
    card->layoutIfNeeded();
    EXPECT_EQ(view->_renders(), 1U);
    card->setNeedsLayout();
    child(card, "another");
    card->layoutIfNeeded();
    EXPECT_EQ(view->_renders(), 1U);
    draw(card);
    draw(card);
    EXPECT_EQ(view->_renders(), 3U);
    EXPECT_EQ(cache->asked.size(), 3U);
}

TEST_F(ArtworkImageViewTest, AnotherScaleMeasuresAgain) {
    view->setImageSource(artwork("1"));
    card->layoutIfNeeded();
    card->setTraitCollection(UITraitCollection{.displayScale = 3});
    card->layoutIfNeeded();
    EXPECT_EQ(view->_renders(), 2U);
}

} // namespace
} // namespace orvo
