#include "platform/uikit/solver/ExactSolver.h"

#include <algorithm>
#include <cstdlib>
#include <functional>
#include <map>

namespace orvo::test {

namespace {

using Matrix = std::vector<std::vector<std::int64_t>>;

std::int64_t determinant(const Matrix& matrix) {
    if (matrix.size() == 1)
        return matrix[0][0];
    std::int64_t sum = 0;
    for (std::size_t column = 0; column < matrix.size(); ++column) {
        if (matrix[0][column] == 0)
            continue;
        Matrix minor(matrix.begin() + 1, matrix.end());
        for (auto& row : minor)
            row.erase(row.begin() + static_cast<std::ptrdiff_t>(column));
        sum += (column % 2 == 0 ? 1 : -1) * matrix[0][column] * determinant(minor);
    }
    return sum;
}

/// Compares fractions one after the other.
bool isLess(const std::vector<std::int64_t>& a,
            std::int64_t denominatorOfA,
            const std::vector<std::int64_t>& b,
            std::int64_t denominatorOfB) {
    for (std::size_t place = 0; place < a.size(); ++place) {
        const std::int64_t left = a[place] * denominatorOfB;
        const std::int64_t right = b[place] * denominatorOfA;
        if (left != right)
            return left < right;
    }
    return false;
}

} // namespace

ExactSolver::ExactSolver(std::size_t variables, std::vector<ExactConstraint> constraints)
    : _variables(variables)
    , _constraints(std::move(constraints)) {
    std::vector<std::size_t> chosen;
    collectPoints(chosen, 0);
    for (std::size_t index = 0; index < _constraints.size(); ++index) {
        if (_constraints[index].priority < 1000)
            continue;
        _kept.push_back(index);
        if (!canHold(_kept)) {
            _kept.pop_back();
            _dropped.push_back(index);
        }
    }
    choose();
}

bool ExactSolver::canHold(const std::vector<std::size_t>& indices) const {
    return std::any_of(_points.begin(), _points.end(), [&](const Point& point) {
        return std::all_of(indices.begin(), indices.end(), [&](std::size_t index) {
            return error(index, point) == 0;
        });
    });
}

void ExactSolver::collectPoints(std::vector<std::size_t>& chosen, std::size_t next) {
    if (chosen.size() == _variables) {
        addPoint(chosen);
        return;
    }
    for (std::size_t plane = next; plane < _constraints.size() + _variables; ++plane) {
        chosen.push_back(plane);
        collectPoints(chosen, plane + 1);
        chosen.pop_back();
    }
}

/// Planes beyond the constraints are those on which a variable is zero. Cramer's rule.
void ExactSolver::addPoint(const std::vector<std::size_t>& chosen) {
    Matrix matrix;
    std::vector<std::int64_t> right;
    for (const std::size_t plane : chosen) {
        matrix.emplace_back(_variables, 0);
        if (plane < _constraints.size()) {
            matrix.back() = _constraints[plane].coefficients;
            right.push_back(-_constraints[plane].constant);
        } else {
            matrix.back()[plane - _constraints.size()] = 1;
            right.push_back(0);
        }
    }
    const std::int64_t whole = determinant(matrix);
    if (whole == 0)
        return;
    Point point{.numerators = {}, .denominator = std::abs(whole)};
    for (std::size_t variable = 0; variable < _variables; ++variable) {
        Matrix replaced = matrix;
        for (std::size_t row = 0; row < _variables; ++row)
            replaced[row][variable] = right[row];
        point.numerators.push_back(determinant(replaced) * (whole < 0 ? -1 : 1));
    }
    _points.push_back(std::move(point));
}

/// In halves of the point's denominator.
std::int64_t ExactSolver::error(std::size_t constraint, const Point& point) const {
    const ExactConstraint& given = _constraints[constraint];
    std::int64_t sum = given.constant * point.denominator;
    for (std::size_t variable = 0; variable < _variables; ++variable)
        sum += given.coefficients[variable] * point.numerators[variable];
    if (given.relation == LinearRelation::LessOrEqual)
        return std::max<std::int64_t>(0, sum);
    if (given.relation == LinearRelation::GreaterOrEqual)
        return std::max<std::int64_t>(0, -sum);
    return std::abs(sum);
}

/// What is to be small, the most important first.
std::vector<std::int64_t> ExactSolver::badness(const Point& point) const {
    std::map<int, std::int64_t, std::greater<>> levels;
    for (std::size_t index = 0; index < _constraints.size(); ++index) {
        if (_constraints[index].priority < 1000)
            levels[_constraints[index].priority] += error(index, point);
    }
    std::vector<std::int64_t> result;
    for (const auto& [priority, sum] : levels)
        result.push_back(sum);
    for (const std::int64_t numerator : point.numerators)
        result.push_back(std::abs(numerator));
    return result;
}

void ExactSolver::choose() {
    const Point* best = nullptr;
    std::vector<std::int64_t> least;
    for (const Point& point : _points) {
        if (!std::all_of(_kept.begin(), _kept.end(), [&](std::size_t index) {
                return error(index, point) == 0;
            }))
            continue;
        std::vector<std::int64_t> own = badness(point);
        const bool isBetter = !best || isLess(own, point.denominator, least, best->denominator);
        if (isBetter) {
            best = &point;
            least = std::move(own);
        }
    }
    for (const std::int64_t numerator : best->numerators)
        _values.push_back(static_cast<double>(numerator) / static_cast<double>(best->denominator));
}

} // namespace orvo::test
