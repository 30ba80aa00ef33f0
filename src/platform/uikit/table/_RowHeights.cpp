#include "platform/uikit/table/_RowHeights.h"

#include <bit>

namespace orvo {

_RowHeights::_RowHeights(std::vector<CGFloat> heights)
    : _heights(std::move(heights))
    , _sums(_heights) {
    for (std::size_t i = 0; i < _sums.size(); ++i) {
        const std::size_t next = i | (i + 1);
        if (next < _sums.size())
            _sums[next] += _sums[i];
    }
}

void _RowHeights::setHeight(std::size_t row, CGFloat height) {
    const CGFloat change = height - _heights.at(row);
    _heights[row] = height;
    for (std::size_t i = row; i < _sums.size(); i |= i + 1)
        _sums[i] += change;
}

CGFloat _RowHeights::top(std::size_t row) const {
    CGFloat sum = 0;
    for (std::size_t end = row; end > 0; end &= end - 1)
        sum += _sums[end - 1];
    return sum;
}

std::size_t _RowHeights::rowAt(CGFloat y) const {
    std::size_t row = 0;
    CGFloat rest = y < 0 ? 0 : y;
    for (std::size_t step = std::bit_floor(count()); step > 0; step /= 2) {
        const std::size_t next = row + step;
        if (next <= count() && _sums[next - 1] <= rest) {
            rest -= _sums[next - 1];
            row = next;
        }
    }
    return row;
}

} // namespace orvo
