#include "platform/uikit/text/TextMeasurer.h"

#include "platform/uikit/text/ToolkitTextMeasurer.h"

namespace orvo {

EnvironmentSlot<std::shared_ptr<TextMeasurer>>& TextMeasurer::shared() {
    static EnvironmentSlot<std::shared_ptr<TextMeasurer>> slot(
        [] { return std::make_shared<ToolkitTextMeasurer>(); });
    return slot;
}

} // namespace orvo
