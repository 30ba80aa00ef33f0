#include "platform/uikit/_ContentConstraints.h"

#include <algorithm>
#include <cmath>
#include <cstdio>

namespace orvo {

namespace {

// One line of a text gives way only after the further lines of every other text, but before what
// says where texts stand.
constexpr UILayoutPriority FirstLinePriority = 749.5;
// Far below a pixel, far above what the solver rounds to.
constexpr CGFloat Tolerance = 0.001;

} // namespace

void _ContentConstraints::update(LayoutSolver& solver,
                                 const _LayoutVariables& variables,
                                 const UIView& view) {
    const auto size = view.intrinsicContentSize();
    const auto put =
        [&](Kind kind, SolverVariable variable, CGFloat length, UILayoutPriority priority) {
            if (length < 0)
                clear(solver, kind);
            else
                set(solver, kind, variable, length, priority);
        };
    constexpr auto Horizontal = UILayoutConstraintAxis::Horizontal;
    constexpr auto Vertical = UILayoutConstraintAxis::Vertical;
    put(WidthHugging, variables.width, size.width, view.contentHuggingPriorityForAxis(Horizontal));
    put(WidthResistance,
        variables.width,
        size.width,
        view.contentCompressionResistancePriorityForAxis(Horizontal));
    const CGFloat solvedWidth = solver.value(variables.width);
    const auto wrapped = view._intrinsicHeightForWidth(solvedWidth > 0 ? solvedWidth : size.width);
    const auto height = wrapped.value_or(size.height);
    const auto resistance = view.contentCompressionResistancePriorityForAxis(Vertical);
    put(HeightHugging, variables.height, height, view.contentHuggingPriorityForAxis(Vertical));
    put(HeightResistance, variables.height, height, resistance);
    _wraps = wrapped.has_value();
    _firstLine = _wraps ? view._wholeLinesWithin(solvedWidth, 0).value_or(0) : -1;
    put(FirstLine, variables.height, _firstLine, std::max(resistance, FirstLinePriority));
}

void _ContentConstraints::remove(LayoutSolver& solver) {
    for (int kind = 0; kind < Kinds; ++kind)
        clear(solver, static_cast<Kind>(kind));
    _wraps = false;
}

bool _ContentConstraints::fitHeight(LayoutSolver& solver,
                                    const _LayoutVariables& variables,
                                    const UIView& view) {
    if (!_wraps)
        return false;
    const auto height = view._intrinsicHeightForWidth(solver.value(variables.width));
    return height && setHeight(solver, variables, *height);
}

bool _ContentConstraints::canDropLines(const LayoutSolver& solver,
                                       const _LayoutVariables& variables) const {
    const auto wanted = _parts[HeightResistance].size;
    return _wraps && wanted > _firstLine + Tolerance &&
           solver.value(variables.height) < wanted - Tolerance;
}

bool _ContentConstraints::dropLines(LayoutSolver& solver,
                                    const _LayoutVariables& variables,
                                    const UIView& view) {
    const auto whole = view._wholeLinesWithin(solver.value(variables.width),
                                              solver.value(variables.height) + Tolerance);
    return whole && setHeight(solver, variables, *whole);
}

bool _ContentConstraints::setHeight(LayoutSolver& solver,
                                    const _LayoutVariables& variables,
                                    CGFloat height) {
    if (std::abs(height - _parts[HeightResistance].size) < Tolerance)
        return false;
    for (const auto kind : {HeightHugging, HeightResistance})
        set(solver, kind, variables.height, height, _parts.at(kind).priority);
    return true;
}

void _ContentConstraints::set(LayoutSolver& solver,
                              Kind kind,
                              SolverVariable variable,
                              CGFloat size,
                              UILayoutPriority priority) {
    auto& part = _parts.at(kind);
    if (!part.handle) {
        const bool hugging = kind == WidthHugging || kind == HeightHugging;
        const LinearTerm term{variable, 1};
        part.handle = solver
                          .makeConstraint({&term, 1},
                                          hugging ? LinearRelation::LessOrEqual
                                                  : LinearRelation::GreaterOrEqual,
                                          -size,
                                          static_cast<float>(priority))
                          .constraint;
        std::ignore = solver.add(part.handle);
    } else {
        if (part.size != size)
            std::ignore = solver.setConstant(part.handle, -size);
        if (part.priority != priority)
            std::ignore = solver.setPriority(part.handle, static_cast<float>(priority));
    }
    part.size = size;
    part.priority = priority;
}

void _ContentConstraints::clear(LayoutSolver& solver, Kind kind) {
    auto& part = _parts.at(kind);
    if (part.handle)
        std::ignore = solver.destroy(part.handle);
    part = {};
}

std::string _ContentConstraints::nameOf(SolverConstraint constraint) const {
    constexpr std::array Names{"width <=", "width >=", "height <=", "height >=", "height >="};
    for (std::size_t kind = 0; kind < _parts.size(); ++kind) {
        const auto& part = _parts.at(kind);
        if (part.handle != constraint)
            continue;
        char text[64];
        std::snprintf(
            text, sizeof text, "%s %g @%g (content)", Names.at(kind), part.size, part.priority);
        return text;
    }
    return {};
}

} // namespace orvo
