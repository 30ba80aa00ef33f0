#pragma once

#include "platform/foundation/NSObject.h"
#include "platform/uikit/ArtworkImageSource.h"

namespace orvo {

/// What a row shows as its artwork, and how strongly. Immutable.
class OWConfiguredArtwork : public virtual NSObject {
public:
    [[nodiscard]] static std::shared_ptr<OWConfiguredArtwork>
    initWithArtworkSource_alpha(std::shared_ptr<ArtworkImageSource> artworkSource, double alpha);

    [[nodiscard]] const std::shared_ptr<ArtworkImageSource>& artworkSource() const noexcept {
        return _artworkSource;
    }
    /// 1 is opaque.
    [[nodiscard]] double alpha() const noexcept { return _alpha; }

    /// Any kind of this class.
    [[nodiscard]] bool isEqual(const NSObject* other) const override;
    /// The alpha exactly, then the sources: equal by content, or, where both can be archived
    /// securely, by their archives.
    [[nodiscard]] bool isEqualToConfiguredArtwork(const OWConfiguredArtwork& other) const;
    /// The alpha's hash and the source's own, even where equality goes by archives.
    [[nodiscard]] std::uint64_t hash() const override;

private:
    std::shared_ptr<ArtworkImageSource> _artworkSource;
    double _alpha = 0;
};

} // namespace orvo
