#pragma once

#include "platform/uikit/ArtworkImageSource.h"
#include "platform/uikit/UIView.h"

#include <cstdint>

namespace orvo {

/// Shows an artwork at its own size, in the middle, in the look of the vibrancy around it if any.
/// It keeps no picture: what it draws is its source's to keep. Main thread.
class ArtworkImageView : public UIView {
public:
    [[nodiscard]] static std::shared_ptr<ArtworkImageView> init();
    [[nodiscard]] static std::shared_ptr<ArtworkImageView> initWithFrame(CGRect frame);

    [[nodiscard]] const std::shared_ptr<ArtworkImageSource>& imageSource() const noexcept {
        return _imageSource;
    }
    /// Nil shows nothing. A source that is equal to the present one changes nothing on screen.
    virtual void setImageSource(std::shared_ptr<ArtworkImageSource> source);

    /// How often this view has asked a source for its picture, to measure or to draw it.
    [[nodiscard]] std::uint64_t _renders() const noexcept { return _renderCount; }

    /// The size of the artwork's picture; none without one.
    [[nodiscard]] CGSize intrinsicContentSize() const override;
    void drawRect(Canvas& canvas) override;
    void traitCollectionDidChange(const UITraitCollection& previous) override;
    [[nodiscard]] std::string _dumpedContent() const override;
    [[nodiscard]] std::string className() const override { return "ArtworkImageView"; }

private:
    [[nodiscard]] std::shared_ptr<UIImage> picture() const;

    std::shared_ptr<ArtworkImageSource> _imageSource;
    mutable std::optional<CGSize> _pictureSize; ///< nil until it is asked for
    mutable std::uint64_t _renderCount = 0;
};

} // namespace orvo
