#pragma once

#include "platform/uikit/UIGeometry.h"
#include "platform/uikit/UILayoutGuide.h"
#include "platform/uikit/UITraitCollection.h"

#include <array>
#include <optional>
#include <string>
#include <vector>

namespace orvo {

class Canvas;
class UIColor;
class _LayoutEngine;

enum class UILayoutConstraintAxis { Horizontal = 0, Vertical = 1 };

/// Whether a view's contents are mirrored where one reads from right to left.
enum class UISemanticContentAttribute { Unspecified, ForceLeftToRight, ForceRightToLeft };

/// No length of its own, as a side of `intrinsicContentSize`.
inline constexpr CGFloat UIViewNoIntrinsicMetric = -1;
/// What fitting aims at: as small, or as large, as the constraints allow.
inline constexpr CGSize UILayoutFittingCompressedSize{0, 0};
inline constexpr CGSize UILayoutFittingExpandedSize{10000, 10000};

/// A rectangle of the screen, with views inside it. Superviews keep their subviews; the way back is
/// weak. Main thread.
class UIView : public UILayoutItem {
public:
    [[nodiscard]] static std::shared_ptr<UIView> init();
    [[nodiscard]] static std::shared_ptr<UIView> initWithFrame(CGRect frame);
    UIView();
    ~UIView() override;

    // The tree
    /// Nil for a root.
    [[nodiscard]] std::shared_ptr<UIView> superview() const { return _superview.lock(); }
    /// From back to front.
    [[nodiscard]] const std::vector<std::shared_ptr<UIView>>& subviews() const noexcept {
        return _subviews;
    }
    /// Takes it out of an earlier superview first.
    /// @throws NSInvalidArgumentException for nil, itself or a view above it
    virtual void addSubview(const std::shared_ptr<UIView>& view);
    /// `index` past the end is the end.
    void insertSubview_atIndex(const std::shared_ptr<UIView>& view, std::size_t index);
    /// Deactivates the constraints between it, or what it holds, and what stays.
    void removeFromSuperview();
    [[nodiscard]] bool isDescendantOfView(const UIView& view) const;
    virtual void didMoveToSuperview() {}
    virtual void didAddSubview(const std::shared_ptr<UIView>&) {}
    virtual void willRemoveSubview(const std::shared_ptr<UIView>&) {}

    // Geometry, in points
    /// In the coordinates of the superview. A view that constraints place is placed again by the
    /// next layout pass.
    [[nodiscard]] const CGRect& frame() const noexcept { return _frame; }
    void setFrame(const CGRect& frame);
    /// The visible part in its own coordinates; its origin is where a scrolling view has scrolled.
    [[nodiscard]] CGRect bounds() const noexcept { return {_boundsOrigin, _frame.size}; }
    void setBounds(const CGRect& bounds);
    [[nodiscard]] CGPoint convertPoint_toView(CGPoint point, const UIView& view) const;
    [[nodiscard]] CGRect convertRect_toView(const CGRect& rect, const UIView& view) const;

    // Looks
    [[nodiscard]] bool isHidden() const noexcept { return _hidden; }
    /// A hidden view keeps its place, but in a stack view.
    virtual void setHidden(bool hidden);
    /// 0 to 1, for the view and what it holds. Kept as given; drawing clamps it.
    [[nodiscard]] CGFloat alpha() const noexcept { return _alpha; }
    void setAlpha(CGFloat alpha);
    /// Nil: none.
    [[nodiscard]] const std::shared_ptr<UIColor>& backgroundColor() const noexcept {
        return _backgroundColor;
    }
    void setBackgroundColor(std::shared_ptr<UIColor> color);
    /// Its own, or that of the nearest view above it that has one; at last the label colour.
    [[nodiscard]] std::shared_ptr<UIColor> tintColor() const;
    void setTintColor(std::shared_ptr<UIColor> color);
    [[nodiscard]] CGFloat cornerRadius() const noexcept { return _cornerRadius; }
    void setCornerRadius(CGFloat radius);
    [[nodiscard]] bool clipsToBounds() const noexcept { return _clipsToBounds; }
    void setClipsToBounds(bool clips);

    // Traits
    /// Those of the nearest view above (or itself) that was given some, else the system's.
    [[nodiscard]] UITraitCollection traitCollection() const;
    /// For roots: nil follows the system. Tells the whole tree when anything changed.
    void setTraitCollection(const std::optional<UITraitCollection>& traits);
    /// The system's traits have changed from `previous`: tells the whole tree.
    void _traitsDidChange(const UITraitCollection& previous);
    /// Called from the view down to what it holds.
    virtual void traitCollectionDidChange(const UITraitCollection& previous);
    [[nodiscard]] UISemanticContentAttribute semanticContentAttribute() const noexcept {
        return _semantic;
    }
    void setSemanticContentAttribute(UISemanticContentAttribute attribute);
    /// From its semantics, else from the traits.
    [[nodiscard]] UIUserInterfaceLayoutDirection effectiveUserInterfaceLayoutDirection() const;

