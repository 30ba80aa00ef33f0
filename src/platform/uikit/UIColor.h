#pragma once

#include "platform/foundation/NSObject.h"
#include "platform/uikit/UITraitCollection.h"
#include "platform/uikit/drawing/RGBA.h"

namespace orvo {

/// A colour, which may be another one by night and with more contrast. Immutable. Any thread.
class UIColor final : public virtual NSObject {
public:
    struct Variants {
        RGBA light;
        RGBA dark;
        RGBA lightHighContrast;
        RGBA darkHighContrast;

        friend bool operator==(const Variants&, const Variants&) = default;
    };

    /// The same colour everywhere.
    [[nodiscard]] static std::shared_ptr<UIColor> colorWithRGBA(RGBA value);
    [[nodiscard]] static std::shared_ptr<UIColor> colorWithVariants(const Variants& variants);

    /// Behind everything.
    [[nodiscard]] static std::shared_ptr<UIColor> cardColor();
    [[nodiscard]] static std::shared_ptr<UIColor> labelColor();
    [[nodiscard]] static std::shared_ptr<UIColor> secondaryLabelColor();
    /// The secondary colour, thinned.
    [[nodiscard]] static std::shared_ptr<UIColor> separatorColor();
    [[nodiscard]] static std::shared_ptr<UIColor> systemGrayColor();
    /// A line that runs normally.
    [[nodiscard]] static std::shared_ptr<UIColor> goodServiceColor();
    /// A line with something to know.
    [[nodiscard]] static std::shared_ptr<UIColor> advisoryColor();

    [[nodiscard]] RGBA resolvedColorWithTraitCollection(const UITraitCollection& traits) const;
    /// The same colour in every variant, with its opacity multiplied.
    [[nodiscard]] std::shared_ptr<UIColor> colorWithAlphaComponent(double alpha) const;

    [[nodiscard]] bool isEqual(const NSObject* other) const override;
    [[nodiscard]] std::uint64_t hash() const override;
    [[nodiscard]] std::string description() const override;

private:
    Variants _variants;
};

} // namespace orvo
