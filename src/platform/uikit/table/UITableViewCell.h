#pragma once

#include "platform/uikit/UIView.h"

namespace orvo {

enum class UITableViewCellStyle { Default = 0 };

/// What is drawn along the bottom edge of a row.
enum class UITableViewCellSeparatorStyle { None = 0, SingleLine = 1 };

/// One row of a table: what it shows lies in its content view. A table makes a few cells and hands
/// them to row after row. It is laid out by itself, as wide as its table, and as high as its
/// constraints say where the table leaves that to them. Main thread.
class UITableViewCell : public UIView {
public:
    /// A separator line: where it begins and ends, and in which colour.
    struct Separator {
        NSDirectionalEdgeInsets insets; ///< leading and trailing count
        std::shared_ptr<UIColor> color;
    };

    /// A cell without a reuse identifier is never handed out again.
    [[nodiscard]] static std::shared_ptr<UITableViewCell>
    initWithStyle_reuseIdentifier(UITableViewCellStyle style,
                                  std::optional<std::string> reuseIdentifier);

    [[nodiscard]] UITableViewCellStyle style() const noexcept { return _style; }
    [[nodiscard]] const std::optional<std::string>& reuseIdentifier() const noexcept {
        return _reuseIdentifier;
    }
    /// Always as large as the cell.
    [[nodiscard]] const std::shared_ptr<UIView>& contentView() const noexcept {
        return _contentView;
    }
    /// Nil, the default: as the table has it.
    [[nodiscard]] std::optional<UITableViewCellSeparatorStyle>
    separatorStyleOverride() const noexcept {
        return _separatorOverride;
    }
    virtual void setSeparatorStyleOverride(std::optional<UITableViewCellSeparatorStyle> style);
    /// Nil, the default: those of the table.
    [[nodiscard]] const std::optional<NSDirectionalEdgeInsets>& separatorInset() const noexcept {
        return _separatorInset;
    }
    void setSeparatorInset(const std::optional<NSDirectionalEdgeInsets>& insets);

    /// The cell is about to show another row. An override calls its base.
    virtual void prepareForReuse();

    /// While it is pressed.
    [[nodiscard]] bool isHighlighted() const noexcept { return _highlighted; }
    void setHighlighted(bool highlighted) { setHighlighted_animated(highlighted, false); }
    virtual void setHighlighted_animated(bool highlighted, bool animated);
    [[nodiscard]] bool isSelected() const noexcept { return _selected; }
    void setSelected(bool selected) { setSelected_animated(selected, false); }
    virtual void setSelected_animated(bool selected, bool animated);
    /// Whether it shows that keys go to it.
    [[nodiscard]] bool isFocused() const noexcept { return _focused; }
    void _setFocused(bool focused);
    /// How much of the highlighted look is seen, 0 to 1.
    [[nodiscard]] double _highlightLevel() const noexcept { return _highlightLevelNow; }

    /// What the table draws under this row; nil for none.
    [[nodiscard]] const std::optional<Separator>& _separator() const noexcept { return _line; }
    void _setSeparator(std::optional<Separator> separator);

    [[nodiscard]] bool _isLayoutRoot() const override { return true; }
    [[nodiscard]] UILayoutPriority _rootHeightPriority() const override;
    void drawRect(Canvas& canvas) override;
    /// Where none was set: what is spoken for the views inside that are shown, in order.
    [[nodiscard]] std::optional<std::string> accessibilityLabel() const override;
    [[nodiscard]] std::string className() const override { return "UITableViewCell"; }

protected:
    bool _initWithStyle_reuseIdentifier(UITableViewCellStyle style,
                                        std::optional<std::string> reuseIdentifier);

private:
    void updateHighlight(bool animated);

    UITableViewCellStyle _style = UITableViewCellStyle::Default;
    std::optional<std::string> _reuseIdentifier;
    std::shared_ptr<UIView> _contentView;
    std::optional<UITableViewCellSeparatorStyle> _separatorOverride;
    std::optional<NSDirectionalEdgeInsets> _separatorInset;
    std::optional<Separator> _line;
    bool _highlighted = false;
    bool _selected = false;
    bool _focused = false;
    double _highlightLevelNow = 0;
};

} // namespace orvo
