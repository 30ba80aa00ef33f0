#include "platform/uikit/UIImage.h"

#include "platform/foundation/Exceptions.h"

#include <array>
#include <cmath>
#include <map>

namespace orvo {

namespace {

struct FixedImage {
    const char* name;
    UIEdgeInsets empty;
};

constexpr UIEdgeInsets AroundDisc{2, 2, 2, 2};
constexpr std::array FixedImages{
    FixedImage{"good-v2", AroundDisc},
    FixedImage{"good-alt-v2", AroundDisc},
    FixedImage{"advisories-v2", {3, 2, 3, 2}},
    FixedImage{"WidgetGenericTransit", {1, 5, 1, 5}},
};
constexpr CGSize FixedImageSize{24, 24};

} // namespace

std::shared_ptr<UIImage> UIImage::imageNamed(const std::string& name) {
    static const auto images = [] {
        std::map<std::string, std::shared_ptr<UIImage>> made;
        for (const auto& fixed : FixedImages) {
            auto image = std::make_shared<UIImage>();
            image->_name = fixed.name;
            image->_size = FixedImageSize;
            image->_alignmentRectInsets = fixed.empty;
            made.emplace(fixed.name, std::move(image));
        }
        return made;
    }();
    const auto found = images.find(name);
    return found == images.end() ? nullptr : found->second;
}

std::shared_ptr<UIImage>
UIImage::imageWithPixels_size_scale(std::vector<std::uint32_t> pixels, CGSize size, double scale) {
    const auto columns = std::llround(size.width * scale);
    const auto rows = std::llround(size.height * scale);
    if (columns < 0 || rows < 0 || std::cmp_not_equal(pixels.size(), columns * rows))
        throw NSInvalidArgumentException("the number of pixels does not fit the size of the image");
    auto image = std::make_shared<UIImage>();
    image->_size = size;
    image->_scale = scale;
    image->_pixels = std::move(pixels);
    return image;
}

std::shared_ptr<UIImage> UIImage::imageToDisplayWithScreenScale_nightMode(double, bool) {
    return strong(this);
}

std::string UIImage::description() const {
    return rootDescription() + " " +
           _name.value_or(std::to_string(_size.width) + " x " + std::to_string(_size.height));
}

} // namespace orvo
