#include "platform/uikit/solver/TieBreaker.h"

#include <algorithm>
#include <cmath>

namespace orvo {

namespace {

using Side = SimplexBasis::Side;

/// How far a symbol of the basis may move, at this rate, before it stands at its target; nothing if
/// it moves away from it. Between its target and its side lies nothing that could stop it.
std::optional<double> room(const SimplexBasis::State& state, double rate) {
    if (rate > 0 ? state.side == Side::Above : state.side == Side::Below)
        return std::nullopt;
    return std::max(0.0, (state.target - state.value) / rate);
}

} // namespace

TieBreaker::Outcome TieBreaker::run(SimplexBasis& basis, std::span<const Symbol> variables) {
    collect(basis);
    if (_freeCount == 0)
        return Outcome::Unique;
    _stepsLeft = basis.stepBound();
    for (const Symbol variable : variables) {
        if (!settle(basis, variable))
            return Outcome::Stalled;
        if (_freeCount == 0)
            break;
    }
    return Outcome::Chosen;
}

/// Finds the symbols outside the basis that may move at no price, and in which directions.
void TieBreaker::collect(SimplexBasis& basis) {
    _freeCount = 0;
    const auto count = static_cast<Symbol>(basis.size());
    for (Symbol symbol = 0; symbol < count; ++symbol) {
        const SimplexBasis::State& state = basis[symbol];
        basis.setFree(symbol, false, false);
        if (!state.isPresent || state.isBasic)
            continue;
        const int above = basis.price(symbol, Side::Above);
        const int below = basis.price(symbol, Side::Below);
        bool up = above == 0 || !basis.isRequired(symbol);
        bool down = below == 0 || !basis.isRequired(symbol);
        if (!up && !down)
            continue;
        _prices.assign(basis.levelCapacity(), 0);
        basis.addColumnPrices(symbol, _prices);
        for (const std::uint32_t level : basis.levels()) {
            const bool isOwn = level == state.level;
            const double rising = _prices[level] + (isOwn ? above : 0);
            const double falling = _prices[level] + (isOwn ? below : 0);
            up = up && std::abs(rising) <= SimplexBasis::PriceTolerance;
            down = down && std::abs(falling) <= SimplexBasis::PriceTolerance;
        }
        basis.setFree(symbol, up, down);
        _freeCount += up || down ? 1 : 0;
    }
}

void TieBreaker::lock(SimplexBasis& basis, Symbol symbol) noexcept {
    if (basis[symbol].isFreeUp || basis[symbol].isFreeDown)
        --_freeCount;
    basis.setFree(symbol, false, false);
}

/// Brings the variable as near to zero as the free symbols allow, then locks all that would move
/// it.
bool TieBreaker::settle(SimplexBasis& basis, Symbol variable) {
    while (basis[variable].isBasic && _freeCount > 0) {
        const std::optional<Entering> next = entering(basis, variable);
        if (!next) {
            lockRow(basis, variable);
            return true;
        }
        if (_stepsLeft-- == 0)
            return false;
        move(basis, variable, *next);
    }
    lock(basis, variable);
    return true;
}

/// The first free column in order that would bring the variable nearer to zero; of a variable at
/// zero, one that would lower it, so that it can be held there.
std::optional<TieBreaker::Entering> TieBreaker::entering(const SimplexBasis& basis,
                                                         Symbol variable) const noexcept {
    const bool mustRise = basis[variable].value < -SimplexBasis::Tolerance;
    std::optional<Entering> best;
    std::uint64_t order = 0;
    const SparseTableau& tableau = basis.tableau();
    for (auto place = tableau.firstInRow(variable); place != SparseTableau::None;
         place = tableau[place].nextInRow) {
        const SparseTableau::Entry& entry = tableau[place];
        const bool rises = mustRise == (entry.coefficient > 0);
        const SimplexBasis::State& column = basis[entry.column];
        if ((rises ? column.isFreeUp : column.isFreeDown) &&
            std::abs(entry.coefficient) >= SimplexBasis::SmallestPivot &&
            (!best || column.order < order)) {
            best = Entering{place, rises};
            order = column.order;
        }
    }
    return best;
}

void TieBreaker::lockRow(SimplexBasis& basis, Symbol row) noexcept {
    const SparseTableau& tableau = basis.tableau();
    for (auto place = tableau.firstInRow(row); place != SparseTableau::None;
         place = tableau[place].nextInRow)
        lock(basis, tableau[place].column);
}

/// Moves the column until the variable is zero or a constraint of the basis reaches its target,
/// which then takes the column's place outside; the constraint may go back where it came from.
void TieBreaker::move(SimplexBasis& basis, Symbol variable, Entering entering) {
    const SparseTableau& tableau = basis.tableau();
    const Symbol column = tableau[entering.place].column;
    const double direction = entering.rises ? 1 : -1;
    SimplexBasis::Place stop = entering.place;
    double least = std::abs(basis[variable].value / tableau[stop].coefficient);
    for (auto place = tableau.firstInColumn(column); place != SparseTableau::None;
         place = tableau[place].nextInColumn) {
        const SparseTableau::Entry& entry = tableau[place];
        if (basis[entry.row].isVariable ||
            std::abs(entry.coefficient) < SimplexBasis::SmallestPivot)
            continue;
        const auto own = room(basis[entry.row], entry.coefficient * direction);
        if (!own || *own > least + SimplexBasis::PriceTolerance)
            continue;
        if (*own < least - SimplexBasis::PriceTolerance ||
            basis[entry.row].order < basis[tableau[stop].row].order) {
            stop = place;
            least = *own;
        }
    }
    const Symbol leaving = tableau[stop].row;
    const Side from = basis[leaving].side;
    lock(basis, column);
    basis.pivot(stop, entering.rises ? Side::Above : Side::Below);
    if (leaving == variable || from == Side::At)
        return;
    basis.setFree(leaving, from == Side::Above, from == Side::Below);
    ++_freeCount;
}

} // namespace orvo
