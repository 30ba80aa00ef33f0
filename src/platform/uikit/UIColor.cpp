#include "platform/uikit/UIColor.h"

#include "platform/foundation/Hashing.h"

#include <algorithm>
#include <cmath>
#include <cstdio>

namespace orvo {

namespace {

constexpr double SeparatorPart = 0.2;

std::shared_ptr<UIColor> make(std::uint32_t light,
                              std::uint32_t dark,
                              std::uint32_t lightHighContrast,
                              std::uint32_t darkHighContrast) {
    return UIColor::colorWithVariants({.light = RGBA::fromHex(light),
                                       .dark = RGBA::fromHex(dark),
                                       .lightHighContrast = RGBA::fromHex(lightHighContrast),
                                       .darkHighContrast = RGBA::fromHex(darkHighContrast)});
}

RGBA faded(RGBA colour, double alpha) {
    const double part = std::clamp(alpha, 0.0, 1.0) * colour.alpha;
    colour.alpha = static_cast<std::uint8_t>(std::lround(part));
    return colour;
}

std::uint64_t bits(RGBA colour) {
    return (std::uint64_t{colour.red} << 24) | (std::uint64_t{colour.green} << 16) |
           (std::uint64_t{colour.blue} << 8) | colour.alpha;
}

std::string hex(RGBA colour) {
    char text[10];
    std::snprintf(text, sizeof text, "#%08x", static_cast<unsigned>(bits(colour)));
    return text;
}

} // namespace

std::shared_ptr<UIColor> UIColor::colorWithRGBA(RGBA value) {
    return colorWithVariants({value, value, value, value});
}

std::shared_ptr<UIColor> UIColor::colorWithVariants(const Variants& variants) {
    auto color = std::make_shared<UIColor>();
    color->_variants = variants;
    return color;
}

std::shared_ptr<UIColor> UIColor::cardColor() {
    static const auto color = make(0xF4F4F6, 0x1E1E22, 0xFFFFFF, 0x000000);
    return color;
}

std::shared_ptr<UIColor> UIColor::labelColor() {
    static const auto color = make(0x17171A, 0xF5F5F7, 0x000000, 0xFFFFFF);
    return color;
}

std::shared_ptr<UIColor> UIColor::secondaryLabelColor() {
    static const auto color = make(0x5B5B63, 0xA9A9B2, 0x3A3A40, 0xD2D2D8);
    return color;
}

std::shared_ptr<UIColor> UIColor::separatorColor() {
    static const auto color = secondaryLabelColor()->colorWithAlphaComponent(SeparatorPart);
    return color;
}

// Beside the secondary texts, and as easy to read: the same grey.
std::shared_ptr<UIColor> UIColor::systemGrayColor() {
    return secondaryLabelColor();
}

std::shared_ptr<UIColor> UIColor::goodServiceColor() {
    static const auto color = make(0x1B7F3B, 0x4CC36A, 0x0B5F26, 0x6BE08A);
    return color;
}

std::shared_ptr<UIColor> UIColor::advisoryColor() {
    static const auto color = make(0xA34A00, 0xFFB340, 0x7A3600, 0xFFC766);
    return color;
}

RGBA UIColor::resolvedColorWithTraitCollection(const UITraitCollection& traits) const {
    const bool dark = traits.userInterfaceStyle == UIUserInterfaceStyle::Dark;
    if (traits.accessibilityContrast == UIAccessibilityContrast::High)
        return dark ? _variants.darkHighContrast : _variants.lightHighContrast;
    return dark ? _variants.dark : _variants.light;
}

std::shared_ptr<UIColor> UIColor::colorWithAlphaComponent(double alpha) const {
    return colorWithVariants({faded(_variants.light, alpha),
                              faded(_variants.dark, alpha),
                              faded(_variants.lightHighContrast, alpha),
                              faded(_variants.darkHighContrast, alpha)});
}

bool UIColor::isEqual(const NSObject* other) const {
    const auto* color = dynamic_cast<const UIColor*>(other);
    return color && color->_variants == _variants;
}

std::uint64_t UIColor::hash() const {
    return (bits(_variants.light) ^ (bits(_variants.dark) << 32)) * HashMultiplier;
}

std::string UIColor::description() const {
    return rootDescription() + " " + hex(_variants.light) + " " + hex(_variants.dark);
}

} // namespace orvo
