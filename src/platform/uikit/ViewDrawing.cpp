#include "platform/uikit/ViewDrawing.h"

#include "platform/uikit/UIColor.h"
#include "platform/uikit/UIImage.h"
#include "platform/uikit/UIView.h"
#include "platform/uikit/drawing/PixelCanvas.h"

#include <algorithm>
#include <cmath>

namespace orvo {

namespace {

void drawView(UIView& view, Canvas& canvas) {
    if (view.isHidden() || view.alpha() <= 0)
        return;
    canvas.save();
    if (view.alpha() < 1)
        canvas.fade(view.alpha());
    const auto bounds = view.bounds();
    const CGRect area{{0, 0}, bounds.size};
    if (const auto& background = view.backgroundColor())
        canvas.fill(area,
                    view.cornerRadius(),
                    background->resolvedColorWithTraitCollection(view.traitCollection()));
    if (view.clipsToBounds())
        canvas.clip(area, view.cornerRadius());
    canvas.translate(-bounds.origin.x, -bounds.origin.y);
    view.drawRect(canvas);
    for (const auto& subview : view.subviews()) {
        canvas.save();
        canvas.translate(subview->frame().origin.x, subview->frame().origin.y);
        drawView(*subview, canvas);
        canvas.restore();
    }
    canvas.restore();
}

} // namespace

void drawViewHierarchy(UIView& root, Canvas& canvas) {
    drawView(root, canvas);
    root._didDisplay();
}

std::shared_ptr<UIImage> snapshotOf(UIView& root, double scale) {
    root.layoutIfNeeded();
    const auto size = root.frame().size;
    const auto columns = static_cast<int>(std::lround(size.width * scale));
    const auto rows = static_cast<int>(std::lround(size.height * scale));
    std::vector<std::uint32_t> pixels(static_cast<std::size_t>(columns) *
                                      static_cast<std::size_t>(rows));
    if (!pixels.empty()) {
        PixelCanvas canvas(pixels, columns, rows, scale);
        drawViewHierarchy(root, canvas);
    }
    return UIImage::imageWithPixels_size_scale(
        std::move(pixels), {columns / scale, rows / scale}, scale);
}

} // namespace orvo
