#include "presentation/FontControllable.h"

#include "platform/uikit/UIFont.h"
#include "platform/uikit/UILabel.h"

#include <utility>

namespace orvo {

std::shared_ptr<FontControllable> FontControllable::_of(const std::shared_ptr<NSObject>& object) {
    if (auto controllable = std::dynamic_pointer_cast<FontControllable>(object))
        return controllable;
    return UILabelFontControllable::controllableWithLabel(
        std::dynamic_pointer_cast<UILabel>(object));
}

std::shared_ptr<UILabelFontControllable>
UILabelFontControllable::controllableWithLabel(std::shared_ptr<UILabel> label) {
    if (!label)
        return nullptr;
    auto controllable = std::make_shared<UILabelFontControllable>();
    controllable->_label = std::move(label);
    return controllable;
}

std::shared_ptr<UIFont> UILabelFontControllable::font() const {
    return _label->font();
}

void UILabelFontControllable::setFont(const std::shared_ptr<UIFont>& font) {
    _label->setFont(font);
}

std::shared_ptr<NSObject> UILabelFontControllable::_controlled() {
    return _label;
}

bool UILabelFontControllable::isEqual(const NSObject* other) const {
    const auto* controllable = dynamic_cast<const UILabelFontControllable*>(other);
    return _label->isEqual(controllable ? controllable->_label.get() : other);
}

std::uint64_t UILabelFontControllable::hash() const {
    return _label->hash();
}

std::string UILabelFontControllable::description() const {
    return _label->description();
}

} // namespace orvo
