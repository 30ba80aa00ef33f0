#include "presentation/DynamicTypeWizard.h"

#include "platform/foundation/NSNotificationCenter.h"
#include "platform/foundation/NSNumber.h"
#include "platform/foundation/NSString.h"
#include "platform/uikit/NSLayoutConstraint.h"
#include "platform/uikit/UIContentSizeCategory.h"
#include "platform/uikit/UILabel.h"
#include "platform/uikit/UIStackView.h"

#include <utility>

namespace orvo {

namespace {

constexpr const char* ChangeSelector = "_contentSizeCategoryDidChange";

class BoxedFontProvider final : public virtual NSObject {
public:
    explicit BoxedFontProvider(FontProvider provider)
        : _provider(std::move(provider)) {}
    [[nodiscard]] const FontProvider& provider() const noexcept { return _provider; }

private:
    FontProvider _provider;
};

std::shared_ptr<DynamicTypeValue> makeValue(double unscaledValue, const FontProvider& provider) {
    auto value = DynamicTypeValue::init();
    value->setFontProvider(provider);
    value->setUnscaledValue(unscaledValue);
    return value;
}

std::shared_ptr<DynamicTypeValue> valueIn(const NSMapTable& map,
                                          const std::shared_ptr<NSObject>& key) {
    return std::dynamic_pointer_cast<DynamicTypeValue>(map.objectForKey(key));
}

/// The view in whose pixels the constraint counts; nil where its first item has none.
std::shared_ptr<UIView> viewOf(const NSLayoutConstraint& constraint) {
    const auto item = constraint.firstItem();
    if (auto view = std::dynamic_pointer_cast<UIView>(item))
        return view;
    const auto guide = std::dynamic_pointer_cast<UILayoutGuide>(item);
    return guide ? guide->owningView() : nullptr;
}

void applySpacing(UIStackView& stackView, const DynamicTypeValue& value) {
    stackView.setSpacing(value._scaledValueForView(&stackView));
}

} // namespace

void ScaleConstraintToDynamicValue(const std::shared_ptr<NSLayoutConstraint>& constraint,
                                   const DynamicTypeValue& value) {
    constraint->setConstant(value._scaledValueForView(viewOf(*constraint).get()));
}

void MakeObjectsPerformSelectorWithMap(const std::shared_ptr<NSMapTable>& map) {
    for (const auto& key : typed<NSObject>(map->allKeys())) {
        const auto name = stringValue(map->objectForKey(key).get());
        const auto method = name ? key->methodForSelector(NSSelectorFromString(*name)) : nullptr;
        if (method)
            method(nullptr);
    }
}

const std::shared_ptr<DynamicTypeWizard>& DynamicTypeWizard::_singletonInstance() {
    static const auto instance = init();
    return instance;
}

std::shared_ptr<DynamicTypeWizard> DynamicTypeWizard::init() {
    auto wizard = std::make_shared<DynamicTypeWizard>();
    return wizard->_init() ? wizard : nullptr;
}

bool DynamicTypeWizard::_init() {
    _labelToFontMap = NSMapTable::weakToStrongObjectsMapTable();
    _constraintToValueMap = NSMapTable::weakToStrongObjectsMapTable();
    _stackToValueMap = NSMapTable::weakToStrongObjectsMapTable();
    NSDictionary::Entries phases;
    for (std::uint64_t phase = 0; phase < 3; ++phase)
        phases.emplace_back(NSNumber::numberWithUnsignedInteger(phase),
                            NSMapTable::weakToStrongObjectsMapTable());
    _objectToSelectorStringMaps = NSDictionary::dictionaryWithEntries(std::move(phases));
    NSNotificationCenter::defaultCenter()->addObserver_selector_name_object(
        strong(this),
        Selector(ChangeSelector),
        UIContentSizeCategoryDidChangeNotification,
        nullptr);
    return true;
}

std::shared_ptr<NSMapTable> DynamicTypeWizard::_mapOfPhase(std::uint64_t phase) const {
    return std::dynamic_pointer_cast<NSMapTable>(
        _objectToSelectorStringMaps->objectForKey(*NSNumber::numberWithUnsignedInteger(phase)));
}

void DynamicTypeWizard::autorefreshLabel_withFontProvider(
    const std::shared_ptr<FontControllable>& label, const FontProvider& provider) {
    if (!provider)
        return;
    label->setFont(provider());
    _singletonInstance()->_labelToFontMap->setObject_forKey(
        std::make_shared<BoxedFontProvider>(provider), label->_controlled());
}

void DynamicTypeWizard::autorefreshLabel_withFontProvider(const std::shared_ptr<UILabel>& label,
                                                          const FontProvider& provider) {
    autorefreshLabel_withFontProvider(FontControllable::_of(label), provider);
}

std::shared_ptr<NSLayoutConstraint>
DynamicTypeWizard::autoscaledConstraint_constant_withFontProvider(
    const std::shared_ptr<NSLayoutConstraint>& constraint,
    double constant,
    const FontProvider& provider) {
    if (provider) {
        const auto value = makeValue(constant, provider);
        ScaleConstraintToDynamicValue(constraint, *value);
        _singletonInstance()->_constraintToValueMap->setObject_forKey(value, constraint);
    }
    return constraint;
}

void DynamicTypeWizard::updateUnscaledConstantValue_fontProvider_forConstraint(
    double constant,
    const FontProvider& provider,
    const std::shared_ptr<NSLayoutConstraint>& constraint) {
    const auto value = valueIn(*_singletonInstance()->_constraintToValueMap, constraint);
    if (!value)
        return;
    value->setUnscaledValue(constant);
    value->setFontProvider(provider);
    ScaleConstraintToDynamicValue(constraint, *value);
}

void DynamicTypeWizard::autoscaleStackView_spacing_withFontProvider(
    const std::shared_ptr<UIStackView>& stackView, double spacing, const FontProvider& provider) {
    if (!provider)
        return;
    const auto value = makeValue(spacing, provider);
    applySpacing(*stackView, *value);
    _singletonInstance()->_stackToValueMap->setObject_forKey(value, stackView);
}

void DynamicTypeWizard::makeObject_performSelector_whenSizeCategoryChangesWithOrder(
    const std::shared_ptr<NSObject>& object, const Selector& selector, std::uint64_t order) {
    if (!object->respondsToSelector(selector))
        return;
    if (const auto map = _singletonInstance()->_mapOfPhase(order))
        map->setObject_forKey(NSString::string(NSStringFromSelector(selector)), object);
}

void DynamicTypeWizard::unregisterObject(const std::shared_ptr<NSObject>& object) {
    for (const std::uint64_t phase : {0U, 2U, 1U})
        _singletonInstance()->_mapOfPhase(phase)->removeObjectForKey(object.get());
}

void DynamicTypeWizard::_contentSizeCategoryDidChange() {
    for (const auto& label : typed<NSObject>(_labelToFontMap->allKeys())) {
        const auto box =
            std::dynamic_pointer_cast<BoxedFontProvider>(_labelToFontMap->objectForKey(label));
        if (box)
            FontControllable::_of(label)->setFont(box->provider()());
    }
    MakeObjectsPerformSelectorWithMap(_mapOfPhase(0));
    for (const auto& constraint : typed<NSLayoutConstraint>(_constraintToValueMap->allKeys()))
        if (const auto value = valueIn(*_constraintToValueMap, constraint))
            ScaleConstraintToDynamicValue(constraint, *value);
    for (const auto& stackView : typed<UIStackView>(_stackToValueMap->allKeys()))
        if (const auto value = valueIn(*_stackToValueMap, stackView))
            applySpacing(*stackView, *value);
    MakeObjectsPerformSelectorWithMap(_mapOfPhase(1));
    MakeObjectsPerformSelectorWithMap(_mapOfPhase(2));
}

NSObject::Method DynamicTypeWizard::methodForSelector(const Selector& selector) {
    if (selector == Selector(ChangeSelector))
        return [this](const std::shared_ptr<NSObject>&) {
            _contentSizeCategoryDidChange();
            return nullptr;
        };
    return NSObject::methodForSelector(selector);
}

} // namespace orvo
