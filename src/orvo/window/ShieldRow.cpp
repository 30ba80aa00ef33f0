#include "orvo/window/private/ShieldRow.h"

#include <QPaintEvent>
#include <QPainter>
#include <QStyle>

#include <algorithm>
#include <cmath>

namespace orvo {

namespace {

constexpr int Size = 4; // 20 points high
constexpr int Gap = 6;
constexpr double AfterFactor = 0.92;

std::shared_ptr<TransitArtworkDataSource> neutralShield(const std::string& text) {
    TransitArtworkDataSource::Fields fields;
    fields.shieldDataSource = TransitShieldDataSource::initWithFields({.shieldText = text});
    return TransitArtworkDataSource::initWithFields(std::move(fields));
}

} // namespace

ShieldRow::ShieldRow(const std::vector<LineMark>& lines,
                     const QString& after,
                     const WindowLooks& looks)
    : _after(after)
    , _looks(looks) {
    QStringList spoken;
    for (auto line : lines) {
        if (!line.artwork)
            line.artwork = neutralShield(line.title);
        spoken << QString::fromStdString(line.spoken());
        _lines.push_back(std::move(line));
    }
    if (!_after.isEmpty())
        spoken << _after;
    setAccessibleName(spoken.join("; "));
    setFont(WindowLooks::font(AfterFactor));
    QSizePolicy policy(QSizePolicy::Preferred, QSizePolicy::Fixed);
    policy.setHeightForWidth(true);
    setSizePolicy(policy);
}

std::vector<QSize> ShieldRow::sizes() const {
    std::vector<QSize> sizes;
    for (const auto& line : _lines)
        sizes.push_back(_looks.shield(line, Size, 1).size());
    if (!_after.isEmpty())
        sizes.emplace_back(fontMetrics().horizontalAdvance(_after), fontMetrics().height());
    return sizes;
}

std::vector<QRect> ShieldRow::placesIn(int width) const {
    const auto sizes = this->sizes();
    int rowHeight = 0;
    for (const auto& size : sizes)
        rowHeight = std::max(rowHeight, size.height());
    std::vector<QRect> places;
    int x = 0;
    int y = 0;
    for (const auto& size : sizes) {
        if (x > 0 && x + size.width() > width) {
            x = 0;
            y += rowHeight + Gap;
        }
        places.emplace_back(QPoint(x, y + (rowHeight - size.height()) / 2), size);
        x += size.width() + Gap;
    }
    return places;
}

int ShieldRow::heightForWidth(int width) const {
    int bottom = 0;
    for (const auto& place : placesIn(width))
        bottom = std::max(bottom, place.bottom() + 1);
    return bottom;
}

QSize ShieldRow::sizeHint() const {
    int width = 0;
    for (const auto& size : sizes())
        width += size.width() + (width > 0 ? Gap : 0);
    return {width, heightForWidth(width)};
}

QSize ShieldRow::minimumSizeHint() const {
    int width = 0;
    int height = 0;
    for (const auto& size : sizes()) {
        width = std::max(width, size.width());
        height = std::max(height, size.height());
    }
    return {width, height};
}

void ShieldRow::paintEvent(QPaintEvent*) {
    QPainter painter(this);
    const auto places = placesIn(width());
    for (std::size_t i = 0; i < places.size(); ++i) {
        const auto place = QStyle::visualRect(layoutDirection(), rect(), places[i]);
        if (i < _lines.size()) {
            painter.drawPixmap(place.topLeft(),
                               _looks.shield(_lines[i], Size, devicePixelRatioF()));
        } else {
            painter.setPen(_looks.secondary);
            painter.drawText(place, Qt::AlignVCenter | Qt::AlignLeading, _after);
        }
    }
}

} // namespace orvo
