#pragma once

#include "platform/uikit/UILabel.h"

namespace orvo {

/// The label of the kit's cells. Main thread.
class KitLabel : public UILabel {
public:
    [[nodiscard]] static std::shared_ptr<KitLabel> init();
    [[nodiscard]] static std::shared_ptr<KitLabel> initWithFrame(CGRect frame);

    [[nodiscard]] std::string className() const override { return "KitLabel"; }
};

} // namespace orvo
