#pragma once

#include "platform/foundation/NSObject.h"

namespace orvo {

enum class NSTextAlignment { Left = 0, Center = 1, Right = 2, Justified = 3, Natural = 4 };
inline constexpr NSTextAlignment NSTextAlignmentNatural = NSTextAlignment::Natural;

enum class NSLineBreakMode {
    ByWordWrapping = 0,
    ByCharWrapping = 1,
    ByClipping = 2,
    ByTruncatingHead = 3,
    ByTruncatingTail = 4,
    ByTruncatingMiddle = 5,
};
inline constexpr NSLineBreakMode NSLineBreakByWordWrapping = NSLineBreakMode::ByWordWrapping;
inline constexpr NSLineBreakMode NSLineBreakByTruncatingTail = NSLineBreakMode::ByTruncatingTail;

class NSMutableParagraphStyle;

/// How the lines of a paragraph stand. Immutable but as `NSMutableParagraphStyle`.
class NSParagraphStyle : public virtual NSCopying {
public:
    /// No line spacing, natural alignment, word wrapping. Always the same object.
    [[nodiscard]] static std::shared_ptr<NSParagraphStyle> defaultParagraphStyle();

    /// Points between two lines, beside what the font asks for.
    [[nodiscard]] double lineSpacing() const noexcept { return _lineSpacing; }
    [[nodiscard]] NSTextAlignment alignment() const noexcept { return _alignment; }
    [[nodiscard]] NSLineBreakMode lineBreakMode() const noexcept { return _lineBreakMode; }

    /// An immutable style of the same values.
    [[nodiscard]] std::shared_ptr<NSObject> copy() const override;
    [[nodiscard]] std::shared_ptr<NSMutableParagraphStyle> mutableCopy() const;
    /// By values, whether mutable or not.
    [[nodiscard]] bool isEqual(const NSObject* other) const override;
    [[nodiscard]] std::uint64_t hash() const override;
    [[nodiscard]] std::string description() const override;

private:
    friend class NSMutableParagraphStyle;

    double _lineSpacing = 0;
    NSTextAlignment _alignment = NSTextAlignment::Natural;
    NSLineBreakMode _lineBreakMode = NSLineBreakMode::ByWordWrapping;
};

class NSMutableParagraphStyle final : public NSParagraphStyle {
public:
    void setLineSpacing(double spacing) noexcept { _lineSpacing = spacing; }
    void setAlignment(NSTextAlignment alignment) noexcept { _alignment = alignment; }
    void setLineBreakMode(NSLineBreakMode mode) noexcept { _lineBreakMode = mode; }
};

} // namespace orvo
