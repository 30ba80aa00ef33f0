#pragma once

#include "platform/uikit/solver/LinearConstraint.h"

#include <cstdint>
#include <vector>

namespace orvo::test {

/// A constraint in whole halves, so that it can be solved without rounding.
struct ExactConstraint {
    std::vector<std::int64_t> coefficients; ///< halves, one a variable
    std::int64_t constant = 0;              ///< halves
    LinearRelation relation = LinearRelation::Equal;
    int priority = 1000;
};

/// A second, slow solver that shares nothing with the first but the definition of the solution: it
/// tries every point in which as many constraints (or variables being zero) as there are variables
/// meet, all in whole numbers. For up to four variables and about a dozen constraints.
class ExactSolver {
public:
    /// Constraints are in the order in which they were made.
    ExactSolver(std::size_t variables, std::vector<ExactConstraint> constraints);

    [[nodiscard]] const std::vector<double>& values() const noexcept { return _values; }
    /// Which required constraints were left out, by index.
    [[nodiscard]] const std::vector<std::size_t>& dropped() const noexcept { return _dropped; }
    /// Whether these constraints can hold together.
    [[nodiscard]] bool canHold(const std::vector<std::size_t>& indices) const;

private:
    /// Numerators and their common, positive denominator.
    struct Point {
        std::vector<std::int64_t> numerators;
        std::int64_t denominator = 1;
    };

    void collectPoints(std::vector<std::size_t>& chosen, std::size_t next);
    void addPoint(const std::vector<std::size_t>& chosen);
    [[nodiscard]] std::int64_t error(std::size_t constraint, const Point& point) const;
    [[nodiscard]] std::vector<std::int64_t> badness(const Point& point) const;
    void choose();

    std::size_t _variables;
    std::vector<ExactConstraint> _constraints;
    std::vector<Point> _points;
    std::vector<std::size_t> _kept;
    std::vector<std::size_t> _dropped;
    std::vector<double> _values;
};

} // namespace orvo::test
