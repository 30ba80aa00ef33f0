#include "platform/mapuikit/KitTableViewCell.h"

namespace orvo {

std::shared_ptr<KitTableViewCell>
KitTableViewCell::initWithStyle_reuseIdentifier(UITableViewCellStyle style,
                                                std::optional<std::string> reuseIdentifier) {
    auto cell = std::make_shared<KitTableViewCell>();
    return cell->_initWithStyle_reuseIdentifier(style, std::move(reuseIdentifier)) ? cell : nullptr;
}

} // namespace orvo
