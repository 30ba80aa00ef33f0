#pragma once

#include "platform/uikit/_ConstraintShape.h"
#include "platform/uikit/_ContentConstraints.h"
#include "platform/uikit/_FrameConstraints.h"

#include <array>
#include <map>
#include <optional>
#include <string>
#include <vector>

namespace orvo {

/// The layout of one root: keeps the constraints of its tree in a solver and knows where they put
/// every view and guide. What changes between two solves is collected; then what no longer holds is
/// taken out before anything new goes in. A text that wraps is solved a second time, at the height
/// for the width that came out, and one that got less height than it needs once more each time that
/// it loses whole lines. Main thread.
class _LayoutEngine {
public:
    /// `root` must outlive it. Does not descend into layout roots inside.
    explicit _LayoutEngine(UIView& root);
    _LayoutEngine(const _LayoutEngine&) = delete;
    _LayoutEngine& operator=(const _LayoutEngine&) = delete;
    ~_LayoutEngine();

    /// Views, guides, constraints, priorities or directions are not what they were. The next layout
    /// pass from above comes to the root.
    void structureChanged();
    /// Likewise.
    void constantChanged(const NSLayoutConstraint& constraint);
    /// What the content of a view asks for, or where its baselines lie, is not what it was.
    void contentChanged(const UIView& view);
    /// The frame of the root, or of a view whose frame is given.
    void frameChanged(const UIView& view);

    /// Brings everything up to date and asks for the layout of each view whose subviews move. Costs
    /// nothing when nothing changed.
    void solve();
    /// The size of the root when it should be `target` as far as the priorities go. Nothing moves.
    [[nodiscard]] CGSize
    fittingSize(CGSize target, UILayoutPriority horizontal, UILayoutPriority vertical);

    /// In the root's coordinates, before rounding, as of the last solve; nil for what no constraint
    /// concerns.
    [[nodiscard]] std::optional<CGRect> solvedFrame(const UILayoutItem& item) const;
    /// The same on whole device pixels. Edges are rounded, not sizes: what touched still does.
    [[nodiscard]] std::optional<CGRect> pixelFrame(const UILayoutItem& item) const;

    /// In order: those of each view from the root down, then those that come with it.
    [[nodiscard]] std::vector<std::shared_ptr<NSLayoutConstraint>> constraints() const;
    [[nodiscard]] const LayoutSolver& solver() const noexcept { return _solver; }

private:
    /// A view or guide of the layout.
    struct Item {
        std::weak_ptr<UILayoutItem> object;
        _LayoutVariables variables;
        _FrameConstraints frame; ///< of a view whose frame is given
        _ContentConstraints content;
        bool isUsed = false;
    };

    /// A constraint of a view, as it is in the solver.
    struct Installed {
        std::weak_ptr<NSLayoutConstraint> object;
        SolverConstraint handle;
        _ConstraintShape shape;
        double offset = 0; ///< what baselines add to its constant
        bool hasBaseline = false;
        bool isUsed = false;
    };

    void update();
    void synchronise();
    void collect(UIView& view, std::vector<std::shared_ptr<NSLayoutConstraint>>& into) const;
    [[nodiscard]] bool isRoot(const UILayoutItem& object) const;

    Item& itemFor(UILayoutItem& object);
    void removeUnusedItems();
    void install(const std::shared_ptr<NSLayoutConstraint>& constraint,
                 const _ConstraintShape& shape);
    [[nodiscard]] SolverConstraint make(const NSLayoutConstraint& constraint,
                                        const Installed& installed);
    void setFrame(Item& item, const UIView& view);
    void updateRoot();
    void updateContent();

    void solveWithTexts();
    [[nodiscard]] bool fitHeights();
    [[nodiscard]] bool dropLines();
    void runSolver();
    void log(const SolverConflict& conflict) const;
    [[nodiscard]] std::string nameOf(SolverConstraint constraint) const;
    void askForLayout();

    UIView& _root;
    LayoutSolver _solver;
    std::map<std::uint64_t, Item> _items;          // by creation number
    std::map<std::uint64_t, Installed> _installed; // by creation number
    std::array<SolverConstraint, 2> _rootSize;     // width and height
    bool _structureDirty = true;
    bool _contentDirty = true;
    bool _dirty = true;
};

} // namespace orvo
