#include "orvo/window/private/WindowLooks.h"

#include "orvo/window/LineMark.h"
#include "platform/mapuikit/IconManager.h"
#include "platform/uikit/drawing/FixedImagePainter.h"

#include <QApplication>
#include <QFontDatabase>
#include <QImage>
#include <QPainter>
#include <QScreen>
#include <QStyle>

#include <array>
#include <cmath>
#include <span>
#include <utility>

namespace orvo {

namespace {

constexpr double UsualPoints = 10.5;   // where no desktop says how large text is
constexpr double UnscaledInch = 96.5;  // logical dots; a desktop that enlarges text has more
constexpr double SeparatorPart = 0.2;  // of the secondary colour
constexpr double HighlightPart = 0.08; // of the text's colour
constexpr double FaintPart = 0.55;     // of the secondary colour, for what cannot be used now

QColor hex(std::uint32_t rgb) {
    return QColor::fromRgb(rgb);
}

/// `part` of `over` on the ground, opaque.
QColor mixed(const QColor& ground, const QColor& over, double part) {
    const auto channel = [&](double below, double above) {
        return static_cast<float>(below + (above - below) * part);
    };
    return QColor::fromRgbF(channel(ground.redF(), over.redF()),
                            channel(ground.greenF(), over.greenF()),
                            channel(ground.blueF(), over.blueF()));
}

QImage imageOf(std::span<const std::uint32_t> pixels, int columns, int rows) {
    return QImage(reinterpret_cast<const uchar*>(pixels.data()),
                  columns,
                  rows,
                  QImage::Format_ARGB32_Premultiplied)
        .copy();
}

/// The desktop's font; Inter, which the card has, where the desktop names none.
QFont desktopFont() {
    static const QFont font = [] {
        QFont given = QApplication::font();
        const auto family = given.family();
        const bool isNamed = !family.isEmpty() && !family.startsWith("Sans", Qt::CaseInsensitive);
        if (!isNamed) {
            if (QFontDatabase::hasFamily("Inter"))
                given.setFamilies({"Inter", family});
            given.setPointSizeF(UsualPoints);
        }
        return given;
    }();
    return font;
}

} // namespace

WindowLooks WindowLooks::of(const DesktopAppearance& appearance) {
    WindowLooks looks;
    looks.isDark = appearance.isDark;
    looks.textScale = appearance.textScale;
    if (appearance.isDark) {
        const bool more = appearance.hasHighContrast;
        looks.card = hex(more ? 0x000000 : 0x1E1E22);
        looks.field = hex(more ? 0x000000 : 0x28282D);
        looks.text = hex(more ? 0xFFFFFF : 0xF5F5F7);
        looks.secondary = hex(more ? 0xD2D2D8 : 0xA9A9B2);
        looks.good = hex(more ? 0x6BE08A : 0x4CC36A);
        looks.advisory = hex(more ? 0xFFC766 : 0xFFB340);
        looks.link = hex(more ? 0xA8CCFF : 0x7FB2FF);
    } else {
        const bool more = appearance.hasHighContrast;
        looks.card = hex(more ? 0xFFFFFF : 0xF4F4F6);
        looks.field = hex(0xFFFFFF);
        looks.text = hex(more ? 0x000000 : 0x17171A);
        looks.secondary = hex(more ? 0x3A3A40 : 0x5B5B63);
        looks.good = hex(more ? 0x0B5F26 : 0x1B7F3B);
        looks.advisory = hex(more ? 0x7A3600 : 0xA34A00);
        looks.link = hex(more ? 0x0A3D8F : 0x1A5DBF);
    }
    looks.separator =
        mixed(looks.card, looks.secondary, appearance.hasHighContrast ? 1.0 : SeparatorPart);
    looks.highlight = mixed(looks.field, looks.text, HighlightPart);
    return looks;
}

void WindowLooks::applyToApplication() const {
    static const bool isFusion = QApplication::setStyle("fusion") != nullptr;
    static_cast<void>(isFusion); // once: a change of style costs every widget
    QApplication::setPalette(palette());
    if (auto* const application = qobject_cast<QApplication*>(QCoreApplication::instance()))
        application->setStyleSheet(styleSheet());
    QFont given = desktopFont();
    const auto* screen = QGuiApplication::primaryScreen();
    const bool isEnlarged = screen && screen->logicalDotsPerInch() > UnscaledInch;
    if (!isEnlarged && given.pointSizeF() > 0)
        given.setPointSizeF(given.pointSizeF() * textScale);
    QApplication::setFont(given);
}

QFont WindowLooks::font(double factor, QFont::Weight weight) {
    QFont font = QApplication::font();
    if (font.pointSizeF() > 0)
        font.setPointSizeF(font.pointSizeF() * factor);
    else
        font.setPixelSize(static_cast<int>(std::lround(font.pixelSize() * factor)));
    font.setWeight(weight);
    return font;
}

QPixmap WindowLooks::shield(const LineMark& mark, int size, double scale) const {
    const auto manager = IconManager::sharedManager();
    const auto& artwork = mark.picture();
    const auto image = artwork && manager
                           ? manager->drawnImageForArtwork_shieldSize_scale_nightMode(
                                 *artwork, size, scale, isDark)
                           : nullptr;
    if (!image)
        return {};
    auto pixmap =
        QPixmap::fromImage(imageOf(image->pixels(),
                                   static_cast<int>(std::lround(image->size().width * scale)),
                                   static_cast<int>(std::lround(image->size().height * scale))));
    pixmap.setDevicePixelRatio(scale);
    return pixmap;
}

QPixmap
WindowLooks::fixedImage(std::string_view name, double side, const QColor& color, double scale) {
    const int pixels = static_cast<int>(std::lround(side * scale));
    const auto drawn =
        FixedImagePainter::draw(name, pixels, RGBA::fromHex(color.rgb() & 0xFFFFFFU));
    if (drawn.empty())
        return {};
    auto pixmap = QPixmap::fromImage(imageOf(drawn, pixels, pixels));
    pixmap.setDevicePixelRatio(scale);
    return pixmap;
}

QPixmap WindowLooks::magnifier(const QColor& color, double scale) {
    constexpr double side = 16;
    QPixmap pixmap(QSizeF(side * scale, side * scale).toSize());
    pixmap.setDevicePixelRatio(scale);
    pixmap.fill(Qt::transparent);
    QPainter painter(&pixmap);
    painter.setRenderHint(QPainter::Antialiasing);
    painter.setPen(QPen(color, 1.6, Qt::SolidLine, Qt::RoundCap));
    painter.drawEllipse(QRectF(2.5, 2.5, 8, 8));
    painter.drawLine(QPointF(9.7, 9.7), QPointF(13.2, 13.2));
    painter.end();
    return pixmap;
}

QString WindowLooks::styleSheet() const {
    const auto edge = mixed(card, secondary, 0.45).name();
    const auto button = mixed(card, text, isDark ? 0.1 : 0.04).name();
    const auto pressed = mixed(card, text, isDark ? 0.2 : 0.12).name();
    const auto faint = mixed(card, secondary, FaintPart).name();
    return QString(R"(
QLineEdit, QListWidget { border: 1px solid %1; border-radius: 8px; background: %2; }
QLineEdit { padding: 7px 8px; }
QListWidget { padding: 4px 0; outline: 0; }
QLineEdit:focus { border-color: %3; }
QPushButton { border: 1px solid %1; border-radius: 7px; padding: 5px 14px; background: %4; }
QPushButton:focus { border-color: %3; }
QPushButton:hover, QPushButton:pressed { background: %5; }
QPushButton:disabled { color: %6; border-color: %7; background: transparent; }
QScrollBar:vertical { width: 12px; background: transparent; border: 0; }
QScrollBar::handle:vertical { background: %1; border-radius: 4px; margin: 2px; min-height: 32px; }
QScrollBar::add-line, QScrollBar::sub-line { height: 0; }
QScrollBar::add-page, QScrollBar::sub-page { background: transparent; }
)")
        .arg(edge, field.name(), link.name(), button, pressed, faint, separator.name());
}

QPalette WindowLooks::palette() const {
    const auto white = hex(0xFFFFFF);
    const auto colors = std::to_array<std::pair<QPalette::ColorRole, QColor>>(
        {{QPalette::Window, card},
         {QPalette::WindowText, text},
         {QPalette::Base, field},
         {QPalette::AlternateBase, card},
         {QPalette::Text, text},
         {QPalette::PlaceholderText, secondary},
         {QPalette::Button, mixed(card, text, isDark ? 0.1 : 0.03)},
         {QPalette::ButtonText, text},
         {QPalette::BrightText, text},
         {QPalette::ToolTipBase, field},
         {QPalette::ToolTipText, text},
         {QPalette::Link, link},
         {QPalette::LinkVisited, link},
         {QPalette::Highlight, hex(isDark ? 0x3D6FB8 : 0x2F6FCF)},
         {QPalette::HighlightedText, white},
         {QPalette::Light, mixed(card, white, isDark ? 0.1 : 0.8)},
         {QPalette::Midlight, mixed(card, white, isDark ? 0.06 : 0.5)},
         {QPalette::Mid, mixed(card, text, 0.25)},
         {QPalette::Dark, mixed(card, text, 0.35)},
         {QPalette::Shadow, hex(0x000000)}});
    QPalette palette;
    for (const auto& [role, color] : colors)
        palette.setColor(role, color);
    const auto faint = mixed(card, secondary, FaintPart);
    for (const auto role : {QPalette::WindowText, QPalette::Text, QPalette::ButtonText})
        palette.setColor(QPalette::Disabled, role, faint);
    return palette;
}

} // namespace orvo
