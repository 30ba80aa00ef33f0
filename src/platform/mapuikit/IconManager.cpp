#include "platform/mapuikit/IconManager.h"

#include "platform/mapuikit/ShieldPainter.h"

namespace orvo {

std::shared_ptr<TransitShieldDataSource>
IconManager::shieldOfArtwork(const TransitArtworkDataSource& artwork) {
    if (auto shield = artwork.shieldDataSource())
        return shield;
    if (auto fallback = artwork.iconFallbackShieldDataSource())
        return fallback;
    const auto text = artwork.textDataSource() ? artwork.textDataSource()->text() : nullptr;
    if (!text || text->alternativeString().value_or("").empty())
        return nullptr;
    return TransitShieldDataSource::initWithFields({.shieldText = text->alternativeString()});
}

std::string IconManager::_nameOfArtwork(const TransitArtworkDataSource& artwork) {
    const auto shield = shieldOfArtwork(artwork);
    const bool isVisible = shield && ShieldPainter::isVisible(*shield);
    return isVisible ? "[" + shield->shieldText().value_or("") + "]" : "";
}

std::shared_ptr<IconManager> IconManager::sharedManager() {
    return manager().get();
}

EnvironmentSlot<std::shared_ptr<IconManager>>& IconManager::manager() {
    static EnvironmentSlot<std::shared_ptr<IconManager>> slot(
        [] { return std::make_shared<IconManager>(); });
    return slot;
}

std::shared_ptr<UIImage> IconManager::drawnImageForArtwork_shieldSize_scale_nightMode(
    const TransitArtworkDataSource& artwork,
    std::int64_t shieldSize,
    double scale,
    bool nightMode) const {
    const auto shield = shieldOfArtwork(artwork);
    return shield ? ShieldPainter::draw(*shield, shieldSize, scale, nightMode) : nullptr;
}

} // namespace orvo
