#include "platform/uikit/UIImageDrawing.h"

#include "platform/uikit/UIColor.h"
#include "platform/uikit/UIImage.h"
#include "platform/uikit/UIView.h"
#include "platform/uikit/drawing/Canvas.h"

#include <algorithm>
#include <cmath>

namespace orvo::UIImageDrawing {

namespace {

constexpr const char* GoodServiceImage = "good-v2";

} // namespace

CGRect placeIn(const CGRect& bounds, CGSize image, double scale) {
    if (image.width <= 0 || image.height <= 0)
        return {bounds.origin, {}};
    const double factor = std::clamp(
        std::min(bounds.size.width / image.width, bounds.size.height / image.height), 0.0, 1.0);
    const CGSize size{image.width * factor, image.height * factor};
    return {{UIRoundToScale(bounds.origin.x + (bounds.size.width - size.width) / 2, scale),
             UIRoundToScale(bounds.origin.y + (bounds.size.height - size.height) / 2, scale)},
            size};
}

void draw(Canvas& canvas, const UIImage& image, const CGRect& bounds, const UIView& view) {
    const auto traits = view.traitCollection();
    const auto rect = placeIn(bounds, image.size(), canvas.scale());
    const auto vibrant = view._vibrantColor();
    if (image.name()) {
        auto color = vibrant;
        if (!color)
            color =
                *image.name() == GoodServiceImage ? UIColor::goodServiceColor() : view.tintColor();
        canvas.fixedImage(*image.name(), rect, color->resolvedColorWithTraitCollection(traits));
        return;
    }
    const auto tint =
        (vibrant ? vibrant : view.tintColor())->resolvedColorWithTraitCollection(traits);
    canvas.pixels(image.pixels(),
                  static_cast<int>(std::lround(image.size().width * image.scale())),
                  static_cast<int>(std::lround(image.size().height * image.scale())),
                  rect,
                  vibrant ? &tint : nullptr);
}

} // namespace orvo::UIImageDrawing
