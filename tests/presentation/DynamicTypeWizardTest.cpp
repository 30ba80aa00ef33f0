#include "presentation/DynamicTypeWizard.h"

#include "platform/foundation/NSNotificationCenter.h"
#include "platform/foundation/NSNumber.h"
#include "platform/foundation/NSString.h"
#include "platform/uikit/NSLayoutConstraint.h"
#include "platform/uikit/UIContentSizeCategory.h"
#include "platform/uikit/UIFont.h"
#include "platform/uikit/UILabel.h"
#include "platform/uikit/UIStackView.h"
#include "platform/uikit/UITraitCollection.h"

#include <gtest/gtest.h>

#include <functional>
#include <string>
#include <thread>
#include <utility>
#include <vector>

namespace orvo {
namespace {

using Wizard = DynamicTypeWizard;
using Names = std::vector<std::string>;

void changeSize(const std::shared_ptr<NSObject>& sender = nullptr) {
    NSNotificationCenter::defaultCenter()->postNotificationName_object(
        UIContentSizeCategoryDidChangeNotification, sender);
}

std::shared_ptr<UIFont> headline() {
    return UIFont::preferredFontForTextStyle(UIFontTextStyle::Headline);
}

std::shared_ptr<UIFont> noFont() {
    return nullptr;
}

std::shared_ptr<NSLayoutConstraint> heightOf(const std::shared_ptr<NSObject>& item) {
    return NSLayoutConstraint::
        constraintWithItem_attribute_relatedBy_toItem_attribute_multiplier_constant(
            item,
            NSLayoutAttribute::Height,
            NSLayoutRelation::Equal,
            nullptr,
            NSLayoutAttribute::NotAnAttribute,
            1,
            1);
}

std::size_t countOf(const std::shared_ptr<NSMapTable>& map) {
    return map->count();
}

/// Notes the selectors that it performs.
class Performer final : public virtual NSObject {
public:
    Performer(std::string mark, Names& performed)
        : _mark(std::move(mark))
        , _performed(performed) {}
    Method methodForSelector(const Selector& selector) override {
        if (isDeaf || !selector.name().starts_with("do"))
            return NSObject::methodForSelector(selector);
        return [this, name = selector.name()](const auto&) -> std::shared_ptr<NSObject> {
            _performed.push_back(_mark + name);
            if (whenPerforming)
                whenPerforming();
            return NSString::string("ignored");
        };
    }
    std::function<void()> whenPerforming;
    bool isDeaf = false;

private:
    std::string _mark;
    Names& _performed;
};

/// Not a label, but with a font.
class Fonted final : public FontControllable {
public:
    explicit Fonted(std::function<void()> whenSet = {})
        : _whenSet(std::move(whenSet)) {}
    std::shared_ptr<UIFont> font() const override { return _font; }
    void setFont(const std::shared_ptr<UIFont>& font) override {
        _font = font;
        ++timesSet;
        if (_whenSet)
            _whenSet();
    }
    int timesSet = 0;

private:
    std::shared_ptr<UIFont> _font;
    std::function<void()> _whenSet;
};

class DynamicTypeWizardTest : public ::testing::Test {
protected:
    /// The system's text size and screen scale from now on; tells nobody.
    void useSize(UIContentSizeCategory category, double scale = 1) {
        _override.reset();
        UITraitCollection traits;
        traits.preferredContentSizeCategory = category;
        traits.displayScale = scale;
        _override.emplace(UITraitCollection::system().overrideWith(traits));
    }
    std::shared_ptr<Performer> performer(const char* mark = "") {
        return std::make_shared<Performer>(mark, performed);
    }
    static void
    perform(const std::shared_ptr<NSObject>& object, const char* selector, std::uint64_t phase) {
        Wizard::makeObject_performSelector_whenSizeCategoryChangesWithOrder(
            object, Selector(selector), phase);
    }

