#pragma once

#include "platform/uikit/drawing/Canvas.h"

#include <memory>

namespace orvo {

/// Draws into pixels: premultiplied ARGB, row by row from the top, which must outlive it. Texts
/// need a graphical application object; without one they are left out.
class PixelCanvas final : public Canvas {
public:
    /// `pixels` holds `columns` × `rows`; `scale` is in pixels a point.
    PixelCanvas(std::span<std::uint32_t> pixels, int columns, int rows, double scale);
    ~PixelCanvas() override;

    [[nodiscard]] double scale() const override { return _scale; }
    void save() override;
    void restore() override;
    void translate(double x, double y) override;
    void clip(const CGRect& rect, double cornerRadius) override;
    void fade(double alpha) override;
    void fill(const CGRect& rect, double cornerRadius, RGBA color) override;
    void stroke(const CGRect& rect, double cornerRadius, double width, RGBA color) override;
    void text(const TextLine& line, CGPoint baseline, RGBA color) override;
    void pixels(std::span<const std::uint32_t> pixels,
                int columns,
                int rows,
                const CGRect& rect,
                const RGBA* tint) override;
    void fixedImage(std::string_view name, const CGRect& rect, RGBA color) override;

private:
    struct Painting;

    double _scale;
    std::unique_ptr<Painting> _painting;
};

} // namespace orvo
