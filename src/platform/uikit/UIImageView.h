#pragma once

#include "platform/uikit/UIView.h"

namespace orvo {

class UIImage;

/// Shows one image, as large as fits without distortion, in the middle; never larger than it is.
/// Fixed images are drawn in the vibrant colour, else in the tint colour. Main thread.
class UIImageView : public UIView {
public:
    [[nodiscard]] static std::shared_ptr<UIImageView> init();
    [[nodiscard]] static std::shared_ptr<UIImageView>
    initWithImage(const std::shared_ptr<UIImage>& image);

    [[nodiscard]] const std::shared_ptr<UIImage>& image() const noexcept { return _image; }
    /// Nil shows nothing.
    void setImage(std::shared_ptr<UIImage> image);

    /// The size of the image; none without an image.
    [[nodiscard]] CGSize intrinsicContentSize() const override;
    void drawRect(Canvas& canvas) override;
    [[nodiscard]] std::string _dumpedContent() const override;
    [[nodiscard]] std::string className() const override { return "UIImageView"; }

private:
    std::shared_ptr<UIImage> _image;
};

} // namespace orvo
