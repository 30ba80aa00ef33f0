#include "platform/uikit/UILabel.h"

#include "platform/uikit/NSAttributedString.h"
#include "platform/uikit/UIColor.h"
#include "platform/uikit/UIFont.h"
#include "platform/uikit/drawing/Canvas.h"

#include <algorithm>
#include <cmath>

namespace orvo {

namespace {

// Edges go to whole device pixels: a label may be that much lower, or narrower, than its text.
constexpr CGFloat RoundedOff = 1;

constexpr std::size_t MostWidths = 4;

std::uint64_t measurements = 0;

/// How many of the lines fit into a height; at least one.
std::size_t linesWithin(const TextLines& lines, CGFloat height) {
    std::size_t count = 0;
    CGFloat bottom = 0;
    for (const auto& line : lines.lines) {
        bottom += line.metrics.lineHeight();
        if (count > 0 && bottom > height)
            break;
        bottom += lines.lineSpacing;
        ++count;
    }
    return count;
}

} // namespace

std::shared_ptr<UILabel> UILabel::init() {
    return initWithFrame({});
}

std::shared_ptr<UILabel> UILabel::initWithFrame(CGRect frame) {
    auto label = std::make_shared<UILabel>();
    return label->_initWithFrame(frame) ? label : nullptr;
}

bool UILabel::_initWithFrame(CGRect frame) {
    setIsAccessibilityElement(true);
    return UIView::_initWithFrame(frame);
}

std::uint64_t UILabel::_measurements() noexcept {
    return measurements;
}

// Content

std::optional<std::string> UILabel::text() const {
    return _text;
}

void UILabel::setText(const std::optional<std::string>& text) {
    if (text == _text && !_attributed)
        return;
    _text = text;
    _attributed = nullptr;
    contentChanged();
}

std::shared_ptr<NSAttributedString> UILabel::attributedText() const {
    if (_attributed || !_text)
        return _attributed;
    NSAttributedString::Attributes attributes;
    if (_font)
        attributes.emplace(NSFontAttributeName, _font);
    return NSAttributedString::initWithString_attributes(*_text, std::move(attributes));
}

void UILabel::setAttributedText(const std::shared_ptr<NSAttributedString>& text) {
    _attributed = text ? std::dynamic_pointer_cast<NSAttributedString>(text->copy()) : nullptr;
    _text = text ? std::optional(text->string()) : std::nullopt;
    contentChanged();
}

void UILabel::setFont(const std::shared_ptr<UIFont>& font) {
    if (equal(font, _font))
        return;
    _font = font;
    if (_attributed && _font && _attributed->length() > 0) {
        const auto changed = _attributed->mutableCopy();
        changed->addAttribute_value_range(NSFontAttributeName, _font, {0, changed->length()});
        _attributed = changed;
    }
    contentChanged();
}

void UILabel::setTextColor(std::shared_ptr<UIColor> color) {
    _textColor = std::move(color);
    setNeedsDisplay();
}

void UILabel::setTextAlignment(NSTextAlignment alignment) {
    _alignment = alignment;
    setNeedsDisplay();
}

void UILabel::setLineBreakMode(NSLineBreakMode mode) {
    if (mode == _lineBreakMode)
        return;
    _lineBreakMode = mode;
    contentChanged();
}

void UILabel::setNumberOfLines(std::int64_t lines) {
    if (lines == _numberOfLines)
        return;
    _numberOfLines = lines;
    contentChanged();
}

void UILabel::setPreferredMaxLayoutWidth(CGFloat width) {
    if (width == _preferredWidth)
        return;
    _preferredWidth = width;
    contentChanged();
}

void UILabel::contentChanged() {
    _layout.reset();
    _lines.clear();
    _visible.reset();
    invalidateIntrinsicContentSize();
    setNeedsDisplay();
}

void UILabel::traitCollectionDidChange(const UITraitCollection& previous) {
    UIView::traitCollectionDidChange(previous);
    if (previous.layoutDirection != traitCollection().layoutDirection)
        contentChanged();
}

std::optional<std::string> UILabel::accessibilityLabel() const {
    const auto given = UIView::accessibilityLabel();
    return given ? given : _text;
}

// Lines

std::shared_ptr<NSParagraphStyle> UILabel::paragraphStyle() const {
    if (!_attributed || _attributed->length() == 0)
        return nullptr;
    return std::dynamic_pointer_cast<NSParagraphStyle>(
        _attributed->attribute_atIndex_effectiveRange(NSParagraphStyleAttributeName, 0, nullptr));
}

TextLayout::Request UILabel::request() const {
    const auto font = _font ? _font : UIFont::preferredFontForTextStyle(UIFontTextStyle::Body);
    TextLayout::Request request;
    request.text = _text.value_or("");
    request.rightToLeft =
        effectiveUserInterfaceLayoutDirection() == UIUserInterfaceLayoutDirection::RightToLeft;
    request.breaksAnywhere = _lineBreakMode == NSLineBreakMode::ByCharWrapping;
    if (const auto style = paragraphStyle()) {
        request.lineSpacing = style->lineSpacing();
        request.breaksAnywhere =
            request.breaksAnywhere || style->lineBreakMode() == NSLineBreakMode::ByCharWrapping;
    }
    if (_attributed) {
        for (const auto& run : _attributed->runs()) {
            const auto found = run.attributes.find(NSFontAttributeName);
            const auto own = found == run.attributes.end()
                                 ? nullptr
                                 : std::dynamic_pointer_cast<UIFont>(found->second);
            request.runs.push_back(
                {run.range.location, run.range.end(), (own ? own : font)->face()});
        }
    }
    if (request.runs.empty())
        request.runs.push_back({0, request.text.size(), font->face()});
    return request;
}

const TextLayout& UILabel::layout() const {
    if (!_layout) {
        ++measurements;
        _layout = std::make_unique<TextLayout>(request());
    }
    return *_layout;
}

std::size_t UILabel::maximumLines() const {
    return _numberOfLines <= 0 ? TextLayout::AnyNumber : static_cast<std::size_t>(_numberOfLines);
}

const TextLines& UILabel::linesAt(CGFloat width) const {
    const auto known = std::ranges::find(_lines, width, &std::pair<CGFloat, TextLines>::first);
    if (known != _lines.end())
        return known->second;
    if (_lines.size() == MostWidths)
        _lines.erase(_lines.begin() + 1);
    return _lines.emplace_back(width, layout().lines(width, maximumLines())).second;
}

CGSize UILabel::intrinsicContentSize() const {
    if (!_text)
        return {0, 0};
    if (_text->empty())
        return {0, layout().metricsAtStart().lineHeight()};
    const auto width = _preferredWidth > 0 ? _preferredWidth : TextLayout::Unlimited;
    const auto& lines = linesAt(width);
    return {lines.width(), lines.height()};
}

std::optional<CGFloat> UILabel::_intrinsicHeightForWidth(CGFloat width) const {
    if (_numberOfLines == 1 || !_text || _text->empty() || _preferredWidth > 0)
        return std::nullopt;
    return linesAt(width).height();
}

std::optional<CGFloat> UILabel::_wholeLinesWithin(CGFloat width, CGFloat height) const {
    if (!_text || _text->empty())
        return std::nullopt;
    const auto& lines = linesAt(width);
    return lines.height(linesWithin(lines, height));
}

std::optional<CGFloat> UILabel::_firstBaselineFromTop() const {
    return layout().metricsAtStart().ascender;
}

CGFloat UILabel::_lastBaselineFromBottom() const {
    const auto metrics = layout().metricsAtEnd();
    return metrics.leading - metrics.descender;
}

/// The size that the layout came to, unless the frame was set to another since.
CGSize UILabel::shownSize() const {
    const auto size = frame().size;
    const bool isRounded = std::abs(size.width - _solvedSize.width) <= RoundedOff &&
                           std::abs(size.height - _solvedSize.height) <= RoundedOff;
    return isRounded ? _solvedSize : size;
}

const TextLines& UILabel::_visibleLines() const {
    const auto size = shownSize();
    if (_visible && _visibleSize == size)
        return *_visible;
    _visibleSize = size;
    _visible = TextLines();
    if (_text && !_text->empty() && size.height > 0 && size.width > 0) {
        _visible = linesAt(size.width);
        const auto fitting = linesWithin(*_visible, size.height + RoundedOff);
        if (fitting < _visible->lines.size())
            _visible = layout().lines(size.width, fitting);
    }
    return *_visible;
}

std::string UILabel::_dumpedContent() const {
    std::string text;
    for (const auto& line : _visibleLines().lines)
        text += (text.empty() ? "\"" : " \"") + line.text + "\"";
    return text;
}

// Drawing

void UILabel::drawRect(Canvas& canvas) {
    const auto& shown = _visibleLines();
    if (shown.lines.empty())
        return;
    auto color = _vibrantColor();
    if (!color)
        color = _textColor ? _textColor : UIColor::labelColor();
    const auto resolved = color->resolvedColorWithTraitCollection(traitCollection());
    const auto style = paragraphStyle();
    auto alignment =
        style && style->alignment() != NSTextAlignment::Natural ? style->alignment() : _alignment;
    const bool rightToLeft =
        effectiveUserInterfaceLayoutDirection() == UIUserInterfaceLayoutDirection::RightToLeft;
    if (alignment == NSTextAlignment::Natural || alignment == NSTextAlignment::Justified)
        alignment = rightToLeft ? NSTextAlignment::Right : NSTextAlignment::Left;
    for (std::size_t i = 0; i < shown.lines.size(); ++i) {
        const auto& line = shown.lines[i];
        const CGFloat room = frame().size.width - line.width;
        CGFloat x = 0;
        if (alignment == NSTextAlignment::Right)
            x = room;
        else if (alignment == NSTextAlignment::Center)
            x = room / 2;
        canvas.text(line, {x, shown.baselineOf(i)}, resolved);
    }
}

} // namespace orvo
