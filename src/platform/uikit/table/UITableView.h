#pragma once

#include "platform/uikit/table/UIScrollView.h"
#include "platform/uikit/table/UITableViewCell.h"
#include "platform/uikit/table/UITableViewDataSource.h"
#include "platform/uikit/table/UITableViewDelegate.h"
#include "platform/uikit/table/_RowHeights.h"

#include <functional>
#include <map>
#include <set>

namespace orvo {

class UIVibrancyEffect;

enum class UITableViewStyle { Plain = 0 };

/// How rows come in when they are reloaded.
enum class UITableViewRowAnimation {
    None = 5,
    Automatic = 100, ///< rows where there were none fade in
};

/// Keys that a table understands.
enum class UITableViewKey { Up, Down, PageUp, PageDown, Home, End, Return };

/// A height that follows from the constraints in the cell.
inline constexpr CGFloat UITableViewAutomaticDimension = -1;

/// A column of rows in sections, which scrolls. It has cells for the rows in sight only, and hands
/// a cell that has gone out of sight to the next row of its kind; after a reload, each row gets the
/// cell that it had where it can. Heights are of whole device pixels. Main thread.
class UITableView : public UIScrollView {
public:
    /// Makes a cell with that reuse identifier.
    using CellClass = std::function<std::shared_ptr<UITableViewCell>(
        UITableViewCellStyle style, const std::string& reuseIdentifier)>;

    [[nodiscard]] static std::shared_ptr<UITableView> initWithFrame_style(CGRect frame,
                                                                          UITableViewStyle style);

    // Who knows what is shown; neither is kept alive
    [[nodiscard]] std::shared_ptr<UITableViewDataSource> dataSource() const {
        return _dataSource.lock();
    }
    /// Reloads.
    virtual void setDataSource(const std::shared_ptr<UITableViewDataSource>& dataSource);
    [[nodiscard]] std::shared_ptr<UITableViewDelegate> delegate() const { return _delegate.lock(); }
    /// Reloads.
    virtual void setDelegate(const std::shared_ptr<UITableViewDelegate>& delegate);

    // Cells
    /// An empty class takes the registration back.
    virtual void registerClass_forCellReuseIdentifier(CellClass cellClass,
                                                      const std::string& identifier);
    /// A cell to be shown now; nil when none is free and no class is registered.
    [[nodiscard]] virtual std::shared_ptr<UITableViewCell>
    dequeueReusableCellWithIdentifier(const std::string& identifier);
    /// The same for a row, which gets the cell that it had last if that is free.
    /// @throws NSInvalidArgumentException when none is free and no class is registered
    [[nodiscard]] virtual std::shared_ptr<UITableViewCell>
    dequeueReusableCellWithIdentifier_forIndexPath(const std::string& identifier,
                                                   const std::shared_ptr<NSIndexPath>& indexPath);

    // Looks
    [[nodiscard]] UITableViewStyle style() const noexcept { return _style; }
    /// Default: automatic.
    [[nodiscard]] CGFloat rowHeight() const noexcept { return _rowHeight; }
    void setRowHeight(CGFloat height);
    /// Default: automatic, which is 44.
    [[nodiscard]] CGFloat estimatedRowHeight() const noexcept { return _estimatedRowHeight; }
    void setEstimatedRowHeight(CGFloat height);
    /// Of cells that do not say otherwise. Default: a single line.
    [[nodiscard]] UITableViewCellSeparatorStyle separatorStyle() const noexcept {
        return _separatorStyle;
    }
    void setSeparatorStyle(UITableViewCellSeparatorStyle style);
    /// Default: none, from edge to edge.
    [[nodiscard]] const NSDirectionalEdgeInsets& separatorInset() const noexcept {
        return _separatorInset;
    }
    void setSeparatorInset(const NSDirectionalEdgeInsets& insets);
    /// Nil, the default, is the colour of separators.
    [[nodiscard]] const std::shared_ptr<UIColor>& separatorColor() const noexcept {
        return _separatorColor;
    }
    void setSeparatorColor(std::shared_ptr<UIColor> color);
    /// Comes before the colour. Default: nil.
    [[nodiscard]] const std::shared_ptr<UIVibrancyEffect>& separatorEffect() const noexcept {
        return _separatorEffect;
    }
    void setSeparatorEffect(std::shared_ptr<UIVibrancyEffect> effect);
    /// Stands under the last row, as wide as the table and as high as it is. With one, however low,
    /// the room under the rows has no separators. Default: nil.
    [[nodiscard]] const std::shared_ptr<UIView>& tableFooterView() const noexcept {
        return _footer;
    }
    virtual void setTableFooterView(const std::shared_ptr<UIView>& view);

