#include "platform/uikit/solver/LinearConstraint.h"

namespace orvo {

std::string_view describe(SolverRefusal refusal) noexcept {
    switch (refusal) {
    case SolverRefusal::None:
        return "";
    case SolverRefusal::UnknownVariable:
        return "The variable is not one of this solver.";
    case SolverRefusal::UnknownConstraint:
        return "The constraint is not one of this solver.";
    case SolverRefusal::NotFinite:
        return "A constant, coefficient or priority is infinite or not a number.";
    case SolverRefusal::ConstantTooLarge:
        return "The constant lies beyond ten million.";
    case SolverRefusal::CoefficientOutOfRange:
        return "A coefficient is neither 0 nor between a thousandth and a thousand.";
    case SolverRefusal::PriorityOutOfRange:
        return "The priority is not between 1 and 1000.";
    case SolverRefusal::StillInUse:
        return "A constraint still names the variable.";
    }
    return "";
}

} // namespace orvo
