#pragma once

#include "platform/foundation/NSObject.h"

#include <functional>
#include <memory>

namespace orvo {

class UIFont;
class UILabel;

/// The font for the content size category of the moment; may answer nil. Called again at every
/// change.
using FontProvider = std::function<std::shared_ptr<UIFont>()>;

/// Something whose font can be set.
class FontControllable : public virtual NSObject {
public:
    [[nodiscard]] virtual std::shared_ptr<UIFont> font() const = 0;
    virtual void setFont(const std::shared_ptr<UIFont>& font) = 0;

    /// The object that lives on screen; what stands for another object names that one.
    [[nodiscard]] virtual std::shared_ptr<NSObject> _controlled() {
        return {shared_from_this(), this};
    }
    /// An object as one whose font can be set: itself, or what stands for a label. Nil for others.
    [[nodiscard]] static std::shared_ptr<FontControllable>
    _of(const std::shared_ptr<NSObject>& object);
};

/// A label as one. Equals, hashes and is described as the label itself.
class UILabelFontControllable final : public FontControllable {
public:
    /// Nil for nil.
    [[nodiscard]] static std::shared_ptr<UILabelFontControllable>
    controllableWithLabel(std::shared_ptr<UILabel> label);

    [[nodiscard]] std::shared_ptr<UIFont> font() const override;
    void setFont(const std::shared_ptr<UIFont>& font) override;
    [[nodiscard]] std::shared_ptr<NSObject> _controlled() override;

    [[nodiscard]] bool isEqual(const NSObject* other) const override;
    [[nodiscard]] std::uint64_t hash() const override;
    [[nodiscard]] std::string description() const override;

private:
    std::shared_ptr<UILabel> _label;
};

} // namespace orvo