    // Constraints
    [[nodiscard]] NSLayoutYAxisAnchor firstBaselineAnchor() const;
    [[nodiscard]] NSLayoutYAxisAnchor lastBaselineAnchor() const;
    /// True by default: the frame is what it was set to. A view that is constrained directly says
    /// no. Of no meaning for a root.
    [[nodiscard]] bool translatesAutoresizingMaskIntoConstraints() const noexcept {
        return _translatesFrame;
    }
    void setTranslatesAutoresizingMaskIntoConstraints(bool translates);
    /// Those that it keeps: active, between it and what it holds. In order of activation.
    [[nodiscard]] const std::vector<std::shared_ptr<NSLayoutConstraint>>&
    constraints() const noexcept {
        return _constraints;
    }
    [[nodiscard]] const std::vector<std::shared_ptr<UILayoutGuide>>& layoutGuides() const noexcept {
        return _guides;
    }
    void addLayoutGuide(const std::shared_ptr<UILayoutGuide>& guide);
    /// Deactivates the constraints of the guide.
    void removeLayoutGuide(const std::shared_ptr<UILayoutGuide>& guide);
    [[nodiscard]] NSDirectionalEdgeInsets directionalLayoutMargins() const noexcept {
        return _margins;
    }
    void setDirectionalLayoutMargins(const NSDirectionalEdgeInsets& margins);
    /// The bounds less the margins. Always the same guide.
    [[nodiscard]] std::shared_ptr<UILayoutGuide> layoutMarginsGuide();

    /// Where baselines are taken from; itself unless it shows another view in its place. A view
    /// that is hidden counts as hidden in a stack view that arranges the one showing it.
    [[nodiscard]] virtual std::shared_ptr<UIView> viewForFirstBaselineLayout();
    [[nodiscard]] virtual std::shared_ptr<UIView> viewForLastBaselineLayout();
    /// Of the view itself, at its present size. Without text: its bottom edge, for both.
    [[nodiscard]] virtual std::optional<CGFloat> _firstBaselineFromTop() const {
        return std::nullopt;
    }
    [[nodiscard]] virtual CGFloat _lastBaselineFromBottom() const { return 0; }

    // Sizes
    /// The size that its content wants; a side may be `UIViewNoIntrinsicMetric`.
    [[nodiscard]] virtual CGSize intrinsicContentSize() const;
    void invalidateIntrinsicContentSize();
    /// The same where the height depends on the width (text that wraps), else nil.
    [[nodiscard]] virtual std::optional<CGFloat> _intrinsicHeightForWidth(CGFloat) const {
        return std::nullopt;
    }
    /// The greatest height of whole lines within `height`, at least one line; nil where content has
    /// no lines. A content that was compressed is laid out once more at this height.
    [[nodiscard]] virtual std::optional<CGFloat> _wholeLinesWithin(CGFloat /*width*/,
                                                                   CGFloat /*height*/) const {
        return std::nullopt;
    }
    [[nodiscard]] UILayoutPriority contentHuggingPriorityForAxis(UILayoutConstraintAxis axis) const;
    /// Default 250.
    void setContentHuggingPriority_forAxis(UILayoutPriority priority, UILayoutConstraintAxis axis);
    [[nodiscard]] UILayoutPriority
    contentCompressionResistancePriorityForAxis(UILayoutConstraintAxis axis) const;
    /// Default 750.
    void setContentCompressionResistancePriority_forAxis(UILayoutPriority priority,
                                                         UILayoutConstraintAxis axis);
    /// The size that the constraints inside come to when the view should be `target` as far as the
    /// two priorities go. Frames stay as they are.
    [[nodiscard]] virtual CGSize
    systemLayoutSizeFittingSize_withHorizontalFittingPriority_verticalFittingPriority(
        CGSize target, UILayoutPriority horizontal, UILayoutPriority vertical);
    /// Both priorities at `UILayoutPriorityFittingSizeLevel`.
    [[nodiscard]] CGSize systemLayoutSizeFittingSize(CGSize target);

