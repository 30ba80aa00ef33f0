#include "platform/foundation/Exceptions.h"
#include "platform/uikit/UIColor.h"
#include "platform/uikit/UIVisualEffectView.h"
#include "platform/uikit/ViewAnimator.h"
#include "platform/uikit/drawing/Canvas.h"
#include "platform/uikit/table/UITableView.h"

#include <algorithm>

// Which cells a table has, and where they stand; the table itself is in UITableView.cpp.

namespace orvo {

namespace {

constexpr CGFloat StandardRowHeight = 44;
// Rows that turn out lower than they counted bring more rows into sight.
constexpr int MostPasses = 8;
// New rows come in while a card that grows for them has nearly grown.
constexpr const char* Appearance = "appear";
constexpr double AppearanceDelay = 0.13;
constexpr double AppearanceSeconds = 0.12;

} // namespace

// Counts and heights

void UITableView::forgetRows() {
    _rowsCounted = false;
    ++_reloads;
    setNeedsLayout();
}

void UITableView::countRows() const {
    if (_rowsCounted)
        return;
    _rowsCounted = true;
    const auto table = std::const_pointer_cast<UITableView>(strong(this));
    const auto source = dataSource();
    const auto sections =
        source ? source->numberOfSectionsInTableView(table).value_or(1) : std::int64_t{0};
    _sectionStarts = {0};
    for (std::int64_t section = 0; section < sections; ++section) {
        const auto rows =
            std::max<std::int64_t>(0, source->tableView_numberOfRowsInSection(table, section));
        _sectionStarts.push_back(_sectionStarts.back() + static_cast<Row>(rows));
    }
    std::vector<CGFloat> heights;
    heights.reserve(_sectionStarts.back());
    for (Row row = 0; row < _sectionStarts.back(); ++row) {
        // A row that was measured will hardly be another height now; what is seen stays in place.
        const bool wasMeasured = row < _measured.size() && _measured[row];
        const auto path = pathOf(row);
        const auto wanted = wantedHeight(path);
        if (wanted >= 0)
            heights.push_back(wanted);
        else
            heights.push_back(wasMeasured ? _heights.height(row) : estimatedHeight(path));
    }
    _heights = _RowHeights(std::move(heights));
    _measured.assign(_heights.count(), false);
}

CGFloat UITableView::wantedHeight(const std::shared_ptr<NSIndexPath>& path) const {
    const auto table = std::const_pointer_cast<UITableView>(strong(this));
    const auto delegate = this->delegate();
    const auto own =
        delegate ? delegate->tableView_heightForRowAtIndexPath(table, path) : std::nullopt;
    const auto height = own.value_or(_rowHeight);
    return height < 0 ? UITableViewAutomaticDimension : UIRoundToViewScale(height, this);
}

CGFloat UITableView::estimatedHeight(const std::shared_ptr<NSIndexPath>& path) const {
    const auto table = std::const_pointer_cast<UITableView>(strong(this));
    const auto delegate = this->delegate();
    const auto own =
        delegate ? delegate->tableView_estimatedHeightForRowAtIndexPath(table, path) : std::nullopt;
    const auto height = own.value_or(_estimatedRowHeight);
    return height < 0 ? StandardRowHeight : height;
}

std::int64_t UITableView::numberOfSections() const {
    countRows();
    return static_cast<std::int64_t>(_sectionStarts.size()) - 1;
}

std::int64_t UITableView::numberOfRowsInSection(std::int64_t section) const {
    countRows();
    return static_cast<std::int64_t>(rowsIn(section));
}

UITableView::Row UITableView::rowsIn(std::int64_t section) const {
    const auto index = static_cast<std::size_t>(section);
    return section < 0 || index + 1 >= _sectionStarts.size()
               ? 0
               : _sectionStarts[index + 1] - _sectionStarts[index];
}

std::shared_ptr<NSIndexPath> UITableView::pathOf(Row row) const {
    const auto after = std::ranges::upper_bound(_sectionStarts, row);
    const auto section = after - _sectionStarts.begin() - 1;
    return NSIndexPath::indexPathForRow_inSection(
        static_cast<std::int64_t>(row - _sectionStarts.at(static_cast<std::size_t>(section))),
        section);
}

std::optional<UITableView::Row> UITableView::rowOf(const NSIndexPath& indexPath) const {
    countRows();
    if (indexPath.row() < 0 || static_cast<Row>(indexPath.row()) >= rowsIn(indexPath.section()))
        return std::nullopt;
    return _sectionStarts[static_cast<std::size_t>(indexPath.section())] +
           static_cast<Row>(indexPath.row());
}

CGRect UITableView::rectOf(Row row) const {
    return {{0, _heights.top(row)}, {frame().size.width, _heights.height(row)}};
}

// Reloading

void UITableView::reloadData() {
    touchCancelled();
    setSelected(std::nullopt, false);
    setAllFree();
    forgetRows();
}

void UITableView::reloadSections_withRowAnimation(const std::set<std::int64_t>& sections,
                                                  UITableViewRowAnimation animation) {
    if (!_rowsCounted)
        return reloadData();
    touchCancelled();
    setSelected(std::nullopt, false);
    std::vector<std::pair<std::shared_ptr<NSIndexPath>, std::shared_ptr<UITableViewCell>>> shown;
    for (const auto& [row, cell] : _shown)
        shown.emplace_back(pathOf(row), cell);
    std::map<std::int64_t, std::int64_t> rowsBefore;
    for (const auto section : sections)
        rowsBefore[section] = static_cast<std::int64_t>(rowsIn(section));
    _shown.clear();
    forgetRows();
    const auto count = numberOfSections();
    for (const auto& [path, cell] : shown) {
        const auto row = rowOf(*path);
        if (row && !sections.contains(path->section()))
            _shown[*row] = cell;
        else
            setFree(cell, row);
    }
    for (const auto section : sections) {
        if (section < 0 || section >= count)
            throw NSInvalidArgumentException("section " + std::to_string(section) +
                                             " was reloaded in a table of " +
                                             std::to_string(count) + " sections");
        if (animation == UITableViewRowAnimation::None)
            continue;
        for (auto row = rowsBefore[section]; row < numberOfRowsInSection(section); ++row)
            _fading.insert(*rowOf(*NSIndexPath::indexPathForRow_inSection(row, section)));
    }
}

// Free cells

std::shared_ptr<UITableViewCell> UITableView::takeFree(const std::string& identifier,
                                                       std::optional<Row> row) {
    const auto isOfKind = [&](const Free& free) {
        return free.cell->reuseIdentifier() == identifier;
    };
    auto found = std::ranges::find_if(
        _free, [&](const Free& free) { return isOfKind(free) && row && free.row == row; });
    if (found == _free.end())
        found = std::ranges::find_if(_free, isOfKind);
    if (found == _free.end())
        return nullptr;
    const auto cell = found->cell;
    _free.erase(found);
    cell->prepareForReuse();
    return cell;
}

void UITableView::setFree(const std::shared_ptr<UITableViewCell>& cell, std::optional<Row> row) {
    ViewAnimator::shared().get()->cancel(*cell, Appearance);
    cell->setAlpha(1);
    if (cell->reuseIdentifier())
        _free.push_back({cell, row});
    else
        cell->removeFromSuperview();
}

void UITableView::setAllFree() {
    for (const auto& [row, cell] : std::exchange(_shown, {}))
        setFree(cell, row);
}

void UITableView::freeRowsOutOfSight() {
    const CGFloat top = contentOffset().y;
    const CGFloat bottom = top + frame().size.height;
    for (auto each = _shown.begin(); each != _shown.end();) {
        const auto rect = rectOf(each->first);
        if (rect.origin.y < bottom && rect.origin.y + rect.size.height > top) {
            ++each;
            continue;
        }
        setFree(each->second, each->first);
        each = _shown.erase(each);
    }
}

/// Rows that are no more are not shown, and keys go to the last one.
void UITableView::dropRowsFrom(Row count) {
    while (!_shown.empty() && _shown.rbegin()->first >= count) {
        setFree(_shown.rbegin()->second, std::nullopt);
        _shown.erase(std::prev(_shown.end()));
    }
    if (_focused && *_focused >= count)
        _focused = count > 0 ? std::optional(count - 1) : std::nullopt;
}

// Cells in sight

void UITableView::layoutSubviews() {
    UIScrollView::layoutSubviews();
    countRows();
    dropRowsFrom(_heights.count());
    if (frame().size.width != _measuredWidth) {
        _measuredWidth = frame().size.width;
        _measured.assign(_heights.count(), false);
    }
    updateContentSize();
    if (!loadRowsInSight())
        return; // reloaded while it was asking; another pass follows
    placeCells();
    orderSubviews();
    updateCells();
    if (const bool clips = _maximumContentOffset().y > 0; clips != clipsToBounds())
        setClipsToBounds(clips); // what all fits may stand out at its sides: highlights do
}

/// Answers false where the rows are no more what they were.
bool UITableView::loadRowsInSight() {
    const auto size = frame().size;
    if (size.width <= 0 || size.height <= 0) {
        setAllFree();
        return true;
    }
    // What was in sight stays in place when rows above it turn out to be of another height.
    const Row anchor = _shown.empty() ? 0 : _shown.begin()->first;
    for (int pass = 0; pass < MostPasses; ++pass) {
        freeRowsOutOfSight();
        const CGFloat before = contentOffset().y;
        for (Row row = _heights.rowAt(before);
             row < _heights.count() && _heights.top(row) < contentOffset().y + size.height;
             ++row) {
            if (!_shown.contains(row) && !load(row))
                return false;
            if (_measured[row])
                continue;
            const CGFloat counted = _heights.height(row);
            measure(row);
            updateContentSize();
            if (row < anchor)
                setContentOffset(
                    {contentOffset().x, contentOffset().y + _heights.height(row) - counted});
        }
        if (contentOffset().y == before)
            break;
    }
    freeRowsOutOfSight();
    _fading.clear();
    return true;
}

/// Answers false where the data source has gone, or reloaded the table meanwhile.
bool UITableView::load(Row row) {
    const auto source = dataSource();
    if (!source) {
        forgetRows();
        return false;
    }
    const auto path = pathOf(row);
    const auto reloads = _reloads;
    const auto cell = source->tableView_cellForRowAtIndexPath(strong(this), path);
    if (!cell)
        throw NSInvalidArgumentException("the data source gave no cell for " + path->description());
    if (reloads != _reloads) {
        setFree(cell, std::nullopt);
        return false;
    }
    if (cell->superview().get() != this)
        addSubview(cell);
    _shown[row] = cell;
    if (_fading.erase(row) > 0)
        ViewAnimator::shared().get()->animate(
            *cell,
            Appearance,
            AppearanceDelay,
            AppearanceSeconds,
            [cell = cell.get()](double progress) { cell->setAlpha(progress); });
    return true;
}

void UITableView::measure(Row row) {
    _measured[row] = true;
    const auto cell = _shown.at(row);
    auto height = wantedHeight(pathOf(row));
    if (height < 0) {
        cell->setFrame(rectOf(row));
        height =
            cell->systemLayoutSizeFittingSize_withHorizontalFittingPriority_verticalFittingPriority(
                    {frame().size.width, 0},
                    UILayoutPriorityRequired,
                    UILayoutPriorityFittingSizeLevel)
                .height;
        if (height <= 0)
            height = StandardRowHeight; // a cell without anything in it
    }
    _heights.setHeight(row, height);
}

void UITableView::updateContentSize() {
    const CGFloat footer = _footer ? _footer->frame().size.height : 0;
    setContentSize({frame().size.width, _heights.total() + footer});
}

void UITableView::placeCells() {
    for (const auto& [row, cell] : _shown)
        cell->setFrame(rectOf(row));
    if (_footer)
        _footer->setFrame(
            {{0, _heights.total()}, {frame().size.width, _footer->frame().size.height}});
}

/// In the order of rows, so that who walks the tree reads from top to bottom.
void UITableView::orderSubviews() {
    for (const auto& free : _free)
        free.cell->removeFromSuperview();
    std::size_t index = 0;
    for (const auto& [row, cell] : _shown) {
        if (subviews().at(index) != cell)
            insertSubview_atIndex(cell, index);
        ++index;
    }
}

void UITableView::updateCells() {
    for (const auto& [row, cell] : _shown)
        updateCell(row, *cell);
}

void UITableView::updateCell(Row row, UITableViewCell& cell) {
    cell.setSelected(_selected == row);
    cell._setFocused(_isFirstResponder && _focused == row);
    const auto style = cell.separatorStyleOverride().value_or(_separatorStyle);
    if (style == UITableViewCellSeparatorStyle::None)
        cell._setSeparator(std::nullopt);
    else
        cell._setSeparator(UITableViewCell::Separator{
            cell.separatorInset().value_or(_separatorInset), lineColor()});
}

std::shared_ptr<UIColor> UITableView::lineColor() const {
    if (_separatorEffect)
        return _separatorEffect->color();
    return _separatorColor ? _separatorColor : UIColor::separatorColor();
}

std::shared_ptr<UITableViewCell> UITableView::cellOf(std::optional<Row> row) const {
    const auto found = row ? _shown.find(*row) : _shown.end();
    return found == _shown.end() ? nullptr : found->second;
}

void UITableView::traitCollectionDidChange(const UITraitCollection& previous) {
    UIScrollView::traitCollectionDidChange(previous);
    // Free cells are outside the tree, where nobody tells them.
    _free.clear();
    _measured.assign(_measured.size(), false);
}

void UITableView::drawRect(Canvas& canvas) {
    if (_footer || _separatorStyle == UITableViewCellSeparatorStyle::None)
        return;
    // Without a footer the rows seem to go on.
    const auto rows = _heights.count();
    auto height = _rowHeight > 0 ? _rowHeight : StandardRowHeight;
    if (rows > 0 && _heights.height(rows - 1) > 0)
        height = _heights.height(rows - 1);
    const CGFloat pixel = 1 / canvas.scale();
    const CGFloat bottom = contentOffset().y + frame().size.height;
    const auto color = lineColor()->resolvedColorWithTraitCollection(traitCollection());
    const bool rightToLeft =
        effectiveUserInterfaceLayoutDirection() == UIUserInterfaceLayoutDirection::RightToLeft;
    const CGFloat width = frame().size.width - _separatorInset.leading - _separatorInset.trailing;
    for (CGFloat y = _heights.total() + height; y <= bottom; y += height)
        canvas.fill({{rightToLeft ? _separatorInset.trailing : _separatorInset.leading, y - pixel},
                     {width, pixel}},
                    0,
                    color);
}

} // namespace orvo
