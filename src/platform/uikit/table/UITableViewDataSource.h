#pragma once

#include "platform/uikit/NSIndexPath.h"

#include <optional>

namespace orvo {

class UITableView;
class UITableViewCell;

/// Knows what a table shows. Optional methods answer nil. Main thread.
class UITableViewDataSource : public virtual NSObject {
public:
    /// Optional; then there is one section.
    [[nodiscard]] virtual std::optional<std::int64_t>
    numberOfSectionsInTableView(const std::shared_ptr<UITableView>& /*tableView*/) {
        return std::nullopt;
    }
    [[nodiscard]] virtual std::int64_t
    tableView_numberOfRowsInSection(const std::shared_ptr<UITableView>& tableView,
                                    std::int64_t section) = 0;
    /// Never nil. The table asks for the rows that are seen, from top to bottom, and again only
    /// after a reload or when a row comes back into sight.
    [[nodiscard]] virtual std::shared_ptr<UITableViewCell>
    tableView_cellForRowAtIndexPath(const std::shared_ptr<UITableView>& tableView,
                                    const std::shared_ptr<NSIndexPath>& indexPath) = 0;
};

} // namespace orvo
