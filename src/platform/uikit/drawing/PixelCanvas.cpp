#include "platform/uikit/drawing/PixelCanvas.h"

#include "platform/uikit/drawing/FixedImagePainter.h"
#include "platform/uikit/drawing/TintedPixels.h"
#include "platform/uikit/drawing/_ShapedLines.h"

#include <QImage>
#include <QPainter>
#include <QPainterPath>
#include <QTextLayout>

#include <algorithm>
#include <cmath>

namespace orvo {

namespace {

QColor colorOf(RGBA color) {
    return {color.red, color.green, color.blue, color.alpha};
}

QRectF rectOf(const CGRect& rect) {
    return {rect.origin.x, rect.origin.y, rect.size.width, rect.size.height};
}

/// The same rectangle with its edges on whole device pixels; nothing that is there vanishes.
QRectF onPixels(const QRectF& rect, const QTransform& transform) {
    const QRectF device = transform.mapRect(rect);
    const double left = std::round(device.left());
    const double top = std::round(device.top());
    const double right = std::max(left + 1, std::round(device.right()));
    const double bottom = std::max(top + 1, std::round(device.bottom()));
    return transform.inverted().mapRect(QRectF(left, top, right - left, bottom - top));
}

} // namespace

struct PixelCanvas::Painting {
    Painting(std::span<std::uint32_t> pixels, int columns, int rows)
        : image(reinterpret_cast<uchar*>(pixels.data()),
                columns,
                rows,
                static_cast<qsizetype>(columns) * static_cast<qsizetype>(sizeof(std::uint32_t)),
                QImage::Format_ARGB32_Premultiplied)
        , painter(&image) {}

    QImage image;
    QPainter painter;
};

PixelCanvas::PixelCanvas(std::span<std::uint32_t> pixels, int columns, int rows, double scale)
    : _scale(scale)
    , _painting(std::make_unique<Painting>(pixels, columns, rows)) {
    auto& painter = _painting->painter;
    painter.setRenderHints(QPainter::Antialiasing | QPainter::TextAntialiasing |
                           QPainter::SmoothPixmapTransform);
    painter.scale(scale, scale);
}

PixelCanvas::~PixelCanvas() = default;

void PixelCanvas::save() {
    _painting->painter.save();
}

void PixelCanvas::restore() {
    _painting->painter.restore();
}

void PixelCanvas::translate(double x, double y) {
    _painting->painter.translate(x, y);
}

void PixelCanvas::clip(const CGRect& rect, double cornerRadius) {
    auto& painter = _painting->painter;
    if (cornerRadius <= 0) {
        painter.setClipRect(rectOf(rect), Qt::IntersectClip);
        return;
    }
    QPainterPath path;
    path.addRoundedRect(rectOf(rect), cornerRadius, cornerRadius);
    painter.setClipPath(path, Qt::IntersectClip);
}

void PixelCanvas::fade(double alpha) {
    _painting->painter.setOpacity(_painting->painter.opacity() * alpha);
}

void PixelCanvas::fill(const CGRect& rect, double cornerRadius, RGBA color) {
    auto& painter = _painting->painter;
    if (cornerRadius <= 0) {
        painter.fillRect(onPixels(rectOf(rect), painter.worldTransform()), colorOf(color));
        return;
    }
    painter.setPen(Qt::NoPen);
    painter.setBrush(colorOf(color));
    painter.drawRoundedRect(rectOf(rect), cornerRadius, cornerRadius);
}

void PixelCanvas::stroke(const CGRect& rect, double cornerRadius, double width, RGBA color) {
    auto& painter = _painting->painter;
    painter.setPen(QPen(colorOf(color), width, Qt::SolidLine, Qt::SquareCap, Qt::MiterJoin));
    painter.setBrush(Qt::NoBrush);
    const double half = width / 2;
    const double radius = std::max(0.0, cornerRadius - half);
    painter.drawRoundedRect(rectOf(rect).adjusted(half, half, -half, -half), radius, radius);
}

void PixelCanvas::text(const TextLine& line, CGPoint baseline, RGBA color) {
    const auto* const layout = _ShapedLines::shapeOf(line);
    if (!layout || layout->lineCount() == 0)
        return;
    auto& painter = _painting->painter;
    const auto transform = painter.worldTransform();
    const double wanted = transform.dy() + transform.m22() * baseline.y;
    const double y = (std::round(wanted) - transform.dy()) / transform.m22();
    painter.setPen(colorOf(color));
    layout->draw(&painter, QPointF(baseline.x, y - layout->lineAt(0).ascent()));
}

void PixelCanvas::pixels(std::span<const std::uint32_t> pixels,
                         int columns,
                         int rows,
                         const CGRect& rect,
                         const RGBA* tint) {
    const auto tinted = tint ? TintedPixels::of(pixels, *tint) : std::vector<std::uint32_t>();
    const auto* const data = tint ? tinted.data() : pixels.data();
    const QImage image(reinterpret_cast<const uchar*>(data),
                       columns,
                       rows,
                       static_cast<qsizetype>(columns) *
                           static_cast<qsizetype>(sizeof(std::uint32_t)),
                       QImage::Format_ARGB32_Premultiplied);
    _painting->painter.drawImage(rectOf(rect), image);
}

void PixelCanvas::fixedImage(std::string_view name, const CGRect& rect, RGBA color) {
    const int side =
        static_cast<int>(std::lround(std::min(rect.size.width, rect.size.height) * _scale));
    const auto drawn = FixedImagePainter::draw(name, side, color);
    if (!drawn.empty())
        pixels(drawn, side, side, rect, nullptr);
}

} // namespace orvo
