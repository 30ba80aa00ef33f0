#pragma once

#include "platform/mapuikit/SizedTransitArtwork.h"

#include <algorithm>
#include <map>
#include <memory>
#include <set>
#include <string>
#include <utility>
#include <vector>

namespace orvo::testing {

/// Gives pictures of the widths that the test says, by the shield's text and the size, and counts
/// them. A width that was not said is that of the size, in points times 10.
class WidthsCache final : public ArtworkDataSourceCache {
public:
    std::shared_ptr<UIImage> imageForArtwork_shieldSize_scale_nightMode(
        const std::shared_ptr<TransitArtworkDataSource>& artwork,
        std::int64_t shieldSize,
        double scale,
        bool nightMode) override {
        if (!artwork)
            return nullptr;
        ++images;
        scales.insert(scale);
        const auto text = artwork->shieldDataSource()->shieldText().value_or("");
        if (const auto form = text + std::to_string(shieldSize);
            std::ranges::find(forms, form) == forms.end())
            forms.push_back(form);
        askedForNight = askedForNight || nightMode;
        const auto said = widths.find({text, shieldSize});
        const double width =
            said == widths.end() ? 10.0 * static_cast<double>(shieldSize) : said->second;
        const auto pixels = static_cast<std::size_t>(width);
        return UIImage::imageWithPixels_size_scale(
            std::vector<std::uint32_t>(pixels), {static_cast<double>(pixels), 1}, 1);
    }

    std::map<std::pair<std::string, std::int64_t>, double> widths;
    int images = 0;
    std::vector<std::string> forms; ///< text and size of what was asked for, in order, once each
    std::set<double> scales;        ///< of the screens that they were asked for
    bool askedForNight = false;
};

inline std::shared_ptr<SizedTransitArtwork>
sizedArtwork(const std::string& text,
             std::int64_t size,
             const std::shared_ptr<ArtworkDataSourceCache>& cache) {
    return SizedTransitArtwork::initWithArtwork_shieldSize_artworkCache(
        TransitArtworkDataSource::initWithFields(
            {.artworkSourceType = 1,
             .shieldDataSource =
                 TransitShieldDataSource::initWithFields({.shieldType = 1, .shieldText = text})}),
        size,
        cache);
}

} // namespace orvo::testing
