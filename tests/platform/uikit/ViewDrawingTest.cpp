#include "platform/uikit/ViewDrawing.h"

#include "ViewTest.h"
#include "platform/uikit/UIColor.h"
#include "platform/uikit/UIImage.h"
#include "platform/uikit/UIImageDrawing.h"
#include "platform/uikit/UIImageView.h"
#include "platform/uikit/UIVisualEffectView.h"
#include "platform/uikit/drawing/FixedImagePainter.h"
#include "support/RecordingCanvas.h"

#include <algorithm>
#include <cmath>

namespace orvo {
namespace {

class DrawingTest : public testing::ViewTest {
protected:
    using Lines = std::vector<std::string>;
    static Lines draw(const std::shared_ptr<UIView>& view) {
        view->layoutIfNeeded();
        testing::RecordingCanvas canvas(2);
        drawViewHierarchy(*view, canvas);
        return canvas.drawn;
    }
};

TEST_F(DrawingTest, BackgroundThenContentThenSubviewsInOrder) {
    const auto card = root(100, 50);
    card->setBackgroundColor(UIColor::cardColor());
    card->setCornerRadius(14);
    const auto text = label(card, "text", "hello");
    place(text, 10, 20);
    EXPECT_EQ(
        draw(card),
        (Lines{"fill F4F4F6 radius 14 at 0 0 100 50", "text \"hello\" 17171A at 10 28 25 0"}));
}

TEST_F(DrawingTest, HiddenAndTransparentViewsAreLeftOut) {
    const auto card = root(100, 50);
    const auto hidden = label(card, "hidden", "hidden");
    const auto clear = label(card, "clear", "clear");
    const auto faint = label(card, "faint", "faint");
    place(hidden, 0, 0);
    place(clear, 0, 0);
    place(faint, 0, 0);
    hidden->setHidden(true);
    clear->setAlpha(0);
    faint->setAlpha(0.5);
    EXPECT_EQ(draw(card), (Lines{"fade 0.5", "text \"faint\" 17171A at 0 8 25 0"}));
}

TEST_F(DrawingTest, ScrolledAndClippedContent) {
    const auto scroller = root(100, 50);
    scroller->setClipsToBounds(true);
    const auto text = label(nullptr, "text", "hello");
    text->setTranslatesAutoresizingMaskIntoConstraints(true);
    text->setFrame({{0, 60}, {100, 10}});
    scroller->addSubview(text);
    scroller->setBounds({{0, 40}, {100, 50}});
    EXPECT_EQ(draw(scroller), (Lines{"clip at 0 0 100 50", "text \"hello\" 17171A at 0 28 25 0"}));
}

TEST_F(DrawingTest, AlignmentFollowsTheDirectionOfReading) {
    const auto drawn = [](NSTextAlignment alignment, UIUserInterfaceLayoutDirection direction) {
        const auto card = root(100, 10);
        card->setTraitCollection(UITraitCollection{.layoutDirection = direction});
        const auto text = label(card, "text", "hello");
        text->setTextAlignment(alignment);
        pin(text, card);
        return draw(card).front();
    };
    using enum UIUserInterfaceLayoutDirection;
    EXPECT_EQ(drawn(NSTextAlignment::Natural, LeftToRight), "text \"hello\" 17171A at 0 8 25 0");
    EXPECT_EQ(drawn(NSTextAlignment::Natural, RightToLeft), "text \"hello\" 17171A at 75 8 25 0");
    EXPECT_EQ(drawn(NSTextAlignment::Left, RightToLeft), "text \"hello\" 17171A at 0 8 25 0");
    EXPECT_EQ(drawn(NSTextAlignment::Center, LeftToRight), "text \"hello\" 17171A at 37.5 8 25 0");
    EXPECT_EQ(drawn(NSTextAlignment::Right, LeftToRight), "text \"hello\" 17171A at 75 8 25 0");
}

TEST_F(DrawingTest, VibrancyGivesTextsAndImagesItsColour) {
    const auto effect =
        UIVisualEffectView::initWithEffect(UIVibrancyEffect::widgetEffectForVibrancyStyle(102));
    effect->setFrame({{0, 0}, {100, 24}});
    const auto text = label(effect->contentView(), "text", "a");
    text->setTextColor(UIColor::advisoryColor());
    place(text, 0, 0);
    const auto fixed = constrained(
        UIImageView::initWithImage(UIImage::imageNamed("good-v2")), effect->contentView(), "fixed");
    place(fixed, 20, 0);
    const auto pixels = constrained(
        UIImageView::initWithImage(UIImage::imageWithPixels_size_scale({1, 2, 3, 4}, {1, 1}, 2)),
        effect->contentView(),
        "pixels");
    place(pixels, 50, 0);
    EXPECT_EQ(draw(effect),
              (Lines{"text \"a\" 5B5B63 at 0 8 5 0",
                     "image good-v2 5B5B63 at 20 0 24 24",
                     "pixels 2x2 5B5B63 at 50 0 1 1"}));
}

/// Relative luminance of a colour over a ground, as it is defined for contrast.
double luminance(RGBA color, RGBA ground, double alpha) {
    const auto linear = [alpha](int over, int under) {
        const double part = (under + (over - under) * alpha) / 255;
        return part <= 0.04045 ? part / 12.92 : std::pow((part + 0.055) / 1.055, 2.4);
    };
    return 0.2126 * linear(color.red, ground.red) + 0.7152 * linear(color.green, ground.green) +
           0.0722 * linear(color.blue, ground.blue);
}

TEST_F(DrawingTest, ADimmedMarkCanBeToldFromTheCardInEveryLook) {
    const auto effect =
        UIVisualEffectView::initWithEffect(UIVibrancyEffect::widgetEffectForVibrancyStyle(102));
    effect->setFrame({{0, 0}, {24, 24}});
    const auto mark = constrained(
        UIImageView::initWithImage(UIImage::imageNamed("good-alt-v2")), effect->contentView(), "m");
    pin(mark, effect);
    mark->setAlpha(0.3F);
    const double shown = std::stod(draw(effect).front().substr(std::string("fade ").size()));
    EXPECT_LT(shown, 0.8) << "it is dimmed still";
    for (const auto style : {UIUserInterfaceStyle::Light, UIUserInterfaceStyle::Dark})
        for (const auto contrast :
             {UIAccessibilityContrast::Normal, UIAccessibilityContrast::High}) {
            const UITraitCollection traits{.userInterfaceStyle = style,
                                           .accessibilityContrast = contrast};
            const auto ink =
                UIColor::secondaryLabelColor()->resolvedColorWithTraitCollection(traits);
            const auto card = UIColor::cardColor()->resolvedColorWithTraitCollection(traits);
            const auto [darker, lighter] =
                std::minmax({luminance(ink, card, shown), luminance(ink, card, 0)});
            EXPECT_GE((lighter + 0.05) / (darker + 0.05), 3);
        }
}

TEST_F(DrawingTest, VibrancyFadesToNothingAndFromTheWhole) {
    const auto effect =
        UIVisualEffectView::initWithEffect(UIVibrancyEffect::widgetEffectForVibrancyStyle(102));
    effect->setFrame({{0, 0}, {100, 24}});
    const auto text = label(effect->contentView(), "text", "a");
    place(text, 0, 0);
    const auto faded = [&](double alpha) {
        text->setAlpha(alpha);
        return draw(effect);
    };
    EXPECT_EQ(faded(0), Lines());
    EXPECT_EQ(faded(1), Lines{"text \"a\" 5B5B63 at 0 8 5 0"});
    double last = 0;
    for (const double alpha : {0.01, 0.2, 0.5, 0.9}) {
        const double shown = std::stod(faded(alpha).front().substr(std::string("fade ").size()));
        EXPECT_GT(shown, last);
        EXPECT_LT(shown, 1);
        last = shown;
    }
}

TEST_F(DrawingTest, OutsideVibrancyImagesHaveTheirOwnColourOrTheTint) {
    const auto drawn = [](const char* name) {
        const auto view = UIImageView::initWithImage(UIImage::imageNamed(name));
        view->setFrame({{0, 0}, {24, 24}});
        view->setTintColor(UIColor::advisoryColor());
        return draw(view).front();
    };
    EXPECT_EQ(drawn("good-v2"), "image good-v2 1B7F3B at 0 0 24 24");
    EXPECT_EQ(drawn("advisories-v2"), "image advisories-v2 A34A00 at 0 0 24 24");
}

TEST_F(DrawingTest, AFixedImageSaysWhatIsEmptyAroundIt) {
    constexpr int Side = 240;
    for (const char* name : {"good-v2", "good-alt-v2", "advisories-v2", "WidgetGenericTransit"}) {
        const auto pixels = FixedImagePainter::draw(name, Side, RGBA::fromHex(0x000000));
        CGFloat left = Side;
        CGFloat top = Side;
        CGFloat right = Side;
        CGFloat bottom = Side;
        for (int row = 0; row < Side; ++row)
            for (int column = 0; column < Side; ++column)
                if (pixels[static_cast<std::size_t>(row * Side + column)] != 0) {
                    left = std::min<CGFloat>(left, column);
                    top = std::min<CGFloat>(top, row);
                    right = std::min<CGFloat>(right, Side - 1 - column);
                    bottom = std::min<CGFloat>(bottom, Side - 1 - row);
                }
        const auto& said = UIImage::imageNamed(name)->alignmentRectInsets();
        constexpr double ATenth = 0.15;
        EXPECT_NEAR(said.left, left / 10, ATenth) << name;
        EXPECT_NEAR(said.top, top / 10, ATenth) << name;
        EXPECT_NEAR(said.right, right / 10, ATenth) << name;
        EXPECT_NEAR(said.bottom, bottom / 10, ATenth) << name;
    }
    EXPECT_EQ(UIImage::imageWithPixels_size_scale({1}, {1, 1}, 1)->alignmentRectInsets(),
              UIEdgeInsets());
}

TEST_F(DrawingTest, ImagesShrinkIntoTheirViewButNeverGrow) {
    EXPECT_EQ(UIImageDrawing::placeIn({{0, 0}, {100, 100}}, {24, 24}, 1),
              (CGRect{{38, 38}, {24, 24}}));
    EXPECT_EQ(UIImageDrawing::placeIn({{0, 0}, {12, 100}}, {24, 24}, 1),
              (CGRect{{0, 44}, {12, 12}}));
    EXPECT_EQ(UIImageDrawing::placeIn({{0, 0}, {25, 24}}, {24, 24}, 2),
              (CGRect{{0.5, 0}, {24, 24}}));
    EXPECT_EQ(UIImageDrawing::placeIn({{1, 2}, {25, 24}}, {0, 24}, 2), (CGRect{{1, 2}, {0, 0}}));
}

TEST_F(DrawingTest, WhatChangedAsksToBeDrawnUpToTheRoot) {
    const auto card = root(100, 50);
    const auto text = label(child(card, "box"), "text", "a");
    draw(card);
    EXPECT_FALSE(card->_needsDisplay());
    text->setText("a");
    text->setAlpha(1);
    EXPECT_FALSE(card->_needsDisplay());
    text->setText("b");
    EXPECT_TRUE(card->_needsDisplay());
    draw(card);
    text->setHidden(true);
    EXPECT_TRUE(card->_needsDisplay());
}

TEST_F(DrawingTest, SnapshotHasThePixelsOfItsScale) {
    const auto card = root(10, 5);
    card->setBackgroundColor(UIColor::colorWithRGBA({255, 0, 0, 255}));
    const auto image = snapshotOf(*card, 3);
    EXPECT_EQ(image->size(), (CGSize{10, 5}));
    EXPECT_EQ(image->scale(), 3);
    ASSERT_EQ(image->pixels().size(), 450U);
    EXPECT_EQ(image->pixels().front(), 0xFFFF0000);
    EXPECT_EQ(image->pixels().back(), 0xFFFF0000);
}

} // namespace
} // namespace orvo
