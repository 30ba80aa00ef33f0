#pragma once

#include "platform/foundation/CGGeometry.h"

#include <cstddef>
#include <vector>

namespace orvo {

/// The heights of rows that stand one under the other. Finding a row, or where one stands, and
/// changing a height take time with the logarithm of their number.
class _RowHeights {
public:
    _RowHeights() = default;
    explicit _RowHeights(std::vector<CGFloat> heights);

    [[nodiscard]] std::size_t count() const noexcept { return _heights.size(); }
    [[nodiscard]] CGFloat height(std::size_t row) const { return _heights.at(row); }
    void setHeight(std::size_t row, CGFloat height);
    /// Where a row begins; for `count()`, where the last one ends.
    [[nodiscard]] CGFloat top(std::size_t row) const;
    [[nodiscard]] CGFloat total() const { return top(count()); }
    /// The row that `y` lies in: the first for less than 0, `count()` past the end. Of two rows
    /// that meet there it is the lower one; rows without a height hold no point.
    [[nodiscard]] std::size_t rowAt(CGFloat y) const;

private:
    std::vector<CGFloat> _heights;
    std::vector<CGFloat> _sums; // a binary indexed tree: entry i sums the rows up to i, as many as
                                // the lowest bit of i + 1 says
};

} // namespace orvo
