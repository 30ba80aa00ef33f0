#pragma once

#include "platform/foundation/NSDictionary.h"
#include "platform/foundation/NSMapTable.h"
#include "platform/foundation/Selector.h"
#include "presentation/DynamicTypeValue.h"

#include <cstdint>
#include <memory>

namespace orvo {

class NSLayoutConstraint;
class UILabel;
class UIStackView;

/// Keeps fonts, constants of constraints and spacings in step with the person's text size. What is
/// registered once is applied again whenever the content size category changes; it is not kept
/// alive by that, and drops out by itself. Main thread.
class DynamicTypeWizard : public virtual NSObject {
public:
    /// Made when first asked for; from any thread.
    [[nodiscard]] static const std::shared_ptr<DynamicTypeWizard>& _singletonInstance();
    /// Listens to the default notification centre from then on.
    [[nodiscard]] static std::shared_ptr<DynamicTypeWizard> init();

    /// Sets the font at once. An empty provider does nothing; a second one replaces the first.
    static void autorefreshLabel_withFontProvider(const std::shared_ptr<FontControllable>& label,
                                                  const FontProvider& provider);
    static void autorefreshLabel_withFontProvider(const std::shared_ptr<UILabel>& label,
                                                  const FontProvider& provider);
    /// Sets the constant at once, and answers the same constraint. An empty provider does nothing.
    static std::shared_ptr<NSLayoutConstraint> autoscaledConstraint_constant_withFontProvider(
        const std::shared_ptr<NSLayoutConstraint>& constraint,
        double constant,
        const FontProvider& provider);
    /// Only for a constraint that is registered already.
    static void updateUnscaledConstantValue_fontProvider_forConstraint(
        double constant,
        const FontProvider& provider,
        const std::shared_ptr<NSLayoutConstraint>& constraint);
    /// Sets the spacing at once. An empty provider does nothing.
    static void
    autoscaleStackView_spacing_withFontProvider(const std::shared_ptr<UIStackView>& stackView,
                                                double spacing,
                                                const FontProvider& provider);
    /// Phases 0, 1 and 2 in this order; any other is never reached. One selector an object and
    /// phase, the latest. An object that does not respond is not registered.
    static void makeObject_performSelector_whenSizeCategoryChangesWithOrder(
        const std::shared_ptr<NSObject>& object, const Selector& selector, std::uint64_t order);
    /// From all phases. It stays registered as a label, constraint or stack view.
    static void unregisterObject(const std::shared_ptr<NSObject>& object);

    /// Fonts; phase 0; constraints; spacings; phase 1; phase 2.
    void _contentSizeCategoryDidChange();

    // Weak keys; boxed `FontProvider`s, and `DynamicTypeValue`s.
    [[nodiscard]] const std::shared_ptr<NSMapTable>& labelToFontMap() const noexcept {
        return _labelToFontMap;
    }
    [[nodiscard]] const std::shared_ptr<NSMapTable>& constraintToValueMap() const noexcept {
        return _constraintToValueMap;
    }
    [[nodiscard]] const std::shared_ptr<NSMapTable>& stackToValueMap() const noexcept {
        return _stackToValueMap;
    }
    /// The phases' numbers to map tables: weak keys to names of selectors.
    [[nodiscard]] const std::shared_ptr<NSDictionary>& objectToSelectorStringMaps() const noexcept {
        return _objectToSelectorStringMaps;
    }

    [[nodiscard]] Method methodForSelector(const Selector& selector) override;

protected:
    bool _init();

private:
    [[nodiscard]] std::shared_ptr<NSMapTable> _mapOfPhase(std::uint64_t phase) const;

    std::shared_ptr<NSMapTable> _labelToFontMap;
    std::shared_ptr<NSMapTable> _constraintToValueMap;
    std::shared_ptr<NSMapTable> _stackToValueMap;
    std::shared_ptr<NSDictionary> _objectToSelectorStringMaps;
};

/// Sets the constant to the scaled value, in whole device pixels of the view that the constraint's
/// first item is or belongs to.
void ScaleConstraintToDynamicValue(const std::shared_ptr<NSLayoutConstraint>& constraint,
                                   const DynamicTypeValue& value);
/// Each key of the map performs the selector that it is mapped to. Keys that are added meanwhile do
/// not.
void MakeObjectsPerformSelectorWithMap(const std::shared_ptr<NSMapTable>& map);

} // namespace orvo
