#include "platform/mapuikit/TransitInfoLabelView.h"

#include "platform/geoservices/TransitArtworkTypes.h"
#include "platform/mapuikit/IconManager.h"
#include "platform/mapuikit/ShieldPainter.h"
#include "platform/uikit/UIColor.h"
#include "platform/uikit/UIFont.h"
#include "platform/uikit/UIImageDrawing.h"
#include "platform/uikit/drawing/Canvas.h"

#include <algorithm>

namespace orvo {

namespace {

// A row is arranged with one text after the other until one has room.
constexpr std::size_t TextsKept = 16;

} // namespace

std::shared_ptr<TransitInfoLabelView>
TransitInfoLabelView::initWithLabelItems_iconSize_shieldSize_spaceBetweenShields_maxWidth(
    std::shared_ptr<NSArray> labelItems,
    std::int64_t iconSize,
    std::int64_t shieldSize,
    CGFloat spaceBetweenShields,
    CGFloat maxWidth) {
    auto view = std::make_shared<TransitInfoLabelView>();
    return view->_initWithLabelItems_iconSize_shieldSize_spaceBetweenShields_maxWidth(
               std::move(labelItems), iconSize, shieldSize, spaceBetweenShields, maxWidth)
               ? view
               : nullptr;
}

bool TransitInfoLabelView::_initWithLabelItems_iconSize_shieldSize_spaceBetweenShields_maxWidth(
    std::shared_ptr<NSArray> labelItems,
    std::int64_t iconSize,
    std::int64_t shieldSize,
    CGFloat spaceBetweenShields,
    CGFloat maxWidth) {
    if (!_initWithFrame({}))
        return false;
    _iconSize = iconSize;
    _shieldSize = shieldSize;
    _space = spaceBetweenShields;
    _maxWidth = maxWidth;
    setIsAccessibilityElement(true);
    setLabelItems(std::move(labelItems));
    return true;
}

// Content

void TransitInfoLabelView::setLabelItems(std::shared_ptr<NSArray> items) {
    auto artworks = typed<Artwork>(items.get());
    const bool isSame = equal(items, _labelItems);
    _labelItems = std::move(items);
    if (isSame)
        return;
    _artworks = std::move(artworks);
    forgetMeasures();
}

void TransitInfoLabelView::setArtworkCache(std::shared_ptr<ArtworkDataSourceCache> cache) {
    if (cache == _artworkCache)
        return;
    _artworkCache = std::move(cache);
    forgetMeasures();
}

void TransitInfoLabelView::setFont(std::shared_ptr<UIFont> font) {
    if (equal(font, _font))
        return;
    _font = std::move(font);
    _texts.clear();
    contentChanged();
}

void TransitInfoLabelView::setTextColor(std::shared_ptr<UIColor> color) {
    _textColor = std::move(color);
    setNeedsDisplay();
}

void TransitInfoLabelView::setNumberOfLines(std::int64_t lines) {
    if (lines == _numberOfLines)
        return;
    _numberOfLines = lines;
    contentChanged();
}

void TransitInfoLabelView::setMaxWidth_textForTruncationGenerator(CGFloat width,
                                                                  TruncationGenerator generator) {
    const auto earlier = row();
    const auto earlierText = _truncationText();
    _maxWidth = width;
    _generator = std::move(generator);
    // Asked again only where a text is to be seen: it may be another one now.
    auto now = arranged();
    const bool isSame = now == earlier;
    _row = std::move(now);
    if (isSame && _truncationText() == earlierText)
        return;
    invalidateIntrinsicContentSize();
    setNeedsDisplay();
}

void TransitInfoLabelView::contentChanged() {
    _row.reset();
    invalidateIntrinsicContentSize();
    setNeedsDisplay();
}

void TransitInfoLabelView::forgetMeasures() {
    _sizes.assign(_artworks.size(), std::nullopt);
    _texts.clear();
    contentChanged();
}

void TransitInfoLabelView::traitCollectionDidChange(const UITraitCollection& previous) {
    UIView::traitCollectionDidChange(previous);
    forgetMeasures();
}

// Measures

std::shared_ptr<UIImage>
TransitInfoLabelView::pictureOf(const std::shared_ptr<Artwork>& artwork) const {
    if (!_artworkCache)
        return nullptr;
    const bool isIcon =
        artwork->artworkSourceType() == static_cast<std::int32_t>(TransitArtworkSourceType::Icon);
    const auto traits = traitCollection();
    return _artworkCache->imageForArtwork_shieldSize_scale_nightMode(
        artwork,
        isIcon ? _iconSize : _shieldSize,
        traits.displayScale,
        traits.userInterfaceStyle == UIUserInterfaceStyle::Dark);
}

CGSize TransitInfoLabelView::sizeOf(std::size_t index) const {
    auto& size = _sizes.at(index);
    if (!size) {
        const auto image = pictureOf(_artworks.at(index));
        size = image ? image->size() : CGSize{};
    }
    return *size;
}

CGFloat TransitInfoLabelView::lineHeight() const {
    return ShieldPainter::heightOf(std::max(_shieldSize, _iconSize));
}

std::shared_ptr<UIFont> TransitInfoLabelView::_textFont() const {
    const auto font = _font ? _font : UIFont::preferredFontForTextStyle(UIFontTextStyle::Body);
    if (font->lineHeight() <= lineHeight())
        return font;
    return UIFont::fontWithDescriptor_size(font->fontDescriptor(),
                                           font->pointSize() * lineHeight() / font->lineHeight());
}

CGFloat TransitInfoLabelView::baselineInLine() const {
    return (lineHeight() + _textFont()->capHeight()) / 2;
}

CGFloat TransitInfoLabelView::textWidthFor(std::size_t leftOut) const {
    const auto string = _generator ? _generator(leftOut) : std::nullopt;
    _text = string && !string->empty() ? measured(*string) : nullptr;
    return _text ? _text->width : 0;
}

std::shared_ptr<const TransitInfoLabelView::Text>
TransitInfoLabelView::measured(const std::string& string) const {
    const auto known =
        std::ranges::find(_texts, string, [](const auto& text) { return text->string; });
    if (known != _texts.end())
        return *known;
    TextLayout::Request request;
    request.text = string;
    request.runs.push_back({0, string.size(), _textFont()->face()});
    request.rightToLeft =
        effectiveUserInterfaceLayoutDirection() == UIUserInterfaceLayoutDirection::RightToLeft;
    auto text = std::make_shared<Text>();
    text->string = string;
    text->layout = std::make_shared<TextLayout>(std::move(request));
    text->width = text->layout->lines(TextLayout::Unlimited, 1).width();
    if (_texts.size() == TextsKept)
        _texts.clear();
    _texts.push_back(text);
    return text;
}

_ShieldRow TransitInfoLabelView::arranged() const {
    return _ShieldRow::arrange(
        {.shields = _artworks.size(),
         .sizeOf = [this](std::size_t index) { return sizeOf(index); },
         .space = _space,
         .lineHeight = lineHeight(),
         .width = std::max<CGFloat>(0, _maxWidth),
         .lines = static_cast<std::size_t>(std::max<std::int64_t>(0, _numberOfLines)),
         .textWidth =
             [this](std::size_t leftOut) {
                 return textWidthFor(leftOut);
             }});
}

const _ShieldRow& TransitInfoLabelView::row() const {
    if (!_row)
        _row = arranged();
    return *_row;
}

std::size_t TransitInfoLabelView::_shownShields() const {
    return row().shields.size();
}

std::optional<std::string> TransitInfoLabelView::_truncationText() const {
    return row().text && _text ? std::optional(_text->string) : std::nullopt;
}

CGSize TransitInfoLabelView::intrinsicContentSize() const {
    return row().size;
}

std::optional<CGFloat> TransitInfoLabelView::_firstBaselineFromTop() const {
    return baselineInLine();
}

CGFloat TransitInfoLabelView::_lastBaselineFromBottom() const {
    return lineHeight() - baselineInLine();
}

// Drawing

void TransitInfoLabelView::drawRect(Canvas& canvas) {
    const auto& shown = row();
    const bool rightToLeft =
        effectiveUserInterfaceLayoutDirection() == UIUserInterfaceLayoutDirection::RightToLeft;
    const auto placed = [&](CGRect place) {
        if (rightToLeft)
            place.origin.x = frame().size.width - place.origin.x - place.size.width;
        return place;
    };
    for (std::size_t i = 0; i < shown.shields.size(); ++i) {
        if (const auto image = pictureOf(_artworks[i]))
            UIImageDrawing::draw(canvas, *image, placed(shown.shields[i]), *this);
    }
    if (shown.text && _text)
        drawText(canvas, placed(*shown.text));
}

void TransitInfoLabelView::drawText(Canvas& canvas, const CGRect& place) const {
    const auto lines = _text->layout->lines(std::max(place.size.width, 0.0), 1).lines;
    if (lines.empty())
        return;
    auto color = _vibrantColor();
    if (!color)
        color = _textColor ? _textColor : UIColor::labelColor();
    canvas.text(lines.front(),
                {place.origin.x, place.origin.y + baselineInLine()},
                color->resolvedColorWithTraitCollection(traitCollection()));
}

std::string TransitInfoLabelView::_dumpedContent() const {
    std::string content;
    const auto add = [&content](const std::string& part) {
        content += (content.empty() || part.empty() ? "" : " ") + part;
    };
    for (std::size_t i = 0; i < _shownShields(); ++i)
        add(IconManager::_nameOfArtwork(*_artworks[i]));
    if (const auto text = _truncationText())
        add("\"" + *text + "\"");
    return content;
}

std::optional<std::string> TransitInfoLabelView::accessibilityLabel() const {
    if (auto given = UIView::accessibilityLabel())
        return given;
    std::string spoken;
    const auto add = [&spoken](const std::optional<std::string>& part) {
        if (!part || part->empty())
            return;
        spoken += spoken.empty() ? "" : ", ";
        spoken += *part;
    };
    for (std::size_t i = 0; i < _shownShields(); ++i) {
        const auto& artwork = _artworks[i];
        const auto shield = artwork->shieldDataSource();
        auto text = artwork->accessibilityText();
        if (!text && shield)
            text = shield->shieldText();
        add(text);
    }
    add(_truncationText());
    return spoken.empty() ? std::nullopt : std::optional(spoken);
}

} // namespace orvo
