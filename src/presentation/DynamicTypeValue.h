#pragma once

#include "presentation/FontControllable.h"

namespace orvo {

class UIView;

/// A length, in points, that grows with a font's text style.
class DynamicTypeValue : public virtual NSObject {
public:
    [[nodiscard]] static std::shared_ptr<DynamicTypeValue> init();

    [[nodiscard]] const FontProvider& fontProvider() const noexcept { return _fontProvider; }
    void setFontProvider(FontProvider provider) { _fontProvider = std::move(provider); }
    /// In the default content size category.
    [[nodiscard]] double unscaledValue() const noexcept { return _unscaledValue; }
    void setUnscaledValue(double value) noexcept { _unscaledValue = value; }
    /// In the category of the moment, worked out each time. The unscaled value where there is no
    /// provider, or it answers nil.
    [[nodiscard]] double scaledValue() const;
    /// The same, a whole number of device pixels of `view`; of the main screen for nil.
    [[nodiscard]] double _scaledValueForView(const UIView* view) const;

private:
    FontProvider _fontProvider;
    double _unscaledValue = 0;
};

} // namespace orvo
