#pragma once

#include "platform/uikit/solver/LinearConstraint.h"
#include "platform/uikit/solver/SparseTableau.h"

#include <cstdint>
#include <span>
#include <utility>
#include <vector>

namespace orvo {

/// The linear system as the solver's algorithms see it: symbols, what each wants to be, and a
/// basis.
///
/// A symbol is a variable or the sum of a constraint's terms. Each has a target: 0 for a variable,
/// the constraint's constant with the other sign for a sum. What a sum is off its target, to a side
/// that its relation forbids, is its error. Symbols outside the basis stand exactly at their
/// targets; those in the basis follow from them, row by row of the tableau. So the basis decides
/// all values.
///
/// A symbol in the basis has a *side*: the one whose price per point of error it is held to pay. As
/// long as each stands on its side, and moving a symbol that is outside pays in no direction, the
/// values are the best there are.
class SimplexBasis {
public:
    using Symbol = SparseTableau::Symbol;
    using Place = SparseTableau::Place;
    static constexpr std::uint32_t NoLevel = 0xffffffff;

    /// Errors below this are rounding: a ten-millionth of a point.
    static constexpr double Tolerance = 1e-7;
    /// Prices (errors per point moved) that differ by less are equal.
    static constexpr double PriceTolerance = 1e-9;
    /// A coefficient below this is not divided by.
    static constexpr double SmallestPivot = 1e-7;

    enum class Side : std::uint8_t { At, Below, Above };

    struct State {
        double value = 0;
        double target = 0;
        /// A total order of all symbols, for choices that would otherwise be arbitrary: variables,
        /// the last made first, then constraints, strong ones first, the first made first.
        std::uint64_t order = 0;
        std::uint32_t level = NoLevel; ///< of priority; none for required ones and variables
        LinearRelation relation = LinearRelation::Equal;
        Side side = Side::At;
        bool isPresent = false;
        bool isVariable = false;
        bool isBasic = false;
        bool isQueued = false;  ///< stands in `suspects`
        bool isTouched = false; ///< stands in `touched`
        bool isFreeUp = false;  ///< may rise at no price; kept by the tie breaker
        bool isFreeDown = false;
    };

    struct Term {
        Symbol symbol = 0;
        double coefficient = 0;
    };

    /// Makes room for symbols below `count`.
    void reserve(std::size_t count);
    /// Takes all symbols out.
    void clear() noexcept;

    void insertVariable(Symbol symbol, std::uint32_t serial);
    /// No constraint that names the variable may be present.
    /// @return false if the tableau still ties it to something: rounding has spoilt it
    [[nodiscard]] bool eraseVariable(Symbol symbol) noexcept;
    /// Its terms are of variables that are present, each once.
    void insertConstraint(Symbol symbol,
                          std::span<const Term> terms,
                          LinearRelation relation,
                          double target,
                          float priority,
                          std::uint32_t serial);
    /// Afterwards somebody may pay for what no longer stands in the way: see `needsForgetting`.
    /// @return false, with nothing changed, if rounding has spoilt the tableau
    [[nodiscard]] bool eraseConstraint(Symbol symbol);
    void setTarget(Symbol symbol, double target);

    /// Lets nobody pay anything, so that every error is open again: always a sound beginning.
    void forgetSides();
    [[nodiscard]] bool needsForgetting() const noexcept { return _needsForgetting; }

    /// Moves the entry's row to its target, where it leaves the basis; its column takes its place,
    /// on the given side.
    void pivot(Place place, Side side);
    void setSide(Symbol symbol, Side side);
    /// Computes all values anew from the targets, without what rounding has added up.
    void refreshValues();

    [[nodiscard]] const State& operator[](Symbol symbol) const noexcept { return _states[symbol]; }
    [[nodiscard]] std::size_t size() const noexcept { return _states.size(); }
    [[nodiscard]] const SparseTableau& tableau() const noexcept { return _tableau; }
    void setFree(Symbol symbol, bool up, bool down) noexcept;

    [[nodiscard]] bool isRequired(Symbol symbol) const noexcept {
        return !_states[symbol].isVariable && _states[symbol].level == NoLevel;
    }
    /// Whether it is in the basis and off its side.
    [[nodiscard]] bool isWrong(Symbol symbol) const noexcept;
    /// Of a symbol that stands there, the price per point of rising: −1, 0 or 1.
    [[nodiscard]] int price(Symbol symbol, Side side) const noexcept;
    [[nodiscard]] static Side sideOf(double value, double target) noexcept;

    /// The levels in use, strongest priority first.
    [[nodiscard]] std::span<const std::uint32_t> levels() const noexcept { return _levelOrder; }
    [[nodiscard]] std::size_t levelCapacity() const noexcept { return _levels.size(); }
    /// Adds up, for each level, what rising by one point costs in errors of the rows that depend on
    /// it; `prices` is as long as `levelCapacity`, and zero before.
    void addColumnPrices(Symbol column, std::span<double> prices) const noexcept;

    /// Symbols that may have become wrong; whoever takes one out says so.
    [[nodiscard]] std::vector<Symbol>& suspects() noexcept { return _suspects; }
    void clearQueued(Symbol symbol) noexcept { _states[symbol].isQueued = false; }
    /// Variables whose values may have changed since this was last asked.
    [[nodiscard]] std::vector<Symbol>& touched() noexcept { return _touched; }
    void clearTouched() noexcept;
    /// Whether a variable in the basis has gone from one side of zero to another since asked.
    [[nodiscard]] bool takeSignChange() noexcept { return std::exchange(_hasSignChange, false); }
    void rememberSigns() noexcept;

    [[nodiscard]] std::uint64_t pivotCount() const noexcept { return _pivotCount; }
    /// More steps than any layout takes; an algorithm that goes beyond is led astray by rounding.
    [[nodiscard]] std::size_t stepBound() const noexcept { return 200 + 20 * _states.size(); }

private:
    struct Level {
        float priority = 0;
        std::uint32_t users = 0;
    };

    std::uint32_t useLevel(float priority);
    void releaseLevel(std::uint32_t level);
    void move(Symbol symbol, double change);
    void moveRowsOf(Symbol column, double change);
    void suspect(Symbol symbol);
    Place removalPivot(Symbol column) const noexcept;

    SparseTableau _tableau;
    std::vector<State> _states;
    std::vector<Level> _levels;
    std::vector<std::uint32_t> _levelOrder; // of indices in _levels
    std::vector<Symbol> _suspects;
    std::vector<Symbol> _touched;
    std::uint64_t _pivotCount = 0;
    std::size_t _payers = 0; // symbols of the basis whose side has a price
    bool _needsForgetting = false;
    bool _hasSignChange = false;
};

} // namespace orvo
