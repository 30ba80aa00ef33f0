#include "platform/uikit/ViewDrawing.h"

#include "platform/uikit/UIColor.h"
#include "platform/uikit/UIImage.h"
#include "platform/uikit/UIView.h"
#include "platform/uikit/drawing/PixelCanvas.h"

#include <algorithm>
#include <cmath>

namespace orvo {

namespace {

// A mark that is dimmed to 0.3 keeps a contrast of 3 to the card in each look.
constexpr double VibrantFading = 0.3;

/// How much of a view is seen. Vibrancy dims by its colour; what fades in it besides fades slowly,
/// so that it can still be told from the card.
double shownAlpha(const UIView& view) {
    const double alpha = std::min<double>(view.alpha(), 1);
    return view._vibrantColor() ? std::pow(alpha, VibrantFading) : alpha;
}

void drawView(UIView& view, Canvas& canvas) {
    if (view.isHidden() || view.alpha() <= 0)
        return;
    canvas.save();
    if (view.alpha() < 1)
        canvas.fade(shownAlpha(view));
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
