#include "platform/uikit/UIVisualEffectView.h"

#include "platform/foundation/Hashing.h"
#include "platform/uikit/UIColor.h"

namespace orvo {

namespace {

constexpr std::int64_t SecondaryStyle = 102;
constexpr std::int64_t TertiaryStyle = 103;

} // namespace

std::shared_ptr<UIVibrancyEffect>
UIVibrancyEffect::widgetEffectForVibrancyStyle(std::int64_t style) {
    auto effect = std::make_shared<UIVibrancyEffect>();
    effect->_style = style;
    return effect;
}

std::shared_ptr<UIVibrancyEffect> UIVibrancyEffect::widgetTertiaryVibrancyEffect() {
    return widgetEffectForVibrancyStyle(TertiaryStyle);
}

std::shared_ptr<UIColor> UIVibrancyEffect::color() const {
    switch (_style) {
    case SecondaryStyle:
        return UIColor::secondaryLabelColor();
    case TertiaryStyle:
        return UIColor::separatorColor();
    default:
        return UIColor::labelColor();
    }
}

bool UIVibrancyEffect::isEqual(const NSObject* other) const {
    const auto* effect = dynamic_cast<const UIVibrancyEffect*>(other);
    return effect && effect->_style == _style;
}

std::uint64_t UIVibrancyEffect::hash() const {
    return static_cast<std::uint64_t>(_style) * HashMultiplier;
}

std::shared_ptr<UIVisualEffectView>
UIVisualEffectView::initWithEffect(const std::shared_ptr<UIVibrancyEffect>& effect) {
    auto view = std::make_shared<UIVisualEffectView>();
    return view->_initWithEffect(effect) ? view : nullptr;
}

bool UIVisualEffectView::_initWithEffect(const std::shared_ptr<UIVibrancyEffect>& effect) {
    if (!_initWithFrame({}))
        return false;
    _effect = effect;
    _contentView = UIView::init();
    _contentView->_setFillsSuperview(true);
    addSubview(_contentView);
    return true;
}

std::shared_ptr<UIColor> UIVisualEffectView::_vibrantColor() const {
    return _effect ? _effect->color() : UIView::_vibrantColor();
}

} // namespace orvo
