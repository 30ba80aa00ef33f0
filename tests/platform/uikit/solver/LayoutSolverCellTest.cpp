// The layout of a table row, in numbers that can be checked with a pencil.

#include "platform/uikit/solver/CellSystem.h"

#include <gtest/gtest.h>

#include <array>

namespace {

using namespace orvo;
using orvo::test::CellSystem;
using enum CellSystem::Item;
using enum CellSystem::Edge;

using Frame = std::array<double, 4>;

class LayoutSolverCell : public testing::Test {
protected:
    LayoutSolverCell() { solver.solve(); }

    [[nodiscard]] Frame frame(CellSystem::Item item) const {
        return {cell.value(item, Left),
                cell.value(item, Top),
                cell.value(item, Width),
                cell.value(item, Height)};
    }
    void set(SolverConstraint constraint, double length) {
        ASSERT_EQ(solver.setConstant(constraint, -length), SolverRefusal::None);
        solver.solve();
    }

    LayoutSolver solver;
    CellSystem cell{solver};
};

// Capitals begin 4 below the first line's top and the last line ends 4 above its bottom: what is
// centred in 110 is 61 − 4 − 4 = 53 high.
TEST_F(LayoutSolverCell, CentresTheTextBetweenCapitalsAndLastBaseline) {
    EXPECT_EQ(cell.constraints().size(), 37U);
    EXPECT_EQ(frame(Row), (Frame{0, 0, 359, 110}));
    EXPECT_EQ(frame(Content), (Frame{0, 28.5, 359, 53}));
    EXPECT_EQ(frame(Stack), (Frame{0, 24.5, 319, 61}));
    EXPECT_EQ(frame(Primary), (Frame{0, 24.5, 319, 20}));
    EXPECT_EQ(frame(Secondary), (Frame{0, 45.5, 319, 40}));
}

TEST_F(LayoutSolverCell, CentresTheImageInTheGutter) {
    EXPECT_EQ(frame(Gutter), (Frame{319, 28.5, 40, 53}));
    EXPECT_EQ(frame(Image), (Frame{321, 42, 38, 26}));
    EXPECT_EQ(frame(OtherImage), frame(Image));
}

TEST_F(LayoutSolverCell, WiderGutterTakesItsWidthFromTheText) {
    set(cell.gutterWidth, 60);
    EXPECT_EQ(frame(Gutter), (Frame{299, 28.5, 60, 53}));
    EXPECT_EQ(frame(Primary), (Frame{0, 24.5, 299, 20}));
}

TEST_F(LayoutSolverCell, TextRunsToTheEdgeWhenItIsTiedToTheContent) {
    ASSERT_EQ(solver.remove(cell.trailingAtGutter), SolverRefusal::None);
    ASSERT_EQ(solver.add(cell.trailingAtContent), SolverRefusal::None);
    solver.solve();
    EXPECT_EQ(frame(Primary), (Frame{0, 24.5, 359, 20}));
    EXPECT_EQ(frame(Gutter), (Frame{319, 28.5, 40, 53}));
}

// In 50 there is room for 50 − 1 − 20 + 4 + … of the second line only: it gives way, not the first.
TEST_F(LayoutSolverCell, SecondLineGivesWayBeforeTheFirst) {
    set(cell.rowHeight, 50);
    EXPECT_EQ(frame(Content), (Frame{0, 4, 359, 42}));
    EXPECT_EQ(frame(Primary), (Frame{0, 0, 319, 20}));
    EXPECT_EQ(frame(Secondary), (Frame{0, 21, 319, 29}));
    set(cell.rowHeight, 110);
    EXPECT_EQ(frame(Secondary), (Frame{0, 45.5, 319, 40}));
}

TEST_F(LayoutSolverCell, LongerTextGrowsBothWaysFromTheMiddle) {
    ASSERT_EQ(solver.setConstant(cell.secondaryHeight, -60), SolverRefusal::None);
    solver.solve();
    EXPECT_EQ(frame(Content), (Frame{0, 18.5, 359, 73}));
    EXPECT_EQ(frame(Primary), (Frame{0, 14.5, 319, 20}));
    EXPECT_EQ(frame(Secondary), (Frame{0, 35.5, 319, 60}));
}

} // namespace
