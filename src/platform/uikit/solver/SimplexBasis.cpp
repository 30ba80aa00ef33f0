#include "platform/uikit/solver/SimplexBasis.h"

#include <algorithm>
#include <bit>
#include <cmath>

namespace orvo {

namespace {

using Side = SimplexBasis::Side;

constexpr std::uint64_t variableOrder(std::uint32_t serial) noexcept {
    return ~serial;
}

/// Bits of positive floating-point numbers are ordered as the numbers are.
std::uint64_t constraintOrder(float priority, std::uint32_t serial) noexcept {
    const auto below = std::bit_cast<std::uint32_t>(SolverLimits::RequiredPriority) -
                       std::bit_cast<std::uint32_t>(priority);
    return (std::uint64_t{below} + 1) << 32U | serial;
}

/// Where a symbol stands that nobody holds to pay for anything.
constexpr Side restingSide(LinearRelation relation) noexcept {
    switch (relation) {
    case LinearRelation::LessOrEqual:
        return Side::Below;
    case LinearRelation::GreaterOrEqual:
        return Side::Above;
    case LinearRelation::Equal:
        break;
    }
    return Side::At;
}

} // namespace

void SimplexBasis::reserve(std::size_t count) {
    if (count <= _states.size())
        return;
    _states.resize(count);
    _tableau.reserve(count);
}

void SimplexBasis::clear() noexcept {
    for (const Symbol symbol : _touched)
        _states[symbol].isTouched = false;
    std::fill(_states.begin(), _states.end(), State{});
    _tableau.clear();
    _levels.clear();
    _levelOrder.clear();
    _suspects.clear();
    _touched.clear();
    _payers = 0;
    _needsForgetting = false;
    _hasSignChange = false;
}

void SimplexBasis::insertVariable(Symbol symbol, std::uint32_t serial) {
    State& state = _states[symbol];
    state = State{.order = variableOrder(serial), .isPresent = true, .isVariable = true};
    _touched.push_back(symbol);
    state.isTouched = true;
}

bool SimplexBasis::eraseVariable(Symbol symbol) noexcept {
    State& state = _states[symbol];
    if (state.isBasic || _tableau.firstInColumn(symbol) != SparseTableau::None)
        return false;
    if (state.isTouched)
        std::erase(_touched, symbol);
    state = State{};
    return true;
}

void SimplexBasis::insertConstraint(Symbol symbol,
                                    std::span<const Term> terms,
                                    LinearRelation relation,
                                    double target,
                                    float priority,
                                    std::uint32_t serial) {
    double value = 0;
    for (const Term& term : terms) {
        value += term.coefficient * _states[term.symbol].value;
        if (_states[term.symbol].isBasic)
            _tableau.addRowToSum(term.symbol, term.coefficient);
        else
            _tableau.addColumnToSum(term.symbol, term.coefficient);
    }
    _tableau.makeRowOfSum(symbol);
    State& state = _states[symbol];
    const bool isQueued = state.isQueued;
    state = State{.value = value,
                  .target = target,
                  .order = constraintOrder(priority, serial),
                  .relation = relation,
                  .side = restingSide(relation),
                  .isPresent = true,
                  .isBasic = true,
                  .isQueued = isQueued};
    if (priority < SolverLimits::RequiredPriority)
        state.level = useLevel(priority);
    suspect(symbol);
}

bool SimplexBasis::eraseConstraint(Symbol symbol) {
    if (!_states[symbol].isBasic) {
        const Place place = removalPivot(symbol);
        if (place == SparseTableau::None)
            return false;
        pivot(place, Side::At);
        _needsForgetting = true;
    }
    if (price(symbol, _states[symbol].side) != 0)
        _needsForgetting = true;
    setSide(symbol, Side::At);
    _tableau.eraseRow(symbol);
    State& state = _states[symbol];
    if (state.level != NoLevel)
        releaseLevel(state.level);
    const bool isQueued = state.isQueued;
    state = State{.isQueued = isQueued};
    return true;
}

void SimplexBasis::setTarget(Symbol symbol, double target) {
    State& state = _states[symbol];
    const double change = target - state.target;
    state.target = target;
    if (state.isBasic) {
        suspect(symbol);
        return;
    }
    state.value = target;
    moveRowsOf(symbol, change);
}

void SimplexBasis::forgetSides() {
    for (Symbol symbol = 0; symbol < _states.size(); ++symbol) {
        State& state = _states[symbol];
        if (!state.isBasic || state.isVariable)
            continue;
        state.side = restingSide(state.relation);
        suspect(symbol);
    }
    _payers = 0;
    _needsForgetting = false;
}

void SimplexBasis::pivot(Place place, Side side) {
    const Symbol leaving = _tableau[place].row;
    const Symbol entering = _tableau[place].column;
    const double change =
        (_states[leaving].target - _states[leaving].value) / _tableau[place].coefficient;
    moveRowsOf(entering, change);
    setSide(leaving, Side::At);
    _states[leaving].value = _states[leaving].target;
    _states[leaving].isBasic = false;
    _tableau.pivot(place);
    _states[entering].isBasic = true;
    move(entering, change);
    setSide(entering, side);
    ++_pivotCount;
}

void SimplexBasis::setSide(Symbol symbol, Side side) {
    State& state = _states[symbol];
    if (!state.isVariable) {
        if (price(symbol, state.side) != 0)
            --_payers;
        if (price(symbol, side) != 0)
            ++_payers;
    }
    state.side = side;
}

void SimplexBasis::refreshValues() {
    for (Symbol symbol = 0; symbol < _states.size(); ++symbol) {
        if (!_states[symbol].isBasic)
            continue;
        double value = 0;
        for (Place place = _tableau.firstInRow(symbol); place != SparseTableau::None;
             place = _tableau[place].nextInRow)
            value += _tableau[place].coefficient * _states[_tableau[place].column].target;
        move(symbol, value - _states[symbol].value);
    }
}

void SimplexBasis::setFree(Symbol symbol, bool up, bool down) noexcept {
    _states[symbol].isFreeUp = up;
    _states[symbol].isFreeDown = down;
}

bool SimplexBasis::isWrong(Symbol symbol) const noexcept {
    const State& state = _states[symbol];
    if (!state.isBasic || state.isVariable)
        return false;
    const double excess = state.value - state.target;
    return (state.side != Side::Above && excess > Tolerance) ||
           (state.side != Side::Below && excess < -Tolerance);
}

int SimplexBasis::price(Symbol symbol, Side side) const noexcept {
    const State& state = _states[symbol];
    if (state.isVariable)
        return 0;
    if (side == Side::Below && state.relation != LinearRelation::LessOrEqual)
        return -1;
    return side == Side::Above && state.relation != LinearRelation::GreaterOrEqual ? 1 : 0;
}

Side SimplexBasis::sideOf(double value, double target) noexcept {
    if (value > target + Tolerance)
        return Side::Above;
    return value < target - Tolerance ? Side::Below : Side::At;
}

void SimplexBasis::addColumnPrices(Symbol column, std::span<double> prices) const noexcept {
    if (_payers == 0)
        return;
    for (Place place = _tableau.firstInColumn(column); place != SparseTableau::None;
         place = _tableau[place].nextInColumn) {
        const SparseTableau::Entry& entry = _tableau[place];
        const std::uint32_t level = _states[entry.row].level;
        if (level != NoLevel)
            prices[level] += price(entry.row, _states[entry.row].side) * entry.coefficient;
    }
}

void SimplexBasis::clearTouched() noexcept {
    for (const Symbol symbol : _touched)
        _states[symbol].isTouched = false;
    _touched.clear();
}

void SimplexBasis::rememberSigns() noexcept {
    for (State& state : _states) {
        if (state.isVariable)
            state.side = sideOf(state.value, 0);
    }
    _hasSignChange = false;
}

std::uint32_t SimplexBasis::useLevel(float priority) {
    std::size_t free = _levels.size();
    for (std::size_t level = 0; level < _levels.size(); ++level) {
        if (_levels[level].users == 0) {
            free = level;
        } else if (_levels[level].priority == priority) {
            ++_levels[level].users;
            return static_cast<std::uint32_t>(level);
        }
    }
    if (free == _levels.size())
        _levels.emplace_back();
    _levels[free] = {priority, 1};
    const auto place =
        std::find_if(_levelOrder.begin(), _levelOrder.end(), [&](std::uint32_t other) {
            return _levels[other].priority < priority;
        });
    _levelOrder.insert(place, static_cast<std::uint32_t>(free));
    return static_cast<std::uint32_t>(free);
}

void SimplexBasis::releaseLevel(std::uint32_t level) {
    if (--_levels[level].users == 0)
        std::erase(_levelOrder, level);
}

void SimplexBasis::move(Symbol symbol, double change) {
    State& state = _states[symbol];
    state.value += change;
    if (!state.isVariable) {
        if (!state.isQueued && isWrong(symbol))
            suspect(symbol);
        return;
    }
    if (!state.isTouched) {
        state.isTouched = true;
        _touched.push_back(symbol);
    }
    if (state.side != sideOf(state.value, 0))
        _hasSignChange = true;
}

void SimplexBasis::moveRowsOf(Symbol column, double change) {
    for (Place place = _tableau.firstInColumn(column); place != SparseTableau::None;
         place = _tableau[place].nextInColumn)
        move(_tableau[place].row, _tableau[place].coefficient * change);
}

void SimplexBasis::suspect(Symbol symbol) {
    State& state = _states[symbol];
    if (state.isQueued)
        return;
    state.isQueued = true;
    _suspects.push_back(symbol);
}

/// Some variable depends on every column. The one whose entry is largest is taken; among equals the
/// one made last, which other constraints are least likely to have been built upon.
SimplexBasis::Place SimplexBasis::removalPivot(Symbol column) const noexcept {
    Place best = SparseTableau::None;
    double largest = SmallestPivot;
    for (Place place = _tableau.firstInColumn(column); place != SparseTableau::None;
         place = _tableau[place].nextInColumn) {
        const SparseTableau::Entry& entry = _tableau[place];
        const double size = std::abs(entry.coefficient);
        if (!_states[entry.row].isVariable || size < largest)
            continue;
        if (best == SparseTableau::None || size > largest ||
            _states[entry.row].order < _states[_tableau[best].row].order) {
            best = place;
            largest = size;
        }
    }
    return best;
}

} // namespace orvo