    // Rows
    [[nodiscard]] std::int64_t numberOfSections() const;
    /// 0 for a section that is none.
    [[nodiscard]] std::int64_t numberOfRowsInSection(std::int64_t section) const;
    /// Asks for everything again at the next layout pass; nothing stays selected or pressed.
    virtual void reloadData();
    /// The same for the cells of some sections.
    /// @throws NSInvalidArgumentException for a section that is none
    virtual void reloadSections_withRowAnimation(const std::set<std::int64_t>& sections,
                                                 UITableViewRowAnimation animation);
    /// In the table's coordinates; rows not yet seen count with their estimated heights. Empty for
    /// a row that is none.
    [[nodiscard]] CGRect rectForRowAtIndexPath(const NSIndexPath& indexPath) const;
    /// Nil where there is no row.
    [[nodiscard]] std::shared_ptr<NSIndexPath> indexPathForRowAtPoint(CGPoint point) const;
    /// Nil for one that is not shown.
    [[nodiscard]] std::shared_ptr<NSIndexPath> indexPathForCell(const UITableViewCell& cell) const;
    /// Nil for a row out of sight.
    [[nodiscard]] std::shared_ptr<UITableViewCell>
    cellForRowAtIndexPath(const NSIndexPath& indexPath) const;
    /// From top to bottom, as of the latest layout pass.
    [[nodiscard]] std::vector<std::shared_ptr<UITableViewCell>> visibleCells() const;
    [[nodiscard]] std::vector<std::shared_ptr<NSIndexPath>> indexPathsForVisibleRows() const;
    /// As little as is needed.
    void scrollToRowAtIndexPath(const NSIndexPath& indexPath);
    bool scrollBy(CGPoint distance) override;

    // Selection
    /// Nil while none is.
    [[nodiscard]] std::shared_ptr<NSIndexPath> indexPathForSelectedRow() const;
    /// Tells the delegate nothing. Nil, or a row that is none, deselects.
    void selectRowAtIndexPath_animated(const std::shared_ptr<NSIndexPath>& indexPath,
                                       bool animated);
    /// Nothing for a row that is not selected.
    virtual void deselectRowAtIndexPath_animated(const std::shared_ptr<NSIndexPath>& indexPath,
                                                 bool animated);

    // What a person does. Points are in the table's coordinates.
    /// Whether a press on the row does something.
    [[nodiscard]] bool
    _shouldHighlightRowAtIndexPath(const std::shared_ptr<NSIndexPath>& indexPath);
    /// Selects the row as a press would, and tells the delegate.
    /// @returns whether the row may be selected
    bool _pressRowAtIndexPath(const std::shared_ptr<NSIndexPath>& indexPath);
    void touchBegan(CGPoint point);
    /// A press that leaves its row is over.
    void touchMoved(CGPoint point);
    void touchEnded(CGPoint point);
    void touchCancelled();

    /// Keys go to the table: the row that had them last shows it, at first the first in sight.
    void becomeFirstResponder();
    void resignFirstResponder();
    [[nodiscard]] bool isFirstResponder() const noexcept { return _isFirstResponder; }
    /// The row that keys go to; nil while there is none.
    [[nodiscard]] std::shared_ptr<NSIndexPath> focusedIndexPath() const;
    /// Moves to a row, which scrolls into sight. Nothing for one that is none.
    void focusRowAtIndexPath(const NSIndexPath& indexPath);
    /// Answers whether the key did something: at the first and last row a host can go on from
    /// there.
    bool pressKey(UITableViewKey key);

