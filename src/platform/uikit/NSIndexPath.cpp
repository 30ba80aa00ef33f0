#include "platform/uikit/NSIndexPath.h"

#include "platform/foundation/Hashing.h"

namespace orvo {

std::shared_ptr<NSIndexPath> NSIndexPath::indexPathForRow_inSection(std::int64_t row,
                                                                    std::int64_t section) {
    auto path = std::make_shared<NSIndexPath>();
    path->_row = row;
    path->_section = section;
    return path;
}

bool NSIndexPath::isEqual(const NSObject* other) const {
    const auto* path = dynamic_cast<const NSIndexPath*>(other);
    return path && path->_row == _row && path->_section == _section;
}

std::uint64_t NSIndexPath::hash() const {
    return (static_cast<std::uint64_t>(_section) * 31 + static_cast<std::uint64_t>(_row)) *
           HashMultiplier;
}

std::string NSIndexPath::description() const {
    return rootDescription() + " {section = " + std::to_string(_section) +
           ", row = " + std::to_string(_row) + "}";
}

std::shared_ptr<NSObject> NSIndexPath::copy() const {
    return std::const_pointer_cast<NSObject>(shared_from_this());
}

} // namespace orvo
