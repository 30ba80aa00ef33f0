#pragma once

#include "platform/uikit/table/UITableViewCell.h"

namespace orvo {

/// The cell of the kit's tables. Main thread.
class KitTableViewCell : public UITableViewCell {
public:
    [[nodiscard]] static std::shared_ptr<KitTableViewCell>
    initWithStyle_reuseIdentifier(UITableViewCellStyle style,
                                  std::optional<std::string> reuseIdentifier);

    [[nodiscard]] std::string className() const override { return "KitTableViewCell"; }
};

} // namespace orvo