    void layoutSubviews() override;
    void drawRect(Canvas& canvas) override;
    void traitCollectionDidChange(const UITraitCollection& previous) override;
    [[nodiscard]] std::string className() const override { return "UITableView"; }

protected:
    bool _initWithFrame_style(CGRect frame, UITableViewStyle style);

private:
    using Row = std::size_t; ///< counted through all sections
    struct Free {
        std::shared_ptr<UITableViewCell> cell;
        std::optional<Row> row; ///< that it showed
    };

    // Counts and heights
    void countRows() const;
    void forgetRows();
    [[nodiscard]] Row rowsIn(std::int64_t section) const;
    [[nodiscard]] std::shared_ptr<NSIndexPath> pathOf(Row row) const;
    [[nodiscard]] std::optional<Row> rowOf(const NSIndexPath& indexPath) const;
    [[nodiscard]] CGFloat wantedHeight(const std::shared_ptr<NSIndexPath>& path) const;
    [[nodiscard]] CGFloat estimatedHeight(const std::shared_ptr<NSIndexPath>& path) const;
    [[nodiscard]] CGRect rectOf(Row row) const;

    // Cells
    [[nodiscard]] std::shared_ptr<UITableViewCell> takeFree(const std::string& identifier,
                                                            std::optional<Row> row);
    void setFree(const std::shared_ptr<UITableViewCell>& cell, std::optional<Row> row);
    void setAllFree();
    void freeRowsOutOfSight();
    [[nodiscard]] bool loadRowsInSight();
    [[nodiscard]] bool load(Row row);
    void measure(Row row);
    void updateContentSize();
    void placeCells();
    void orderSubviews();
    void updateCell(Row row, UITableViewCell& cell);
    void updateCells();
    void dropRowsFrom(Row count);
    [[nodiscard]] std::shared_ptr<UIColor> lineColor() const;
    [[nodiscard]] std::shared_ptr<UITableViewCell> cellOf(std::optional<Row> row) const;

    void selectByHand(const std::shared_ptr<NSIndexPath>& indexPath);
    void setPressed(std::optional<Row> row);
    void setSelected(std::optional<Row> row, bool animated);
    void setFocused(Row row);
    [[nodiscard]] Row rowAfterKey(UITableViewKey key) const;

    UITableViewStyle _style = UITableViewStyle::Plain;
    std::weak_ptr<UITableViewDataSource> _dataSource;
    std::weak_ptr<UITableViewDelegate> _delegate;
    std::map<std::string, CellClass> _classes;
    CGFloat _rowHeight = UITableViewAutomaticDimension;
    CGFloat _estimatedRowHeight = UITableViewAutomaticDimension;
    UITableViewCellSeparatorStyle _separatorStyle = UITableViewCellSeparatorStyle::SingleLine;
    NSDirectionalEdgeInsets _separatorInset;
    std::shared_ptr<UIColor> _separatorColor;
    std::shared_ptr<UIVibrancyEffect> _separatorEffect;
    std::shared_ptr<UIView> _footer;

    // Brought up to date when asked for.
    mutable bool _rowsCounted = false;
    mutable std::vector<Row> _sectionStarts; ///< one more than there are sections
    mutable _RowHeights _heights;
    mutable std::vector<bool> _measured;
    CGFloat _measuredWidth = 0;
    std::uint64_t _reloads = 0;

    std::map<Row, std::shared_ptr<UITableViewCell>> _shown;
    std::vector<Free> _free; // the one that has been free longest first
    std::set<Row> _fading;   ///< rows that fade in when they are loaded

    std::optional<Row> _pressed;
    std::optional<Row> _selected;
    std::optional<Row> _focused;
    bool _isFirstResponder = false;
};

} // namespace orvo
