#pragma once

#include "platform/foundation/NSObject.h"

#include <string>

namespace orvo {

class UIImage;

/// Something that an artwork view can show: a fixed image, or artwork at a size.
class ArtworkImageSource : public virtual NSObject {
public:
    /// The image for a screen of `scale` pixels a point, by day or by night; nil when there is
    /// nothing to show.
    [[nodiscard]] virtual std::shared_ptr<UIImage>
    imageToDisplayWithScreenScale_nightMode(double scale, bool nightMode) = 0;
    /// What it is, as the dump of a view tree says it. Empty where it has no name.
    [[nodiscard]] virtual std::string _dumpedName() const { return {}; }
};

} // namespace orvo
