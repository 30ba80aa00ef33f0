#pragma once

#include "platform/uikit/solver/SimplexBasis.h"

#include <cstddef>
#include <cstdint>
#include <optional>
#include <vector>

namespace orvo {

/// Brings every symbol of a basis to its side, by the dual simplex method.
///
/// It takes a symbol off its side and asks what the cheapest way is to move it to its target: to
/// let another symbol leave its target, or to pay the symbol's own price. Prices are compared level
/// by level, strongest first, so that no number of weak errors outweighs a strong one.
class DualSimplex {
public:
    using Symbol = SimplexBasis::Symbol;

    enum class Outcome : std::uint8_t {
        Solved,
        Impossible, ///< a required constraint cannot hold; see `impossibleRow`
        Stalled,    ///< not done within the bound on steps, which only rounding can bring about
    };

    /// Whose errors are dealt with.
    enum class Scope : std::uint8_t { RequiredOnly, All };

    /// After `forgetSides`, or where only targets changed and rows were inserted since a run that
    /// solved it. No two runs with the same basis differ.
    [[nodiscard]] Outcome run(SimplexBasis& basis, Scope scope);

    /// The row that proves `Impossible`: its symbol and those of its columns contradict one
    /// another, and would not if any one of them were left out.
    [[nodiscard]] Symbol impossibleRow() const noexcept { return _impossibleRow; }
    /// Whether the last run changed the basis or a side.
    [[nodiscard]] bool didWork() const noexcept { return _steps != 0; }

private:
    /// A column that may move to help a row.
    struct Candidate {
        SimplexBasis::Place place = SparseTableau::None;
        std::size_t prices = 0; ///< where its prices begin, one a level
        double size = 0;        ///< of its coefficient
    };

    [[nodiscard]] std::optional<Symbol> firstWrong(SimplexBasis& basis, Scope scope);
    [[nodiscard]] bool step(SimplexBasis& basis, Symbol row);
    void collect(const SimplexBasis& basis, Symbol row, bool mustRise);
    void addCandidate(const SimplexBasis& basis, SimplexBasis::Place place, bool rises);
    [[nodiscard]] bool isFlipCheapest(const SimplexBasis& basis, Symbol row, int ownPrice);
    [[nodiscard]] double keepCheapest(std::uint32_t level);
    [[nodiscard]] const Candidate& choose(const SimplexBasis& basis) const noexcept;

    std::vector<Candidate> _candidates;
    std::vector<double> _prices;
    std::size_t _steps = 0;
    Symbol _impossibleRow = 0;
    bool _isCautious = false;
};

} // namespace orvo
