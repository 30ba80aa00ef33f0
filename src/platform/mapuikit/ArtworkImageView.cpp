#include "platform/mapuikit/ArtworkImageView.h"

#include "platform/uikit/UIImage.h"
#include "platform/uikit/UIImageDrawing.h"

namespace orvo {

std::shared_ptr<ArtworkImageView> ArtworkImageView::init() {
    return initWithFrame({});
}

std::shared_ptr<ArtworkImageView> ArtworkImageView::initWithFrame(CGRect frame) {
    auto view = std::make_shared<ArtworkImageView>();
    return view->_initWithFrame(frame) ? view : nullptr;
}

void ArtworkImageView::setImageSource(std::shared_ptr<ArtworkImageSource> source) {
    const bool isSame = equal(source, _imageSource);
    _imageSource = std::move(source);
    if (isSame)
        return;
    _pictureSize.reset();
    invalidateIntrinsicContentSize();
    setNeedsDisplay();
}

std::shared_ptr<UIImage> ArtworkImageView::picture() const {
    if (!_imageSource)
        return nullptr;
    ++_renderCount;
    const auto traits = traitCollection();
    return _imageSource->imageToDisplayWithScreenScale_nightMode(
        traits.displayScale, traits.userInterfaceStyle == UIUserInterfaceStyle::Dark);
}

CGSize ArtworkImageView::intrinsicContentSize() const {
    if (!_pictureSize) {
        const auto image = picture();
        _pictureSize = image ? image->size() : UIView::intrinsicContentSize();
    }
    return *_pictureSize;
}

void ArtworkImageView::drawRect(Canvas& canvas) {
    if (const auto image = picture())
        UIImageDrawing::draw(canvas, *image, bounds(), *this);
}

std::string ArtworkImageView::_dumpedContent() const {
    return _imageSource ? _imageSource->_dumpedName() : "";
}

void ArtworkImageView::traitCollectionDidChange(const UITraitCollection& previous) {
    UIView::traitCollectionDidChange(previous);
    // A picture's edges lie on device pixels, so its size in points is not the same at each scale.
    _pictureSize.reset();
    invalidateIntrinsicContentSize();
}

} // namespace orvo
