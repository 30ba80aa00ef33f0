#pragma once

#include "platform/foundation/EnvironmentSlot.h"
#include "platform/geoservices/TransitArtworkDataSource.h"
#include "platform/uikit/UIImage.h"

namespace orvo {

/// The rendering library's: draws shields, and may keep sheets of many drawn ones ("atlases") for
/// maps that show hundreds at once. Main thread, in a program with a screen (a graphical
/// application object, be it an offscreen one).
class IconManager : public virtual NSObject {
public:
    /// May be nil where nothing can be drawn.
    [[nodiscard]] static std::shared_ptr<IconManager> sharedManager();
    /// What `sharedManager()` answers.
    static EnvironmentSlot<std::shared_ptr<IconManager>>& manager();

    /// What is drawn of an artwork: its shield, or else its fallback shield or text as one. Nil for
    /// an artwork without any.
    [[nodiscard]] static std::shared_ptr<TransitShieldDataSource>
    shieldOfArtwork(const TransitArtworkDataSource& artwork);
    /// That shield as dumps write it, `[M1]`, or `[]` for a colour alone; empty where there is
    /// nothing to draw.
    [[nodiscard]] static std::string _nameOfArtwork(const TransitArtworkDataSource& artwork);

    [[nodiscard]] virtual bool isCachingAtlases() const { return _cachesAtlases; }
    virtual void setIsCachingAtlases(bool caching) { _cachesAtlases = caching; }

    /// The artwork's shield, or else its fallback shield or text, at a size from 0 to 7 (others
    /// count as the nearest), for a screen of `scale` pixels a point. Nil for an artwork without
    /// any, and in a program without a screen.
    [[nodiscard]] virtual std::shared_ptr<UIImage>
    drawnImageForArtwork_shieldSize_scale_nightMode(const TransitArtworkDataSource& artwork,
                                                    std::int64_t shieldSize,
                                                    double scale,
                                                    bool nightMode) const;

private:
    bool _cachesAtlases = true;
};

} // namespace orvo
