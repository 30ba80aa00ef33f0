#include "presentation/TransitDirectionsListArtworkWidthCalculator.h"

#include "platform/uikit/UIScreen.h"

#include <algorithm>
#include <utility>
#include <vector>

namespace orvo {

namespace {

constexpr double WidthInPlaceOfANegativeOne = 50;

using Artwork = std::shared_ptr<SizedTransitArtwork>;

ArtworkWidthCalculatorSizeParameter normalised(ArtworkWidthCalculatorSizeParameter parameter) {
    auto& least = parameter.defaultArtworkViewWidth;
    auto& most = parameter.maxArtworkViewWidth;
    if (least > 0 && most >= least)
        return parameter;
    if (least < 0) // and not for 0, which stays
        least = WidthInPlaceOfANegativeOne;
    if (most < least)
        most = least;
    return parameter;
}

/// The artworks that are left, narrowest first, each in its current form.
class Column {
public:
    explicit Column(const std::shared_ptr<NSArray>& artworks)
        : _screenScale(UIScreen::mainScreen()->scale())
        , _artworks(typed<SizedTransitArtwork>(artworks)) {
        _sort();
    }

    [[nodiscard]] bool isEmpty() const noexcept { return _artworks.empty(); }
    [[nodiscard]] Artwork widest() const { return _currentForm(_artworks.back()); }
    [[nodiscard]] double imageWidth(const Artwork& form) const {
        const auto image = form->imageToDisplayWithScreenScale_nightMode(_screenScale, false);
        return image ? image->size().width : 0;
    }
    void removeWidest() { _artworks.pop_back(); }
    void shrinkWidest() {
        const auto form = widest();
        _replacements->setObject_forKey(
            SizedTransitArtwork::initWithArtwork_shieldSize_artworkCache(
                form->artwork(), form->shieldSize() - 1, form->artworkCache()),
            _artworks.back());
        _sort();
    }
    [[nodiscard]] const std::shared_ptr<NSMapTable>& replacements() const noexcept {
        return _replacements;
    }

private:
    [[nodiscard]] Artwork _currentForm(const Artwork& initial) const {
        const auto replacement = _replacements->objectForKey(initial);
        return replacement ? std::dynamic_pointer_cast<SizedTransitArtwork>(replacement) : initial;
    }
    void _sort() {
        std::ranges::stable_sort(
            _artworks, {}, [this](const Artwork& one) { return imageWidth(_currentForm(one)); });
    }

    double _screenScale;
    std::vector<Artwork> _artworks; // in their initial form
    std::shared_ptr<NSMapTable> _replacements = NSMapTable::strongToStrongObjectsMapTable();
};

} // namespace

std::shared_ptr<TransitDirectionsListArtworkWidthCalculator>
TransitDirectionsListArtworkWidthCalculator::initWithSizedArtworks_sizeParameter(
    std::shared_ptr<NSArray> artworks, ArtworkWidthCalculatorSizeParameter sizeParameter) {
    auto calculator = std::make_shared<TransitDirectionsListArtworkWidthCalculator>();
    calculator->_artworks = std::move(artworks); // immutable, so a copy is the array itself
    calculator->_sizeParameter = normalised(sizeParameter);
    return calculator;
}

std::shared_ptr<NSMapTable>
TransitDirectionsListArtworkWidthCalculator::calculateArtworkViewWidthAndArtworkSizes(
    double* width) const {
    Column column(_artworks);
    const double least = _sizeParameter.defaultArtworkViewWidth;
    const double most = _sizeParameter.maxArtworkViewWidth;
    const auto& insets = _sizeParameter.artworkInsets;
    double columnWidth = least;
    while (!column.isEmpty()) {
        const auto form = column.widest();
        const double formWidth = column.imageWidth(form) + insets.left + insets.right;
        if (formWidth <= most) { // the default is never above the maximum
            columnWidth = std::max(formWidth, least);
            break;
        }
        if (form->shieldSize() < 1)
            column.removeWidest();
        else
            column.shrinkWidest();
    }
    if (width)
        *width = columnWidth;
    return column.replacements();
}

} // namespace orvo
