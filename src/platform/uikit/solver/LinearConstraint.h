#pragma once

#include <compare>
#include <cstdint>
#include <string_view>

namespace orvo {

/// Names a variable or a constraint of one `LayoutSolver`. Never names anything else once its
/// bearer is gone, however often the place is used again.
template <class Bearer>
struct SolverHandle {
    std::uint32_t index = 0;
    std::uint32_t serial = 0; ///< counts what the solver made; 0 names nothing

    [[nodiscard]] explicit operator bool() const noexcept { return serial != 0; }
    [[nodiscard]] friend bool operator==(SolverHandle, SolverHandle) noexcept = default;
    /// In the order in which they were made.
    [[nodiscard]] friend std::strong_ordering operator<=>(SolverHandle a, SolverHandle b) noexcept {
        return a.serial <=> b.serial;
    }
};

using SolverVariable = SolverHandle<struct SolverVariableTag>;
using SolverConstraint = SolverHandle<struct SolverConstraintTag>;

/// A variable as often as the coefficient says.
struct LinearTerm {
    SolverVariable variable;
    double coefficient = 1;
};

/// How the sum of terms and constant relates to zero.
enum class LinearRelation : std::uint8_t { LessOrEqual, Equal, GreaterOrEqual };

/// What is within the reach of the solver's arithmetic; anything else is refused when it is given.
struct SolverLimits {
    static constexpr float RequiredPriority = 1000;
    static constexpr float MinimumPriority = 1;
    static constexpr double MaximumConstant = 1e7;     ///< either sign
    static constexpr double MinimumCoefficient = 1e-3; ///< either sign; 0 leaves the term out
    static constexpr double MaximumCoefficient = 1e3;  ///< either sign
};

/// Why a request was turned down; nothing has changed then.
enum class SolverRefusal : std::uint8_t {
    None,
    UnknownVariable,   ///< never made by this solver, or destroyed
    UnknownConstraint, ///< never made by this solver, or destroyed
    NotFinite,         ///< a constant, coefficient or priority is infinite or no number
    ConstantTooLarge,
    CoefficientOutOfRange,
    PriorityOutOfRange, ///< not from 1 to 1000
    StillInUse,         ///< a constraint still names the variable
};

/// One sentence in English, for logs; empty for `None`.
[[nodiscard]] std::string_view describe(SolverRefusal refusal) noexcept;

} // namespace orvo