    Names performed;

private:
    std::optional<EnvironmentSlot<UITraitCollection>::Override> _override;
};

TEST_F(DynamicTypeWizardTest, AValueWithoutAFontStaysUnscaled) {
    useSize(UIContentSizeCategory::AX5);
    const auto value = DynamicTypeValue::init();
    value->setUnscaledValue(10.3);
    EXPECT_EQ(value->scaledValue(), 10.3);
    value->setFontProvider(noFont);
    EXPECT_EQ(value->scaledValue(), 10.3);
    value->setFontProvider(headline);
    EXPECT_EQ(value->scaledValue(), headline()->_scaledValueForValue(10.3));
    EXPECT_GT(value->scaledValue(), 20);
}

TEST_F(DynamicTypeWizardTest, TheProviderIsAskedEachTime) {
    int asked = 0;
    const auto value = DynamicTypeValue::init();
    value->setFontProvider([&] {
        ++asked;
        return headline();
    });
    (void)value->scaledValue();
    (void)value->scaledValue();
    EXPECT_EQ(asked, 2);
}

TEST_F(DynamicTypeWizardTest, ALabelsFontIsSetAtOnceAndAtEachChange) {
    useSize(UIContentSizeCategory::L);
    const auto label = UILabel::init();
    Wizard::autorefreshLabel_withFontProvider(label, headline);
    EXPECT_EQ(label->font()->pointSize(), 17);
    useSize(UIContentSizeCategory::AX5);
    EXPECT_EQ(label->font()->pointSize(), 17);
    changeSize();
    EXPECT_EQ(label->font()->pointSize(), 53);
}

TEST_F(DynamicTypeWizardTest, ASecondProviderReplacesTheFirst) {
    const auto fonted = std::make_shared<Fonted>();
    int first = 0;
    Wizard::autorefreshLabel_withFontProvider(fonted, [&] {
        ++first;
        return headline();
    });
    Wizard::autorefreshLabel_withFontProvider(fonted, noFont);
    EXPECT_EQ(fonted->font(), nullptr);
    changeSize();
    EXPECT_EQ(first, 1);
    EXPECT_EQ(fonted->timesSet, 3);
    EXPECT_EQ(fonted->font(), nullptr);
}

TEST_F(DynamicTypeWizardTest, WithoutAProviderNothingIsDoneOrRegistered) {
    const auto fonted = std::make_shared<Fonted>();
    Wizard::autorefreshLabel_withFontProvider(fonted, nullptr);
    const auto constraint = heightOf(UIView::init());
    EXPECT_EQ(Wizard::autoscaledConstraint_constant_withFontProvider(constraint, 50, nullptr),
              constraint);
    const auto stack = UIStackView::init();
    Wizard::autoscaleStackView_spacing_withFontProvider(stack, 50, nullptr);
    changeSize();
    EXPECT_EQ(fonted->timesSet, 0);
    EXPECT_EQ(constraint->constant(), 1);
    EXPECT_EQ(stack->spacing(), 0);
}

TEST_F(DynamicTypeWizardTest, AConstraintsConstantIsScaledAtOnceAndAtEachChange) {
    useSize(UIContentSizeCategory::L);
    const auto view = UIView::init();
    const auto constraint = heightOf(view);
    EXPECT_EQ(Wizard::autoscaledConstraint_constant_withFontProvider(constraint, 21, headline),
              constraint);
    EXPECT_EQ(constraint->constant(), 21);
    useSize(UIContentSizeCategory::XS);
    changeSize();
    EXPECT_EQ(constraint->constant(), 17); // 21 × 14 ÷ 17 = 17.3
}

TEST_F(DynamicTypeWizardTest, RoundsForTheViewOfTheFirstItem) {
    useSize(UIContentSizeCategory::L, 1);
    UITraitCollection doubled;
    doubled.displayScale = 2;
    const auto view = UIView::init();
    view->setTraitCollection(doubled);
    const auto guide = UILayoutGuide::init();
    view->addLayoutGuide(guide);
    const auto value = DynamicTypeValue::init();
    value->setUnscaledValue(10.3);
    for (const auto& item : std::vector<std::shared_ptr<NSObject>>{view, guide}) {
        const auto constraint = heightOf(item);
        ScaleConstraintToDynamicValue(constraint, *value);
        EXPECT_EQ(constraint->constant(), 10.5);
    }
}

TEST_F(DynamicTypeWizardTest, AFirstItemThatIsNeitherViewNorOwnedGuideIsRoundedWithNoView) {
    useSize(UIContentSizeCategory::L, 2);
    const auto guide = UILayoutGuide::init();
    const auto value = DynamicTypeValue::init();
    value->setUnscaledValue(10.3);
    for (const auto& item : std::vector<std::shared_ptr<NSObject>>{guide, nullptr}) {
        const auto constraint = heightOf(item);
        ScaleConstraintToDynamicValue(constraint, *value);
        EXPECT_EQ(constraint->constant(), 10.5);
    }
}

TEST_F(DynamicTypeWizardTest, ANilFontLeavesConstraintsAndSpacingsUnscaledButRounded) {
    useSize(UIContentSizeCategory::AX5, 2);
    const auto view = UIView::init();
    const auto constraint =
        Wizard::autoscaledConstraint_constant_withFontProvider(heightOf(view), 10.3, noFont);
    EXPECT_EQ(constraint->constant(), 10.5);
    const auto stack = UIStackView::init();
    Wizard::autoscaleStackView_spacing_withFontProvider(stack, 7.2, noFont);
    EXPECT_EQ(stack->spacing(), 7);
}

TEST_F(DynamicTypeWizardTest, OnlyARegisteredConstraintIsUpdated) {
    useSize(UIContentSizeCategory::L);
    const auto view = UIView::init();
    const auto registered =
        Wizard::autoscaledConstraint_constant_withFontProvider(heightOf(view), 20, headline);
    Wizard::updateUnscaledConstantValue_fontProvider_forConstraint(30, noFont, registered);
    EXPECT_EQ(registered->constant(), 30);
    useSize(UIContentSizeCategory::AX5);
    changeSize();
    EXPECT_EQ(registered->constant(), 30);
    Wizard::updateUnscaledConstantValue_fontProvider_forConstraint(31.2, headline, registered);
    EXPECT_GT(registered->constant(), 90);
    Wizard::updateUnscaledConstantValue_fontProvider_forConstraint(31.2, nullptr, registered);
    EXPECT_EQ(registered->constant(), 31) << "without a provider as it is, in whole pixels";
    const auto other = heightOf(view);
    Wizard::updateUnscaledConstantValue_fontProvider_forConstraint(30, headline, other);
    EXPECT_EQ(other->constant(), 1);
    changeSize();
    EXPECT_EQ(other->constant(), 1);
}

TEST_F(DynamicTypeWizardTest, AStacksSpacingIsScaledAtOnceAndAtEachChange) {
    useSize(UIContentSizeCategory::L);
    const auto stack = UIStackView::init();
    Wizard::autoscaleStackView_spacing_withFontProvider(stack, 21, headline);
    EXPECT_EQ(stack->spacing(), 21);
    useSize(UIContentSizeCategory::AX5);
    changeSize();
    EXPECT_EQ(stack->spacing(), 65); // 21 × 53 ÷ 17 = 65.5, less a rounding of the font's
}

TEST_F(DynamicTypeWizardTest, AStacksSpacingIsRoundedForTheStack) {
    useSize(UIContentSizeCategory::L, 1);
    const auto stack = UIStackView::init();
    stack->setTraitCollection(UITraitCollection{.displayScale = 2});
    Wizard::autoscaleStackView_spacing_withFontProvider(stack, 10.3, noFont);
    EXPECT_EQ(stack->spacing(), 10.5);
    stack->setSpacing(0);
    changeSize();
    EXPECT_EQ(stack->spacing(), 10.5);
}

TEST_F(DynamicTypeWizardTest, ASelectorIsPerformedAtEachChangeWhoeverSendsIt) {
    const auto object = performer();
    perform(object, "doIt", 1);
    changeSize(NSString::string("somebody"));
    changeSize();
    EXPECT_EQ(performed, (Names{"doIt", "doIt"}));
}

TEST_F(DynamicTypeWizardTest, AnObjectThatDoesNotRespondIsNotRegistered) {
    const auto object = performer();
    const auto before = countOf(std::dynamic_pointer_cast<NSMapTable>(
        Wizard::_singletonInstance()->objectToSelectorStringMaps()->objectForKey(
            *NSNumber::numberWithInteger(1))));
    perform(object, "unknown", 1);
    EXPECT_EQ(countOf(std::dynamic_pointer_cast<NSMapTable>(
                  Wizard::_singletonInstance()->objectToSelectorStringMaps()->objectForKey(
                      *NSNumber::numberWithInteger(1)))),
              before);
}

TEST_F(DynamicTypeWizardTest, AnObjectThatRespondsNoMoreIsSkipped) {
    const auto object = performer();
    const auto other = performer("other ");
    perform(object, "doIt", 1);
    perform(other, "doIt", 1);
    object->isDeaf = true;
    changeSize();
    EXPECT_EQ(performed, Names{"other doIt"});
}

TEST_F(DynamicTypeWizardTest, ALaterSelectorOfAPhaseReplacesTheEarlier) {
    const auto object = performer();
    perform(object, "doFirst", 0);
    perform(object, "doSecond", 0);
    perform(object, "doThird", 2);
    changeSize();
    EXPECT_EQ(performed, (Names{"doSecond", "doThird"}));
}

TEST_F(DynamicTypeWizardTest, AnObjectRegisteredForPhaseThreeIsNeverCalled) {
    const auto object = performer();
    perform(object, "doIt", 3);
    changeSize();
    EXPECT_EQ(performed, Names{});
}

TEST_F(DynamicTypeWizardTest, ThereAreThreePhases) {
    const auto maps = Wizard::_singletonInstance()->objectToSelectorStringMaps();
    EXPECT_EQ(maps->entries().size(), 3U);
    for (std::int64_t phase = 0; phase < 3; ++phase)
        EXPECT_TRUE(std::dynamic_pointer_cast<NSMapTable>(
            maps->objectForKey(*NSNumber::numberWithInteger(phase))));
}

TEST_F(DynamicTypeWizardTest, UnregisteringLeavesLabelsConstraintsAndStacks) {
    const auto object = performer();
    for (const std::uint64_t phase : {0U, 1U, 2U})
        perform(object, "doIt", phase);
    const auto fonted = std::make_shared<Fonted>();
    Wizard::autorefreshLabel_withFontProvider(fonted, noFont);
    useSize(UIContentSizeCategory::L);
    const auto view = UIView::init();
    const auto constraint =
        Wizard::autoscaledConstraint_constant_withFontProvider(heightOf(view), 17, headline);
    const auto stack = UIStackView::init();
    Wizard::autoscaleStackView_spacing_withFontProvider(stack, 17, headline);
    for (const auto& one :
         std::vector<std::shared_ptr<NSObject>>{object, fonted, constraint, stack})
        Wizard::unregisterObject(one);
    useSize(UIContentSizeCategory::AX5);
    changeSize();
    EXPECT_EQ(performed, Names{});
    EXPECT_EQ(fonted->timesSet, 2);
    EXPECT_EQ(constraint->constant(), 53);
    EXPECT_EQ(stack->spacing(), 53);
}

TEST_F(DynamicTypeWizardTest, AChangeGoesFontsPhaseZeroConstraintsStacksPhaseOnePhaseTwo) {
    useSize(UIContentSizeCategory::L);
    const auto note = [this](const char* what) {
        return [this, what] {
            performed.emplace_back(what);
            return std::shared_ptr<UIFont>();
        };
    };
    const auto object = performer();
    perform(object, "do2", 2);
    perform(object, "do1", 1);
    perform(object, "do0", 0);
    const auto stack = UIStackView::init();
    Wizard::autoscaleStackView_spacing_withFontProvider(stack, 1, note("stack"));
    const auto view = UIView::init();
    const auto constraint = Wizard::autoscaledConstraint_constant_withFontProvider(
        heightOf(view), 1, note("constraint"));
    const auto fonted = std::make_shared<Fonted>();
    Wizard::autorefreshLabel_withFontProvider(fonted, note("font"));
    performed.clear();
    changeSize();
    EXPECT_EQ(performed, (Names{"font", "do0", "constraint", "stack", "do1", "do2"}));
}

TEST_F(DynamicTypeWizardTest, WhatIsRegisteredDuringTheCallsIsNotCalledInThatPass) {
    const auto late = performer("late ");
    const auto object = performer();
    object->whenPerforming = [&] {
        perform(late, "do1", 1);
    };
    perform(object, "do1", 1);
    changeSize();
    EXPECT_EQ(performed, Names{"do1"});
    changeSize();
    EXPECT_EQ(performed, (Names{"do1", "do1", "late do1"}));
}

TEST_F(DynamicTypeWizardTest, WhatHasGoneDropsOutByItself) {
    const auto wizard = Wizard::_singletonInstance();
    const auto labels = countOf(wizard->labelToFontMap());
    const auto constraints = countOf(wizard->constraintToValueMap());
    const auto stacks = countOf(wizard->stackToValueMap());
    {
        const auto label = UILabel::init();
        Wizard::autorefreshLabel_withFontProvider(label, headline);
        const auto constraint =
            Wizard::autoscaledConstraint_constant_withFontProvider(heightOf(label), 1, headline);
        const auto stack = UIStackView::init();
        Wizard::autoscaleStackView_spacing_withFontProvider(stack, 1, headline);
        perform(performer(), "doIt", 1);
        EXPECT_EQ(countOf(wizard->labelToFontMap()), labels + 1);
        EXPECT_EQ(countOf(wizard->constraintToValueMap()), constraints + 1);
        EXPECT_EQ(countOf(wizard->stackToValueMap()), stacks + 1);
    }
    EXPECT_EQ(countOf(wizard->labelToFontMap()), labels);
    EXPECT_EQ(countOf(wizard->constraintToValueMap()), constraints);
    EXPECT_EQ(countOf(wizard->stackToValueMap()), stacks);
    changeSize();
    EXPECT_EQ(performed, Names{});
}

TEST_F(DynamicTypeWizardTest, ThereIsOneWizardWhoeverAsksFirst) {
    std::shared_ptr<Wizard> other;
    std::thread([&] { other = Wizard::_singletonInstance(); }).join();
    EXPECT_EQ(other, Wizard::_singletonInstance());
}

TEST_F(DynamicTypeWizardTest, ALabelIsTheKeyAndWhatStandsForItIsEqual) {
    const auto label = UILabel::init();
    const auto one = UILabelFontControllable::controllableWithLabel(label);
    EXPECT_TRUE(one->isEqual(UILabelFontControllable::controllableWithLabel(label).get()));
    EXPECT_TRUE(one->isEqual(label.get()));
    EXPECT_EQ(one->hash(), label->hash());
    Wizard::autorefreshLabel_withFontProvider(one, headline);
    EXPECT_TRUE(Wizard::_singletonInstance()->labelToFontMap()->objectForKey(label));
}

} // namespace
} // namespace orvo
