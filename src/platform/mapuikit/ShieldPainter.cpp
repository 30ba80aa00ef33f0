#include "platform/mapuikit/ShieldPainter.h"

#include "platform/geoservices/TransitArtworkTypes.h"
#include "platform/uikit/text/private/ToolkitFonts.h"

#include <QFont>
#include <QGuiApplication>
#include <QImage>
#include <QPainter>
#include <QPainterPath>
#include <QTextBoundaryFinder>

#include <algorithm>
#include <array>
#include <cmath>
#include <optional>

namespace orvo::ShieldPainter {

namespace {

constexpr double TextPart = 0.58;    // of the height
constexpr double PaddingPart = 0.3;  // of the height, each side
constexpr double RoundedPart = 0.22; // corner radius of trams, buses and neutral shields
constexpr double SquarePart = 0.1;   // of rail
constexpr qsizetype DiscCharacters = 2;
constexpr qsizetype MostCharacters = 40; // no column has room for more
constexpr double VisibleContrast = 1.6;  // between shield and card; below it a hairline helps

// Laid out large and scaled down: font sizes of the toolkit are whole pixels, a path's are not.
constexpr int LayoutPixels = 128;

struct Colours {
    QColor background;
    QColor text;
};

QColor cardColour(bool nightMode) {
    return nightMode ? QColor(0x1E, 0x1E, 0x22) : QColor(0xF4, 0xF4, 0xF6);
}
QColor secondaryColour(bool nightMode) {
    return nightMode ? QColor(0xA9, 0xA9, 0xB2) : QColor(0x5B, 0x5B, 0x63);
}

Colours neutralColours(bool nightMode) {
    const QColor light(0xE3, 0xE3, 0xE8);
    const QColor dark(0x3A, 0x3A, 0x40);
    return nightMode ? Colours{dark, light} : Colours{light, dark};
}

/// Relative luminance and contrast by WCAG 2.
double luminance(const QColor& colour) {
    const auto linear = [](double part) {
        return part <= 0.04045 ? part / 12.92 : std::pow((part + 0.055) / 1.055, 2.4);
    };
    return 0.2126 * linear(colour.redF()) + 0.7152 * linear(colour.greenF()) +
           0.0722 * linear(colour.blueF());
}

double contrast(const QColor& a, const QColor& b) {
    const auto [darker, lighter] = std::minmax({luminance(a), luminance(b)});
    return (lighter + 0.05) / (darker + 0.05);
}

/// From `RRGGBB` or `RRGGBB,RRGGBB`; nothing for anything else.
std::optional<Colours> ownColours(const TransitShieldDataSource& shield) {
    const auto parts = QString::fromStdString(shield.shieldColorString().value_or("")).split(',');
    const QColor background("#" + parts.first());
    if (parts.first().size() != 6 || !background.isValid())
        return std::nullopt;
    const QColor given = parts.size() > 1 ? QColor("#" + parts[1]) : QColor();
    if (given.isValid())
        return Colours{background, given};
    return Colours{background,
                   contrast(background, Qt::white) >= contrast(background, Qt::black) ? Qt::white
                                                                                      : Qt::black};
}

/// The text, or as much of its beginning as is whole characters and may be drawn.
QString drawnText(const TransitShieldDataSource& shield) {
    auto text = QString::fromStdString(shield.shieldText().value_or(""));
    if (text.size() <= MostCharacters)
        return text;
    const QString begin = text.left(MostCharacters + 1); // whether a character ends there
    QTextBoundaryFinder characters(QTextBoundaryFinder::Grapheme, begin);
    characters.setPosition(MostCharacters);
    const qsizetype end =
        characters.isAtBoundary() ? MostCharacters : characters.toPreviousBoundary();
    return begin.left(end > 0 ? end : MostCharacters) + u'…';
}

/// The text as a shape whose capitals stand `capHeight`-centred around y = 0, from x = 0.
struct TextShape {
    QPainterPath path = {};
    double width = 0;
};

TextShape textShape(const QString& text, double height) {
    const auto font =
        ToolkitFonts::fontOf({.pointSize = LayoutPixels, .weight = QFont::DemiBold}, text);
    const QFontMetricsF metrics(font);
    QPainterPath path;
    path.addText(0, metrics.capHeight() / 2, font, text);
    const double factor = height * TextPart / LayoutPixels;
    return {QTransform::fromScale(factor, factor).map(path),
            metrics.horizontalAdvance(text) * factor};
}

double cornerRadius(TransitShieldType type, const QString& text, double width, double height) {
    switch (type) {
    case TransitShieldType::Metro:
        return text.size() <= DiscCharacters ? std::min(width, height) / 2 : height / 2;
    case TransitShieldType::Ferry:
    case TransitShieldType::Cable:
        return height / 2;
    case TransitShieldType::Rail:
        return height * SquarePart;
    case TransitShieldType::Neutral:
    case TransitShieldType::Tram:
    case TransitShieldType::Bus:
        break;
    }
    return height * RoundedPart;
}

std::shared_ptr<UIImage> imageOf(const QImage& image, double scale) {
    std::vector<std::uint32_t> pixels;
    pixels.reserve(static_cast<std::size_t>(image.width()) *
                   static_cast<std::size_t>(image.height()));
    for (int row = 0; row < image.height(); ++row) {
        const auto* line = reinterpret_cast<const std::uint32_t*>(image.constScanLine(row));
        pixels.insert(pixels.end(), line, line + image.width());
    }
    return UIImage::imageWithPixels_size_scale(
        std::move(pixels), {image.width() / scale, image.height() / scale}, scale);
}

} // namespace

double heightOf(std::int64_t shieldSize) noexcept {
    constexpr std::array<double, 8> Heights = {12, 14, 16, 18, 20, 22, 25, 28};
    constexpr auto Largest = static_cast<std::int64_t>(Heights.size()) - 1;
    return Heights.at(static_cast<std::size_t>(std::clamp(shieldSize, std::int64_t{0}, Largest)));
}

bool isVisible(const TransitShieldDataSource& shield) {
    return !shield.shieldText().value_or("").empty() || ownColours(shield);
}

std::shared_ptr<UIImage>
draw(const TransitShieldDataSource& shield, std::int64_t shieldSize, double scale, bool nightMode) {
    if (!isVisible(shield) || !qobject_cast<QGuiApplication*>(QCoreApplication::instance()))
        return nullptr;
    const auto text = drawnText(shield);
    const auto colours = ownColours(shield).value_or(neutralColours(nightMode));
    const double height = heightOf(shieldSize);
    const auto shape = text.isEmpty() ? TextShape() : textShape(text, height);
    const auto type = static_cast<TransitShieldType>(shield.shieldType());
    const bool isDisc = type == TransitShieldType::Metro && text.size() <= DiscCharacters;
    const double wanted =
        isDisc ? height : std::max(height, shape.width + 2 * PaddingPart * height);
    const int columns = static_cast<int>(std::ceil(wanted * scale));
    const int rows = static_cast<int>(std::lround(height * scale));

    QImage image(columns, rows, QImage::Format_ARGB32_Premultiplied);
    image.fill(Qt::transparent);
    QPainter painter(&image);
    painter.setRenderHint(QPainter::Antialiasing);
    painter.scale(scale, scale);
    const double width = columns / scale;
    const double radius = cornerRadius(type, text, width, height);
    painter.setPen(Qt::NoPen);
    painter.setBrush(colours.background);
    painter.drawRoundedRect(QRectF(0, 0, width, height), radius, radius);
    if (contrast(colours.background, cardColour(nightMode)) < VisibleContrast) {
        const double hairline = 1 / scale;
        painter.setPen(QPen(secondaryColour(nightMode), hairline));
        painter.setBrush(Qt::NoBrush);
        painter.drawRoundedRect(
            QRectF(hairline / 2, hairline / 2, width - hairline, height - hairline),
            radius,
            radius);
    }
    // A text too wide for its disc shrinks into it.
    const double room = width - 2 * 0.12 * height;
    const double shrink = std::min(1.0, room / std::max(shape.width, 1.0));
    painter.translate(width / 2, height / 2);
    painter.scale(shrink, shrink);
    painter.translate(-shape.width / 2, 0);
    painter.fillPath(shape.path, colours.text);
    painter.end();
    return imageOf(image, scale);
}

} // namespace orvo::ShieldPainter
