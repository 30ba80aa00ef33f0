#include "platform/uikit/drawing/PngWriter.h"

#include "platform/foundation/Exceptions.h"

#include <QImage>
#include <gtest/gtest.h>

#include <array>

namespace orvo {
namespace {

QImage imageOf(const std::vector<std::uint8_t>& file) {
    return QImage::fromData(file.data(), static_cast<int>(file.size()), "PNG");
}

constexpr std::array<std::uint32_t, 6> Pixels{
    0xFFFF0000, 0xFF00FF00, 0xFF0000FF, 0x80800000, 0x00000000, 0xFFFFFFFF};

TEST(PngWriter, AnotherReaderFindsEachPixelInItsPlace) {
    const auto image = imageOf(PngWriter::write(Pixels, 3, 2, 1));
    ASSERT_EQ(image.size(), QSize(3, 2));
    EXPECT_EQ(image.pixel(0, 0), 0xFFFF0000);
    EXPECT_EQ(image.pixel(1, 0), 0xFF00FF00);
    EXPECT_EQ(image.pixel(2, 0), 0xFF0000FF);
    EXPECT_EQ(image.pixel(0, 1), 0x80FF0000) << "the file's are not premultiplied";
    EXPECT_EQ(image.pixel(1, 1), 0U);
    EXPECT_EQ(image.pixel(2, 1), 0xFFFFFFFF);
}

TEST(PngWriter, SaysHowLargeAPixelIs) {
    for (const auto& [scale, perMetre] : {std::pair(1.0, 2835), {2.0, 5669}, {3.0, 8504}}) {
        const auto image = imageOf(PngWriter::write(Pixels, 2, 3, scale));
        EXPECT_EQ(image.dotsPerMeterX(), perMetre) << scale;
        EXPECT_EQ(image.dotsPerMeterY(), perMetre) << scale;
    }
}

TEST(PngWriter, TheSamePixelsAreTheSameFile) {
    EXPECT_EQ(PngWriter::write(Pixels, 3, 2, 2), PngWriter::write(Pixels, 3, 2, 2));
    EXPECT_NE(PngWriter::write(Pixels, 3, 2, 2), PngWriter::write(Pixels, 2, 3, 2));
}

TEST(PngWriter, PixelsMustFit) {
    EXPECT_THROW(static_cast<void>(PngWriter::write(Pixels, 3, 3, 1)), NSInvalidArgumentException);
    EXPECT_THROW(static_cast<void>(PngWriter::write(Pixels, -3, -2, 1)),
                 NSInvalidArgumentException);
}

TEST(PngWriter, WithoutPixelsThereIsNoFile) {
    EXPECT_TRUE(PngWriter::write({}, 0, 0, 1).empty());
}

} // namespace
} // namespace orvo
