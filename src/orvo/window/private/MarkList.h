#pragma once

#include "orvo/window/LineMark.h"

#include <QListWidget>

namespace orvo {

class MarkDelegate;

/// A list of lines and places, one a row. Rows are moved inside it and never copied: what travels
/// with the pointer says only that they are rows, since no other list could read them.
class MarkList final : public QListWidget {
public:
    /// @param delegate paints the rows; must outlive the list. Not nil.
    /// @param spokenName what the list is called by a voice
    MarkList(MarkDelegate* delegate, const QString& spokenName);

    /// At the end. `note` stands at the end of the row, and is spoken after the mark; may be empty.
    void addMark(const LineMark& mark, const QString& note);
    [[nodiscard]] static LineMark markOf(const QListWidgetItem& item);

protected:
    [[nodiscard]] QMimeData* mimeData(const QList<QListWidgetItem*>& items) const override;
};

} // namespace orvo
