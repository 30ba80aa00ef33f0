#include "platform/uikit/solver/DualSimplex.h"

#include <algorithm>
#include <cmath>
#include <span>

namespace orvo {

namespace {

using Side = SimplexBasis::Side;

/// Of equally cheap columns, those with coefficients this much smaller than the largest are passed
/// over: dividing by them would magnify rounding.
constexpr double WorthwhileShare = 0.1;

} // namespace

DualSimplex::Outcome DualSimplex::run(SimplexBasis& basis, Scope scope) {
    _steps = 0;
    _isCautious = false;
    const std::size_t bound = basis.stepBound();
    while (const std::optional<Symbol> row = firstWrong(basis, scope)) {
        if (++_steps > bound)
            return Outcome::Stalled;
        // Late choices are those that are proven never to come back to the same basis.
        _isCautious = _steps > bound / 2;
        if (!step(basis, *row)) {
            _impossibleRow = *row;
            return Outcome::Impossible;
        }
    }
    return Outcome::Solved;
}

/// The first in order; what turns out to stand right is no suspect any more.
std::optional<DualSimplex::Symbol> DualSimplex::firstWrong(SimplexBasis& basis, Scope scope) {
    std::vector<Symbol>& suspects = basis.suspects();
    std::size_t kept = 0;
    std::size_t first = 0;
    for (const Symbol symbol : suspects) {
        if (!basis.isWrong(symbol)) {
            basis.clearQueued(symbol);
            continue;
        }
        if (basis[symbol].order < basis[suspects[first]].order || kept == 0)
            first = kept;
        suspects[kept++] = symbol;
    }
    suspects.resize(kept);
    if (kept == 0 || (scope == Scope::RequiredOnly && !basis.isRequired(suspects[first])))
        return std::nullopt;
    return suspects[first];
}

bool DualSimplex::step(SimplexBasis& basis, Symbol row) {
    const SimplexBasis::State& state = basis[row];
    const bool mustRise = state.value < state.target;
    const Side flipped = mustRise ? Side::Below : Side::Above;
    collect(basis, row, mustRise);
    if (basis.isRequired(row)) {
        if (_candidates.empty())
            return false;
        for (const std::uint32_t level : basis.levels())
            static_cast<void>(keepCheapest(level));
    } else {
        const int rise = std::abs(basis.price(row, flipped) - basis.price(row, state.side));
        if (isFlipCheapest(basis, row, rise)) {
            basis.setSide(row, flipped);
            return true;
        }
    }
    const SimplexBasis::Place place = choose(basis).place;
    const bool rises = mustRise == (basis.tableau()[place].coefficient > 0);
    basis.pivot(place, rises ? Side::Above : Side::Below);
    return true;
}

/// The columns that may move without breaking a required constraint of their own.
void DualSimplex::collect(const SimplexBasis& basis, Symbol row, bool mustRise) {
    _candidates.clear();
    _prices.clear();
    const SparseTableau& tableau = basis.tableau();
    for (auto place = tableau.firstInRow(row); place != SparseTableau::None;
         place = tableau[place].nextInRow) {
        const double coefficient = tableau[place].coefficient;
        if (std::abs(coefficient) < SimplexBasis::SmallestPivot)
            continue;
        const bool rises = mustRise == (coefficient > 0);
        const Symbol column = tableau[place].column;
        if (basis.isRequired(column) && basis.price(column, rises ? Side::Above : Side::Below) != 0)
            continue;
        addCandidate(basis, place, rises);
    }
}

void DualSimplex::addCandidate(const SimplexBasis& basis, SimplexBasis::Place place, bool rises) {
    const SparseTableau::Entry& entry = basis.tableau()[place];
    const double size = std::abs(entry.coefficient);
    const std::size_t first = _prices.size();
    _prices.resize(first + basis.levelCapacity(), 0);
    const std::span<double> prices(_prices.data() + first, basis.levelCapacity());
    basis.addColumnPrices(entry.column, prices);
    const double share = (rises ? 1 : -1) / size;
    for (double& price : prices)
        price *= share;
    if (const std::uint32_t level = basis[entry.column].level; level != SimplexBasis::NoLevel)
        prices[level] +=
            std::abs(basis.price(entry.column, rises ? Side::Above : Side::Below)) / size;
    _candidates.push_back({place, first, size});
}

/// Leaves only the cheapest candidates, and answers whether the row's own price is cheaper still.
bool DualSimplex::isFlipCheapest(const SimplexBasis& basis, Symbol row, int ownPrice) {
    bool isUndecided = true;
    for (const std::uint32_t level : basis.levels()) {
        if (_candidates.empty())
            return true;
        const double cheapest = keepCheapest(level);
        const double own = level == basis[row].level ? ownPrice : 0;
        if (!isUndecided)
            continue;
        if (cheapest > own + SimplexBasis::PriceTolerance)
            return true;
        isUndecided = cheapest >= own - SimplexBasis::PriceTolerance;
    }
    return isUndecided;
}

double DualSimplex::keepCheapest(std::uint32_t level) {
    double cheapest = _prices[_candidates.front().prices + level];
    for (const Candidate& candidate : _candidates)
        cheapest = std::min(cheapest, _prices[candidate.prices + level]);
    if (_candidates.size() > 1)
        std::erase_if(_candidates, [&](const Candidate& candidate) {
            return _prices[candidate.prices + level] > cheapest + SimplexBasis::PriceTolerance;
        });
    return cheapest;
}

const DualSimplex::Candidate& DualSimplex::choose(const SimplexBasis& basis) const noexcept {
    double largest = 0;
    for (const Candidate& candidate : _candidates)
        largest = std::max(largest, candidate.size);
    const double least = _isCautious ? 0 : largest * WorthwhileShare;
    const Candidate* best = nullptr;
    std::uint64_t order = 0;
    for (const Candidate& candidate : _candidates) {
        const std::uint64_t own = basis[basis.tableau()[candidate.place].column].order;
        if (candidate.size >= least && (!best || own < order)) {
            best = &candidate;
            order = own;
        }
    }
    return *best;
}

} // namespace orvo
