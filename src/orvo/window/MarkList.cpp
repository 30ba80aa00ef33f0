#include "orvo/window/private/MarkList.h"

#include "orvo/window/private/MarkDelegate.h"

#include <QMimeData>

namespace orvo {

MarkList::MarkList(MarkDelegate* delegate, const QString& spokenName) {
    setItemDelegate(delegate);
    setAccessibleName(spokenName);
    setVerticalScrollMode(QAbstractItemView::ScrollPerPixel);
    setHorizontalScrollBarPolicy(Qt::ScrollBarAlwaysOff);
    setUniformItemSizes(true);
    setFrameShape(QFrame::StyledPanel);
}

void MarkList::addMark(const LineMark& mark, const QString& note) {
    auto* const item = new QListWidgetItem(this);
    item->setData(MarkDelegate::MarkRole, QVariant::fromValue(mark));
    item->setData(MarkDelegate::NoteRole, note);
    auto spoken = QString::fromStdString(mark.spoken());
    if (!note.isEmpty())
        spoken += ", " + note;
    item->setData(Qt::AccessibleTextRole, spoken);
    item->setToolTip(spoken.toHtmlEscaped());
}

LineMark MarkList::markOf(const QListWidgetItem& item) {
    return item.data(MarkDelegate::MarkRole).value<LineMark>();
}

QMimeData* MarkList::mimeData(const QList<QListWidgetItem*>&) const {
    auto* const rows = new QMimeData;
    rows->setData(model()->mimeTypes().value(0), {});
    return rows;
}

} // namespace orvo
