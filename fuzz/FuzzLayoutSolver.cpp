#include "platform/uikit/solver/LayoutSolver.h"

#include <cmath>
#include <cstdlib>
#include <vector>

namespace {

using namespace orvo;

/// Reads small numbers until the bytes are used up, then zeros.
class Bytes {
public:
    Bytes(const std::uint8_t* data, std::size_t size)
        : _at(data)
        , _end(data + size) {}

    [[nodiscard]] bool isAtEnd() const { return _at == _end; }
    std::uint8_t next() { return isAtEnd() ? std::uint8_t{0} : *_at++; }
    std::size_t below(std::size_t count) { return next() % count; }

private:
    const std::uint8_t* _at;
    const std::uint8_t* _end;
};

/// A constraint as it was asked for, so that it can be made again.
struct Request {
    std::vector<std::pair<std::size_t, double>> terms;
    LinearRelation relation = LinearRelation::Equal;
    double constant = 0;
    float priority = 1000;
    bool isAdded = true;
    SolverConstraint made;
};

constexpr std::size_t MaximumVariables = 12;
constexpr std::size_t MaximumConstraints = 40;

void require(bool condition) {
    if (!condition)
        std::abort();
}

double constantOf(Bytes& bytes) {
    return static_cast<double>(bytes.below(41)) * 5 - 100;
}

float priorityOf(Bytes& bytes) {
    constexpr float Priorities[] = {1000, 1000, 999, 750, 749.5F, 250, 1, 1000};
    return Priorities[bytes.below(std::size(Priorities))];
}

Request requestOf(Bytes& bytes, std::size_t variables) {
    constexpr double Coefficients[] = {1, -1, 1, -1, 0.5, -0.5, 2, -3};
    Request request;
    for (std::size_t count = bytes.below(4); count > 0; --count) {
        const std::size_t variable = bytes.below(variables);
        request.terms.emplace_back(variable, Coefficients[bytes.below(std::size(Coefficients))]);
    }
    request.relation = static_cast<LinearRelation>(bytes.below(3));
    request.constant = constantOf(bytes);
    request.priority = priorityOf(bytes);
    return request;
}

/// A solver, and what was asked of it.
struct Playground {
    LayoutSolver solver;
    std::vector<SolverVariable> variables;
    std::vector<Request> requests;

    explicit Playground(std::size_t count) {
        for (std::size_t index = 0; index < count; ++index)
            variables.push_back(solver.makeVariable());
    }

    void make(Request request) {
        std::vector<LinearTerm> terms;
        for (const auto& [variable, coefficient] : request.terms)
            terms.push_back({variables[variable], coefficient});
        const auto made =
            solver.makeConstraint(terms, request.relation, request.constant, request.priority);
        require(made.refusal == SolverRefusal::None);
        request.made = made.constraint;
        if (request.isAdded)
            require(solver.add(request.made) == SolverRefusal::None);
        requests.push_back(std::move(request));
    }

    void change(Bytes& bytes) {
        const std::uint8_t kind = bytes.next();
        if (requests.empty() || (kind % 8 < 3 && requests.size() < MaximumConstraints)) {
            make(requestOf(bytes, variables.size()));
            return;
        }
        const std::size_t index = bytes.below(requests.size());
        Request& request = requests[index];
        switch (kind % 8) {
        case 3:
            require(solver.destroy(request.made) == SolverRefusal::None);
            requests.erase(requests.begin() + static_cast<std::ptrdiff_t>(index));
            break;
        case 4:
            request.isAdded = !request.isAdded;
            require((request.isAdded ? solver.add(request.made) : solver.remove(request.made)) ==
                    SolverRefusal::None);
            break;
        case 5:
            request.priority = priorityOf(bytes);
            require(solver.setPriority(request.made, request.priority) == SolverRefusal::None);
            break;
        default:
            request.constant = constantOf(bytes);
            require(solver.setConstant(request.made, request.constant) == SolverRefusal::None);
        }
    }

    /// What is required holds, but for what is reported.
    void checkRequired(const SolverOutcome& outcome) const {
        std::size_t dropped = 0;
        for (const Request& request : requests) {
            if (!request.isAdded || request.priority < SolverLimits::RequiredPriority)
                continue;
            if (solver.isDropped(request.made))
                ++dropped;
            else
                require(solver.error(request.made) < 1e-3);
        }
        require(dropped == outcome.conflicts.size());
        for (const SolverConflict& conflict : outcome.conflicts)
            require(!conflict.members.empty() && conflict.members.back() == conflict.dropped &&
                    solver.isDropped(conflict.dropped));
    }

    /// The way to a solution leaves no trace in it.
    void checkAgainstNothing() const {
        Playground fresh(variables.size());
        for (const Request& request : requests)
            fresh.make(request);
        require(!fresh.solver.solve().isStalled);
        for (std::size_t index = 0; index < variables.size(); ++index) {
            const double value = solver.value(variables[index]);
            const double expected = fresh.solver.value(fresh.variables[index]);
            require(std::abs(value - expected) <= 1e-4 + 1e-7 * std::abs(expected));
        }
    }
};

} // namespace

/// Whatever is asked, in whatever order: what is required holds or is reported, and the solution is
/// the one that is found from nothing.
extern "C" int LLVMFuzzerTestOneInput(const std::uint8_t* data, std::size_t size) {
    Bytes bytes(data, size);
    Playground playground(1 + bytes.below(MaximumVariables));
    while (!bytes.isAtEnd()) {
        for (std::size_t count = 1 + bytes.below(4); count > 0; --count)
            playground.change(bytes);
        const SolverOutcome outcome = playground.solver.solve();
        require(!outcome.isStalled);
        playground.checkRequired(outcome);
        playground.checkAgainstNothing();
    }
    return 0;
}