    // The layout pass
    void setNeedsLayout();
    /// Solves what has changed and lays out this view and what it holds, until nothing needs it.
    void layoutIfNeeded();
    /// Puts the subviews that constraints place where they belong. An override calls its base
    /// first.
    virtual void layoutSubviews();
    [[nodiscard]] bool needsLayout() const noexcept { return _needsLayout; }
    /// Has the next layout pass of a view above visit this one, as for a subview that needs layout:
    /// what its engine has to solve is solved, and what that moves is laid out.
    void _setSubtreeNeedsLayout();
    /// Whether it is laid out by itself (a row): constraints do not reach over its edge. A view
    /// without a superview is one as well.
    [[nodiscard]] virtual bool _isLayoutRoot() const { return false; }
    /// How strongly the frame of a layout root binds its constraints. Rows, whose own height wins
    /// until their table has asked for it, say less.
    [[nodiscard]] virtual UILayoutPriority _rootHeightPriority() const {
        return UILayoutPriorityRequired;
    }
    /// Whether it always fills its superview: constraints on it are constraints on that.
    [[nodiscard]] bool _fillsSuperview() const noexcept { return _fills; }
    void _setFillsSuperview(bool fills);
    /// Constraints that come with the view itself (a stack view's); they need no activation.
    [[nodiscard]] virtual std::vector<std::shared_ptr<NSLayoutConstraint>> _ownConstraints();
    /// The engine of the nearest layout root, made when first asked for.
    [[nodiscard]] _LayoutEngine& _layoutEngine();
    /// Where the engine puts a subview or guide of this view, in its coordinates, on whole device
    /// pixels; nil for what no constraint concerns.
    [[nodiscard]] std::optional<CGRect> _placeOf(const UILayoutItem& item,
                                                 const _LayoutEngine& engine) const;
    /// Told after each solve: its size before it was rounded to device pixels.
    virtual void _didSolveSize(CGSize) {}
    void _holdConstraint(const std::shared_ptr<NSLayoutConstraint>& constraint);
    void _releaseConstraint(NSLayoutConstraint& constraint);

    // Drawing
    void setNeedsDisplay();
    /// Whether this view or one that it holds has to be drawn again.
    [[nodiscard]] bool _needsDisplay() const noexcept { return _displayDirty; }
    void _didDisplay();
    /// Draws its own content in its own coordinates, under its subviews.
    virtual void drawRect(Canvas&) {}
    /// The colour that content inside is shown in, in place of its own: that of the nearest
    /// vibrancy effect above; nil outside any.
    [[nodiscard]] virtual std::shared_ptr<UIColor> _vibrantColor() const;

    /// What it shows by itself, as the dump of a view tree says it: texts in quotes, shields in
    /// brackets, images by their names. Empty for nothing.
    [[nodiscard]] virtual std::string _dumpedContent() const { return {}; }

    // Accessibility
    [[nodiscard]] bool isAccessibilityElement() const noexcept { return _accessible; }
    void setIsAccessibilityElement(bool element) noexcept { _accessible = element; }
    /// What is spoken; nil where the view has nothing to say.
    [[nodiscard]] virtual std::optional<std::string> accessibilityLabel() const {
        return _accessibilityLabel;
    }
    void setAccessibilityLabel(std::optional<std::string> label) {
        _accessibilityLabel = std::move(label);
    }

    [[nodiscard]] UIView* _layoutView() const override { return _asView(); }
    [[nodiscard]] const CGRect& _placedFrame() const override { return _frame; }
    [[nodiscard]] UIView* _asView() const override { return const_cast<UIView*>(this); }
    [[nodiscard]] std::string className() const override { return "UIView"; }

protected:
    bool _initWithFrame(CGRect frame);
    /// Its own constraints are not what they were.
    void _setArrangementChanged() { structureChanged(); }

private:
    [[nodiscard]] bool isLayoutRoot() const { return _superview.expired() || _isLayoutRoot(); }
    [[nodiscard]] UIView& layoutRoot();
    void structureChanged();
    void deactivateConstraintsReaching(const UIView& subtree);
    void place(const CGRect& frame);
    void layOutTree();
    void placeGuides();
    void tellTraits(const UITraitCollection& previous);

    std::weak_ptr<UIView> _superview;
    std::vector<std::shared_ptr<UIView>> _subviews;
    CGRect _frame;
    CGPoint _boundsOrigin;
    bool _hidden = false;
    CGFloat _alpha = 1;
    std::shared_ptr<UIColor> _backgroundColor;
    std::shared_ptr<UIColor> _tintColor;
    CGFloat _cornerRadius = 0;
    bool _clipsToBounds = false;
    std::optional<UITraitCollection> _traits;
    UISemanticContentAttribute _semantic = UISemanticContentAttribute::Unspecified;
    bool _translatesFrame = true;
    bool _fills = false;
    std::vector<std::shared_ptr<NSLayoutConstraint>> _constraints;
    std::vector<std::shared_ptr<UILayoutGuide>> _guides;
    std::shared_ptr<UILayoutGuide> _marginsGuide;
    std::vector<std::shared_ptr<NSLayoutConstraint>> _marginConstraints;
    NSDirectionalEdgeInsets _margins;
    std::array<UILayoutPriority, 2> _hugging{UILayoutPriorityDefaultLow,
                                             UILayoutPriorityDefaultLow};
    std::array<UILayoutPriority, 2> _compression{UILayoutPriorityDefaultHigh,
                                                 UILayoutPriorityDefaultHigh};
    bool _needsLayout = true;
    bool _subtreeNeedsLayout = true;
    bool _displayDirty = true;
    bool _accessible = false;
    std::optional<std::string> _accessibilityLabel;
    std::unique_ptr<_LayoutEngine> _engine;
};

} // namespace orvo
