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

/// What stands below the title.
QString detailOf(const LineMark& mark) {
    const bool isPosition = mark.muid == 0 && !mark.detail.empty();
    // Of a position, latitude stands first in every language.
    return isPosition ? QChar(LeftToRight) + textOf(mark.detail) + QChar(EndOfDirection)
                      : textOf(mark.detail);
}

/// One row while it is painted, from its edges to its middle: what is painted takes its room from
/// what comes later.
class RowPainting {
public:
    RowPainting(QPainter& painter, const QStyleOptionViewItem& option, const WindowLooks& looks)
        : _painter(painter)
        , _option(option)
        , _looks(looks)
        , _inside(option.rect.adjusted(Side, 0, -Side, 0)) {}

    void paintGround() const;
    void paintShield(const LineMark& mark);
    void paintNote(const QString& note);
    void paintTexts(const QString& title, const QString& detail) const;

private:
    void paintLine(const QRect& line, const QString& text) const;
    /// A place in a row that is read from left to right, where it is in this one.
    [[nodiscard]] QRect placed(const QRect& rect) const {
        return QStyle::visualRect(_option.direction, _option.rect, rect);
    }

    QPainter& _painter;
    const QStyleOptionViewItem& _option;
    const WindowLooks& _looks;
    QRect _inside; ///< what is free, as if it were read from left to right
};

void RowPainting::paintGround() const {
    if (!_option.state.testFlag(QStyle::State_Selected))
        return;
    const QRectF ground = QRectF(_option.rect).adjusted(Inset, 1, -Inset, -1);
    _painter.setPen(Qt::NoPen);
    _painter.setBrush(_looks.highlight);
    _painter.drawRoundedRect(ground, Radius, Radius);
    if (!_option.state.testFlag(QStyle::State_HasFocus))
        return;
    _painter.setPen(QPen(_looks.link, RingWidth));
    _painter.setBrush(Qt::NoBrush);
    _painter.drawRoundedRect(ground.adjusted(1, 1, -1, -1), Radius - 1, Radius - 1);
}

void RowPainting::paintShield(const LineMark& mark) {
    const double scale = _painter.device()->devicePixelRatioF();
    int width = ShieldColumn; // titles begin below one another, with or without a shield
    if (const auto shield = _looks.shield(mark, ShieldSize, scale); !shield.isNull()) {
        const auto size = shield.deviceIndependentSize().toSize();
        width = std::max(width, size.width());
        const QPoint middle(_inside.left() + (width - size.width()) / 2,
                            _inside.top() + (_inside.height() - size.height()) / 2);
        _painter.drawPixmap(placed(QRect(middle, size)).topLeft(), shield);
    }
    _inside.setLeft(_inside.left() + width + Side);
}

void RowPainting::paintNote(const QString& note) {
    if (note.isEmpty())
        return;
    const auto font = WindowLooks::font(DetailFactor);
    QRect room = _inside;
    room.setLeft(room.right() - QFontMetrics(font).horizontalAdvance(note));
    _painter.setFont(font);
    _painter.setPen(_looks.secondary);
    _painter.drawText(placed(room), Qt::AlignVCenter | Qt::AlignLeft, note);
    _inside.setRight(room.left() - Side);
}

void RowPainting::paintTexts(const QString& title, const QString& detail) const {
    const auto titleFont = WindowLooks::font(1, QFont::Medium);
    const auto detailFont = WindowLooks::font(DetailFactor);
    const int titleHeight = QFontMetrics(titleFont).height();
    const int detailHeight = detail.isEmpty() ? 0 : QFontMetrics(detailFont).height();
    const int top = _inside.top() + (_inside.height() - titleHeight - detailHeight) / 2;
    _painter.setFont(titleFont);
    _painter.setPen(_looks.text);
    paintLine({_inside.left(), top, _inside.width(), titleHeight}, title);
    if (detail.isEmpty())
        return;
    _painter.setFont(detailFont);
    _painter.setPen(_looks.secondary);
    paintLine({_inside.left(), top + titleHeight, _inside.width(), detailHeight}, detail);
}

/// On the side where reading starts, whatever the language of the text.
void RowPainting::paintLine(const QRect& line, const QString& text) const {
    const auto side = _option.direction == Qt::RightToLeft ? Qt::AlignRight : Qt::AlignLeft;
    const int flags = static_cast<int>(Qt::AlignVCenter) | static_cast<int>(Qt::AlignAbsolute) |
                      static_cast<int>(Qt::TextSingleLine) | static_cast<int>(side);
    _painter.drawText(
        placed(line), flags, _painter.fontMetrics().elidedText(text, Qt::ElideRight, line.width()));
}

} // namespace

void MarkDelegate::paint(QPainter* painter,
                         const QStyleOptionViewItem& option,
                         const QModelIndex& index) const {
    const auto mark = index.data(MarkRole).value<LineMark>();
    painter->save();
    painter->setRenderHint(QPainter::Antialiasing);
    RowPainting row(*painter, option, _looks);
    row.paintGround();
    row.paintShield(mark);
    row.paintNote(index.data(NoteRole).toString());
    row.paintTexts(textOf(mark.title), detailOf(mark));
    painter->restore();
}

QSize MarkDelegate::sizeHint(const QStyleOptionViewItem&, const QModelIndex&) const {
    const int text = QFontMetrics(WindowLooks::font(1, QFont::Medium)).height() +
                     QFontMetrics(WindowLooks::font(DetailFactor)).height();
    return {ShieldColumn + 4 * Side, text + 2 * Above};
}

} // namespace orvo
