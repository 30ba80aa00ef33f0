#include "platform/uikit/drawing/FixedImagePainter.h"

#include <QImage>
#include <QPainter>
#include <QPainterPath>
#include <QtMath>

#include <algorithm>
#include <cmath>
#include <initializer_list>
#include <map>

namespace orvo::FixedImagePainter {

namespace {

// All coordinates below are those of a grid of 24 by 24. Straight edges lie on whole numbers: they
// fall on whole pixels at every scale.
constexpr double Grid = 24;
constexpr double Stroke = 2;

/// Draws a stencil: covers, and cuts out.
class Stencil {
public:
    explicit Stencil(QPainter& painter)
        : _painter(painter) {}

    void fill(const QPainterPath& path) { _painter.fillPath(path, Qt::black); }
    void stroke(const QPainterPath& path) {
        _painter.strokePath(path,
                            QPen(Qt::black, Stroke, Qt::SolidLine, Qt::RoundCap, Qt::RoundJoin));
    }
    /// From now on, what is drawn is cut out.
    void beginCuttingOut() {
        _painter.setCompositionMode(QPainter::CompositionMode_DestinationOut);
    }

private:
    QPainter& _painter;
};

QPainterPath polyline(std::initializer_list<QPointF> points) {
    QPainterPath path(*points.begin());
    std::for_each(points.begin() + 1, points.end(), [&](QPointF point) { path.lineTo(point); });
    return path;
}

QPainterPath disc(QPointF centre, double radius) {
    QPainterPath path;
    path.addEllipse(centre, radius, radius);
    return path;
}

QPainterPath roundedRectangle(const QRectF& rectangle, double radius) {
    QPainterPath path;
    path.addRoundedRect(rectangle, radius, radius);
    return path;
}

void drawCheckedDisc(Stencil& stencil) {
    stencil.fill(disc({12, 12}, 10));
    stencil.beginCuttingOut();
    stencil.stroke(polyline({{7.5, 12.5}, {10.5, 15.5}, {16.5, 9}}));
}

/// An isosceles triangle on its base, around corners that lie `radius` inside it.
QPainterPath roundedTriangle(QPointF top, QPointF right, QPointF left, double radius) {
    const auto around = [&](QPointF corner) {
        return QRectF(corner.x() - radius, corner.y() - radius, 2 * radius, 2 * radius);
    };
    // Directions that the sides face, counter-clockwise from the right.
    const double rightSide =
        qRadiansToDegrees(std::atan2(right.x() - top.x(), right.y() - top.y()));
    const double leftSide = 180 - rightSide;
    constexpr double Base = -90;
    QPainterPath path;
    path.arcMoveTo(around(top), leftSide);
    path.arcTo(around(top), leftSide, rightSide - leftSide);
    path.arcTo(around(right), rightSide, Base - rightSide);
    path.arcTo(around(left), Base, Base - rightSide);
    path.closeSubpath();
    return path;
}

void drawWarningTriangle(Stencil& stencil) {
    stencil.fill(roundedTriangle({12, 5}, {20, 19}, {4, 19}, 2));
    stencil.beginCuttingOut();
    stencil.stroke(polyline({{12, 9}, {12, 13.5}}));
    stencil.fill(disc({12, 17.25}, 1.25));
}

void drawTram(Stencil& stencil) {
    stencil.stroke(polyline({{9, 2}, {15, 2}})); // current collector
    stencil.stroke(polyline({{12, 2}, {12, 6}}));
    stencil.fill(roundedRectangle({5, 5, 14, 14}, 3));
    stencil.stroke(polyline({{8, 18}, {6, 22}})); // rails
    stencil.stroke(polyline({{16, 18}, {18, 22}}));
    stencil.beginCuttingOut();
    stencil.fill(roundedRectangle({7, 8, 10, 4}, 1)); // window
    stencil.fill(disc({8.5, 15.5}, 1.25));            // lamps
    stencil.fill(disc({15.5, 15.5}, 1.25));
}

using Drawing = void (*)(Stencil& stencil);

Drawing drawingNamed(std::string_view name) {
    static const std::map<std::string_view, Drawing> drawings{
        {"good-v2", drawCheckedDisc},
        {"good-alt-v2", drawCheckedDisc}, // told apart by their colours
        {"advisories-v2", drawWarningTriangle},
        {"WidgetGenericTransit", drawTram},
    };
    const auto found = drawings.find(name);
    return found == drawings.end() ? nullptr : found->second;
}

} // namespace

std::vector<std::uint32_t> draw(std::string_view name, int side, RGBA color) {
    const Drawing drawing = drawingNamed(name);
    if (!drawing || side < 1)
        return {};
    const auto length = static_cast<std::size_t>(side);
    std::vector<std::uint32_t> pixels(length * length);
    QImage image(reinterpret_cast<uchar*>(pixels.data()),
                 side,
                 side,
                 static_cast<qsizetype>(length * sizeof(std::uint32_t)),
                 QImage::Format_ARGB32_Premultiplied);
    QPainter painter(&image);
    painter.setRenderHint(QPainter::Antialiasing);
    painter.scale(side / Grid, side / Grid);
    Stencil stencil(painter);
    drawing(stencil);
    painter.setCompositionMode(QPainter::CompositionMode_SourceIn);
    painter.fillRect(QRectF(0, 0, Grid, Grid),
                     QColor(color.red, color.green, color.blue, color.alpha));
    return pixels;
}

} // namespace orvo::FixedImagePainter
