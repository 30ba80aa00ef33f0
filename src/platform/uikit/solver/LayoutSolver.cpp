#include "platform/uikit/solver/LayoutSolver.h"

#include <algorithm>
#include <cmath>
#include <utility>

namespace orvo {

namespace {

/// Sums of coefficients below this are what rounding leaves of zero.
constexpr double ZeroCoefficient = 1e-10;

/// Coarser than rounding, finer than any pixel.
double rounded(double value) noexcept {
    constexpr double Steps = 1 << 20;
    return std::nearbyint(value * Steps) / Steps + 0.0; // never −0
}

SolverRefusal refusalOfConstant(double constant) noexcept {
    if (!std::isfinite(constant))
        return SolverRefusal::NotFinite;
    return std::abs(constant) > SolverLimits::MaximumConstant ? SolverRefusal::ConstantTooLarge
                                                              : SolverRefusal::None;
}

SolverRefusal refusalOfPriority(float priority) noexcept {
    if (!std::isfinite(priority))
        return SolverRefusal::NotFinite;
    return priority < SolverLimits::MinimumPriority || priority > SolverLimits::RequiredPriority
               ? SolverRefusal::PriorityOutOfRange
               : SolverRefusal::None;
}

} // namespace

void LayoutSolver::reserve(std::size_t variables, std::size_t constraints) {
    _records.reserve(variables + constraints);
    _variables.reserve(variables);
    _waiting.reserve(constraints);
    _terms.reserve(3 * constraints);
    _basis.reserve(variables + constraints);
}

SolverVariable LayoutSolver::makeVariable() {
    const Symbol symbol = newSymbol();
    Record& record = _records[symbol];
    record.state = State::Variable;
    _variables.push_back(symbol);
    _basis.insertVariable(symbol, record.serial);
    return {symbol, record.serial};
}

SolverRefusal LayoutSolver::destroy(SolverVariable variable) {
    const Record* const record = find(variable);
    if (!record)
        return SolverRefusal::UnknownVariable;
    if (record->users != 0)
        return SolverRefusal::StillInUse;
    if (!_basis.eraseVariable(variable.index))
        _mustRebuild = _isChanged = true;
    std::erase(_variables, variable.index);
    _records[variable.index] = Record{};
    _freeSymbols.push_back(variable.index);
    return SolverRefusal::None;
}

LayoutSolver::Made LayoutSolver::makeConstraint(std::span<const LinearTerm> terms,
                                                LinearRelation relation,
                                                double constant,
                                                float priority) {
    for (const SolverRefusal refusal :
         {refusalOfConstant(constant), refusalOfPriority(priority), mergeTerms(terms)}) {
        if (refusal != SolverRefusal::None)
            return {.refusal = refusal};
    }
    const Symbol symbol = newSymbol();
    Record& record = _records[symbol];
    record.state = State::Idle;
    record.relation = relation;
    record.number = constant;
    record.priority = priority;
    storeTerms(record);
    return {{symbol, record.serial}};
}

SolverRefusal LayoutSolver::destroy(SolverConstraint constraint) {
    if (!find(constraint))
        return SolverRefusal::UnknownConstraint;
    takeOut(constraint.index);
    Record& record = _records[constraint.index];
    for (std::uint32_t at = record.firstTerm; at != SparseTableau::None;) {
        StoredTerm& term = _terms[at];
        --_records[term.variable].users;
        const std::uint32_t next = std::exchange(term.next, _firstFreeTerm);
        _firstFreeTerm = at;
        at = next;
    }
    record = Record{};
    _freeSymbols.push_back(constraint.index);
    return SolverRefusal::None;
}

SolverRefusal LayoutSolver::add(SolverConstraint constraint) {
    const Record* const record = find(constraint);
    if (!record)
        return SolverRefusal::UnknownConstraint;
    if (record->state == State::Idle) {
        _records[constraint.index].state = State::Waiting;
        _waiting.push_back(constraint.index);
        _isChanged = true;
    }
    return SolverRefusal::None;
}

SolverRefusal LayoutSolver::remove(SolverConstraint constraint) {
    if (!find(constraint))
        return SolverRefusal::UnknownConstraint;
    takeOut(constraint.index);
    return SolverRefusal::None;
}

SolverRefusal LayoutSolver::setConstant(SolverConstraint constraint, double constant) {
    const Record* const record = find(constraint);
    if (!record)
        return SolverRefusal::UnknownConstraint;
    if (const SolverRefusal refusal = refusalOfConstant(constant); refusal != SolverRefusal::None)
        return refusal;
    if (record->number == constant)
        return SolverRefusal::None;
    _records[constraint.index].number = constant;
    if (record->state == State::Held)
        _basis.setTarget(constraint.index, 0.0 - constant);
    _isChanged = _isChanged || record->state != State::Idle;
    return SolverRefusal::None;
}

SolverRefusal LayoutSolver::setPriority(SolverConstraint constraint, float priority) {
    const Record* const record = find(constraint);
    if (!record)
        return SolverRefusal::UnknownConstraint;
    if (const SolverRefusal refusal = refusalOfPriority(priority); refusal != SolverRefusal::None)
        return refusal;
    if (record->priority == priority)
        return SolverRefusal::None;
    const bool wasAdded = record->state != State::Idle;
    takeOut(constraint.index);
    _records[constraint.index].priority = priority;
    return wasAdded ? add(constraint) : SolverRefusal::None;
}

SolverOutcome LayoutSolver::solve() {
    _changed.clear();
    _conflictsChanged = false;
    if (_isChanged)
        update();
    publish();
    return {_changed, _conflicts, _conflictsChanged, _isStalled};
}

double LayoutSolver::value(SolverVariable variable) const noexcept {
    const Record* const record = find(variable);
    return record ? record->number : 0;
}

double LayoutSolver::error(SolverConstraint constraint) const noexcept {
    const Record* const record = find(constraint);
    if (!record)
        return 0;
    double sum = record->number;
    for (std::uint32_t at = record->firstTerm; at != SparseTableau::None; at = _terms[at].next)
        sum += _terms[at].coefficient * _records[_terms[at].variable].number;
    switch (record->relation) {
    case LinearRelation::LessOrEqual:
        return std::max(0.0, sum);
    case LinearRelation::GreaterOrEqual:
        return std::max(0.0, -sum);
    case LinearRelation::Equal:
        break;
    }
    return std::abs(sum);
}

bool LayoutSolver::isAdded(SolverConstraint constraint) const noexcept {
    const Record* const record = find(constraint);
    return record && record->state != State::Idle;
}

bool LayoutSolver::isDropped(SolverConstraint constraint) const noexcept {
    const Record* const record = find(constraint);
    return record && record->state == State::Dropped;
}

double LayoutSolver::constant(SolverConstraint constraint) const noexcept {
    const Record* const record = find(constraint);
    return record ? record->number : 0;
}

float LayoutSolver::priority(SolverConstraint constraint) const noexcept {
    const Record* const record = find(constraint);
    return record ? record->priority : 0;
}

const LayoutSolver::Record* LayoutSolver::find(SolverVariable variable) const noexcept {
    if (!variable || variable.index >= _records.size())
        return nullptr;
    const Record& record = _records[variable.index];
    return record.serial == variable.serial && record.state == State::Variable ? &record : nullptr;
}

const LayoutSolver::Record* LayoutSolver::find(SolverConstraint constraint) const noexcept {
    if (!constraint || constraint.index >= _records.size())
        return nullptr;
    const Record& record = _records[constraint.index];
    return record.serial == constraint.serial && record.state != State::Variable ? &record
                                                                                 : nullptr;
}

LayoutSolver::Symbol LayoutSolver::newSymbol() {
    Symbol symbol = 0;
    if (_freeSymbols.empty()) {
        symbol = static_cast<Symbol>(_records.size());
        _records.emplace_back();
        if (_records.size() > _basis.size())
            _basis.reserve(std::max<std::size_t>(64, 2 * _records.size()));
    } else {
        symbol = _freeSymbols.back();
        _freeSymbols.pop_back();
    }
    _records[symbol].serial = ++_lastSerial;
    return symbol;
}

/// Brings the terms into `_merged`, each variable once.
SolverRefusal LayoutSolver::mergeTerms(std::span<const LinearTerm> terms) {
    _merged.clear();
    for (const LinearTerm& term : terms) {
        if (!find(term.variable))
            return SolverRefusal::UnknownVariable;
        if (!std::isfinite(term.coefficient))
            return SolverRefusal::NotFinite;
        const auto same = std::find_if(_merged.begin(), _merged.end(), [&](const auto& other) {
            return other.symbol == term.variable.index;
        });
        if (same == _merged.end())
            _merged.push_back({term.variable.index, term.coefficient});
        else
            same->coefficient += term.coefficient;
    }
    std::erase_if(_merged,
                  [](const auto& term) { return std::abs(term.coefficient) < ZeroCoefficient; });
    const bool fits = std::all_of(_merged.begin(), _merged.end(), [](const auto& term) {
        return std::abs(term.coefficient) >= SolverLimits::MinimumCoefficient &&
               std::abs(term.coefficient) <= SolverLimits::MaximumCoefficient;
    });
    return fits ? SolverRefusal::None : SolverRefusal::CoefficientOutOfRange;
}

void LayoutSolver::storeTerms(Record& record) {
    for (auto term = _merged.rbegin(); term != _merged.rend(); ++term) {
        std::uint32_t place = _firstFreeTerm;
        if (place == SparseTableau::None) {
            place = static_cast<std::uint32_t>(_terms.size());
            _terms.emplace_back();
        } else {
            _firstFreeTerm = _terms[place].next;
        }
        _terms[place] = {term->symbol, record.firstTerm, term->coefficient};
        record.firstTerm = place;
        ++_records[term->symbol].users;
    }
}

void LayoutSolver::takeOut(Symbol symbol) {
    Record& record = _records[symbol];
    if (record.state == State::Idle)
        return;
    if (record.state == State::Held && !_basis.eraseConstraint(symbol))
        _mustRebuild = true;
    record.state = State::Idle;
    _isChanged = true;
}

void LayoutSolver::publish() {
    for (const Symbol symbol : _basis.touched()) {
        Record& record = _records[symbol];
        const double value = rounded(_basis[symbol].value);
        if (value == record.number)
            continue;
        record.number = value;
        _changed.push_back({symbol, record.serial});
    }
    _basis.clearTouched();
    std::sort(_changed.begin(), _changed.end());
}

} // namespace orvo
