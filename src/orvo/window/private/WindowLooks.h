#pragma once

#include "platform/settings/DesktopAppearance.h"

#include <QColor>
#include <QFont>
#include <QPalette>
#include <QPixmap>

#include <string_view>

namespace orvo {

struct LineMark;

/// The colours and sizes of the windows: those of the card, so that widget and windows are one
/// thing. A value.
struct WindowLooks {
    QColor card;
    QColor field; ///< the ground of fields and lists
    QColor text;
    QColor secondary;
    QColor good;
    QColor advisory;
    QColor link;
    QColor separator;
    QColor highlight; ///< the ground of a row that is chosen
    bool isDark = false;
    double textScale = 1;

    [[nodiscard]] static WindowLooks of(const DesktopAppearance& appearance);

    /// The application's style, palette and font: the desktop's font, in the person's size.
    void applyToApplication() const;
    /// The application's font, that many times as large.
    [[nodiscard]] static QFont font(double factor, QFont::Weight weight = QFont::Normal);

    /// The line's shield, or else its system's mark, for a device of that scale; null for a mark
    /// without one.
    /// @param size 0 to 7
    [[nodiscard]] QPixmap shield(const LineMark& mark, int size, double scale) const;
    /// One of the program's fixed images, `side` points wide and high.
    [[nodiscard]] static QPixmap
    fixedImage(std::string_view name, double side, const QColor& color, double scale);
    /// Stands in a field that searches.
    [[nodiscard]] static QPixmap magnifier(const QColor& color, double scale);

private:
    [[nodiscard]] QPalette palette() const;
    /// Fields, lists, buttons and scroll bars in the card's manner.
    [[nodiscard]] QString styleSheet() const;
};

} // namespace orvo
