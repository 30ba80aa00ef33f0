#include "platform/uikit/UIScreen.h"

#include "platform/uikit/UITraitCollection.h"

namespace orvo {

std::shared_ptr<UIScreen> UIScreen::mainScreen() {
    static const auto screen = std::make_shared<UIScreen>();
    return screen;
}

double UIScreen::scale() const {
    return UITraitCollection::system().get().displayScale;
}

} // namespace orvo
