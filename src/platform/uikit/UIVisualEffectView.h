#pragma once

#include "platform/uikit/UIView.h"

namespace orvo {

/// A look for what lies inside an effect view. Immutable.
class UIVibrancyEffect final : public virtual NSObject {
public:
    /// 101 for primary text, 102 for secondary text and dimmed artwork, 103 for the lines between
    /// rows; any other number looks like 101.
    [[nodiscard]] static std::shared_ptr<UIVibrancyEffect>
    widgetEffectForVibrancyStyle(std::int64_t style);
    /// That of style 103.
    [[nodiscard]] static std::shared_ptr<UIVibrancyEffect> widgetTertiaryVibrancyEffect();

    [[nodiscard]] std::int64_t style() const noexcept { return _style; }
    /// In light, dark and more contrast.
    [[nodiscard]] std::shared_ptr<UIColor> color() const;

    [[nodiscard]] bool isEqual(const NSObject* other) const override;
    [[nodiscard]] std::uint64_t hash() const override;

private:
    std::int64_t _style = 0;
};

/// Shows its content view's texts and images in the look of its effect. Main thread.
class UIVisualEffectView : public UIView {
public:
    [[nodiscard]] static std::shared_ptr<UIVisualEffectView>
    initWithEffect(const std::shared_ptr<UIVibrancyEffect>& effect);

    /// Nil: no effect.
    [[nodiscard]] const std::shared_ptr<UIVibrancyEffect>& effect() const noexcept {
        return _effect;
    }
    /// Fills the view. What is to be shown goes into it, never into the effect view itself.
    [[nodiscard]] const std::shared_ptr<UIView>& contentView() const noexcept {
        return _contentView;
    }

    [[nodiscard]] std::shared_ptr<UIColor> _vibrantColor() const override;
    [[nodiscard]] std::string className() const override { return "UIVisualEffectView"; }

protected:
    bool _initWithEffect(const std::shared_ptr<UIVibrancyEffect>& effect);

private:
    std::shared_ptr<UIVibrancyEffect> _effect;
    std::shared_ptr<UIView> _contentView;
};

} // namespace orvo
