#pragma once

#include "platform/foundation/CGGeometry.h"
#include "platform/uikit/NSIndexPath.h"

#include <optional>

namespace orvo {

class UITableView;

/// Decides how a table's rows behave. Every method is optional; those with an answer then answer
/// nil. Main thread.
class UITableViewDelegate : public virtual NSObject {
public:
    /// Optional; then the table's `rowHeight`. May be `UITableViewAutomaticDimension`.
    [[nodiscard]] virtual std::optional<CGFloat>
    tableView_heightForRowAtIndexPath(const std::shared_ptr<UITableView>& /*tableView*/,
                                      const std::shared_ptr<NSIndexPath>& /*indexPath*/) {
        return std::nullopt;
    }
    /// How high a row of automatic height counts until it is seen. Optional; then the table's
    /// `estimatedRowHeight`.
    [[nodiscard]] virtual std::optional<CGFloat>
    tableView_estimatedHeightForRowAtIndexPath(const std::shared_ptr<UITableView>& /*tableView*/,
                                               const std::shared_ptr<NSIndexPath>& /*indexPath*/) {
        return std::nullopt;
    }
    /// Whether a press shows on the row; where it does not, the row cannot be selected by hand.
    /// Optional; then it may.
    [[nodiscard]] virtual std::optional<bool>
    tableView_shouldHighlightRowAtIndexPath(const std::shared_ptr<UITableView>& /*tableView*/,
                                            const std::shared_ptr<NSIndexPath>& /*indexPath*/) {
        return std::nullopt;
    }
    /// The person has selected a row, which stays selected until it is deselected.
    virtual void
    tableView_didSelectRowAtIndexPath(const std::shared_ptr<UITableView>& /*tableView*/,
                                      const std::shared_ptr<NSIndexPath>& /*indexPath*/) {}
};

} // namespace orvo
