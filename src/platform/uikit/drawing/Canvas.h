#pragma once

#include "platform/foundation/CGGeometry.h"
#include "platform/uikit/drawing/RGBA.h"
#include "platform/uikit/text/TextLayout.h"

#include <span>
#include <string_view>

namespace orvo {

/// What views draw on. Lengths are points in the coordinates of the view that draws. Main thread.
class Canvas {
public:
    Canvas() = default;
    Canvas(const Canvas&) = delete;
    Canvas& operator=(const Canvas&) = delete;
    virtual ~Canvas() = default;

    /// Pixels a point.
    [[nodiscard]] virtual double scale() const = 0;

    /// Keeps position, clip and opacity until the matching `restore`.
    virtual void save() = 0;
    virtual void restore() = 0;
    virtual void translate(double x, double y) = 0;
    virtual void clip(const CGRect& rect, double cornerRadius) = 0;
    /// Everything until `restore` becomes this much fainter, 0 to 1.
    virtual void fade(double alpha) = 0;

    virtual void fill(const CGRect& rect, double cornerRadius, RGBA color) = 0;
    /// Inside the edge of `rect`.
    virtual void stroke(const CGRect& rect, double cornerRadius, double width, RGBA color) = 0;
    /// `baseline` is where the line starts at its left; its y goes to a whole device pixel.
    virtual void text(const TextLine& line, CGPoint baseline, RGBA color) = 0;
    /// Premultiplied ARGB, stretched over `rect`. With `tint` it is shown in that colour alone, its
    /// shades as they were.
    virtual void pixels(std::span<const std::uint32_t> pixels,
                        int columns,
                        int rows,
                        const CGRect& rect,
                        const RGBA* tint) = 0;
    /// A fixed image of the program by its name, in one colour.
    virtual void fixedImage(std::string_view name, const CGRect& rect, RGBA color) = 0;
};

} // namespace orvo
