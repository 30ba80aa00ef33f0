#pragma once

#include "platform/uikit/solver/LayoutSolver.h"

#include <array>
#include <initializer_list>
#include <vector>

namespace orvo::test {

/// The system of a table row as it stands on a screen: two lines of text in a stack, centred in a
/// fixed height, beside two images in one place. 37 constraints.
class CellSystem {
public:
    enum Item { Row, Content, Gutter, Stack, Primary, Secondary, Image, OtherImage, Items };
    enum Edge { Left, Top, Width, Height };

    static constexpr double CapHeight = 12;
    static constexpr double Ascent = 16;
    static constexpr double Descent = 4;

    explicit CellSystem(LayoutSolver& solver)
        : _solver(solver) {
        for (auto& item : _variables) {
            for (SolverVariable& variable : item)
                variable = solver.makeVariable();
        }
        makeFrame();
        makeTexts();
        makeImages();
    }

    /// In the order in which they were made; each of them is added.
    [[nodiscard]] const std::vector<SolverConstraint>& constraints() const { return _constraints; }
    [[nodiscard]] SolverVariable variable(Item item, Edge edge) const {
        return _variables.at(item).at(edge);
    }
    [[nodiscard]] double value(Item item, Edge edge) const {
        return _solver.value(variable(item, edge));
    }

    SolverConstraint rowWidth;
    SolverConstraint rowHeight;
    SolverConstraint gutterWidth;
    SolverConstraint trailingAtGutter;
    /// Made, but not added: where the text ends when there is no image.
    SolverConstraint trailingAtContent;
    SolverConstraint secondaryHeight;

private:
    enum class Point { Start, End, Middle };
    using Terms = std::vector<LinearTerm>;

    /// The point of the item along an axis, `factor` times.
    void addPoint(Terms& terms, Item item, Edge axis, Point point, double factor) const {
        terms.push_back({variable(item, axis), factor});
        if (point != Point::Start)
            terms.push_back({variable(item, axis == Left ? Width : Height),
                             point == Point::End ? factor : factor / 2});
    }
    SolverConstraint make(const Terms& terms,
                          LinearRelation relation,
                          double constant,
                          float priority = SolverLimits::RequiredPriority) {
        return _solver.makeConstraint(terms, relation, constant, priority).constraint;
    }
    SolverConstraint added(SolverConstraint constraint) {
        static_cast<void>(_solver.add(constraint));
        _constraints.push_back(constraint);
        return constraint;
    }
    /// First item's point relates to that of the second plus `distance`.
    SolverConstraint relate(Item first,
                            Edge axis,
                            Point point,
                            LinearRelation relation,
                            Item second,
                            Point other,
                            double distance = 0,
                            float priority = SolverLimits::RequiredPriority) {
        Terms terms;
        addPoint(terms, first, axis, point, 1);
        addPoint(terms, second, axis, other, -1);
        return make(terms, relation, -distance, priority);
    }
    SolverConstraint
    size(Item item, Edge edge, LinearRelation relation, double length, float priority = 1000) {
        return added(make({{variable(item, edge), 1}}, relation, -length, priority));
    }

    void makeFrame() {
        using enum LinearRelation;
        rowWidth = size(Row, Width, Equal, 359);
        rowHeight = size(Row, Height, Equal, 110);
        added(relate(Content, Top, Point::Middle, Equal, Row, Point::Middle));
        added(relate(Content, Left, Point::Start, Equal, Row, Point::Start));
        added(relate(Content, Left, Point::End, Equal, Row, Point::End));
        added(relate(Content, Top, Point::Start, GreaterOrEqual, Row, Point::Start));
        added(relate(Content, Top, Point::End, LessOrEqual, Row, Point::End));
        added(relate(Gutter, Top, Point::Start, Equal, Content, Point::Start));
        added(relate(Gutter, Top, Point::End, Equal, Content, Point::End));
        added(relate(Gutter, Left, Point::End, Equal, Content, Point::End));
        gutterWidth = size(Gutter, Width, Equal, 40);
    }
    void makeTexts() {
        using enum LinearRelation;
        added(relate(Primary, Top, Point::Start, GreaterOrEqual, Row, Point::Start));
        added(relate(
            Primary, Top, Point::Start, Equal, Content, Point::Start, CapHeight - Ascent, 750));
        added(relate(Content, Top, Point::End, Equal, Secondary, Point::End, -Descent));
        added(relate(Stack, Left, Point::Start, Equal, Content, Point::Start));
        trailingAtGutter = added(relate(Stack, Left, Point::End, Equal, Gutter, Point::Start));
        trailingAtContent = relate(Stack, Left, Point::End, Equal, Content, Point::End);
        for (const Item text : {Primary, Secondary}) {
            added(relate(text, Left, Point::Start, Equal, Stack, Point::Start));
            added(relate(text, Left, Point::End, Equal, Stack, Point::End));
        }
        added(relate(Primary, Top, Point::Start, Equal, Stack, Point::Start));
        added(relate(Secondary, Top, Point::Start, Equal, Primary, Point::End, 1));
        added(relate(Secondary, Top, Point::End, Equal, Stack, Point::End));
        size(Primary, Height, GreaterOrEqual, 20, 749);
        size(Primary, Height, LessOrEqual, 20, 251);
        secondaryHeight = size(Secondary, Height, GreaterOrEqual, 40, 748);
        size(Secondary, Height, LessOrEqual, 40, 250);
    }
    void makeImages() {
        using enum LinearRelation;
        added(relate(Image, Left, Point::End, Equal, Gutter, Point::End));
        added(relate(Image, Top, Point::Middle, Equal, Content, Point::Middle));
        added(relate(Image, Top, Point::Start, GreaterOrEqual, Row, Point::Start, 8));
        added(relate(Image, Top, Point::End, LessOrEqual, Row, Point::End, -8));
        for (const Edge axis : {Left, Top}) {
            for (const Point point : {Point::Start, Point::End})
                added(relate(Image, axis, point, Equal, OtherImage, point));
        }
        size(Image, Width, Equal, 38, 750);
        size(Image, Height, Equal, 26, 750);
    }

    LayoutSolver& _solver;
    std::array<std::array<SolverVariable, 4>, Items> _variables;
    std::vector<SolverConstraint> _constraints;
};

} // namespace orvo::test
