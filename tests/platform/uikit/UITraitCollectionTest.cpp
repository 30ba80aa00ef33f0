#include "platform/uikit/UITraitCollection.h"

#include "ViewTest.h"
#include "platform/foundation/NSNotificationCenter.h"
#include "platform/uikit/UIColor.h"
#include "platform/uikit/UIScreen.h"
#include "platform/uikit/UIVisualEffectView.h"

namespace orvo {
namespace {

/// Counts what it hears.
class Listener : public virtual NSObject {
public:
    int heard = 0;
    Method methodForSelector(const Selector& selector) override {
        if (selector.name() != "changed")
            return {};
        return [this](const auto&) {
            ++heard;
            return nullptr;
        };
    }
};

/// Remembers what it was told.
class Watcher : public UIView {
public:
    std::vector<UITraitCollection> told;
    void traitCollectionDidChange(const UITraitCollection& previous) override {
        told.push_back(previous);
    }
};

using TraitsTest = testing::ViewTest;

TEST_F(TraitsTest, OnlyAnotherSizeCategoryIsAnnounced) {
    const auto listener = std::make_shared<Listener>();
    NSNotificationCenter::defaultCenter()->addObserver_selector_name_object(
        listener, Selector("changed"), UIContentSizeCategoryDidChangeNotification, nullptr);
    UITraitCollection::setSystem({.userInterfaceStyle = UIUserInterfaceStyle::Dark});
    EXPECT_EQ(listener->heard, 0);
    UITraitCollection::setSystem({.preferredContentSizeCategory = UIContentSizeCategory::XL});
    EXPECT_EQ(listener->heard, 1);
    UITraitCollection::setSystem({.preferredContentSizeCategory = UIContentSizeCategory::XL});
    EXPECT_EQ(listener->heard, 1);
}

TEST_F(TraitsTest, ScreenHasTheScaleOfTheSystem) {
    UITraitCollection::setSystem({.displayScale = 3});
    EXPECT_EQ(UIScreen::mainScreen()->scale(), 3);
    EXPECT_EQ(UIScreen::mainScreen(), UIScreen::mainScreen());
}

TEST_F(TraitsTest, ViewsInheritTraitsAndAreToldOnceFromTheTop) {
    const auto card = root(10, 10);
    const auto watcher = constrained(std::make_shared<Watcher>(), child(card, "box"), "watcher");
    watcher->told.clear();
    const UITraitCollection dark{.userInterfaceStyle = UIUserInterfaceStyle::Dark};
    card->setTraitCollection(dark);
    EXPECT_EQ(watcher->traitCollection(), dark);
    EXPECT_EQ(watcher->told, std::vector{UITraitCollection()});
    card->setTraitCollection(dark);
    EXPECT_EQ(watcher->told.size(), 1U);
}

TEST_F(TraitsTest, ViewIsToldWhenItComesUnderOtherTraits) {
    const auto card = root(10, 10);
    card->setTraitCollection(UITraitCollection{.displayScale = 2});
    const auto watcher = std::make_shared<Watcher>();
    card->addSubview(watcher);
    EXPECT_EQ(watcher->told.size(), 1U);
    const auto second = std::make_shared<Watcher>();
    root(10, 10)->addSubview(second);
    EXPECT_TRUE(second->told.empty());
}

TEST_F(TraitsTest, LengthsAreRoundedToTheScaleOfTheirView) {
    const auto card = root(10, 10);
    card->setTraitCollection(UITraitCollection{.displayScale = 2});
    const auto box = child(card, "box");
    EXPECT_EQ(UIRoundToViewScale(15.3, box.get()), 15.5);
    EXPECT_EQ(UIRoundToViewScale(15.25, box.get()), 15.5);
    EXPECT_EQ(UIRoundToViewScale(15.3, nullptr), 15);
    EXPECT_EQ(UIRoundToViewScale(-0.5, nullptr), -1);
    UITraitCollection::setSystem({.displayScale = 3});
    EXPECT_DOUBLE_EQ(UIRoundToViewScale(15.3, nullptr), 46.0 / 3);
}

TEST_F(TraitsTest, ColoursHaveAVariantForDarkAndForContrast) {
    const auto color = UIColor::labelColor();
    const auto resolved = [&color](UIUserInterfaceStyle style, UIAccessibilityContrast contrast) {
        return color->resolvedColorWithTraitCollection(
            {.userInterfaceStyle = style, .accessibilityContrast = contrast});
    };
    using enum UIUserInterfaceStyle;
    using enum UIAccessibilityContrast;
    EXPECT_EQ(resolved(Light, Normal), RGBA::fromHex(0x17171A));
    EXPECT_EQ(resolved(Dark, Normal), RGBA::fromHex(0xF5F5F7));
    EXPECT_EQ(resolved(Light, High), RGBA::fromHex(0x000000));
    EXPECT_EQ(resolved(Dark, High), RGBA::fromHex(0xFFFFFF));
}

TEST_F(TraitsTest, SeparatorsAreTheSecondaryColourThinned) {
    const auto color = UIColor::separatorColor()->resolvedColorWithTraitCollection({});
    EXPECT_EQ(color, (RGBA{0x5B, 0x5B, 0x63, 51}));
}

TEST_F(TraitsTest, VibrancyStylesAreTwoLooks) {
    const auto primary = UIVibrancyEffect::widgetEffectForVibrancyStyle(101);
    const auto secondary = UIVibrancyEffect::widgetEffectForVibrancyStyle(102);
    EXPECT_EQ(primary->color(), UIColor::labelColor());
    EXPECT_EQ(secondary->color(), UIColor::secondaryLabelColor());
    EXPECT_EQ(secondary->style(), 102);
    EXPECT_FALSE(primary->isEqual(secondary.get()));
}

TEST_F(TraitsTest, VibrancyReachesEverythingInsideItsContentView) {
    const auto effect =
        UIVisualEffectView::initWithEffect(UIVibrancyEffect::widgetEffectForVibrancyStyle(102));
    const auto box = child(effect->contentView(), "box");
    EXPECT_EQ(box->_vibrantColor(), UIColor::secondaryLabelColor());
    EXPECT_EQ(root(1, 1)->_vibrantColor(), nullptr);
}

TEST_F(TraitsTest, ContentViewOfAnEffectAlwaysFillsIt) {
    const auto card = root(100, 50);
    const auto effect = constrained(
        UIVisualEffectView::initWithEffect(UIVibrancyEffect::widgetEffectForVibrancyStyle(101)),
        card,
        "effect");
    const auto text = label(effect->contentView(), "text", "four");
    pin(text, effect);
    place(effect, 10, 5);
    EXPECT_EQ(layout(card), R"(
UIView1 0 0 100 50
  effect 10 5 20 10
    UIView2 10 5 20 10
      text 10 5 20 10 "four"
)");
}

TEST_F(TraitsTest, TintComesFromTheNearestViewThatHasOne) {
    const auto card = root(10, 10);
    const auto box = child(card, "box");
    EXPECT_EQ(box->tintColor(), UIColor::labelColor());
    card->setTintColor(UIColor::advisoryColor());
    EXPECT_EQ(box->tintColor(), UIColor::advisoryColor());
    box->setTintColor(UIColor::goodServiceColor());
    EXPECT_EQ(box->tintColor(), UIColor::goodServiceColor());
}

} // namespace
} // namespace orvo
