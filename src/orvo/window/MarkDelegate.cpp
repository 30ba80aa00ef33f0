#include "orvo/window/private/MarkDelegate.h"

#include <QPainter>
#include <QPainterPath>

#include <algorithm>

namespace orvo {

namespace {

constexpr int ShieldSize = 5; // 22 points high
constexpr int ShieldColumn = 44;
constexpr int Side = 12;
constexpr int Inset = 4;
constexpr int Above = 9;
constexpr int RingWidth = 2;
constexpr double Radius = 6;
constexpr double DetailFactor = 0.88;
constexpr char16_t LeftToRight = 0x2066;
constexpr char16_t EndOfDirection = 0x2069;

QString textOf(const std::string& text) {
    return QString::fromStdString(text);
}

} // namespace

void MarkDelegate::paint(QPainter* painter,
                         const QStyleOptionViewItem& option,
                         const QModelIndex& index) const {
    const auto mark = index.data(MarkRole).value<LineMark>();
    painter->save();
    painter->setRenderHint(QPainter::Antialiasing);
    const QRectF ground = QRectF(option.rect).adjusted(Inset, 1, -Inset, -1);
    if (option.state.testFlag(QStyle::State_Selected)) {
        painter->setPen(Qt::NoPen);
        painter->setBrush(_looks.highlight);
        painter->drawRoundedRect(ground, Radius, Radius);
        if (option.state.testFlag(QStyle::State_HasFocus)) {
            painter->setPen(QPen(_looks.link, RingWidth));
            painter->setBrush(Qt::NoBrush);
            painter->drawRoundedRect(ground.adjusted(1, 1, -1, -1), Radius - 1, Radius - 1);
        }
    }
    const auto place = [&](const QRect& rect) {
        return QStyle::visualRect(option.direction, option.rect, rect);
    };
    const double scale = painter->device()->devicePixelRatioF();
    QRect inside = option.rect.adjusted(Side, 0, -Side, 0);
    int shieldWidth = 0;
    if (const auto shield = _looks.shield(mark, ShieldSize, scale); !shield.isNull()) {
        const auto size = shield.deviceIndependentSize().toSize();
        shieldWidth = std::max(ShieldColumn, size.width());
        const QRect room(inside.left(), inside.top(), shieldWidth, inside.height());
        const QRect middle(QPoint(room.left() + (room.width() - size.width()) / 2,
                                  room.top() + (room.height() - size.height()) / 2),
                           size);
        painter->drawPixmap(place(middle).topLeft(), shield);
    }
    // Titles begin below one another, with or without a shield.
    inside.setLeft(inside.left() + std::max(ShieldColumn, shieldWidth) + Side);

    const auto detailFont = WindowLooks::font(DetailFactor);
    const QFontMetrics detailMetrics(detailFont);
    const auto note = index.data(NoteRole).toString();
    if (!note.isEmpty()) {
        const int width = detailMetrics.horizontalAdvance(note) + 1;
        QRect room = inside;
        room.setLeft(room.right() + 1 - width);
        painter->setFont(detailFont);
        painter->setPen(_looks.secondary);
        painter->drawText(place(room), Qt::AlignVCenter | Qt::AlignLeft, note);
        inside.setRight(room.left() - Side);
    }
    const auto titleFont = WindowLooks::font(1, QFont::Medium);
    const QFontMetrics titleMetrics(titleFont);
    // Of a position, latitude stands first in every language.
    const auto detail = mark.muid == 0 && !mark.detail.empty()
                            ? QChar(LeftToRight) + textOf(mark.detail) + QChar(EndOfDirection)
                            : textOf(mark.detail);
    const int height = titleMetrics.height() + (detail.isEmpty() ? 0 : detailMetrics.height());
    QRect line(inside.left(),
               inside.top() + (inside.height() - height) / 2,
               inside.width(),
               titleMetrics.height());
    const int start =
        static_cast<int>(Qt::AlignVCenter) | static_cast<int>(Qt::AlignAbsolute) |
        static_cast<int>(Qt::TextSingleLine) |
        static_cast<int>(option.direction == Qt::RightToLeft ? Qt::AlignRight : Qt::AlignLeft);
    painter->setFont(titleFont);
    painter->setPen(_looks.text);
    painter->drawText(place(line),
                      start,
                      titleMetrics.elidedText(textOf(mark.title), Qt::ElideRight, line.width()));
    if (!detail.isEmpty()) {
        line.translate(0, titleMetrics.height());
        line.setHeight(detailMetrics.height());
        painter->setFont(detailFont);
        painter->setPen(_looks.secondary);
        painter->drawText(
            place(line), start, detailMetrics.elidedText(detail, Qt::ElideRight, line.width()));
    }
    painter->restore();
}

QSize MarkDelegate::sizeHint(const QStyleOptionViewItem&, const QModelIndex&) const {
    const int text = QFontMetrics(WindowLooks::font(1, QFont::Medium)).height() +
                     QFontMetrics(WindowLooks::font(DetailFactor)).height();
    return {ShieldColumn + 4 * Side, text + 2 * Above};
}

} // namespace orvo
