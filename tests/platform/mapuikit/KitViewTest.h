#pragma once

#include "platform/geoservices/TransitArtworkDataSource.h"
#include "platform/geoservices/TransitArtworkTypes.h"
#include "platform/mapuikit/ArtworkDataSourceCache.h"
#include "platform/uikit/ViewDrawing.h"
#include "platform/uikit/ViewTest.h"
#include "support/RecordingCanvas.h"

namespace orvo::testing {

/// Draws every shield half as wide again for each character as its height, without keeping it.
class PlainArtworkCache final : public ArtworkDataSourceCache {
public:
    std::shared_ptr<UIImage> imageForArtwork_shieldSize_scale_nightMode(
        const std::shared_ptr<TransitArtworkDataSource>& artwork,
        std::int64_t shieldSize,
        double scale,
        bool nightMode) override {
        asked.push_back(artwork->shieldDataSource()->shieldText().value_or("") + " " +
                        std::to_string(shieldSize) + (nightMode ? " night" : ""));
        if (!artwork->shieldDataSource()->shieldText())
            return nullptr;
        const auto characters = artwork->shieldDataSource()->shieldText()->size();
        const CGSize size{10.0 + 10 * static_cast<double>(characters),
                          14 + 2.0 * static_cast<double>(shieldSize)};
        return UIImage::imageWithPixels_size_scale(
            std::vector<std::uint32_t>(
                static_cast<std::size_t>(size.width * scale * size.height * scale)),
            size,
            scale);
    }

    std::vector<std::string> asked;
};

inline std::shared_ptr<TransitArtworkDataSource>
shieldArtwork(const std::optional<std::string>& text,
              TransitArtworkSourceType type = TransitArtworkSourceType::Shield) {
    return TransitArtworkDataSource::initWithFields(
        {.artworkSourceType = static_cast<std::int32_t>(type),
         .shieldDataSource = TransitShieldDataSource::initWithFields({.shieldText = text})});
}

class KitViewTest : public ViewTest {
protected:
    /// What is drawn of a tree after a layout pass.
    static std::vector<std::string> draw(const std::shared_ptr<UIView>& view, double scale = 1) {
        view->layoutIfNeeded();
        RecordingCanvas canvas(scale);
        drawViewHierarchy(*view, canvas);
        return canvas.drawn;
    }

    std::shared_ptr<PlainArtworkCache> cache = std::make_shared<PlainArtworkCache>();
};

} // namespace orvo::testing
