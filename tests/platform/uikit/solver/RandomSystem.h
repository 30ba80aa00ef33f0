#pragma once

#include "platform/uikit/solver/ExactSolver.h"
#include "platform/uikit/solver/LayoutSolver.h"

#include <random>
#include <vector>

namespace orvo::test {

/// Small systems by chance, the same from the same seed, which are full of ties and constraints
/// that say the same. Of odd seeds they are full of conflicts too, of even ones those are rare.
class RandomSystem {
public:
    explicit RandomSystem(std::uint32_t seed)
        : _hasConflicts(seed % 2 != 0)
        , _random(seed) {}

    /// From 0 to `count` − 1. Not a standard distribution: those differ between libraries.
    [[nodiscard]] std::size_t pick(std::size_t count) { return _random() % count; }

    [[nodiscard]] ExactConstraint constraint(std::size_t variables) {
        ExactConstraint made;
        made.coefficients.assign(variables, 0);
        for (std::size_t term = 0; term < 1 + pick(3); ++term)
            made.coefficients[pick(variables)] = Coefficients[pick(std::size(Coefficients))];
        made.constant = constant();
        made.relation = static_cast<LinearRelation>(pick(3));
        made.priority = priority();
        return made;
    }
    [[nodiscard]] std::int64_t constant() { return static_cast<std::int64_t>(pick(9)) * 5 - 20; }
    [[nodiscard]] int priority() {
        const std::size_t share = _hasConflicts ? 3 : 8;
        return pick(share) == 0 ? 1000 : Priorities[pick(std::size(Priorities))];
    }

private:
    static constexpr std::int64_t Coefficients[] = {2, 2, 2, -2, -2, -2, 1, -1, 4, -6};
    static constexpr int Priorities[] = {750, 750, 749, 250, 250, 251, 999};

    bool _hasConflicts;
    std::mt19937 _random;
};

/// The constraint as the solver takes it.
[[nodiscard]] inline SolverConstraint make(LayoutSolver& solver,
                                           const std::vector<SolverVariable>& variables,
                                           const ExactConstraint& given) {
    std::vector<LinearTerm> terms;
    for (std::size_t index = 0; index < variables.size(); ++index)
        terms.push_back({variables[index], static_cast<double>(given.coefficients[index]) / 2});
    return solver
        .makeConstraint(terms,
                        given.relation,
                        static_cast<double>(given.constant) / 2,
                        static_cast<float>(given.priority))
        .constraint;
}

} // namespace orvo::test
