// How the solver comes to a solution: from the last one, or from nothing.

#include "platform/uikit/solver/LayoutSolver.h"

#include <algorithm>
#include <cmath>
#include <utility>

namespace orvo {

namespace {

/// After so many solves that only changed constants, values are computed anew.
constexpr std::uint32_t SolvesBetweenRefreshes = 1024;

/// How far a sum may be off its terms, as a share of the largest and of one point.
constexpr double AcceptedDrift = SimplexBasis::Tolerance / 100;

/// A tie broken within rounding of a target may need a second look; more than a few never help.
constexpr int MaximumRounds = 4;

} // namespace

void LayoutSolver::update() {
    if (_mustRebuild || !_conflicts.empty() || !updateInPlace())
        rebuild();
    _isChanged = false;
    _mustRebuild = _isStalled;
}

/// From the last solution to the next one.
/// @return false if that needs a rebuild: a conflict has to be named, or rounding has added up
bool LayoutSolver::updateInPlace() {
    if (++_solvesSinceRefresh > SolvesBetweenRefreshes) {
        _solvesSinceRefresh = 0;
        _basis.refreshValues();
    }
    bool mustBreakTies = !_waiting.empty() || _basis.needsForgetting();
    if (_basis.needsForgetting())
        _basis.forgetSides();
    // Required ones first, one by one: each then finds its variables where they are to stay.
    for (const Symbol symbol : _waiting) {
        const Record& record = _records[symbol];
        if (record.state != State::Waiting || record.priority < SolverLimits::RequiredPriority)
            continue;
        insert(symbol);
        if (_dual.run(_basis, DualSimplex::Scope::RequiredOnly) != DualSimplex::Outcome::Solved)
            return false;
        mustBreakTies = true;
    }
    for (const Symbol symbol : _waiting) {
        if (_records[symbol].state == State::Waiting)
            insert(symbol);
    }
    _waiting.clear();
    return settle(mustBreakTies) && (_basis.pivotCount() == _checkedPivots || isAccurate());
}

/// Deals with all that stands wrong, and with ties.
bool LayoutSolver::settle(bool mustBreakTies) {
    mustBreakTies = (_basis.takeSignChange() && _isTied) || mustBreakTies;
    for (int round = 0; round < MaximumRounds; ++round) {
        if (_dual.run(_basis, DualSimplex::Scope::All) != DualSimplex::Outcome::Solved)
            return false;
        if (!_dual.didWork() && !mustBreakTies)
            return true;
        const TieBreaker::Outcome outcome = _ties.run(_basis, _variables);
        if (outcome == TieBreaker::Outcome::Stalled)
            return false;
        mustBreakTies = false;
        _isTied = outcome == TieBreaker::Outcome::Chosen;
        if (!_isTied)
            return true;
        _basis.rememberSigns();
    }
    return true;
}

/// Whether rounding has left the tableau true to the constraints as they were given.
bool LayoutSolver::isAccurate() {
    _checkedPivots = _basis.pivotCount();
    for (Symbol symbol = 0; symbol < _records.size(); ++symbol) {
        if (_records[symbol].state != State::Held)
            continue;
        double rest = -_basis[symbol].value;
        double largest = 1;
        for (auto at = _records[symbol].firstTerm; at != SparseTableau::None;
             at = _terms[at].next) {
            const double term = _terms[at].coefficient * _basis[_terms[at].variable].value;
            rest += term;
            largest = std::max(largest, std::abs(term));
        }
        if (!(std::abs(rest) <= AcceptedDrift * largest))
            return false;
    }
    return true;
}

void LayoutSolver::insert(Symbol symbol) {
    Record& record = _records[symbol];
    _merged.clear();
    for (auto at = record.firstTerm; at != SparseTableau::None; at = _terms[at].next)
        _merged.push_back({_terms[at].variable, _terms[at].coefficient});
    _basis.insertConstraint(
        symbol, _merged, record.relation, 0.0 - record.number, record.priority, record.serial);
    record.state = State::Held;
}

/// From nothing, in the order in which the constraints were made. Each conflict found leaves out
/// one constraint more; with these left out it begins again.
void LayoutSolver::rebuild() {
    const std::vector<SolverConflict> before = std::exchange(_conflicts, {});
    _waiting.clear();
    for (Symbol symbol = 0; symbol < _records.size(); ++symbol) {
        Record& record = _records[symbol];
        if (record.state == State::Idle || record.state == State::Variable ||
            record.state == State::Unused)
            continue;
        record.state = State::Waiting;
        _waiting.push_back(symbol);
    }
    std::sort(_waiting.begin(), _waiting.end(), [&](Symbol a, Symbol b) {
        return _records[a].serial < _records[b].serial;
    });
    while (!tryRebuild()) {
    }
    _waiting.clear();
    _conflictsChanged = before != _conflicts;
}

/// @return false if one more constraint had to be dropped
bool LayoutSolver::tryRebuild() {
    _basis.clear();
    _isStalled = false;
    for (const Symbol variable : _variables)
        _basis.insertVariable(variable, _records[variable].serial);
    for (const bool isRequired : {true, false}) {
        for (const Symbol symbol : _waiting) {
            const Record& record = _records[symbol];
            if (record.state == State::Dropped ||
                (record.priority == SolverLimits::RequiredPriority) != isRequired)
                continue;
            insert(symbol);
            if (isRequired && _dual.run(_basis, DualSimplex::Scope::RequiredOnly) ==
                                  DualSimplex::Outcome::Impossible) {
                recordConflict(_dual.impossibleRow());
                return false;
            }
        }
    }
    _isStalled = !settle(true) || !isAccurate();
    return true;
}

void LayoutSolver::recordConflict(Symbol row) {
    SolverConflict conflict;
    const SparseTableau& tableau = _basis.tableau();
    conflict.members.push_back({row, _records[row].serial});
    for (auto place = tableau.firstInRow(row); place != SparseTableau::None;
         place = tableau[place].nextInRow) {
        const Symbol column = tableau[place].column;
        if (_basis.isRequired(column) &&
            std::abs(tableau[place].coefficient) >= SimplexBasis::SmallestPivot)
            conflict.members.push_back({column, _records[column].serial});
    }
    std::sort(conflict.members.begin(), conflict.members.end());
    conflict.dropped = conflict.members.back();
    _records[conflict.dropped.index].state = State::Dropped;
    _conflicts.push_back(std::move(conflict));
}

} // namespace orvo
