#pragma once

#include "orvo/window/LineMark.h"
#include "orvo/window/private/WindowLooks.h"

#include <QWidget>

#include <vector>

namespace orvo {

/// The shields of some lines side by side, in as many rows as they need, with a text after them. A
/// line without a shield gets a neutral one with its name.
class ShieldRow final : public QWidget {
public:
    /// `after` may be empty.
    ShieldRow(const std::vector<LineMark>& lines, const QString& after, const WindowLooks& looks);

    [[nodiscard]] bool hasHeightForWidth() const override { return true; }
    [[nodiscard]] int heightForWidth(int width) const override;
    [[nodiscard]] QSize sizeHint() const override;
    [[nodiscard]] QSize minimumSizeHint() const override;

protected:
    void paintEvent(QPaintEvent* event) override;

private:
    /// Where the shields and, last, the text stand when there is that much width.
    [[nodiscard]] std::vector<QRect> placesIn(int width) const;
    [[nodiscard]] std::vector<QSize> sizes() const;

    std::vector<LineMark> _lines;
    QString _after;
    WindowLooks _looks;
};

} // namespace orvo
