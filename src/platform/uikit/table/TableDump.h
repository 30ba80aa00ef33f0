#pragma once

#include <string>

namespace orvo {

class UITableView;

/// What a table shows, as of its latest layout pass: its frame, how much of its content is scrolled
/// away, the size of that, then each row in sight: section and row, the cell's class, where it
/// begins and how high it is, and what is marked (`line` for a separator, `pressed`, `selected`,
/// `focused`). Lays nothing out.
[[nodiscard]] std::string dumpTable(const UITableView& table);

} // namespace orvo
