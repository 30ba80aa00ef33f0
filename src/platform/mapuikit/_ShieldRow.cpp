#include "platform/mapuikit/_ShieldRow.h"

#include <algorithm>

namespace orvo {

namespace {

/// Puts one thing after the other, into the next line where it has no room in this one.
class Lines {
public:
    explicit Lines(const _ShieldRow::Request& request)
        : _request(request) {}

    CGRect put(CGSize size) {
        if (size.width <= 0)
            return {{_end, 0}, {}};
        CGFloat x = _end == 0 ? 0 : _end + _request.space;
        if (_end > 0 && x + size.width > _request.width) {
            ++_line;
            x = 0;
        }
        _end = x + size.width;
        _widest = std::max(_widest, _end);
        const CGFloat top = static_cast<CGFloat>(_line) * (_request.lineHeight + _request.space);
        return {{x, top + (_request.lineHeight - size.height) / 2}, size};
    }
    /// Whether all that was put stands in the width and the lines that there are.
    [[nodiscard]] bool fits() const {
        return _widest <= _request.width && (_request.lines == 0 || _line < _request.lines);
    }
    [[nodiscard]] CGSize size() const {
        const auto lines = static_cast<CGFloat>(_line + 1);
        return {_widest, lines * _request.lineHeight + (lines - 1) * _request.space};
    }

private:
    const _ShieldRow::Request& _request;
    std::size_t _line = 0;
    CGFloat _end = 0;
    CGFloat _widest = 0;
};

/// The sizes of the shields that have room by themselves.
std::vector<CGSize> shieldsWithRoom(const _ShieldRow::Request& request) {
    Lines lines(request);
    std::vector<CGSize> sizes;
    for (std::size_t i = 0; i < request.shields; ++i) {
        const auto size = request.sizeOf(i);
        lines.put(size);
        if (!lines.fits())
            break;
        sizes.push_back(size);
    }
    return sizes;
}

} // namespace

_ShieldRow _ShieldRow::arrange(const Request& request) {
    const auto sizes = shieldsWithRoom(request);
    for (auto shown = sizes.size();; --shown) {
        const auto leftOut = request.shields - shown;
        Lines lines(request);
        _ShieldRow row;
        for (std::size_t i = 0; i < shown; ++i)
            row.shields.push_back(lines.put(sizes[i]));
        const CGFloat wanted =
            leftOut > 0 && request.textWidth ? request.textWidth(leftOut) : CGFloat(0);
        if (wanted > 0) {
            const auto width = shown == 0 ? std::min(wanted, request.width) : wanted;
            row.text = lines.put({width, request.lineHeight});
        }
        if (lines.fits() || shown == 0) {
            row.size = lines.size();
            return row;
        }
    }
}

} // namespace orvo
