#pragma once

#include "platform/foundation/CGGeometry.h"
#include "platform/uikit/ArtworkImageSource.h"
#include "platform/uikit/UIGeometry.h"

#include <cstdint>
#include <optional>
#include <span>
#include <string>
#include <vector>

namespace orvo {

/// A picture: pixels, or one of the program's fixed images by its name, which is drawn where and in
/// the colour in which it is shown. Immutable. Any thread.
class UIImage final : public ArtworkImageSource {
public:
    /// The fixed image of that name: `good-v2`, `good-alt-v2`, `advisories-v2`,
    /// `WidgetGenericTransit`, each 24 × 24 points. The same object each time; nil for a name that
    /// the program has no image of.
    [[nodiscard]] static std::shared_ptr<UIImage> imageNamed(const std::string& name);
    /// Premultiplied ARGB pixels, row by row from the top. `size` in points; the pixel counts are
    /// its sides times `scale`.
    /// @throws NSInvalidArgumentException when the number of pixels does not fit
    [[nodiscard]] static std::shared_ptr<UIImage>
    imageWithPixels_size_scale(std::vector<std::uint32_t> pixels, CGSize size, double scale);

    /// Nil for an image of pixels.
    [[nodiscard]] const std::optional<std::string>& name() const noexcept { return _name; }
    /// In points.
    [[nodiscard]] CGSize size() const noexcept { return _size; }
    /// What is empty around a fixed image's drawing, in points of its size: who lines it up with a
    /// text goes by what one sees. None for an image of pixels.
    [[nodiscard]] const UIEdgeInsets& alignmentRectInsets() const noexcept {
        return _alignmentRectInsets;
    }
    /// Pixels a point; 1 for a fixed image.
    [[nodiscard]] double scale() const noexcept { return _scale; }
    /// Empty for a fixed image.
    [[nodiscard]] std::span<const std::uint32_t> pixels() const noexcept { return _pixels; }

    /// Itself: a fixed image is drawn for whatever screen shows it.
    [[nodiscard]] std::shared_ptr<UIImage>
    imageToDisplayWithScreenScale_nightMode(double scale, bool nightMode) override;
    [[nodiscard]] std::string _dumpedName() const override { return _name.value_or(""); }
    [[nodiscard]] std::string description() const override;

private:
    std::optional<std::string> _name;
    CGSize _size;
    UIEdgeInsets _alignmentRectInsets;
    double _scale = 1;
    std::vector<std::uint32_t> _pixels;
};

} // namespace orvo
