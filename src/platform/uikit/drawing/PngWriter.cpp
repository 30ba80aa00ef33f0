#include "platform/uikit/drawing/PngWriter.h"

#include "platform/foundation/Exceptions.h"

#include <QBuffer>
#include <QImage>

#include <cmath>

namespace orvo::PngWriter {

namespace {

constexpr double PointsPerMetre = 72 / 0.0254;

} // namespace

std::vector<std::uint8_t>
write(std::span<const std::uint32_t> pixels, int columns, int rows, double scale) {
    if (columns < 0 || rows < 0 ||
        static_cast<std::size_t>(columns) * static_cast<std::size_t>(rows) != pixels.size())
        throw NSInvalidArgumentException("a picture needs columns times rows pixels");
    QImage image(reinterpret_cast<const uchar*>(pixels.data()),
                 columns,
                 rows,
                 static_cast<qsizetype>(columns) * static_cast<qsizetype>(sizeof(std::uint32_t)),
                 QImage::Format_ARGB32_Premultiplied);
    const int pixelsPerMetre = static_cast<int>(std::lround(PointsPerMetre * scale));
    image.setDotsPerMeterX(pixelsPerMetre);
    image.setDotsPerMeterY(pixelsPerMetre);
    QBuffer file;
    file.open(QIODevice::WriteOnly);
    image.save(&file, "PNG");
    return {file.data().begin(), file.data().end()};
}

} // namespace orvo::PngWriter
