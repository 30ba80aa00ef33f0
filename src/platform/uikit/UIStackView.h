#pragma once

#include "platform/uikit/UIView.h"

namespace orvo {

/// How arranged views share the length of the stack.
enum class UIStackViewDistribution {
    Fill,        ///< by their hugging and compression
    FillEqually, ///< the same length each
};

/// How arranged views lie across the stack.
enum class UIStackViewAlignment {
    Fill,
    Leading,       ///< or top
    FirstBaseline, ///< horizontal stacks only
    Center,
    Trailing,     ///< or bottom
    LastBaseline, ///< horizontal stacks only
};

/// Lays its arranged views out in a row or column. A view that is hidden, or that shows a hidden
/// view in its place (`viewForFirstBaselineLayout`), is left out, with its spacing. Main thread.
class UIStackView : public UIView {
public:
    [[nodiscard]] static std::shared_ptr<UIStackView> init();
    [[nodiscard]] static std::shared_ptr<UIStackView> initWithFrame(CGRect frame);

    [[nodiscard]] const std::vector<std::shared_ptr<UIView>>& arrangedSubviews() const noexcept {
        return _arranged;
    }
    /// Adds it as a subview too, and places it by constraints from now on.
    void addArrangedSubview(const std::shared_ptr<UIView>& view);
    /// It stays a subview.
    void removeArrangedSubview(const std::shared_ptr<UIView>& view);

    /// Default: horizontal.
    [[nodiscard]] UILayoutConstraintAxis axis() const noexcept { return _axis; }
    void setAxis(UILayoutConstraintAxis axis);
    [[nodiscard]] UIStackViewDistribution distribution() const noexcept { return _distribution; }
    void setDistribution(UIStackViewDistribution distribution);
    [[nodiscard]] UIStackViewAlignment alignment() const noexcept { return _alignment; }
    void setAlignment(UIStackViewAlignment alignment);
    /// Points between two views. Setting it costs no rebuild.
    [[nodiscard]] CGFloat spacing() const noexcept { return _spacing; }
    virtual void setSpacing(CGFloat spacing);
    /// Whether spacing in a column is from one view's last baseline to the next one's first.
    [[nodiscard]] bool isBaselineRelativeArrangement() const noexcept { return _baselineRelative; }
    void setBaselineRelativeArrangement(bool relative);

    /// Those of the first and last view that are not left out; itself without any.
    [[nodiscard]] std::shared_ptr<UIView> viewForFirstBaselineLayout() override;
    [[nodiscard]] std::shared_ptr<UIView> viewForLastBaselineLayout() override;
    void willRemoveSubview(const std::shared_ptr<UIView>& view) override;
    [[nodiscard]] std::vector<std::shared_ptr<NSLayoutConstraint>> _ownConstraints() override;
    [[nodiscard]] std::string className() const override { return "UIStackView"; }

private:
    [[nodiscard]] std::vector<std::shared_ptr<UIView>> shownViews() const;
    void rearrange();
    void arrange();
    void alignAcross(const std::shared_ptr<UIView>& view);
    void foldUp(const std::shared_ptr<UIView>& view);
    std::shared_ptr<NSLayoutConstraint> add(const std::shared_ptr<UIView>& view,
                                            NSLayoutAttribute attribute,
                                            NSLayoutRelation relation,
                                            const std::shared_ptr<UIView>& other,
                                            NSLayoutAttribute otherAttribute);

    std::vector<std::shared_ptr<UIView>> _arranged;
    UILayoutConstraintAxis _axis = UILayoutConstraintAxis::Horizontal;
    UIStackViewDistribution _distribution = UIStackViewDistribution::Fill;
    UIStackViewAlignment _alignment = UIStackViewAlignment::Fill;
    CGFloat _spacing = 0;
    bool _baselineRelative = false;
    // As of the latest arrangement.
    std::vector<std::shared_ptr<UIView>> _shown;
    std::vector<std::shared_ptr<NSLayoutConstraint>> _own;
    std::vector<std::shared_ptr<NSLayoutConstraint>> _gaps;
    bool _isStale = true;
};

} // namespace orvo
