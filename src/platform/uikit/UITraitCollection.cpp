#include "platform/uikit/UITraitCollection.h"

#include "platform/foundation/NSNotificationCenter.h"

namespace orvo {

EnvironmentSlot<UITraitCollection>& UITraitCollection::system() {
    static EnvironmentSlot<UITraitCollection> slot([] { return UITraitCollection(); });
    return slot;
}

void UITraitCollection::setSystem(const UITraitCollection& traits) {
    const auto previous = system().get();
    system().set(traits);
    if (traits.preferredContentSizeCategory != previous.preferredContentSizeCategory)
        NSNotificationCenter::defaultCenter()->postNotificationName_object(
            UIContentSizeCategoryDidChangeNotification, nullptr);
}

} // namespace orvo
