// The layout system of a table row, built and changed; each change beside what building anew takes.

#include "../tests/platform/uikit/solver/CellSystem.h"

#include <benchmark/benchmark.h>

#include <memory>
#include <vector>

namespace {

using namespace orvo;
using orvo::test::CellSystem;

/// As many rows as a table shows, each with a solver of its own.
struct Rows {
    std::vector<std::unique_ptr<LayoutSolver>> solvers;
    std::vector<std::unique_ptr<CellSystem>> cells;

    void append() {
        solvers.push_back(std::make_unique<LayoutSolver>());
        solvers.back()->reserve(32, 38);
        cells.push_back(std::make_unique<CellSystem>(*solvers.back()));
        solvers.back()->solve();
    }
    explicit Rows(std::int64_t count) {
        for (std::int64_t row = 0; row < count; ++row)
            append();
    }
};

/// Counts the changes of basis that an iteration takes.
void countPivots(benchmark::State& state, const Rows& rows, std::uint64_t before) {
    std::uint64_t sum = 0;
    for (const auto& solver : rows.solvers)
        sum += solver->pivotCount();
    state.counters["pivots"] =
        benchmark::Counter(static_cast<double>(sum - before), benchmark::Counter::kAvgIterations);
}

std::uint64_t pivotsOf(const Rows& rows) {
    std::uint64_t sum = 0;
    for (const auto& solver : rows.solvers)
        sum += solver->pivotCount();
    return sum;
}

/// The yardstick of all others.
void build(benchmark::State& state) {
    for (auto _ : state)
        benchmark::DoNotOptimize(Rows(state.range(0)));
    state.counters["constraints"] =
        static_cast<double>(Rows(1).cells.front()->constraints().size());
    state.SetComplexityN(state.range(0));
}
BENCHMARK(build)->Arg(1)->Arg(8)->Arg(100)->Unit(benchmark::kMicrosecond);

/// The memory is there; the constraints are only added and solved.
void addAndSolve(benchmark::State& state) {
    Rows rows(1);
    LayoutSolver& solver = *rows.solvers.front();
    for (auto _ : state) {
        for (const SolverConstraint constraint : rows.cells.front()->constraints())
            static_cast<void>(solver.remove(constraint));
        for (const SolverConstraint constraint : rows.cells.front()->constraints())
            static_cast<void>(solver.add(constraint));
        benchmark::DoNotOptimize(solver.solve());
    }
}
BENCHMARK(addAndSolve)->Unit(benchmark::kMicrosecond);

/// One constant of every row changes, to and fro.
void edit(benchmark::State& state,
          SolverConstraint CellSystem::*constraint,
          double from,
          double to) {
    Rows rows(state.range(0));
    const std::uint64_t before = pivotsOf(rows);
    bool isThere = false;
    for (auto _ : state) {
        isThere = !isThere;
        for (std::size_t row = 0; row < rows.cells.size(); ++row) {
            LayoutSolver& solver = *rows.solvers[row];
            static_cast<void>(
                solver.setConstant((*rows.cells[row]).*constraint, isThere ? -to : -from));
            benchmark::DoNotOptimize(solver.solve());
        }
    }
    countPivots(state, rows, before);
    state.SetItemsProcessed(state.iterations() * state.range(0));
}
BENCHMARK_CAPTURE(edit, gutterWidth, &CellSystem::gutterWidth, 40, 60)->Arg(1)->Arg(8)->Arg(100);
BENCHMARK_CAPTURE(edit, rowWidth, &CellSystem::rowWidth, 359, 400)->Arg(1)->Arg(8)->Arg(100);
BENCHMARK_CAPTURE(edit, rowHeight, &CellSystem::rowHeight, 110, 140)->Arg(1)->Arg(8)->Arg(100);
/// So low that the texts have to give way.
BENCHMARK_CAPTURE(edit, lowRow, &CellSystem::rowHeight, 110, 50)->Arg(1)->Arg(8)->Arg(100);

/// The text ends at the image or at the edge of the row, in turn.
void exchange(benchmark::State& state) {
    Rows rows(state.range(0));
    const std::uint64_t before = pivotsOf(rows);
    bool isThere = false;
    for (auto _ : state) {
        isThere = !isThere;
        for (std::size_t row = 0; row < rows.cells.size(); ++row) {
            LayoutSolver& solver = *rows.solvers[row];
            CellSystem& cell = *rows.cells[row];
            static_cast<void>(
                solver.remove(isThere ? cell.trailingAtGutter : cell.trailingAtContent));
            static_cast<void>(solver.add(isThere ? cell.trailingAtContent : cell.trailingAtGutter));
            benchmark::DoNotOptimize(solver.solve());
        }
    }
    countPivots(state, rows, before);
    state.SetItemsProcessed(state.iterations() * state.range(0));
}
BENCHMARK(exchange)->Arg(1)->Arg(8)->Arg(100);

/// Nothing is to be done.
void solveUnchanged(benchmark::State& state) {
    Rows rows(1);
    for (auto _ : state)
        benchmark::DoNotOptimize(rows.solvers.front()->solve());
}
BENCHMARK(solveUnchanged);

} // namespace
