#include "platform/extension/WidgetCard.h"

#include "platform/extension/ScriptedWidget.h"
#include "platform/foundation/NSBundle.h"
#include "platform/foundation/Text.h"
#include "support/FixedTextMeasurer.h"
#include "support/RecordingCanvas.h"

#include <gtest/gtest.h>

namespace orvo {
namespace {

using testing::Mode;

class WidgetCardTest : public ::testing::Test, protected testing::HostWorld {
protected:
    std::shared_ptr<WidgetCard> shownCard(bool offersButton = true) {
        held = host();
        held->setShown(true);
        auto card = WidgetCard::cardWithHost_offersButton(held, offersButton);
        card->layoutIfNeeded();
        return card;
    }

    EnvironmentSlot<std::shared_ptr<TextMeasurer>>::Override measurer =
        TextMeasurer::shared().overrideWith(std::make_shared<testing::FixedTextMeasurer>());
    EnvironmentSlot<UITraitCollection>::Override traits =
        UITraitCollection::system().overrideWith({});
    EnvironmentSlot<std::shared_ptr<NSBundle>>::Override bundle =
        NSBundle::main().overrideWith(NSBundle::bundleWithPath(ORVO_TEST_RESOURCES));
    EnvironmentSlot<std::string>::Override language = Text::locale().overrideWith("en");
    std::shared_ptr<WidgetHost> held;
};

TEST_F(WidgetCardTest, TheWidgetStandsUnderTheHeader) {
    const auto card = shownCard();
    EXPECT_EQ(card->frame().size, CGSize(359, 146));
    EXPECT_EQ(held->view()->frame(), CGRect({0, 36}, {359, 110}));
    EXPECT_EQ(held->view()->superview(), card);
}

TEST_F(WidgetCardTest, OffersTheOtherModeOnlyWhereThereIsMore) {
    const auto card = shownCard();
    EXPECT_EQ(card->buttonTitle(), "Show More");
    EXPECT_GE(card->buttonArea().size.width, 44);
    EXPECT_EQ(card->buttonArea().size.height, 36);
    EXPECT_EQ(card->buttonArea().origin.x + card->buttonArea().size.width, 359);
    widget->largest = Mode::Compact;
    widget->offer();
    card->update();
    EXPECT_EQ(card->buttonArea(), CGRect());
    card->pressButton();
    EXPECT_EQ(held->displayMode(), Mode::Compact);
}

TEST_F(WidgetCardTest, ShowsANewWidgetAndTheWordsOfAnotherLanguage) {
    const auto card = shownCard();
    const auto views = card->subviews().size();
    const auto old = std::exchange(widget, std::make_shared<testing::ScriptedWidget>());
    Text::locale().set("de");
    held->startWidgetAnew();
    card->update();
    card->layoutIfNeeded();
    EXPECT_EQ(card->buttonTitle(), "Mehr anzeigen");
    EXPECT_EQ(card->subviews().size(), views);
    EXPECT_EQ(old->view()->superview(), nullptr);
    EXPECT_EQ(widget->view()->superview(), card);
    EXPECT_EQ(widget->view()->frame(), CGRect({0, 36}, {359, 110}));
}

TEST_F(WidgetCardTest, ThePressedButtonChangesTheModeAndItsWords) {
    const auto card = shownCard();
    card->pressButton();
    EXPECT_EQ(held->displayMode(), Mode::Expanded);
    card->update();
    EXPECT_EQ(card->buttonTitle(), "Show Less");
    card->pressButton();
    EXPECT_EQ(held->displayMode(), Mode::Compact);
}

TEST_F(WidgetCardTest, APicturesHeaderHasNoButton) {
    EXPECT_EQ(shownCard(false)->buttonArea(), CGRect());
}

TEST_F(WidgetCardTest, TheHeaderIsMirroredWhereOneReadsFromTheRight) {
    UITraitCollection::system().set(
        {.layoutDirection = UIUserInterfaceLayoutDirection::RightToLeft});
    const auto card = shownCard();
    EXPECT_EQ(card->buttonArea().origin, CGPoint(0, 0));
    const auto icon = card->subviews().front()->frame();
    EXPECT_EQ(icon.origin.x + icon.size.width, 359 - 16);
}

TEST_F(WidgetCardTest, WhatOneSeesOfTheIconBeginsWhereTheTextsDo) {
    iconName = "WidgetGenericTransit"; // a drawing of 14 in a square of 24
    constexpr CGFloat Seen = 20.0 * 14 / 24;
    constexpr CGFloat HalfPixel = 0.5;
    const auto seenLeft = [](const UIView& icon) {
        return icon.frame().origin.x + (icon.frame().size.width - Seen) / 2;
    };
    const auto card = shownCard();
    const auto& icon = *card->subviews()[0];
    const auto& name = *card->subviews()[1];
    EXPECT_EQ(icon.frame().size, CGSize(20, 20));
    EXPECT_NEAR(seenLeft(icon), 16, HalfPixel);
    EXPECT_NEAR(name.frame().origin.x, 16 + Seen + 8, HalfPixel);
    UITraitCollection::system().set(
        {.layoutDirection = UIUserInterfaceLayoutDirection::RightToLeft});
    const auto mirrored = shownCard();
    EXPECT_NEAR(seenLeft(*mirrored->subviews()[0]) + Seen, 359 - 16, HalfPixel);
}

TEST_F(WidgetCardTest, ALongNameGivesWayToTheButton) {
    const auto card = shownCard();
    held->setWidth(200);
    card->setFrame({{0, 0}, {200, 146}});
    card->layoutIfNeeded();
    const auto name = card->subviews()[1]->frame();
    EXPECT_LE(name.origin.x + name.size.width, card->subviews()[2]->frame().origin.x - 16);
}

TEST_F(WidgetCardTest, HasABorderWithMoreContrastOnly) {
    const auto card = shownCard();
    const auto strokes = [&] {
        testing::RecordingCanvas canvas;
        card->drawRect(canvas);
        return canvas.drawn.size();
    };
    EXPECT_EQ(strokes(), 0U);
    card->setTraitCollection(
        UITraitCollection{.accessibilityContrast = UIAccessibilityContrast::High});
    EXPECT_EQ(strokes(), 1U);
    card->setButtonFocused(true);
    EXPECT_EQ(strokes(), 2U) << "and the ring";
}

} // namespace
} // namespace orvo
