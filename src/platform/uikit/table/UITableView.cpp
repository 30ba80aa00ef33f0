#include "platform/uikit/table/UITableView.h"

#include "platform/foundation/Exceptions.h"
#include "platform/uikit/UIVisualEffectView.h"

#include <algorithm>

namespace orvo {

namespace {

// Heights that are measured on the way move what was aimed at.
constexpr int MostScrollPasses = 32;

} // namespace

std::shared_ptr<UITableView> UITableView::initWithFrame_style(CGRect frame,
                                                              UITableViewStyle style) {
    auto table = std::make_shared<UITableView>();
    return table->_initWithFrame_style(frame, style) ? table : nullptr;
}

bool UITableView::_initWithFrame_style(CGRect frame, UITableViewStyle style) {
    _style = style;
    return UIScrollView::_initWithFrame(frame);
}

void UITableView::setDataSource(const std::shared_ptr<UITableViewDataSource>& dataSource) {
    _dataSource = dataSource;
    touchCancelled();
    setSelected(std::nullopt, false);
    setAllFree();
    forgetRows();
}

void UITableView::setDelegate(const std::shared_ptr<UITableViewDelegate>& delegate) {
    _delegate = delegate;
    forgetRows();
}

// Cells

void UITableView::registerClass_forCellReuseIdentifier(CellClass cellClass,
                                                       const std::string& identifier) {
    if (cellClass)
        _classes[identifier] = std::move(cellClass);
    else
        _classes.erase(identifier);
}

std::shared_ptr<UITableViewCell>
UITableView::dequeueReusableCellWithIdentifier(const std::string& identifier) {
    if (auto cell = takeFree(identifier, std::nullopt))
        return cell;
    const auto found = _classes.find(identifier);
    return found == _classes.end() ? nullptr
                                   : found->second(UITableViewCellStyle::Default, identifier);
}

std::shared_ptr<UITableViewCell> UITableView::dequeueReusableCellWithIdentifier_forIndexPath(
    const std::string& identifier, const std::shared_ptr<NSIndexPath>& indexPath) {
    if (auto cell = takeFree(identifier, rowOf(*indexPath)))
        return cell;
    auto cell = dequeueReusableCellWithIdentifier(identifier);
    if (!cell)
        throw NSInvalidArgumentException("no cell class is registered for " + identifier);
    return cell;
}

// Looks

void UITableView::setRowHeight(CGFloat height) {
    _rowHeight = height;
    forgetRows();
}

void UITableView::setEstimatedRowHeight(CGFloat height) {
    _estimatedRowHeight = height;
    forgetRows();
}

void UITableView::setSeparatorStyle(UITableViewCellSeparatorStyle style) {
    _separatorStyle = style;
    setNeedsLayout();
    setNeedsDisplay();
}

void UITableView::setSeparatorInset(const NSDirectionalEdgeInsets& insets) {
    _separatorInset = insets;
    setNeedsLayout();
    setNeedsDisplay();
}

void UITableView::setSeparatorColor(std::shared_ptr<UIColor> color) {
    _separatorColor = std::move(color);
    setNeedsLayout();
    setNeedsDisplay();
}

void UITableView::setSeparatorEffect(std::shared_ptr<UIVibrancyEffect> effect) {
    _separatorEffect = std::move(effect);
    setNeedsLayout();
    setNeedsDisplay();
}

void UITableView::setTableFooterView(const std::shared_ptr<UIView>& view) {
    if (view == _footer)
        return;
    if (_footer)
        _footer->removeFromSuperview();
    _footer = view;
    if (_footer)
        addSubview(_footer);
    setNeedsLayout();
    setNeedsDisplay();
}

// Rows

CGRect UITableView::rectForRowAtIndexPath(const NSIndexPath& indexPath) const {
    const auto row = rowOf(indexPath);
    return row ? rectOf(*row) : CGRect{};
}

std::shared_ptr<NSIndexPath> UITableView::indexPathForRowAtPoint(CGPoint point) const {
    countRows();
    if (point.x < 0 || point.x >= frame().size.width || point.y < 0)
        return nullptr;
    const auto row = _heights.rowAt(point.y);
    return row < _heights.count() ? pathOf(row) : nullptr;
}

std::shared_ptr<NSIndexPath> UITableView::indexPathForCell(const UITableViewCell& cell) const {
    const auto found = std::ranges::find_if(
        _shown, [&cell](const auto& entry) { return entry.second.get() == &cell; });
    return found == _shown.end() ? nullptr : pathOf(found->first);
}

std::shared_ptr<UITableViewCell>
UITableView::cellForRowAtIndexPath(const NSIndexPath& indexPath) const {
    return cellOf(rowOf(indexPath));
}

std::vector<std::shared_ptr<UITableViewCell>> UITableView::visibleCells() const {
    std::vector<std::shared_ptr<UITableViewCell>> cells;
    for (const auto& [row, cell] : _shown)
        cells.push_back(cell);
    return cells;
}

std::vector<std::shared_ptr<NSIndexPath>> UITableView::indexPathsForVisibleRows() const {
    std::vector<std::shared_ptr<NSIndexPath>> paths;
    for (const auto& [row, cell] : _shown)
        paths.push_back(pathOf(row));
    return paths;
}

void UITableView::scrollToRowAtIndexPath(const NSIndexPath& indexPath) {
    layoutIfNeeded();
    const auto row = rowOf(indexPath);
    if (!row)
        return;
    const auto from = contentOffset();
    scrollRectToVisible(rectOf(*row));
    if (contentOffset() == from)
        return;
    // On the way rows turn out to be of other heights than they counted: aim again at the edge that
    // it came in by.
    const bool isBelow = contentOffset().y > from.y;
    for (int pass = 0; pass < MostScrollPasses; ++pass) {
        layoutIfNeeded();
        const auto before = contentOffset();
        const auto rect = rectOf(*row);
        const CGFloat room = frame().size.height - rect.size.height;
        setContentOffset({before.x, isBelow && room > 0 ? rect.origin.y - room : rect.origin.y});
        if (contentOffset() == before)
            return;
    }
}

bool UITableView::scrollBy(CGPoint distance) {
    CGPoint rest = distance;
    bool hasMoved = false;
    for (int pass = 0; pass < MostScrollPasses; ++pass) {
        const auto before = contentOffset();
        if (!UIScrollView::scrollBy(rest))
            break;
        hasMoved = true;
        rest.x -= contentOffset().x - before.x;
        rest.y -= contentOffset().y - before.y;
        layoutIfNeeded(); // rows that come into sight may bring more to scroll
    }
    if (hasMoved)
        touchCancelled();
    return hasMoved;
}

// Selection

std::shared_ptr<NSIndexPath> UITableView::indexPathForSelectedRow() const {
    countRows();
    return _selected && *_selected < _heights.count() ? pathOf(*_selected) : nullptr;
}

void UITableView::selectRowAtIndexPath_animated(const std::shared_ptr<NSIndexPath>& indexPath,
                                                bool animated) {
    setSelected(indexPath ? rowOf(*indexPath) : std::nullopt, animated);
}

void UITableView::deselectRowAtIndexPath_animated(const std::shared_ptr<NSIndexPath>& indexPath,
                                                  bool animated) {
    if (indexPath && _selected && rowOf(*indexPath) == _selected)
        setSelected(std::nullopt, animated);
}

void UITableView::setSelected(std::optional<Row> row, bool animated) {
    if (row == _selected)
        return;
    const auto earlier = cellOf(std::exchange(_selected, row));
    if (earlier)
        earlier->setSelected_animated(false, animated);
    if (const auto cell = cellOf(row))
        cell->setSelected_animated(true, animated);
}

bool UITableView::_shouldHighlightRowAtIndexPath(const std::shared_ptr<NSIndexPath>& indexPath) {
    if (!indexPath || !rowOf(*indexPath))
        return false;
    const auto delegate = this->delegate();
    return !delegate || delegate->tableView_shouldHighlightRowAtIndexPath(strong(this), indexPath)
                            .value_or(true);
}

bool UITableView::_pressRowAtIndexPath(const std::shared_ptr<NSIndexPath>& indexPath) {
    if (!_shouldHighlightRowAtIndexPath(indexPath))
        return false;
    selectByHand(indexPath);
    return true;
}

void UITableView::selectByHand(const std::shared_ptr<NSIndexPath>& indexPath) {
    setSelected(rowOf(*indexPath), false);
    setPressed(std::nullopt); // after it is selected, so that the look does not blink
    if (const auto delegate = this->delegate())
        delegate->tableView_didSelectRowAtIndexPath(strong(this), indexPath);
}

void UITableView::setPressed(std::optional<Row> row) {
    const auto earlier = cellOf(std::exchange(_pressed, row));
    if (earlier)
        earlier->setHighlighted(false);
    if (const auto cell = cellOf(row))
        cell->setHighlighted(true);
}

void UITableView::touchBegan(CGPoint point) {
    const auto path = indexPathForRowAtPoint(point);
    if (_shouldHighlightRowAtIndexPath(path))
        setPressed(rowOf(*path));
}

void UITableView::touchMoved(CGPoint point) {
    const auto path = indexPathForRowAtPoint(point);
    if (_pressed && (!path || rowOf(*path) != _pressed))
        touchCancelled();
}

void UITableView::touchEnded(CGPoint point) {
    touchMoved(point);
    if (!_pressed)
        return;
    selectByHand(pathOf(*_pressed));
}

void UITableView::touchCancelled() {
    setPressed(std::nullopt);
}

// Keys

void UITableView::becomeFirstResponder() {
    layoutIfNeeded();
    _isFirstResponder = true;
    if (!_focused && !_shown.empty())
        _focused = _shown.begin()->first;
    if (_focused)
        setFocused(*_focused);
}

void UITableView::resignFirstResponder() {
    _isFirstResponder = false;
    updateCells();
}

std::shared_ptr<NSIndexPath> UITableView::focusedIndexPath() const {
    countRows();
    return _focused && *_focused < _heights.count() ? pathOf(*_focused) : nullptr;
}

void UITableView::focusRowAtIndexPath(const NSIndexPath& indexPath) {
    if (const auto row = rowOf(indexPath))
        setFocused(*row);
}

void UITableView::setFocused(Row row) {
    _focused = row;
    scrollToRowAtIndexPath(*pathOf(row));
    updateCells();
}

bool UITableView::pressKey(UITableViewKey key) {
    layoutIfNeeded();
    if (!_focused)
        return false;
    if (key == UITableViewKey::Return)
        return _pressRowAtIndexPath(focusedIndexPath());
    const auto row = rowAfterKey(key);
    if (row == *_focused)
        return false;
    setFocused(row);
    return true;
}

UITableView::Row UITableView::rowAfterKey(UITableViewKey key) const {
    const Row focused = *_focused;
    const Row last = _heights.count() - 1;
    const CGFloat page = frame().size.height;
    switch (key) {
    case UITableViewKey::Up:
        return focused == 0 ? 0 : focused - 1;
    case UITableViewKey::Down:
        return std::min(focused + 1, last);
    case UITableViewKey::PageUp:
        return std::min(_heights.rowAt(_heights.top(focused) - page), focused);
    case UITableViewKey::PageDown:
        return std::clamp(_heights.rowAt(_heights.top(focused) + page), focused, last);
    case UITableViewKey::Home:
        return 0;
    case UITableViewKey::End:
        return last;
    case UITableViewKey::Return:
        break;
    }
    return focused;
}

} // namespace orvo
