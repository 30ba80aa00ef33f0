#pragma once

#include "orvo/window/LineMark.h"
#include "orvo/window/private/WindowLooks.h"

#include <QStyledItemDelegate>

namespace orvo {

/// Draws the rows of a list of lines: the shield, the title and below it what belongs to it, and at
/// the end a note. An item's data is set by `describe`.
class MarkDelegate final : public QStyledItemDelegate {
public:
    enum Role { MarkRole = Qt::UserRole, NoteRole };

    explicit MarkDelegate(QObject* parent)
        : QStyledItemDelegate(parent) {}

    void setLooks(const WindowLooks& looks) { _looks = looks; }

    void paint(QPainter* painter,
               const QStyleOptionViewItem& option,
               const QModelIndex& index) const override;
    [[nodiscard]] QSize sizeHint(const QStyleOptionViewItem& option,
                                 const QModelIndex& index) const override;

private:
    WindowLooks _looks;
};

} // namespace orvo

Q_DECLARE_METATYPE(orvo::LineMark)
