#include "platform/uikit/UIImageView.h"

#include "platform/uikit/UIColor.h"
#include "platform/uikit/UIImage.h"
#include "platform/uikit/UIImageDrawing.h"

#include <algorithm>

namespace orvo {

std::shared_ptr<UIImageView> UIImageView::init() {
    return initWithImage(nullptr);
}

std::shared_ptr<UIImageView> UIImageView::initWithImage(const std::shared_ptr<UIImage>& image) {
    auto view = std::make_shared<UIImageView>();
    if (!view->_initWithFrame({}))
        return nullptr;
    view->_image = image;
    return view;
}

void UIImageView::setImage(std::shared_ptr<UIImage> image) {
    if (image == _image)
        return;
    _image = std::move(image);
    invalidateIntrinsicContentSize();
    setNeedsDisplay();
}

CGSize UIImageView::intrinsicContentSize() const {
    return _image ? _image->size() : UIView::intrinsicContentSize();
}

void UIImageView::drawRect(Canvas& canvas) {
    if (_image)
        UIImageDrawing::draw(canvas, *_image, bounds(), *this);
}

std::string UIImageView::_dumpedContent() const {
    return _image ? _image->_dumpedName() : "";
}

} // namespace orvo
