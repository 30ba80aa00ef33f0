#pragma once

#include "platform/uikit/drawing/Canvas.h"

#include <cstdio>
#include <string>
#include <vector>

namespace orvo::testing {

/// Writes down what is drawn, one line each: what, its colour as `RRGGBB` or `RRGGBBAA`, and where,
/// in points of the view that was drawn first. Of a stroke also the width, of round corners the
/// radius.
class RecordingCanvas final : public Canvas {
public:
    explicit RecordingCanvas(double scale = 1)
        : _scale(scale) {}

    std::vector<std::string> drawn;

    double scale() const override { return _scale; }
    void save() override { _origins.push_back(_origins.back()); }
    void restore() override { _origins.pop_back(); }
    void translate(double x, double y) override {
        _origins.back().x += x;
        _origins.back().y += y;
    }
    void clip(const CGRect& rect, double) override { write("clip", rect); }
    void fade(double alpha) override { drawn.push_back("fade " + number(alpha)); }
    void fill(const CGRect& rect, double radius, RGBA color) override {
        write("fill " + hex(color) + (radius > 0 ? " radius " + number(radius) : ""), rect);
    }
    void stroke(const CGRect& rect, double, double width, RGBA color) override {
        write("stroke " + number(width) + " " + hex(color), rect);
    }
    void text(const TextLine& line, CGPoint baseline, RGBA color) override {
        write("text \"" + line.text + "\" " + hex(color), {baseline, {line.width, 0}});
    }
    void pixels(std::span<const std::uint32_t>,
                int columns,
                int rows,
                const CGRect& rect,
                const RGBA* tint) override {
        write("pixels " + std::to_string(columns) + "x" + std::to_string(rows) +
                  (tint ? " " + hex(*tint) : ""),
              rect);
    }
    void fixedImage(std::string_view name, const CGRect& rect, RGBA color) override {
        write("image " + std::string(name) + " " + hex(color), rect);
    }

private:
    static std::string number(double value) {
        char text[32];
        std::snprintf(text, sizeof text, "%.6g", value == 0 ? 0 : value);
        return text;
    }
    static std::string hex(RGBA color) {
        char text[16];
        std::snprintf(text, sizeof text, "%02X%02X%02X", color.red, color.green, color.blue);
        std::string written = text;
        if (color.alpha != 255) {
            std::snprintf(text, sizeof text, "%02X", color.alpha);
            written += text;
        }
        return written;
    }
    void write(const std::string& what, const CGRect& rect) {
        drawn.push_back(what + " at " + number(rect.origin.x + _origins.back().x) + " " +
                        number(rect.origin.y + _origins.back().y) + " " + number(rect.size.width) +
                        " " + number(rect.size.height));
    }

    double _scale;
    std::vector<CGPoint> _origins{CGPoint()};
};

} // namespace orvo::testing
