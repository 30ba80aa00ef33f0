#pragma once

#include "platform/uikit/NSParagraphStyle.h"
#include "platform/uikit/UIView.h"
#include "platform/uikit/text/TextLayout.h"

namespace orvo {

class NSAttributedString;
class UIFont;

/// A text of one or more lines, which starts at its top. Main thread.
///
/// The text wraps at words, a word that is too long between two characters. Where it has more lines
/// than fit (`numberOfLines`, or the height that the layout leaves) the last whole line that fits
/// ends in an ellipsis.
class UILabel : public UIView {
public:
    [[nodiscard]] static std::shared_ptr<UILabel> init();
    [[nodiscard]] static std::shared_ptr<UILabel> initWithFrame(CGRect frame);

    [[nodiscard]] std::optional<std::string> text() const;
    /// In the font of the label. Nil shows nothing and has no height; an empty text has that of a
    /// line.
    void setText(const std::optional<std::string>& text);
    /// Nil without a text. A plain text carries the label's font.
    [[nodiscard]] std::shared_ptr<NSAttributedString> attributedText() const;
    /// What it leaves open is the label's font and paragraph style; the style at its start holds
    /// for the whole text.
    virtual void setAttributedText(const std::shared_ptr<NSAttributedString>& text);

    /// Nil is the system's body font.
    [[nodiscard]] const std::shared_ptr<UIFont>& font() const noexcept { return _font; }
    /// Applies to the whole text, an attributed one too.
    virtual void setFont(const std::shared_ptr<UIFont>& font);
    [[nodiscard]] const std::shared_ptr<UIColor>& textColor() const noexcept { return _textColor; }
    void setTextColor(std::shared_ptr<UIColor> color);
    /// Default: natural, which is the side where reading starts.
    [[nodiscard]] NSTextAlignment textAlignment() const noexcept { return _alignment; }
    void setTextAlignment(NSTextAlignment alignment);
    /// Default: truncating the tail. In every mode a text that does not fit is cut at its tail.
    [[nodiscard]] NSLineBreakMode lineBreakMode() const noexcept { return _lineBreakMode; }
    void setLineBreakMode(NSLineBreakMode mode);
    /// 0: as many as the text needs. Default: 1.
    [[nodiscard]] std::int64_t numberOfLines() const noexcept { return _numberOfLines; }
    void setNumberOfLines(std::int64_t lines);
    /// The width at which `intrinsicContentSize` wraps; 0, the default, leaves it to the layout,
    /// which asks for the height at the width that it comes to.
    [[nodiscard]] CGFloat preferredMaxLayoutWidth() const noexcept { return _preferredWidth; }
    void setPreferredMaxLayoutWidth(CGFloat width);

    /// The lines as they are shown at the present size.
    [[nodiscard]] const TextLines& _visibleLines() const;
    /// How often this process has measured a label's text.
    [[nodiscard]] static std::uint64_t _measurements() noexcept;

    [[nodiscard]] CGSize intrinsicContentSize() const override;
    [[nodiscard]] std::optional<CGFloat> _intrinsicHeightForWidth(CGFloat width) const override;
    [[nodiscard]] std::optional<CGFloat> _wholeLinesWithin(CGFloat width,
                                                           CGFloat height) const override;
    /// Of the face that the text begins with, and the one that it ends with.
    [[nodiscard]] std::optional<CGFloat> _firstBaselineFromTop() const override;
    [[nodiscard]] CGFloat _lastBaselineFromBottom() const override;
    void _didSolveSize(CGSize size) override { _solvedSize = size; }
    void drawRect(Canvas& canvas) override;
    void traitCollectionDidChange(const UITraitCollection& previous) override;
    /// Its text where none was set.
    [[nodiscard]] std::optional<std::string> accessibilityLabel() const override;
    [[nodiscard]] std::string _dumpedContent() const override;
    [[nodiscard]] std::string className() const override { return "UILabel"; }

protected:
    bool _initWithFrame(CGRect frame);

private:
    [[nodiscard]] const TextLayout& layout() const;
    /// All lines at a width, of at most the label's number.
    [[nodiscard]] const TextLines& linesAt(CGFloat width) const;
    [[nodiscard]] TextLayout::Request request() const;
    [[nodiscard]] std::shared_ptr<NSParagraphStyle> paragraphStyle() const;
    [[nodiscard]] std::size_t maximumLines() const;
    [[nodiscard]] CGSize shownSize() const;
    void contentChanged();

    std::optional<std::string> _text;
    std::shared_ptr<NSAttributedString> _attributed;
    std::shared_ptr<UIFont> _font;
    std::shared_ptr<UIColor> _textColor;
    NSTextAlignment _alignment = NSTextAlignment::Natural;
    NSLineBreakMode _lineBreakMode = NSLineBreakMode::ByTruncatingTail;
    std::int64_t _numberOfLines = 1;
    CGFloat _preferredWidth = 0;
    CGSize _solvedSize;
    mutable std::unique_ptr<TextLayout> _layout;
    /// Lines by their width: the natural one and the last ones that the layout tried.
    mutable std::vector<std::pair<CGFloat, TextLines>> _lines;
    mutable std::optional<TextLines> _visible;
    mutable CGSize _visibleSize;
};

} // namespace orvo
