#pragma once

#include "platform/uikit/solver/DualSimplex.h"
#include "platform/uikit/solver/LinearConstraint.h"
#include "platform/uikit/solver/SimplexBasis.h"
#include "platform/uikit/solver/TieBreaker.h"

#include <cstdint>
#include <span>
#include <string>
#include <vector>

namespace orvo {

/// Required constraints that cannot all hold.
struct SolverConflict {
    /// The member made last: the solver does without it until the others leave room for it.
    SolverConstraint dropped;
    /// All that contradict one another, in the order in which they were made. Without any one of
    /// them the others could hold.
    std::vector<SolverConstraint> members;

    [[nodiscard]] friend bool operator==(const SolverConflict&, const SolverConflict&) = default;
};

/// What a solve came to; the spans are valid until the next one.
struct SolverOutcome {
    /// Variables whose values are not those of the solve before, in the order they were made.
    std::span<const SolverVariable> changed;
    /// All conflicts there are now, in the order in which their last members were made.
    std::span<const SolverConflict> conflicts;
    bool conflictsChanged = false; ///< since the solve before
    /// Rounding kept the solver from an end; the values are some that it came by. Seen only with
    /// coefficients of wildly different sizes.
    bool isStalled = false;
};

/// An incremental solver of linear constraints with priorities.
///
/// Constraints say that a sum of variables and a constant is zero, at least zero or at most zero.
/// Those of priority 1000 hold. Of the others the errors (how far the sum is off) are as small as
/// can be, added up among equals, and lexicographically between priorities: no number of weaker
/// constraints outweighs a stronger one. Where this leaves a choice, variables are as near to zero
/// as can be, the first made first. So there is always exactly one solution: it depends on what is
/// there and on the order in which that was *made*, but neither on the order of adding and removing
/// nor on anything that was there before.
///
/// Changes are collected and take effect at `solve`, which begins where the last one ended;
/// changing a constant touches no more than depends on it. Values are rounded to 2⁻²⁰, so that
/// different ways to one solution end at equal numbers.
///
/// Required constraints that contradict others are reported, and the last one made is left out
/// until there is room for it. For use by one thread at a time. Nothing throws but for want of
/// memory.
class LayoutSolver {
public:
    LayoutSolver() = default;
    LayoutSolver(const LayoutSolver&) = delete;
    LayoutSolver& operator=(const LayoutSolver&) = delete;
    LayoutSolver(LayoutSolver&&) = default;
    LayoutSolver& operator=(LayoutSolver&&) = default;
    ~LayoutSolver() = default;

    struct Made {
        SolverConstraint constraint; ///< names nothing when refused
        SolverRefusal refusal = SolverRefusal::None;
    };

    /// Takes room for so many in one go.
    void reserve(std::size_t variables, std::size_t constraints);

    /// Its value is 0 before the next solve.
    [[nodiscard]] SolverVariable makeVariable();
    /// Refused while a constraint names it, added or not.
    [[nodiscard]] SolverRefusal destroy(SolverVariable variable);

    /// Makes `Σ coefficient × variable + constant  relation  0` without adding it. A variable may
    /// stand in several terms; without terms the constant alone has to satisfy the relation.
    [[nodiscard]] Made makeConstraint(std::span<const LinearTerm> terms,
                                      LinearRelation relation,
                                      double constant,
                                      float priority = SolverLimits::RequiredPriority);
    /// Removes it first.
    [[nodiscard]] SolverRefusal destroy(SolverConstraint constraint);

    /// Adding what is added and removing what is not are nothing, not errors.
    [[nodiscard]] SolverRefusal add(SolverConstraint constraint);
    [[nodiscard]] SolverRefusal remove(SolverConstraint constraint);
    [[nodiscard]] SolverRefusal setConstant(SolverConstraint constraint, double constant);
    [[nodiscard]] SolverRefusal setPriority(SolverConstraint constraint, float priority);

    /// Nothing changed, nothing to do.
    SolverOutcome solve();

    /// As of the last solve; 0 for what is no variable of this solver.
    [[nodiscard]] double value(SolverVariable variable) const noexcept;
    /// How far the constraint is off with these values, 0 or more, whether or not it is added.
    [[nodiscard]] double error(SolverConstraint constraint) const noexcept;
    [[nodiscard]] bool isAdded(SolverConstraint constraint) const noexcept;
    /// Added, but in a conflict at the last solve and left out.
    [[nodiscard]] bool isDropped(SolverConstraint constraint) const noexcept;
    /// 0 for what is no constraint of this solver.
    [[nodiscard]] double constant(SolverConstraint constraint) const noexcept;
    [[nodiscard]] float priority(SolverConstraint constraint) const noexcept;

    /// Such as `c7: v1 - 2 v3 + 8 >= 0 @750, off by 3`; numbers count what was made, and what is
    /// left out or not added says so. Empty for what is no constraint of this solver.
    [[nodiscard]] std::string describe(SolverConstraint constraint) const;
    /// All constraints, one a line, and the values of all variables, in the order they were made.
    [[nodiscard]] std::string describe() const;

    /// Changes of basis so far, for counters in tests and benchmarks.
    [[nodiscard]] std::uint64_t pivotCount() const noexcept { return _basis.pivotCount(); }

private:
    using Symbol = SimplexBasis::Symbol;

    enum class State : std::uint8_t { Unused, Variable, Idle, Waiting, Held, Dropped };

    struct Record {
        std::uint32_t serial = 0;
        std::uint32_t firstTerm = SparseTableau::None;
        std::uint32_t users = 0; ///< constraints that name this variable
        float priority = 0;
        double number = 0; ///< a variable's value as told, a constraint's constant
        LinearRelation relation = LinearRelation::Equal;
        State state = State::Unused;
    };

    /// A term in the list of its constraint, or of free places.
    struct StoredTerm {
        Symbol variable = 0;
        std::uint32_t next = SparseTableau::None;
        double coefficient = 0;
    };

    [[nodiscard]] const Record* find(SolverVariable variable) const noexcept;
    [[nodiscard]] const Record* find(SolverConstraint constraint) const noexcept;
    [[nodiscard]] Symbol newSymbol();
    [[nodiscard]] SolverRefusal mergeTerms(std::span<const LinearTerm> terms);
    void storeTerms(Record& record);
    void takeOut(Symbol symbol);

    void update();
    [[nodiscard]] bool updateInPlace();
    [[nodiscard]] bool settle(bool mustBreakTies);
    [[nodiscard]] bool isAccurate();
    void insert(Symbol symbol);
    void rebuild();
    [[nodiscard]] bool tryRebuild();
    void recordConflict(Symbol row);
    void publish();

    SimplexBasis _basis;
    DualSimplex _dual;
    TieBreaker _ties;
    std::vector<Record> _records; // by symbol
    std::vector<StoredTerm> _terms;
    std::vector<Symbol> _variables; // in the order they were made
    std::vector<Symbol> _freeSymbols;
    std::vector<Symbol> _waiting; // and some that no longer do
    std::vector<SimplexBasis::Term> _merged;
    std::vector<SolverVariable> _changed;
    std::vector<SolverConflict> _conflicts;
    std::uint64_t _checkedPivots = 0;
    std::uint32_t _solvesSinceRefresh = 0;
    std::uint32_t _lastSerial = 0;
    std::uint32_t _firstFreeTerm = SparseTableau::None;
    bool _isChanged = false;
    bool _mustRebuild = false;
    bool _isTied = false;
    bool _conflictsChanged = false;
    bool _isStalled = false;
};

} // namespace orvo
