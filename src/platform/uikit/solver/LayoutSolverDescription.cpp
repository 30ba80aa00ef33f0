// What the solver says of itself, apart from what it does.

#include "platform/uikit/solver/LayoutSolver.h"

#include <algorithm>
#include <cstdio>
#include <cstdlib>

namespace orvo {

namespace {

std::string number(double value) {
    char text[32];
    std::snprintf(text, sizeof text, "%.9g", value);
    return text;
}

/// One summand of a sum that already has `text`.
void appendSummand(std::string& text, double factor, const std::string& name) {
    if (text.empty())
        text += factor < 0 ? "-" : "";
    else
        text += factor < 0 ? " - " : " + ";
    const std::string size = number(std::abs(factor));
    if (name.empty())
        text += size;
    else
        text += size == "1" ? name : size + " " + name;
}

const char* sign(LinearRelation relation) {
    switch (relation) {
    case LinearRelation::LessOrEqual:
        return " <= 0";
    case LinearRelation::GreaterOrEqual:
        return " >= 0";
    case LinearRelation::Equal:
        break;
    }
    return " = 0";
}

} // namespace

std::string LayoutSolver::describe(SolverConstraint constraint) const {
    const Record* const record = find(constraint);
    if (!record)
        return "";
    std::string sum;
    for (auto at = record->firstTerm; at != SparseTableau::None; at = _terms[at].next)
        appendSummand(sum,
                      _terms[at].coefficient,
                      "v" + std::to_string(_records[_terms[at].variable].serial));
    if (record->number != 0 || sum.empty())
        appendSummand(sum, record->number, "");
    std::string text = "c" + std::to_string(record->serial) + ": " + sum + sign(record->relation);
    if (record->priority < SolverLimits::RequiredPriority)
        text += " @" + number(static_cast<double>(record->priority));
    if (record->state == State::Idle)
        return text + ", not added";
    if (record->state == State::Dropped)
        text += ", left out";
    if (const double off = error(constraint); off > SimplexBasis::Tolerance)
        text += ", off by " + number(off);
    return text;
}

std::string LayoutSolver::describe() const {
    std::vector<SolverConstraint> constraints;
    for (Symbol symbol = 0; symbol < _records.size(); ++symbol) {
        if (_records[symbol].state > State::Variable)
            constraints.push_back({symbol, _records[symbol].serial});
    }
    std::sort(constraints.begin(), constraints.end());
    std::string text;
    for (const SolverConstraint constraint : constraints)
        text += describe(constraint) + "\n";
    for (const Symbol variable : _variables)
        text += "v" + std::to_string(_records[variable].serial) + " = " +
                number(_records[variable].number) + "\n";
    return text;
}

} // namespace orvo
