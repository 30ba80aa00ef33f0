#pragma once

#include "platform/uikit/solver/SimplexBasis.h"

#include <cstddef>
#include <optional>
#include <span>
#include <vector>

namespace orvo {

/// Chooses among equally good solutions the one whose variables are nearest to zero: the first
/// variable first, each later one as far as those before it leave it free. There is exactly one, so
/// the values never depend on how they were come by.
class TieBreaker {
public:
    using Symbol = SimplexBasis::Symbol;

    enum class Outcome : std::uint8_t {
        Unique, ///< there was but one solution
        Chosen,
        Stalled, ///< not done within the bound on steps, which only rounding can bring about
    };

    /// All symbols must be on their sides; `variables` are those present, in order.
    [[nodiscard]] Outcome run(SimplexBasis& basis, std::span<const Symbol> variables);

private:
    struct Entering {
        SimplexBasis::Place place = SparseTableau::None;
        bool rises = false;
    };

    void collect(SimplexBasis& basis);
    void lock(SimplexBasis& basis, Symbol symbol) noexcept;
    [[nodiscard]] bool settle(SimplexBasis& basis, Symbol variable);
    [[nodiscard]] std::optional<Entering> entering(const SimplexBasis& basis,
                                                   Symbol variable) const noexcept;
    void lockRow(SimplexBasis& basis, Symbol row) noexcept;
    void move(SimplexBasis& basis, Symbol variable, Entering entering);

    std::vector<double> _prices;
    std::size_t _freeCount = 0;
    std::size_t _stepsLeft = 0;
};

} // namespace orvo
